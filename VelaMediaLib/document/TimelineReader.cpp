#include <VelaMediaLib/base/CaptionAttributes.h>
#include <VelaMediaLib/document/MixerReader.h>
#include <VelaMediaLib/document/TimelineReader.h>
#include <VelaMediaLib/document/TrackReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/timeline/GenericMixer.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/parameters/ValueTraits.h>

#include <cstdio>

namespace VelaMediaLib {

namespace {

template <typename T>
void readField(const Json::Value& object, const char* key, T& field) {
    if (const Json::Value* value = optionalMember(object, key)) field = ValueTraits<T>::read(*value);
}

CaptionAttributes readCaptionAttributes(const Json::Value& value, CaptionAttributes captions) {
    documentObject(value, "a captionAttributes object");
    readField(value, "enabled", captions.enabled);
    readField(value, "fontName", captions.fontName);
    readField(value, "fontSize", captions.fontSize);
    readField(value, "backgroundColor", captions.backgroundColor);
    readField(value, "foregroundColor", captions.foregroundColor);
    readField(value, "lang", captions.lang);
    readField(value, "alignment", captions.alignment);
    readField(value, "defaultFontSize", captions.defaultFontSize);
    readField(value, "opacity", captions.opacity);
    readField(value, "backgroundEnabled", captions.backgroundEnabled);
    readField(value, "backgroundOnlyAroundText", captions.backgroundOnlyAroundText);
    return captions;
}

} // namespace

std::string TimelineReader::sceneMixerName(const Json::Value& scene, unsigned index) {
    if (const Json::Value* name = optionalMember(scene, "ident")) return jsonValueAsString(*name);
    char text[32];
    std::snprintf(text, sizeof text, "scene%04u", index);
    return text;
}

bool TimelineReader::read(const Json::Value& value) {
    setValue(value);
    documentObject(value, "a timeline object");
    Project& project = *context().project;
    const TimelinePtr timeline = project.timeline();
    if (const Json::Value* id = optionalMember(value, idTagName())) {
        context().timelineId = jsonValueAsInt64(*id);
        context().hasTimelineId = true;
        context().takeId(context().timelineId);
    }
    std::vector<boost::shared_ptr<GenericMixer>> mixers;
    std::vector<std::string> names;
    if (const Json::Value* sceneTrack = optionalMember(value, "sceneTrack")) {
        documentObject(*sceneTrack, "a sceneTrack object");
        const Json::Value* scenes = optionalMember(*sceneTrack, "scenes");
        if (scenes) documentArray(*scenes, "an array of scenes");
        for (Json::ArrayIndex i = 0; scenes && i < scenes->size(); ++i) {
            const Json::Value& scene = documentObject((*scenes)[i], "a scene object");
            const auto mixer = GenericMixer::create(project.token());
            if (const Json::Value* velaml = optionalMember(scene, "velaml"))
                if (const Json::Value* tracks =
                        optionalMember(documentObject(*velaml, "a velaml object"), "tracks"))
                    MixerReader(readContext(), mixer).read(*tracks);
            mixers.push_back(mixer);
            names.push_back(sceneMixerName(scene, i));
        }
    }
    if (const Json::Value* attributes = optionalMember(value, "trackAttributes")) {
        documentArray(*attributes, "an array of track attributes");
        if (mixers.empty() || attributes->size() > mixers.front()->numTracks())
            refuseDocument("more trackAttributes than tracks");
        for (Json::ArrayIndex i = 0; i < attributes->size(); ++i)
            TrackReader::readTrackAttributes((*attributes)[i], *mixers.front()->trackAtIndex(i));
    }
    for (size_t i = 0; i < mixers.size(); ++i)
        readingWhere("scene " + std::to_string(i), [&] { timeline->addMixer(names[i], mixers[i]); });
    if (const Json::Value* captions = optionalMember(value, "captionAttributes"))
        timeline->setCaptionAttributes(readCaptionAttributes(*captions, timeline->captionAttributes()));
    if (const Json::Value* colour = optionalMember(value, "backgroundColor"))
        timeline->addAttribute("backgroundColor", ValueTraits<TemplatedColor<int>>::read(*colour));
    if (const Json::Value* gain = optionalMember(value, "gain"))
        timeline->addAttribute("gain", jsonValueAsDouble(*gain));
    if (const Json::Value* legacy = optionalMember(value, "legacyAttenuateAudioMix"))
        timeline->addAttribute("legacyAttenuateAudioMix", jsonValueAsBool(*legacy));
    if (const Json::Value* parameters = optionalMember(value, parametersTagName()))
        timeline->readParameterList(documentObject(*parameters, "an object of parameters"));
    readMetaData(value, *timeline);
    return true;
}

} // namespace VelaMediaLib

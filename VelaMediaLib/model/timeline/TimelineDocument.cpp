// The timeline's document object: its mixers as scenes, then its settings.
#include <VelaMediaLib/model/timeline/Timeline.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>

namespace VelaMediaLib {
namespace {

// A scene: {"velaml": {"tracks": [...]}, "ident": the mixer's name}. Only
// the first scene's tracks have "trackAttributes" entries; the others carry
// their flags on the track.
void writeScene(XMLOptions& options, int indent, const std::string& name, const Mixer& mixer, bool first) {
    JSONWriter scene(options, indent);
    options.key("velaml");
    {
        JSONWriter velaml(options, scene.memberLevel());
        options.key("tracks");
        JSONWriter tracks(options, velaml.memberLevel(), JSONWriter::Array);
        const Mixer::Tracks all = mixer.tracks();
        for (size_t index = 0; index < all.size(); ++index) {
            options.element();
            all[index]->toJSON(options, tracks.memberLevel(), int(index), !first);
        }
    }
    writeJSONMember(options, scene.memberLevel(), "ident", name);
}

} // namespace

void Timeline::toJSON(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    options.key("id") << options.assignNewIdent(this);
    const std::vector<std::string> names = mixerNames();
    std::vector<MixerPtr> scenes;
    for (const std::string& name : names) scenes.push_back(mixer(name));
    options.key("sceneTrack");
    {
        JSONWriter sceneTrack(options, members);
        options.key("scenes");
        JSONWriter array(options, sceneTrack.memberLevel(), JSONWriter::Array);
        for (size_t index = 0; index < scenes.size(); ++index) {
            if (!scenes[index]) continue; // removed meanwhile
            options.element();
            writeScene(options, array.memberLevel(), names[index], *scenes[index], index == 0);
        }
    }
    options.key("trackAttributes");
    {
        JSONWriter array(options, members, JSONWriter::Array);
        if (!scenes.empty() && scenes.front())
            for (const TrackPtr& track : scenes.front()->tracks()) {
                options.element();
                track->toJSONTrackAttributes(options, array.memberLevel());
            }
    }
    options.key("captionAttributes");
    captionAttributes().toJSON(options, members);
    writeAttributeMember(options, members, "backgroundColor", backgroundColor());
    writeAttributeMember(options, members, "gain", gain());
    writeAttributeMember(options, members, "legacyAttenuateAudioMix", legacyAttenuateAudioMixAttribute());
    toJSONParameterList(options, members);
    MetaDatable::toJSON(options, members, *this);
}

} // namespace VelaMediaLib

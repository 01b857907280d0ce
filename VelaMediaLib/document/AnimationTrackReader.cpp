#include <VelaMediaLib/document/AnimationTrackReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/document/format/detail/JSONTreeAccess.h>
#include <VelaMediaLib/model/media/AnimationTrack.h>
#include <VelaMediaLib/model/media/MediaImpl.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterFactory.h>

namespace VelaMediaLib {

namespace {

/// An interpolater code, checked against the known ones.
std::string readInterp(const Json::Value& animation) {
    const Json::Value* interp = optionalMember(animation, "interp");
    if (!interp) return std::string();
    const std::string code = jsonValueAsString(*interp);
    if (code.empty()) return code;
    InterpolaterFactory<double>::byName(code); // refuses a code no interpolater has
    return code;
}

AnimationTrack::Animation readAnimation(const Json::Value& value) {
    documentObject(value, "an animation object");
    AnimationTrack::Animation animation;
    if (const Json::Value* range = optionalMember(value, "range"))
        animation.range = jsonValueAsTickRange(*range);
    if (const Json::Value* end = optionalMember(value, "endTime"))
        animation.endTime = jsonValueAsVelaTime(*end);
    if (const Json::Value* duration = optionalMember(value, "duration"))
        animation.duration = jsonValueAsVelaTime(*duration);
    if (animation.range.second() < 0 || animation.duration < 0)
        refuseDocument("animation of negative duration");
    animation.interp = readInterp(value);
    if (const Json::Value* keyframes = optionalMember(value, "keyframes"))
        for (const Json::Value& entry : documentArray(*keyframes, "an array of animation keyframes")) {
            documentObject(entry, "an animation keyframe");
            AnimationTrack::KeyFrame keyframe;
            if (const Json::Value* name = optionalMember(entry, "parameterName"))
                keyframe.parameterName = jsonValueAsString(*name);
            if (const Json::Value* keyValue = optionalMember(entry, "value"))
                keyframe.value = jsonTreeFromValue(*keyValue);
            keyframe.interp = readInterp(entry);
            animation.keyframes.push_back(keyframe);
        }
    return animation;
}

} // namespace

AnimationTrackReader::AnimationTrackReader(const boost::shared_ptr<ReadContext>& context, Media& media)
    : JSONReader(context), media_(media) {}

AnimationTrack AnimationTrackReader::readTrack(const std::string& name, const Json::Value& animations) {
    std::vector<AnimationTrack::Animation> read;
    for (const Json::Value& entry : documentArray(animations, "an array of animations"))
        read.push_back(readAnimation(entry));
    return AnimationTrack(name, read);
}

bool AnimationTrackReader::read(const Json::Value& tracks) {
    setValue(tracks);
    documentObject(tracks, "an animationTracks object");
    auto* media = dynamic_cast<MediaImpl*>(&media_);
    if (!media) return false;
    for (auto it = tracks.begin(); it != tracks.end(); ++it)
        media->setAnimationTrack(readTrack(it.name(), *it));
    return true;
}

} // namespace VelaMediaLib

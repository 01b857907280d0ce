#include <VelaMediaLib/model/media/AnimationTrack.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>

namespace VelaMediaLib {
namespace {

void writeKeyFrame(XMLOptions& options, int indent, const AnimationTrack::KeyFrame& keyframe) {
    JSONWriter object(options, indent);
    writeJSONMember(options, object.memberLevel(), "parameterName", keyframe.parameterName);
    options.key("value");
    keyframe.value.write(options, object.memberLevel());
    writeJSONMember(options, object.memberLevel(), "interp", keyframe.interp);
}

void writeAnimation(XMLOptions& options, int indent, const AnimationTrack::Animation& animation) {
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    writeJSONMember(options, members, "range", animation.range);
    writeJSONMember(options, members, "endTime", (long long)animation.endTime);
    writeJSONMember(options, members, "duration", (long long)animation.duration);
    writeJSONMember(options, members, "interp", animation.interp);
    options.key("keyframes");
    JSONWriter keyframes(options, members, JSONWriter::Array);
    for (const AnimationTrack::KeyFrame& keyframe : animation.keyframes) {
        options.element();
        writeKeyFrame(options, keyframes.memberLevel(), keyframe);
    }
}

} // namespace

void AnimationTrack::toJSON(XMLOptions& options, int indent) const {
    JSONWriter array(options, indent, JSONWriter::Array);
    for (const AnimationTrack::Animation& animation : animations_) {
        options.element();
        writeAnimation(options, array.memberLevel(), animation);
    }
}

} // namespace VelaMediaLib

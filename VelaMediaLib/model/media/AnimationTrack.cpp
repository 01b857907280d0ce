#include <VelaMediaLib/model/media/AnimationTrack.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>

namespace VelaMediaLib {
namespace {

void writeKeyFrame(XMLOptions& options, int indent, const AnimationTrack::KeyFrame& keyframe) {
    JSONWriter object(options, indent);
    options.key("parameterName");
    writeJSONValue(options, object.memberLevel(), keyframe.parameterName);
    options.key("value");
    keyframe.value.write(options, object.memberLevel());
    options.key("interp");
    writeJSONValue(options, object.memberLevel(), keyframe.interp);
}

void writeAnimation(XMLOptions& options, int indent, const AnimationTrack::Animation& animation) {
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    options.key("range");
    writeJSONValue(options, members, animation.range);
    options.key("endTime");
    writeJSONValue(options, members, (long long)animation.endTime);
    options.key("duration");
    writeJSONValue(options, members, (long long)animation.duration);
    options.key("interp");
    writeJSONValue(options, members, animation.interp);
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

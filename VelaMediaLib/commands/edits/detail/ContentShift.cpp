#include <VelaMediaLib/commands/edits/detail/ContentShift.h>

#include <VelaMediaLib/model/media/MediaImpl.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>

namespace VelaMediaLib {
namespace detail {

namespace {

void shiftAnimations(Media& media, VelaTime by) {
    MediaImpl* const impl = dynamic_cast<MediaImpl*>(&media);
    if (!impl) return;
    for (const auto& entry : impl->animationTracks()) {
        std::vector<AnimationTrack::Animation> animations = entry.second.animations();
        for (AnimationTrack::Animation& animation : animations) {
            animation.range = Range<long long>(animation.range.start() + by, animation.range.duration());
            animation.endTime += by;
        }
        impl->setAnimationTrack(AnimationTrack(entry.first, animations));
    }
}

} // namespace

void shiftKeyframesAndAnimations(Media& media, VelaTime by) {
    if (by == 0 || dynamic_cast<StitchedMedia*>(&media)) return;
    for (const std::string& name : media.parameterNames())
        if (media.hasMadeParameter(name))
            media.parameter(name)->moveKeyframes(RationalTime(by), [](const RationalTime&) { return true; });
    shiftAnimations(media, by);
}

} // namespace detail
} // namespace VelaMediaLib

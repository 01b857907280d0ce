#include <VelaMediaLib/commands/edits/AddAnimationCmd.h>

namespace VelaMediaLib {

void AddAnimationCmd::checkAddition(const MediaPtr& media, const std::string& name,
                                    const Animation& animation) {
    if (!media) throw VelaMediaLibException("no clip to animate");
    checkParameter(media, name);
    checkLength(animation.range.duration());
    if (animation.range.start() < 0)
        throw ValueException<long long>("an animation starts at or after its clip's start",
                                        animation.range.start());
    checkInterpolaterCode(animation.interp);
}

boost::shared_ptr<AddAnimationCmd> AddAnimationCmd::create(const MediaPtr& media,
                                                           const std::string& parameterName,
                                                           const Range<VelaTime>& range,
                                                           const std::string& interpolater) {
    Animation animation;
    animation.range = Range<long long>(range.start(), range.duration());
    animation.endTime = range.end();
    animation.duration = range.duration();
    animation.interp = interpolater;
    checkAddition(media, parameterName, animation);
    boost::shared_ptr<AddAnimationCmd> command(new AddAnimationCmd(media, parameterName, animation));
    command->setName("Add Animation");
    return command;
}

bool AddAnimationCmd::edit(AnimationLists& lists) const {
    lists[name_].push_back(animation_); // an overlap refuses the changed track
    return true;
}

boost::shared_ptr<AddAnimationWithDescriptionCmd>
AddAnimationWithDescriptionCmd::create(const MediaPtr& media, const std::string& parameterName,
                                       const AnimationTrack::Animation& animation) {
    checkAddition(media, parameterName, animation);
    if (animation.endTime != animation.range.end())
        throw ValueException<long long>("an animation ends at its range's end", animation.endTime);
    if (animation.duration < 0 || animation.duration > animation.range.duration())
        throw ValueException<long long>("an animation leads in over at most its length", animation.duration);
    for (const AnimationTrack::KeyFrame& keyframe : animation.keyframes) {
        checkParameter(media, keyframe.parameterName);
        checkInterpolaterCode(keyframe.interp);
    }
    boost::shared_ptr<AddAnimationWithDescriptionCmd> command(
        new AddAnimationWithDescriptionCmd(media, parameterName, animation));
    command->setName("Add Animation");
    return command;
}

} // namespace VelaMediaLib

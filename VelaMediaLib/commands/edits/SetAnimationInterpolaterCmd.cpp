#include <VelaMediaLib/commands/edits/SetAnimationInterpolaterCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<SetAnimationInterpolaterCmd>
SetAnimationInterpolaterCmd::create(const MediaPtr& media, const std::string& parameterName, VelaTime start,
                                    const std::string& interpolater) {
    checkInterpolaterCode(interpolater);
    boost::shared_ptr<SetAnimationInterpolaterCmd> command(
        new SetAnimationInterpolaterCmd(media, parameterName, start, interpolater));
    command->setName("Set Animation Interpolater");
    return command;
}

bool SetAnimationInterpolaterCmd::edit(AnimationLists& lists) const {
    Animation* found = find(lists, name_, start_);
    if (!found) return false;
    found->interp = code_; // the same code changes nothing, which refuses the command
    return true;
}

boost::shared_ptr<SetAnimationAutoInterpolationCmd>
SetAnimationAutoInterpolationCmd::create(const MediaPtr& media, const std::string& parameterName,
                                         bool automatic, const std::string& fixed) {
    if (fixed.empty())
        throw VelaMediaLibException("no fixed interpolater code to turn automatic curves into");
    checkInterpolaterCode(fixed);
    boost::shared_ptr<SetAnimationAutoInterpolationCmd> command(
        new SetAnimationAutoInterpolationCmd(media, parameterName, automatic, fixed));
    command->setName(automatic ? "Automatic Animation Curves" : "Fixed Animation Curves");
    return command;
}

bool SetAnimationAutoInterpolationCmd::edit(AnimationLists& lists) const {
    const auto found = lists.find(name_);
    if (found == lists.end()) return false;
    for (Animation& animation : found->second) {
        if (automatic_)
            animation.interp.clear();
        else if (animation.interp.empty())
            animation.interp = fixed_;
    }
    return true;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/RemoveParameterKeyFrameCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<RemoveParameterKeyFrameCmd>
RemoveParameterKeyFrameCmd::create(const ParameterPtr& parameter, const RationalTime& time) {
    if (!parameter) throw VelaMediaLibException("no parameter to remove a keyframe of");
    boost::shared_ptr<RemoveParameterKeyFrameCmd> command(new RemoveParameterKeyFrameCmd(parameter, time));
    command->setName("Remove Keyframe");
    return command;
}

bool RemoveParameterKeyFrameCmd::edit() {
    track(parameter_);
    bool removed = false;
    visitTypedParameter(*parameter_, [&](auto& typed) { removed = bool(typed.removeKeyFrame(time_)); });
    return removed;
}

boost::shared_ptr<RemoveAllKeyFramesCmd> RemoveAllKeyFramesCmd::create(const ParameterPtr& parameter,
                                                                       const RationalTime& valueAt) {
    if (!parameter) throw VelaMediaLibException("no parameter to remove keyframes of");
    boost::shared_ptr<RemoveAllKeyFramesCmd> command(new RemoveAllKeyFramesCmd(parameter, valueAt));
    command->setName("Remove All Keyframes");
    return command;
}

bool RemoveAllKeyFramesCmd::edit() {
    track(parameter_);
    visitTypedParameter(*parameter_,
                        [&](auto& typed) { typed.setDefaultValue(typed.valueAtTime(valueAt_)); });
    return true; // a curve that was already just that is unchanged, which refuses the command
}

} // namespace VelaMediaLib

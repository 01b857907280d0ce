#include <VelaMediaLib/commands/edits/MoveParameterKeyFrameCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<MoveParameterKeyFrameCmd> MoveParameterKeyFrameCmd::create(const ParameterPtr& parameter,
                                                                             const RationalTime& from,
                                                                             const RationalTime& to) {
    if (!parameter) throw VelaMediaLibException("no parameter to move a keyframe of");
    boost::shared_ptr<MoveParameterKeyFrameCmd> command(new MoveParameterKeyFrameCmd(parameter, from, to));
    command->setName("Move Keyframe");
    return command;
}

bool MoveParameterKeyFrameCmd::edit() {
    if (!parameter_->hasKeyFrameAtTime(from_) || from_ == to_) return false;
    track(parameter_);
    parameter_->moveKeyFrame(from_, to_); // a KeyFrameException refuses the command
    return true;
}

} // namespace VelaMediaLib

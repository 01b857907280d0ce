#include <VelaMediaLib/commands/edits/MoveEdgeModCmd.h>

#include <algorithm>

namespace VelaMediaLib {

VelaTime MoveSideEdgeModCmd::movedDuration(VelaTime before) const {
    const VelaTime reach = media_->duration() + before + 1;
    const VelaTime delta = std::max(-reach, std::min(reach, delta_));
    return edge_ == EdgeModCommandHandler::Left ? before + delta : before - delta;
}

bool MoveSideEdgeModCmd::execute(CommandHandler* handler) {
    position();
    if (delta_ == 0) return false;
    const VelaTime before = modification_->duration();
    const VelaTime after = movedDuration(before);
    checkFits(after);
    if (!edgeHandler(handler).setEdgeModificationDuration(media_, edge_, modification_, after)) return false;
    before_ = before;
    after_ = after;
    return true;
}

bool MoveSideEdgeModCmd::unexecute(CommandHandler* handler) {
    return edgeHandler(handler).setEdgeModificationDuration(media_, edge_, modification_, before_);
}

// Redo gives the duration the move gave, so that a combined move whose
// deltas cancel still replays.
bool MoveSideEdgeModCmd::reexecute(CommandHandler* handler) {
    return edgeHandler(handler).setEdgeModificationDuration(media_, edge_, modification_, after_);
}

CommandPtr MoveSideEdgeModCmd::combine(const CommandPtr& later) {
    const boost::shared_ptr<MoveSideEdgeModCmd> move = boost::dynamic_pointer_cast<MoveSideEdgeModCmd>(later);
    if (!move || move->media_ != media_ || move->edge_ != edge_ || move->modification_ != modification_ ||
        move->handler_ != handler_)
        return Command::combine(later);
    delta_ += move->delta_;
    after_ = move->after_;
    return shared_from_this();
}

boost::shared_ptr<MoveLeftEdgeModCmd> MoveLeftEdgeModCmd::create(const MediaPtr& media,
                                                                 const EdgeModificationPtr& modification,
                                                                 VelaTime delta,
                                                                 const EdgeModCommandHandlerPtr& handler) {
    const boost::shared_ptr<MoveLeftEdgeModCmd> command(
        new MoveLeftEdgeModCmd(media, EdgeModCommandHandler::Left, modification, delta, handler));
    command->setName("Move Left Edge Modification");
    return command;
}

boost::shared_ptr<MoveRightEdgeModCmd> MoveRightEdgeModCmd::create(const MediaPtr& media,
                                                                   const EdgeModificationPtr& modification,
                                                                   VelaTime delta,
                                                                   const EdgeModCommandHandlerPtr& handler) {
    const boost::shared_ptr<MoveRightEdgeModCmd> command(
        new MoveRightEdgeModCmd(media, EdgeModCommandHandler::Right, modification, delta, handler));
    command->setName("Move Right Edge Modification");
    return command;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/RemoveEdgeModCmd.h>

namespace VelaMediaLib {

bool RemoveSideEdgeModCmd::execute(CommandHandler* handler) {
    index_ = position();
    return edgeHandler(handler).removeEdgeModification(media_, edge_, modification_);
}

bool RemoveSideEdgeModCmd::unexecute(CommandHandler* handler) {
    return edgeHandler(handler).insertEdgeModification(media_, edge_, index_, modification_);
}

boost::shared_ptr<RemoveLeftEdgeModCmd>
RemoveLeftEdgeModCmd::create(const MediaPtr& media, const EdgeModificationPtr& modification,
                             const EdgeModCommandHandlerPtr& handler) {
    const boost::shared_ptr<RemoveLeftEdgeModCmd> command(
        new RemoveLeftEdgeModCmd(media, EdgeModCommandHandler::Left, modification, handler));
    command->setName("Remove Left Edge Modification");
    return command;
}

boost::shared_ptr<RemoveRightEdgeModCmd>
RemoveRightEdgeModCmd::create(const MediaPtr& media, const EdgeModificationPtr& modification,
                              const EdgeModCommandHandlerPtr& handler) {
    const boost::shared_ptr<RemoveRightEdgeModCmd> command(
        new RemoveRightEdgeModCmd(media, EdgeModCommandHandler::Right, modification, handler));
    command->setName("Remove Right Edge Modification");
    return command;
}

} // namespace VelaMediaLib

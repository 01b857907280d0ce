#include <VelaMediaLib/commands/edits/EdgeModCmd.h>

#include <algorithm>

namespace VelaMediaLib {

EdgeModCmd::EdgeModCmd(const MediaPtr& media, Edge edge, const EdgeModificationPtr& modification,
                       const EdgeModCommandHandlerPtr& handler)
    : media_(media), edge_(edge), modification_(modification), handler_(handler) {
    if (!media_) throw VelaMediaLibException("no clip for an edge modification");
    if (!modification_) throw VelaMediaLibException("no edge modification");
}

EdgeModCommandHandler& EdgeModCmd::edgeHandler(CommandHandler* handler) const {
    return handler_ ? *handler_ : EdgeModCommandHandler::forCommandHandler(handler);
}

size_t EdgeModCmd::position() const {
    const EdgeModifiable::EdgeModifications on = EdgeModCommandHandler::edgeModifications(*media_, edge_);
    const auto found = std::find(on.begin(), on.end(), modification_);
    if (found == on.end())
        throw AddRemoveException(std::string("the edge modification is not on the clip's ") +
                                 EdgeModCommandHandler::edgeName(edge_) + " edge");
    return size_t(found - on.begin());
}

void EdgeModCmd::checkFits(VelaTime duration) const {
    if (duration < 0)
        throw ValueException<VelaTime>("an edge modification's duration cannot be negative", duration);
    if (duration > media_->duration())
        throw ValueException<VelaTime>("an edge modification cannot be longer than its clip", duration);
}

} // namespace VelaMediaLib

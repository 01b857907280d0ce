#include <VelaMediaLib/commands/edits/EdgeModCloneCmd.h>

#include <VelaMediaLib/commands/edits/AddEdgeModCmd.h>
#include <VelaMediaLib/commands/edits/RemoveEdgeModCmd.h>

#include <boost/make_shared.hpp>
#include <set>

namespace VelaMediaLib {
namespace {

typedef EdgeModCommandHandler::Edge Edge;

CommandPtr addCmd(const MediaPtr& media, Edge edge, const EdgeModificationPtr& modification,
                  const EdgeModCommandHandlerPtr& handler) {
    if (edge == EdgeModCommandHandler::Left) return AddLeftEdgeModCmd::create(media, modification, handler);
    return AddRightEdgeModCmd::create(media, modification, handler);
}

CommandPtr removeCmd(const MediaPtr& media, Edge edge, const EdgeModificationPtr& modification,
                     const EdgeModCommandHandlerPtr& handler) {
    if (edge == EdgeModCommandHandler::Left)
        return RemoveLeftEdgeModCmd::create(media, modification, handler);
    return RemoveRightEdgeModCmd::create(media, modification, handler);
}

} // namespace

boost::shared_ptr<EdgeModCloneCmd> EdgeModCloneCmd::create(const MediaPtr& from, const MediaPtr& to,
                                                           const std::string& group,
                                                           const EdgeModCommandHandlerPtr& handler) {
    if (!from || !to) throw VelaMediaLibException("no clip for an edge modification");
    if (from == to) throw AddRemoveException("a clip's edge modifications cannot be cloned onto itself");
    const boost::shared_ptr<EdgeModCloneCmd> command(new EdgeModCloneCmd(from, to, group, handler));
    command->setName("Clone Edge Modifications");
    return command;
}

EdgeModifiable::EdgeModifications EdgeModCloneCmd::copied(Edge edge) const {
    EdgeModifiable::EdgeModifications result;
    for (const EdgeModificationPtr& modification : EdgeModCommandHandler::edgeModifications(*from_, edge))
        if (group_.empty() || modification->group() == group_) result.push_back(modification);
    return result;
}

bool EdgeModCloneCmd::execute(CommandHandler* handler) {
    if (copied(EdgeModCommandHandler::Left).empty() && copied(EdgeModCommandHandler::Right).empty())
        return false;
    return MultiCommand::execute(handler);
}

void EdgeModCloneCmd::executeCommands(const CommandHandler*) {
    if (cloneEdge(EdgeModCommandHandler::Left)) cloneEdge(EdgeModCommandHandler::Right);
}

// The copies are made once here; redo replays the sub-commands holding them.
bool EdgeModCloneCmd::cloneEdge(Edge edge) {
    EdgeModifiable::EdgeModifications copies;
    std::set<std::string> groups;
    for (const EdgeModificationPtr& original : copied(edge)) {
        copies.push_back(boost::make_shared<EdgeModification>(*original));
        groups.insert(original->group());
    }
    for (const EdgeModificationPtr& own : EdgeModCommandHandler::edgeModifications(*to_, edge))
        if (groups.count(own->group()) && !executeRequired(removeCmd(to_, edge, own, handler_))) return false;
    for (const EdgeModificationPtr& copy : copies)
        if (!executeRequired(addCmd(to_, edge, copy, handler_))) return false;
    return true;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/EdgeModCommandHandler.h>

#include <VelaMediaLib/commands/edits/CommandHandler.h>
#include <VelaMediaLib/model/project/Project.h>

#include <algorithm>

namespace VelaMediaLib {
namespace {

typedef EdgeModifiable::EdgeModifications EdgeModifications;

bool holds(const EdgeModifications& modifications, const EdgeModificationPtr& modification) {
    return std::find(modifications.begin(), modifications.end(), modification) != modifications.end();
}

bool setUnnotified(Media& media, EdgeModCommandHandler::Edge edge, const EdgeModifications& modifications) {
    return edge == EdgeModCommandHandler::Left ? media.setLeftEdgeModificationsUnnotified(modifications)
                                               : media.setRightEdgeModificationsUnnotified(modifications);
}

// Checks and changes the edge's list under one write lock (change answers
// false to refuse), then tells the clip's observers outside it.
template <typename Change>
bool editEdge(const MediaPtr& media, EdgeModCommandHandler::Edge edge, const Change& change) {
    if (!media) return false;
    bool changed = false;
    {
        ScopedWriteLock lock(media->projectMutex());
        EdgeModifications modifications = EdgeModCommandHandler::edgeModifications(*media, edge);
        if (!change(modifications, changed)) return false;
        changed = setUnnotified(*media, edge, modifications) || changed;
    }
    if (changed) media->notify();
    return true;
}

} // namespace

EdgeModifications EdgeModCommandHandler::edgeModifications(const Media& media, Edge edge) {
    return edge == Left ? media.leftEdgeModifications() : media.rightEdgeModifications();
}

bool EdgeModCommandHandler::insertEdgeModification(const MediaPtr& media, Edge edge, size_t index,
                                                   const EdgeModificationPtr& modification) {
    if (!modification) return false;
    return editEdge(media, edge, [&](EdgeModifications& modifications, bool&) {
        if (holds(media->leftEdgeModifications(), modification) ||
            holds(media->rightEdgeModifications(), modification) || index > modifications.size())
            return false;
        modifications.insert(modifications.begin() + index, modification);
        return true;
    });
}

bool EdgeModCommandHandler::removeEdgeModification(const MediaPtr& media, Edge edge,
                                                   const EdgeModificationPtr& modification) {
    return editEdge(media, edge, [&](EdgeModifications& modifications, bool&) {
        const auto found = std::find(modifications.begin(), modifications.end(), modification);
        if (!modification || found == modifications.end()) return false;
        modifications.erase(found);
        return true;
    });
}

// The modification is the clip's own object: its duration changes in place,
// under the same lock that readers of the clip's edges take.
bool EdgeModCommandHandler::setEdgeModificationDuration(const MediaPtr& media, Edge edge,
                                                        const EdgeModificationPtr& modification,
                                                        VelaTime duration) {
    return editEdge(media, edge, [&](const EdgeModifications& modifications, bool& changed) {
        if (duration < 0 || !modification || !holds(modifications, modification)) return false;
        changed = modification->duration() != duration;
        modification->setDuration(duration);
        return true;
    });
}

EdgeModCommandHandler& EdgeModCommandHandler::defaultHandler() {
    static EdgeModCommandHandler instance;
    return instance;
}

// The command handler outlives the command's run, and so does its project.
EdgeModCommandHandler& EdgeModCommandHandler::forCommandHandler(CommandHandler* handler) {
    if (handler)
        if (const boost::shared_ptr<Project> project = handler->project())
            return project->edgeModCommandHandler();
    return defaultHandler();
}

} // namespace VelaMediaLib

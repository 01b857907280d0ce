#include <VelaMediaLib/commands/edits/AddEdgeModCmd.h>

#include <VelaMediaLib/commands/edits/CommandHandler.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

#include <algorithm>

namespace VelaMediaLib {
namespace {

bool onClip(const Media& media, const EdgeModificationPtr& modification) {
    for (const EdgeModifiable::EdgeModifications& edge :
         {media.leftEdgeModifications(), media.rightEdgeModifications()})
        if (std::find(edge.begin(), edge.end(), modification) != edge.end()) return true;
    return false;
}

// Two clips holding one object would share it: a move or a rate change of
// one would change the other too (and scale it twice).
bool onAnotherClip(CommandHandler* handler, const MediaPtr& media, const EdgeModificationPtr& modification) {
    const boost::shared_ptr<Project> project = handler ? handler->project() : boost::shared_ptr<Project>();
    const TimelinePtr timeline = project ? project->timeline() : TimelinePtr();
    if (!timeline) return false;
    for (const MediaPtr& clip : timeline->allMedias())
        if (clip != media && onClip(*clip, modification)) return true;
    return false;
}

} // namespace

bool AddSideEdgeModCmd::execute(CommandHandler* handler) {
    if (onClip(*media_, modification_))
        throw AddRemoveException("the edge modification is already on the clip");
    if (onAnotherClip(handler, media_, modification_))
        throw AddRemoveException("the edge modification is on another clip");
    checkFits(modification_->duration());
    const size_t end = EdgeModCommandHandler::edgeModifications(*media_, edge_).size();
    return edgeHandler(handler).insertEdgeModification(media_, edge_, end, modification_);
}

// It was appended last and nothing after it is still on the edge (undo runs
// in reverse), so taking it off gives back the list before.
bool AddSideEdgeModCmd::unexecute(CommandHandler* handler) {
    return edgeHandler(handler).removeEdgeModification(media_, edge_, modification_);
}

boost::shared_ptr<AddLeftEdgeModCmd> AddLeftEdgeModCmd::create(const MediaPtr& media,
                                                               const EdgeModificationPtr& modification,
                                                               const EdgeModCommandHandlerPtr& handler) {
    const boost::shared_ptr<AddLeftEdgeModCmd> command(
        new AddLeftEdgeModCmd(media, EdgeModCommandHandler::Left, modification, handler));
    command->setName("Add Left Edge Modification");
    return command;
}

boost::shared_ptr<AddRightEdgeModCmd> AddRightEdgeModCmd::create(const MediaPtr& media,
                                                                 const EdgeModificationPtr& modification,
                                                                 const EdgeModCommandHandlerPtr& handler) {
    const boost::shared_ptr<AddRightEdgeModCmd> command(
        new AddRightEdgeModCmd(media, EdgeModCommandHandler::Right, modification, handler));
    command->setName("Add Right Edge Modification");
    return command;
}

boost::shared_ptr<AddEdgeModCmd> AddEdgeModCmd::create(const MediaPtr& media, const EdgeModificationPtr& left,
                                                       const EdgeModificationPtr& right,
                                                       const EdgeModCommandHandlerPtr& handler) {
    if (!media) throw VelaMediaLibException("no clip for an edge modification");
    if (!left && !right) throw VelaMediaLibException("no edge modification");
    const boost::shared_ptr<AddEdgeModCmd> command(new AddEdgeModCmd(media, left, right, handler));
    command->setName("Add Edge Modifications");
    return command;
}

void AddEdgeModCmd::executeCommands(const CommandHandler*) {
    if (left_ && !executeRequired(AddLeftEdgeModCmd::create(media_, left_, handler_))) return;
    if (right_) executeRequired(AddRightEdgeModCmd::create(media_, right_, handler_));
}

} // namespace VelaMediaLib

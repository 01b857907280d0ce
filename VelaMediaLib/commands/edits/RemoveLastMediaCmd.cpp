#include <VelaMediaLib/commands/edits/RemoveLastMediaCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<RemoveLastMediaCmd> RemoveLastMediaCmd::create(const TrackPtr& track) {
    if (!track) throw VelaMediaLibException("no track to remove the last clip of");
    const boost::shared_ptr<RemoveLastMediaCmd> command(new RemoveLastMediaCmd(track));
    command->setName("Remove Last Media");
    return command;
}

bool RemoveLastMediaCmd::execute(CommandHandler* handler) {
    removed_.reset();
    if (MultiCommand::execute(handler) && numUndoCommands() > 0) return true;
    removed_.reset();
    return false;
}

void RemoveLastMediaCmd::executeCommands(const CommandHandler*) {
    MediaPtr last;
    {
        ScopedReadLock lock(track_->projectLock());
        if (track_->mediaRBegin() != track_->mediaREnd()) last = track_->mediaRBegin()->second;
    }
    if (last && executeRequired(RemoveMediaCmd::create(track_, last))) removed_ = last;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/RippleMoveCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<RippleMoveCmd> RippleMoveCmd::create(const TrackPtr& track, const MediaPtr& media,
                                                       VelaTime delta) {
    if (!track || !media) throw VelaMediaLibException("a ripple move needs a track and a clip");
    const boost::shared_ptr<RippleMoveCmd> command(new RippleMoveCmd(track, media, delta));
    command->setName("Ripple Move");
    return command;
}

bool RippleMoveCmd::execute(CommandHandler* handler) {
    return delta_ != 0 && MultiCommand::execute(handler) && numUndoCommands() > 0;
}

// The track's map is keyed by start: from the clip onward it is the ordered set.
void RippleMoveCmd::executeCommands(const CommandHandler*) {
    std::vector<MediaPtr> moving;
    {
        ScopedReadLock lock(track_->projectLock());
        if (!track_->hasMedia(media_)) return;
        for (auto at = track_->lower_bound(media_->lockedTrackRange().start()); at != track_->mediaEnd();
             ++at)
            moving.push_back(at->second);
    }
    if (delta_ < 1) {
        for (const MediaPtr& media : moving)
            if (!executeRequired(MoveCmd::create(track_, media, delta_))) return;
    } else {
        for (auto media = moving.rbegin(); media != moving.rend(); ++media)
            if (!executeRequired(MoveCmd::create(track_, *media, delta_))) return;
    }
}

} // namespace VelaMediaLib

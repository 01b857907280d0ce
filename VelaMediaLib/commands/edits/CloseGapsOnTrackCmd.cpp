#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>

namespace VelaMediaLib {
namespace {

struct Shift {
    MediaPtr media;
    VelaTime delta;
};

} // namespace

boost::shared_ptr<CloseGapsOnTrackCmd> CloseGapsOnTrackCmd::create(const TrackPtr& track) {
    if (!track) throw VelaMediaLibException("no track to close gaps on");
    const boost::shared_ptr<CloseGapsOnTrackCmd> command(new CloseGapsOnTrackCmd(track, false));
    command->setName("Close Gaps");
    return command;
}

boost::shared_ptr<CloseGapsOnTrackCmd> CloseGapsOnTrackCmd::createRequest(const TrackPtr& track) {
    if (!track) throw VelaMediaLibException("no track to close gaps on");
    const boost::shared_ptr<CloseGapsOnTrackCmd> command(new CloseGapsOnTrackCmd(track, true));
    command->setName("Close Gaps");
    return command;
}

void CloseGapsOnTrackCmd::cancel() {
    int waiting = Waiting;
    state_.compare_exchange_strong(waiting, Cancelled);
}

bool CloseGapsOnTrackCmd::hasGap(const Track& track) {
    ScopedReadLock lock(track.projectLock()); // one snapshot of the whole track
    VelaTime expected = 0;
    for (const MediaPtr& media : track.medias()) {
        const Range<VelaTime> range = media->lockedTrackRange();
        if (range.start() != expected) return true;
        expected = range.end();
    }
    return false;
}

// Starting and cancelling are one exchange each, so a request is either
// cancelled before it starts or runs whole.
bool CloseGapsOnTrackCmd::execute(CommandHandler* handler) {
    int waiting = Waiting;
    if (!state_.compare_exchange_strong(waiting, Started) && waiting == Cancelled) return false;
    if (request_ && !track_->parentTimeline()) return false; // a stale request
    return MultiCommand::execute(handler) && numUndoCommands() > 0;
}

// Each clip's target is the sum of the durations before it. A clip moving
// left only lands where the clips before it have already gone (or still end
// earlier); one moving right only where the clips after it have gone.
void CloseGapsOnTrackCmd::executeCommands(const CommandHandler*) {
    std::vector<Shift> shifts;
    {
        ScopedReadLock lock(track_->projectLock());
        VelaTime position = 0;
        for (const MediaPtr& media : track_->medias()) {
            const Range<VelaTime> range = media->lockedTrackRange();
            if (range.start() != position) shifts.push_back(Shift{media, position - range.start()});
            position += range.duration();
        }
    }
    for (const Shift& shift : shifts)
        if (shift.delta < 0 && !executeRequired(MoveCmd::create(track_, shift.media, shift.delta))) return;
    for (auto shift = shifts.rbegin(); shift != shifts.rend(); ++shift)
        if (shift->delta > 0 && !executeRequired(MoveCmd::create(track_, shift->media, shift->delta))) return;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/RemoveRangeMediaCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<RemoveRangeMediaCmd> RemoveRangeMediaCmd::create(const Range<VelaTime>& range) {
    if (range.duration() <= 0) throw VelaMediaLibException("a removed range must be longer than zero");
    const boost::shared_ptr<RemoveRangeMediaCmd> command(new RemoveRangeMediaCmd(range));
    command->setName("Remove Range");
    return command;
}

void RemoveRangeMediaCmd::addTrack(const TrackPtr& track) {
    if (!track) throw VelaMediaLibException("no track to remove a range from");
    tracks_.push_back(track);
}

void RemoveRangeMediaCmd::addTracksOf(const MixerPtr& mixer) {
    if (!mixer) throw VelaMediaLibException("no mixer to remove a range from");
    for (const TrackPtr& track : mixer->tracks()) addTrack(track);
}

// An empty range of every track leaves nothing to record.
bool RemoveRangeMediaCmd::execute(CommandHandler* handler) {
    removed_.clear();
    if (MultiCommand::execute(handler) && numUndoCommands() > 0) return true;
    removed_.clear();
    return false;
}

void RemoveRangeMediaCmd::executeCommands(const CommandHandler*) {
    if (tracks_.empty()) throw VelaMediaLibException("can't remove a range without tracks");
    for (const TrackPtr& track : tracks_)
        if (!clearTrack(track)) return;
}

// Cut at both edges first, so that what lies inside is whole clips.
bool RemoveRangeMediaCmd::clearTrack(const TrackPtr& track) {
    for (const VelaTime edge : {range_.start(), range_.end()})
        if (SplitCmd::mediaToSplit(*track, edge) && !executeRequired(SplitCmd::create(track, edge)))
            return false;
    for (const MediaPtr& media : track->mediasIntersectingRange(range_)) {
        if (!executeRequired(RemoveMediaCmd::create(track, media))) return false;
        removed_.push_back(media);
    }
    return true;
}

} // namespace VelaMediaLib

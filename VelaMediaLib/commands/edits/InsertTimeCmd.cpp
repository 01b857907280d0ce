#include <VelaMediaLib/commands/edits/InsertTimeCmd.h>

#include <VelaMediaLib/commands/edits/RippleMoveCmd.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>

namespace VelaMediaLib {

// A track with nothing at or after the time has nothing to do: not a refusal,
// but a whole edit that did nothing records nothing.
bool TimeRippleCmd::execute(CommandHandler* handler) {
    return MultiCommand::execute(handler) && numUndoCommands() > 0;
}

bool TimeRippleCmd::splitAndRipple(const TrackPtr& track, VelaTime time, VelaTime delta) {
    if (SplitCmd::mediaToSplit(*track, time) && !executeRequired(SplitCmd::create(track, time))) return false;
    MediaPtr first;
    {
        ScopedReadLock lock(track->projectLock());
        const auto at = track->lower_bound(time);
        if (at != track->mediaEnd()) first = at->second;
    }
    return !first || executeRequired(RippleMoveCmd::create(track, first, delta));
}

boost::shared_ptr<InsertTimeCmd> InsertTimeCmd::create(const Range<VelaTime>& range) {
    if (range.duration() <= 0) throw VelaMediaLibException("inserted time must be longer than zero");
    const boost::shared_ptr<InsertTimeCmd> command(new InsertTimeCmd(range));
    command->setName("Insert Time");
    return command;
}

void InsertTimeCmd::addTrack(const TrackPtr& track) {
    if (!track) throw VelaMediaLibException("no track to insert time on");
    tracks_.push_back(track);
}

void InsertTimeCmd::executeCommands(const CommandHandler*) {
    if (tracks_.empty()) throw VelaMediaLibException("can't insert time without tracks");
    for (const TrackPtr& track : tracks_)
        if (!splitAndRipple(track, range_.start(), range_.duration())) return;
}

boost::shared_ptr<SplittingRippleMoveCmd> SplittingRippleMoveCmd::create(const MixerPtr& mixer, VelaTime time,
                                                                         VelaTime delta) {
    const boost::shared_ptr<SplittingRippleMoveCmd> command(new SplittingRippleMoveCmd(mixer, time, delta));
    command->setName("Splitting Ripple Move");
    return command;
}

void SplittingRippleMoveCmd::executeCommands(const CommandHandler*) {
    std::vector<TrackPtr> tracks = tracks_;
    if (mixer_)
        for (const TrackPtr& track : mixer_->tracks()) tracks.push_back(track);
    if (tracks.empty()) throw VelaMediaLibException("can't perform a splitting ripple move without tracks");
    if (delta_ == 0) return;
    for (const TrackPtr& track : tracks)
        if (!splitAndRipple(track, time_, delta_)) return;
}

} // namespace VelaMediaLib

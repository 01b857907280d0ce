#include <VelaMediaLib/commands/edits/ExtendTracksCmd.h>

#include <VelaMediaLib/commands/edits/ExtendEffectsCmd.h>
#include <VelaMediaLib/commands/edits/ExtendMediaAnimationsCmd.h>
#include <VelaMediaLib/commands/edits/ExtendParametersCmd.h>
#include <VelaMediaLib/commands/edits/RippleMoveCmd.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>

namespace VelaMediaLib {

TrackTimeCmd::TrackTimeCmd(VelaTime time, VelaTime amount) : time_(time), amount_(amount) {
    if (amount < 0) throw ValueException<long long>("time amount must not be negative", amount);
}

void TrackTimeCmd::addTrack(const TrackPtr& track) {
    if (!track) throw VelaMediaLibException("no track to extend or reduce time on");
    tracks_.push_back(track);
}

bool TrackTimeCmd::holdsOpenedTime(const Media& media) { return media.state().maxUnbounded(); }

bool TrackTimeCmd::reachesPast(const Track& track, VelaTime time) {
    if (SplitCmd::mediaToSplit(track, time)) return true;
    ScopedReadLock lock(track.projectLock());
    return track.lower_bound(time) != track.mediaEnd();
}

bool TrackTimeCmd::changesAnything() const {
    for (const TrackPtr& track : tracks_)
        if (reachesPast(*track, time_)) return true;
    return false;
}

bool TrackTimeCmd::rippleFrom(const TrackPtr& track, VelaTime from, VelaTime delta) {
    MediaPtr first;
    {
        ScopedReadLock lock(track->projectLock());
        const auto at = track->lower_bound(from);
        if (at != track->mediaEnd()) first = at->second;
    }
    return !first || executeRequired(RippleMoveCmd::create(track, first, delta));
}

boost::shared_ptr<ExtendTracksCmd> ExtendTracksCmd::create(VelaTime time, VelaTime amount) {
    const boost::shared_ptr<ExtendTracksCmd> command(new ExtendTracksCmd(time, amount));
    command->setName("Extend Tracks");
    return command;
}

void ExtendTracksCmd::executeCommands(const CommandHandler*) {
    if (tracks_.empty()) throw VelaMediaLibException("can't extend or reduce time without tracks");
    if (amount_ == 0) return;
    for (const TrackPtr& track : tracks_)
        if (!extendTrack(track)) return;
}

bool ExtendTracksCmd::extendTrack(const TrackPtr& track) {
    const MediaPtr across = SplitCmd::mediaToSplit(*track, time_);
    if (!across || !holdsOpenedTime(*across)) return splitAndRipple(track, time_, amount_);
    const Range<VelaTime> range = across->trackRange();
    const VelaTime local = time_ - range.start();
    if (!rippleFrom(track, range.end(), amount_)) return false;
    if (!executeRequired(TrimEndCmd::create(track, across, -amount_, EdgeEffects()))) return false;
    // Each reports false only when it has nothing to move; a refusal throws.
    execute(ExtendParametersCmd::create(across, local, amount_));
    execute(ExtendMediaAnimationsCmd::create(across, local, amount_));
    execute(ExtendEffectsCmd::create(across, local, amount_));
    return true;
}

boost::shared_ptr<ReduceTracksCmd> ReduceTracksCmd::create(VelaTime time, VelaTime amount) {
    const boost::shared_ptr<ReduceTracksCmd> command(new ReduceTracksCmd(time, amount));
    command->setName("Reduce Tracks");
    return command;
}

void ReduceTracksCmd::executeCommands(const CommandHandler*) {
    if (tracks_.empty()) throw VelaMediaLibException("can't extend or reduce time without tracks");
    if (amount_ == 0) return;
    for (const TrackPtr& track : tracks_)
        if (!reduceTrack(track)) return;
}

bool ReduceTracksCmd::reduceTrack(const TrackPtr& track) {
    const VelaTime end = time_ + amount_;
    const MediaPtr across = SplitCmd::mediaToSplit(*track, time_);
    {
        ScopedReadLock lock(track->projectLock());
        const auto at = track->lower_bound(time_);
        const bool startsInside = at != track->mediaEnd() && at->first < end;
        if (startsInside || (across && across->lockedTrackRange().end() < end))
            throw VelaMediaLibException("the time to remove is not free");
    }
    if (across) {
        const VelaTime local = time_ - across->trackRange().start();
        execute(ReduceParametersCmd::create(across, local, amount_));
        execute(ReduceMediaAnimationsCmd::create(across, local, amount_));
        execute(ReduceEffectsCmd::create(across, local, amount_));
        if (!executeRequired(TrimEndCmd::create(track, across, amount_, EdgeEffects()))) return false;
    }
    return rippleFrom(track, end, -amount_);
}

} // namespace VelaMediaLib

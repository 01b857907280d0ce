#include <VelaMediaLib/commands/edits/ExtendMediaCmd.h>

#include <VelaMediaLib/commands/edits/ExtendEffectsCmd.h>
#include <VelaMediaLib/commands/edits/ExtendTracksCmd.h>
#include <VelaMediaLib/commands/edits/RippleMoveCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>

#include <algorithm>

namespace VelaMediaLib {

MediaLengthCmd::MediaLengthCmd(const MediaPtr& media, VelaTime before, VelaTime after,
                               const MultiTrackEditOptions& options, bool ripple)
    : media_(media), before_(before), after_(after), options_(options), ripple_(ripple) {
    if (!media) throw VelaMediaLibException("no clip to extend or reduce");
    if (before < 0 || after < 0)
        throw ValueException<long long>("extend or reduce amounts must not be negative",
                                        std::min(before, after));
    if (!options.tracks.empty() && !ripple)
        throw VelaMediaLibException("only a rippling edit changes other tracks");
    for (const TrackPtr& track : options.tracks)
        if (!track) throw VelaMediaLibException("no track in the multi-track options");
}

bool MediaLengthCmd::execute(CommandHandler* handler) {
    return MultiCommand::execute(handler) && numUndoCommands() > 0;
}

TrackPtr MediaLengthCmd::trackOfMedia() const {
    TrackPtr track;
    media_->parentVisitor([&](const boost::shared_ptr<SubTimeline>& parent) {
        track = boost::dynamic_pointer_cast<Track>(parent);
    });
    if (!track) throw VelaMediaLibException("the clip is on no track");
    for (const TrackPtr& other : options_.tracks)
        if (other == track)
            throw VelaMediaLibException("the clip's own track is not one of the other tracks");
    return track;
}

bool MediaLengthCmd::otherTracks(VelaTime time, VelaTime delta) {
    if (delta == 0 || options_.tracks.empty()) return true;
    boost::shared_ptr<TrackTimeCmd> command;
    if (delta > 0)
        command = ExtendTracksCmd::create(time, delta);
    else
        command = ReduceTracksCmd::create(time, -delta);
    for (const TrackPtr& track : options_.tracks) command->addTrack(track);
    return !command->changesAnything() || executeRequired(command);
}

bool MediaLengthCmd::rippleAfter(const TrackPtr& track, VelaTime delta) {
    MediaPtr next;
    {
        ScopedReadLock lock(track->projectLock());
        const auto at = track->lower_bound(media_->lockedTrackRange().end());
        if (at != track->mediaEnd()) next = at->second;
    }
    return !next || executeRequired(RippleMoveCmd::create(track, next, delta));
}

boost::shared_ptr<ExtendMediaCmd> ExtendMediaCmd::create(const MediaPtr& media, VelaTime before,
                                                         VelaTime after, const MultiTrackEditOptions& options,
                                                         bool ripple) {
    const boost::shared_ptr<ExtendMediaCmd> command(
        new ExtendMediaCmd(media, before, after, options, ripple));
    command->setName("Extend Media");
    return command;
}

// A start trim keeps the content (keyframes, animations, effects) in place
// and its magnetized effects grow or shrink with the edge; the end side
// fits the effects in one step.
void ExtendMediaCmd::executeCommands(const CommandHandler*) {
    const TrackPtr track = trackOfMedia();
    const Range<VelaTime> range = media_->trackRange();
    if (before_ > 0) {
        if (ripple_ && !otherTracks(range.start(), before_)) return;
        if (ripple_ && !executeRequired(RippleMoveCmd::create(track, media_, before_))) return;
        if (!executeRequired(TrimStartCmd::create(track, media_, -before_))) return;
    }
    if (after_ == 0) return;
    const VelaTime duration = media_->duration();
    if (ripple_ && !otherTracks(media_->trackRange().end(), after_)) return;
    if (ripple_ && !rippleAfter(track, after_)) return;
    if (!executeRequired(TrimEndCmd::create(track, media_, -after_, EdgeEffects()))) return;
    execute(ExtendEffectsCmd::create(media_, duration, after_));
}

boost::shared_ptr<ReduceMediaCmd> ReduceMediaCmd::create(const MediaPtr& media, VelaTime before,
                                                         VelaTime after, const MultiTrackEditOptions& options,
                                                         bool ripple) {
    const boost::shared_ptr<ReduceMediaCmd> command(
        new ReduceMediaCmd(media, before, after, options, ripple));
    command->setName("Reduce Media");
    return command;
}

void ReduceMediaCmd::executeCommands(const CommandHandler*) {
    const TrackPtr track = trackOfMedia();
    const Range<VelaTime> range = media_->trackRange();
    if (before_ > 0) {
        if (!executeRequired(TrimStartCmd::create(track, media_, before_))) return;
        if (ripple_ && !executeRequired(RippleMoveCmd::create(track, media_, -before_))) return;
        if (ripple_ && !otherTracks(range.start(), -before_)) return;
    }
    if (after_ == 0) return;
    execute(ReduceEffectsCmd::create(media_, media_->duration() - after_, after_));
    const VelaTime end = media_->trackRange().end();
    if (!executeRequired(TrimEndCmd::create(track, media_, after_, EdgeEffects()))) return;
    if (!ripple_) return;
    MediaPtr next;
    {
        ScopedReadLock lock(track->projectLock());
        const auto at = track->lower_bound(end);
        if (at != track->mediaEnd()) next = at->second;
    }
    if (next && !executeRequired(RippleMoveCmd::create(track, next, -after_))) return;
    otherTracks(end - after_, -after_);
}

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <vector>

namespace VelaMediaLib {

/// How an edit that changes a clip's length treats tracks other than the
/// clip's own. Empty by default: only the clip's track changes.
struct VELAMEDIALIB_API MultiTrackEditOptions {
    /// Tracks on which the same time is opened (or removed) as the clip gains
    /// (or loses), where it gains it (ExtendTracksCmd, ReduceTracksCmd), so
    /// that what they play stays in step with the clip. Only a rippling edit
    /// moves other tracks; the clip's own track must not be listed.
    std::vector<TrackPtr> tracks;
};

/// What lengthening and shortening a clip at both ends share: the clip,
/// the ticks before and after, the options and whether the edit ripples.
class VELAMEDIALIB_API MediaLengthCmd : public MultiCommand {
public:
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    /// Throws VelaMediaLibException for no clip, a negative amount, or
    /// options naming tracks without rippling (or naming no track).
    MediaLengthCmd(const MediaPtr& media, VelaTime before, VelaTime after,
                   const MultiTrackEditOptions& options, bool ripple);
    /// The clip's track; throws VelaMediaLibException "the clip is on no track".
    TrackPtr trackOfMedia() const;
    /// Opens (positive) or removes (negative) time on the options' tracks.
    bool otherTracks(VelaTime time, VelaTime delta);
    /// Moves the clips after the clip by the delta.
    bool rippleAfter(const TrackPtr& track, VelaTime delta);

    MediaPtr media_;
    VelaTime before_;
    VelaTime after_;
    MultiTrackEditOptions options_;
    bool ripple_;
};

/// Lengthens a clip by `before` ticks at its start and `after` ticks at its
/// end, playing more of its media there (a still simply stands longer). The
/// content keeps its place on the media: the start trim (TrimStartCmd) moves
/// keyframes, animations and effects later by `before` in the clip's ticks,
/// and magnetized effects that reach an edge grow with it.
/// Without ripple the clip grows into the time around it (its start earlier
/// by `before`, its end later by `after`); a neighbour in the way refuses it.
/// With ripple the clip keeps its start and everything after it on its track
/// moves later by before + after; the options' tracks open the same time
/// (`before` at the clip's start, `after` at its old end).
/// A clip on no track, or a clip whose media does not reach far enough,
/// refuses it (exception, or false); nothing changes then. Two zero amounts
/// leave nothing to do (false).
class VELAMEDIALIB_API ExtendMediaCmd : public MediaLengthCmd {
public:
    static boost::shared_ptr<ExtendMediaCmd>
    create(const MediaPtr& media, VelaTime before, VelaTime after,
           const MultiTrackEditOptions& options = MultiTrackEditOptions(), bool ripple = false);

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    using MediaLengthCmd::MediaLengthCmd;
};

/// Shortens a clip by `before` ticks at its start and `after` ticks at its
/// end: the inverse of ExtendMediaCmd with the same arguments. Keyframes,
/// animations and effects move earlier by `before` in the clip's ticks (the
/// start trim carries them; what lay in the removed start stays before the
/// clip's start).
/// Without ripple the clip's edges move in, leaving the time free; with
/// ripple the clip keeps its start and everything after it moves earlier by
/// before + after (the options' tracks lose the same time, which must be free
/// there: ReduceTracksCmd). A clip left with no length (or shorter than its
/// transitions) refuses it.
class VELAMEDIALIB_API ReduceMediaCmd : public MediaLengthCmd {
public:
    static boost::shared_ptr<ReduceMediaCmd>
    create(const MediaPtr& media, VelaTime before, VelaTime after,
           const MultiTrackEditOptions& options = MultiTrackEditOptions(), bool ripple = false);

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    using MediaLengthCmd::MediaLengthCmd;
};

} // namespace VelaMediaLib

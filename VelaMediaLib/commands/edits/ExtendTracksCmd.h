#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/InsertTimeCmd.h>

#include <vector>

namespace VelaMediaLib {

/// What opening and removing time on tracks share: the tracks added, the
/// time and the amount (ticks). Without a track it throws
/// VelaMediaLibException "can't extend or reduce time without tracks"; a
/// sub-edit's refusal refuses the whole (rolled back, false), and so does an
/// edit with nothing to do.
class VELAMEDIALIB_API TrackTimeCmd : public TimeRippleCmd {
public:
    void addTrack(const TrackPtr& track);
    const std::vector<TrackPtr>& tracks() const { return tracks_; }
    /// Whether a clip's content holds over time opened inside it: a clip
    /// without an end to its media (a still, generated content) is extended
    /// there; another is split, as inserted time does, so that what it shows
    /// stays in step with the other tracks.
    static bool holdsOpenedTime(const Media& media);
    /// Whether time opened or removed at the tick changes anything on the
    /// track (a clip covers the tick or starts after it).
    static bool reachesPast(const Track& track, VelaTime time);
    /// Whether it changes anything on any of the tracks added.
    bool changesAnything() const;

protected:
    /// Throws VelaMediaLibException for a negative amount.
    TrackTimeCmd(VelaTime time, VelaTime amount);
    /// Moves the clips from the first at or after `from` on by the delta.
    bool rippleFrom(const TrackPtr& track, VelaTime from, VelaTime delta);

    VelaTime time_;
    VelaTime amount_;
    std::vector<TrackPtr> tracks_;
};

/// Opens `amount` ticks at `time` on each track added, in the order added:
/// everything from the time on moves later by the amount. A clip running
/// across the time is extended by the amount when it holds the opened time
/// (holdsOpenedTime: its end edge moves, and its keyframes, animations and
/// effects from the time on follow: Extend{Parameters,MediaAnimations,
/// Effects}Cmd), and split there otherwise (as InsertTimeCmd does).
class VELAMEDIALIB_API ExtendTracksCmd : public TrackTimeCmd {
public:
    static boost::shared_ptr<ExtendTracksCmd> create(VelaTime time, VelaTime amount);

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    ExtendTracksCmd(VelaTime time, VelaTime amount) : TrackTimeCmd(time, amount) {}
    bool extendTrack(const TrackPtr& track);
};

/// Removes the `amount` ticks from `time` on, on each track added: the inverse
/// of ExtendTracksCmd with the same arguments where it extended a clip (a clip
/// it split stays in two parts, side by side again). Everything from time +
/// amount on moves earlier by the amount. A clip running across the time
/// that reaches at least to its end is shortened by the amount there (its
/// keyframes, animations and effects after the removed time follow back:
/// Reduce{Parameters,MediaAnimations,Effects}Cmd). It deletes no clip: a clip
/// starting inside the removed time, or one ending inside it, refuses the
/// whole with VelaMediaLibException "the time to remove is not free".
class VELAMEDIALIB_API ReduceTracksCmd : public TrackTimeCmd {
public:
    static boost::shared_ptr<ReduceTracksCmd> create(VelaTime time, VelaTime amount);

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    ReduceTracksCmd(VelaTime time, VelaTime amount) : TrackTimeCmd(time, amount) {}
    bool reduceTrack(const TrackPtr& track);
};

} // namespace VelaMediaLib

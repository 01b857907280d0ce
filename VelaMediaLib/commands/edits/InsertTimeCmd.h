#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Mixer.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <vector>

namespace VelaMediaLib {

/// What inserting time and a splitting ripple move share: on one track, a
/// clip across the time is split there and everything from the time on is
/// ripple-moved by the delta, each a sub-edit that must succeed.
class VELAMEDIALIB_API TimeRippleCmd : public MultiCommand {
public:
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    /// False once a sub-edit refused (the whole is then refused).
    bool splitAndRipple(const TrackPtr& track, VelaTime time, VelaTime delta);
};

/// Opens a stretch of empty time on tracks: on each track, in the order
/// added, a clip across the start of the range is split there (SplitCmd),
/// and everything from the start on moves right by the range's length
/// (RippleMoveCmd). Without a track it throws VelaMediaLibException "can't
/// insert time without tracks"; a sub-edit's refusal refuses the whole.
class VELAMEDIALIB_API InsertTimeCmd : public TimeRippleCmd {
public:
    /// Throws VelaMediaLibException for a range that is not longer than zero.
    static boost::shared_ptr<InsertTimeCmd> create(const Range<VelaTime>& range);
    void addTrack(const TrackPtr& track);
    const std::vector<TrackPtr>& tracks() const { return tracks_; }

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit InsertTimeCmd(const Range<VelaTime>& range) : range_(range) {}
    Range<VelaTime> range_;
    std::vector<TrackPtr> tracks_;
};

/// Splits every track of the mixer (or of those added) at a time where a clip
/// lies across it, and ripple-moves everything from the time on by a delta.
/// Without any track it throws VelaMediaLibException "can't perform a
/// splitting ripple move without tracks"; a sub-edit's refusal (a collision
/// of a move to the left) refuses the whole.
class VELAMEDIALIB_API SplittingRippleMoveCmd : public TimeRippleCmd {
public:
    static boost::shared_ptr<SplittingRippleMoveCmd> create(const MixerPtr& mixer, VelaTime time,
                                                            VelaTime delta);
    void addTrack(const TrackPtr& track) { tracks_.push_back(track); }

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    SplittingRippleMoveCmd(const MixerPtr& mixer, VelaTime time, VelaTime delta)
        : mixer_(mixer), time_(time), delta_(delta) {}
    MixerPtr mixer_;
    VelaTime time_;
    VelaTime delta_;
    std::vector<TrackPtr> tracks_;
};

} // namespace VelaMediaLib

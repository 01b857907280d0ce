#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/InsertTimeCmd.h>
#include <VelaMediaLib/model/timeline/DeletionPoint.h>

#include <vector>

namespace VelaMediaLib {

/// Puts back what a ripple delete took out at a tick, on every added track
/// that has a deletion point there: the time is opened again as InsertTimeCmd
/// does (a clip across the tick is split, everything from it on moves right
/// by the point's length), the removed clips are placed back where they
/// were (AddMediaCmd: the same objects, their transitions joining as they
/// stood), and each cut the delete made is joined again (its split undone)
/// where both pieces still stand as the delete left them. The point goes;
/// points inside it come back at their ticks, later ones move right.
///
/// Deleting and then restoring gives the tracks back exactly, the written
/// project included, as long as the cut clips were not edited in between
/// (points are not written). Refused: no track (execute throws "can't
/// restore a deletion point without tracks"); a track on no timeline
/// (throws); no added track with a point at the tick, or a sub-edit's
/// refusal (false, nothing changed).
class VELAMEDIALIB_API RestoreDeletionPointAtTimeCmd : public TimeRippleCmd {
public:
    static boost::shared_ptr<RestoreDeletionPointAtTimeCmd> create(VelaTime time);
    /// A track added twice counts once.
    void addTrack(const TrackPtr& track);
    const std::vector<TrackPtr>& tracks() const { return tracks_; }
    /// Whether the track has a point at the tick (false off a timeline).
    static bool hasDeletionPointAt(const TrackPtr& track, VelaTime time);

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit RestoreDeletionPointAtTimeCmd(VelaTime time) : time_(time) {}
    bool restore(const TrackPtr& track, const DeletionPointPtr& point);
    bool joinCuts(const TrackPtr& track, const DeletionPoint& point);

    VelaTime time_;
    std::vector<TrackPtr> tracks_;
};

} // namespace VelaMediaLib

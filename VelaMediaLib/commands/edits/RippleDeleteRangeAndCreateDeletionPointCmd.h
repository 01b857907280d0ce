#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/DeletionPoint.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

#include <string>
#include <vector>

namespace VelaMediaLib {

/// The cuts a ripple delete made at its range's edges, in the order made:
/// each split, its two pieces, and how they stood right after it. Restoring
/// joins a cut back (undoing the split) only where both pieces still stand
/// so; elsewhere the content comes back in place as separate clips.
struct VELAMEDIALIB_API DeletionCuts : public VelaObject {
    struct Cut {
        boost::shared_ptr<SplitCmd> split;
        MediaPtr left, right;
        /// Each piece as written right after the split: its timing and
        /// everything it holds (effects, keyframes, animations, edge
        /// modifications), which the split's undo puts back as it saw them.
        std::string leftText, rightText;
        /// The slots and links around both pieces, which the split's undo
        /// puts back as it saw them before the split.
        TransitionSlots slots;
    };
    std::vector<Cut> cuts;
    /// A clip as written on its own, to tell whether anything of it changed.
    static std::string textOf(const Media& media);
};

/// Gives one track of a timeline a new list of deletion points; undone by
/// giving it back the list it had (points are immutable, so that is exact).
class VELAMEDIALIB_API SetDeletionPointsCmd : public Command {
public:
    static boost::shared_ptr<SetDeletionPointsCmd> create(const TrackPtr& track,
                                                          const std::vector<DeletionPointPtr>& points);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    /// The list of the timeline the track lies on; VelaMediaLibException "a
    /// deletion point needs a track on a timeline" when it lies on none.
    static boost::shared_ptr<DeletionPointList> listOf(const TrackPtr& track);

private:
    SetDeletionPointsCmd(const TrackPtr& track, const std::vector<DeletionPointPtr>& points)
        : track_(track), points_(points) {}
    TrackPtr track_;
    std::vector<DeletionPointPtr> points_, saved_;
};

/// Removes a range of ticks from tracks and remembers what went as a
/// deletion point at the range's start, one per track it changed (see
/// RestoreDeletionPointAtTimeCmd). On each track, in the order added: a clip
/// across either edge of the range is split there (SplitCmd), the clips then
/// inside are taken off (RemoveMediaCmd, the objects kept by the point), and
/// everything after the range moves left by its length (RippleMoveCmd).
/// Deletion points of the track inside the range, both ends included, go
/// into the new point (restoring it brings them back); later ones move left
/// with the content. Transitions of removed clips stay with them: a
/// neighbour keeps its side (TrackCleanupCmd takes such leftovers off).
///
/// Refused: a range not longer than zero (create throws
/// VelaMediaLibException); no track (execute throws "can't ripple delete
/// without tracks"); a track on no timeline (throws); a sub-edit's refusal
/// (false); a range with nothing in or after it on every track (false,
/// nothing recorded). Every refusal leaves the project as it was.
class VELAMEDIALIB_API RippleDeleteRangeAndCreateDeletionPointCmd : public MultiCommand {
public:
    static boost::shared_ptr<RippleDeleteRangeAndCreateDeletionPointCmd> create(const Range<VelaTime>& range);
    /// A track added twice counts once.
    void addTrack(const TrackPtr& track);
    const std::vector<TrackPtr>& tracks() const { return tracks_; }
    /// The points the last execution made, in the order made.
    const std::vector<DeletionPointPtr>& createdDeletionPoints() const { return created_; }
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    /// Ranges checked by create, latest first.
    explicit RippleDeleteRangeAndCreateDeletionPointCmd(const std::vector<Range<VelaTime>>& ranges)
        : ranges_(ranges) {}
    void executeCommands(const CommandHandler* handler) override;

private:
    /// False once a sub-edit refused.
    bool deleteRange(const TrackPtr& track, const Range<VelaTime>& range);
    bool cutAt(const TrackPtr& track, VelaTime time, DeletionCuts& cuts);

    std::vector<Range<VelaTime>> ranges_;
    std::vector<TrackPtr> tracks_;
    std::vector<DeletionPointPtr> created_;
};

} // namespace VelaMediaLib

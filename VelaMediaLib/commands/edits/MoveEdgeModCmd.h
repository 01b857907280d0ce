#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/EdgeModCmd.h>

namespace VelaMediaLib {

/// Moves the inner end of a modification on one edge of a clip by a tick
/// delta, as a handle dragged along the timeline: the modification stays
/// against its edge and its duration follows. A left modification ends at
/// clip start + duration, so a delta to the right (positive) lengthens it; a
/// right one begins at clip end - duration, so a positive delta shortens it.
/// The new duration must lie within [0, the clip's duration]
/// (ValueException<VelaTime>, EdgeModCmd::checkFits); a modification not on
/// that edge throws AddRemoveException; a delta of 0 changes nothing and
/// reports false. Left and right modifications may overlap on a short clip:
/// each is checked against the clip alone. Undo gives back the duration before
/// and redo the one after, exactly. Two moves of the same modification
/// combine into one step, undone to the duration before the first.
class VELAMEDIALIB_API MoveSideEdgeModCmd : public EdgeModCmd {
public:
    VelaTime delta() const { return delta_; }
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    bool reexecute(CommandHandler* handler) override;
    CommandPtr combine(const CommandPtr& later) override;

protected:
    MoveSideEdgeModCmd(const MediaPtr& media, Edge edge, const EdgeModificationPtr& modification,
                       VelaTime delta, const EdgeModCommandHandlerPtr& handler)
        : EdgeModCmd(media, edge, modification, handler), delta_(delta) {}

private:
    /// The duration after the move, held near the clip's range so that no
    /// sum overflows (checkFits refuses it all the same).
    VelaTime movedDuration(VelaTime before) const;

    VelaTime delta_;
    VelaTime before_ = 0, after_ = 0;
};

/// Moves the inner end of a modification on a clip's left edge (see
/// MoveSideEdgeModCmd): a positive delta lengthens it.
class VELAMEDIALIB_API MoveLeftEdgeModCmd : public MoveSideEdgeModCmd {
public:
    static boost::shared_ptr<MoveLeftEdgeModCmd> create(const MediaPtr& media,
                                                        const EdgeModificationPtr& modification,
                                                        VelaTime delta,
                                                        const EdgeModCommandHandlerPtr& handler = {});

private:
    using MoveSideEdgeModCmd::MoveSideEdgeModCmd;
};

/// Moves the inner end of a modification on a clip's right edge (see
/// MoveSideEdgeModCmd): a positive delta shortens it.
class VELAMEDIALIB_API MoveRightEdgeModCmd : public MoveSideEdgeModCmd {
public:
    static boost::shared_ptr<MoveRightEdgeModCmd> create(const MediaPtr& media,
                                                         const EdgeModificationPtr& modification,
                                                         VelaTime delta,
                                                         const EdgeModCommandHandlerPtr& handler = {});

private:
    using MoveSideEdgeModCmd::MoveSideEdgeModCmd;
};

} // namespace VelaMediaLib

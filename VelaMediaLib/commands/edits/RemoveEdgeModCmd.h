#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/EdgeModCmd.h>

namespace VelaMediaLib {

/// Takes a modification off one edge of a clip; undone by putting the same
/// object back where it stood in the edge's list (with the duration it has),
/// so the order of the edge comes back exactly. One not on that edge throws
/// AddRemoveException "the edge modification is not on the clip's left edge"
/// (or right). Nothing else of the modification's group is touched.
class VELAMEDIALIB_API RemoveSideEdgeModCmd : public EdgeModCmd {
public:
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;

protected:
    using EdgeModCmd::EdgeModCmd;

private:
    size_t index_ = 0; // where it stood, for undo
};

/// Takes a modification off a clip's left edge (see RemoveSideEdgeModCmd).
class VELAMEDIALIB_API RemoveLeftEdgeModCmd : public RemoveSideEdgeModCmd {
public:
    static boost::shared_ptr<RemoveLeftEdgeModCmd> create(const MediaPtr& media,
                                                          const EdgeModificationPtr& modification,
                                                          const EdgeModCommandHandlerPtr& handler = {});

private:
    using RemoveSideEdgeModCmd::RemoveSideEdgeModCmd;
};

/// Takes a modification off a clip's right edge (see RemoveSideEdgeModCmd).
class VELAMEDIALIB_API RemoveRightEdgeModCmd : public RemoveSideEdgeModCmd {
public:
    static boost::shared_ptr<RemoveRightEdgeModCmd> create(const MediaPtr& media,
                                                           const EdgeModificationPtr& modification,
                                                           const EdgeModCommandHandlerPtr& handler = {});

private:
    using RemoveSideEdgeModCmd::RemoveSideEdgeModCmd;
};

} // namespace VelaMediaLib

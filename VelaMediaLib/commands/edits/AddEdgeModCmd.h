#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/EdgeModCmd.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>

namespace VelaMediaLib {

/// Appends a modification to one edge of a clip; undone by taking it off
/// again, which leaves the edge's list as it was. A modification belongs to
/// one clip: one already on the clip (on either edge) throws
/// AddRemoveException "the edge modification is already on the clip", one on
/// another clip of the project's timeline "the edge modification is on
/// another clip" (they would share one object); one longer than the clip or of negative duration throws
/// ValueException<VelaTime> (EdgeModCmd::checkFits). Another of the same group may stand beside it
/// (AddEdgeModCmd and EdgeModCloneCmd decide which belong together). To put
/// the same change on another clip, clone it (EdgeModCloneCmd).
class VELAMEDIALIB_API AddSideEdgeModCmd : public EdgeModCmd {
public:
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;

protected:
    using EdgeModCmd::EdgeModCmd;
};

/// Appends a modification to a clip's left edge (see AddSideEdgeModCmd).
class VELAMEDIALIB_API AddLeftEdgeModCmd : public AddSideEdgeModCmd {
public:
    static boost::shared_ptr<AddLeftEdgeModCmd> create(const MediaPtr& media,
                                                       const EdgeModificationPtr& modification,
                                                       const EdgeModCommandHandlerPtr& handler = {});

private:
    using AddSideEdgeModCmd::AddSideEdgeModCmd;
};

/// Appends a modification to a clip's right edge (see AddSideEdgeModCmd).
class VELAMEDIALIB_API AddRightEdgeModCmd : public AddSideEdgeModCmd {
public:
    static boost::shared_ptr<AddRightEdgeModCmd> create(const MediaPtr& media,
                                                        const EdgeModificationPtr& modification,
                                                        const EdgeModCommandHandlerPtr& handler = {});

private:
    using AddSideEdgeModCmd::AddSideEdgeModCmd;
};

/// Adds a left and a right modification to a clip as one step, the way a
/// fade in and a fade out of one group go together: the left one first, then
/// the right one (either may be null, not both). All or nothing: when the
/// right one is refused the left one is taken off again, and the exception
/// or false goes on.
class VELAMEDIALIB_API AddEdgeModCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException "no clip for an edge modification" or
    /// "no edge modification" (both null).
    static boost::shared_ptr<AddEdgeModCmd> create(const MediaPtr& media, const EdgeModificationPtr& left,
                                                   const EdgeModificationPtr& right,
                                                   const EdgeModCommandHandlerPtr& handler = {});

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    AddEdgeModCmd(const MediaPtr& media, const EdgeModificationPtr& left, const EdgeModificationPtr& right,
                  const EdgeModCommandHandlerPtr& handler)
        : media_(media), left_(left), right_(right), handler_(handler) {}

    MediaPtr media_;
    EdgeModificationPtr left_, right_;
    EdgeModCommandHandlerPtr handler_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/EdgeModCommandHandler.h>
#include <VelaMediaLib/commands/framework/Command.h>

namespace VelaMediaLib {

/// The common part of the commands that change one modification on one edge
/// of a clip. A modification lies against its edge: a left one covers the
/// clip's first `duration` ticks, a right one its last. Modifications live on
/// the clip, so these commands work on a clip wherever it is (a track, a
/// group's inner track, the clipboard, nowhere). They act through the
/// EdgeModCommandHandler given at creation, or else the one the project
/// offers (EdgeModCommandHandler::forCommandHandler), so they also run
/// without a history. Their rules are checked when they execute, since the
/// clip may change between creation and execution; a broken rule throws and
/// changes nothing, a handler's refusal reports false.
class VELAMEDIALIB_API EdgeModCmd : public Command {
public:
    typedef EdgeModCommandHandler::Edge Edge;

    const MediaPtr& media() const { return media_; }
    Edge edge() const { return edge_; }
    const EdgeModificationPtr& modification() const { return modification_; }

protected:
    /// Throws VelaMediaLibException "no clip for an edge modification" or
    /// "no edge modification" for a null argument.
    EdgeModCmd(const MediaPtr& media, Edge edge, const EdgeModificationPtr& modification,
               const EdgeModCommandHandlerPtr& handler);

    EdgeModCommandHandler& edgeHandler(CommandHandler* handler) const;
    /// Where the modification stands on the edge. Throws AddRemoveException
    /// "the edge modification is not on the clip's left edge" (or right).
    size_t position() const;
    /// Throws ValueException<VelaTime> "an edge modification's duration
    /// cannot be negative" or "an edge modification cannot be longer than its
    /// clip" unless 0 <= duration <= the clip's duration.
    void checkFits(VelaTime duration) const;

    MediaPtr media_;
    Edge edge_;
    EdgeModificationPtr modification_;
    EdgeModCommandHandlerPtr handler_;
};

} // namespace VelaMediaLib

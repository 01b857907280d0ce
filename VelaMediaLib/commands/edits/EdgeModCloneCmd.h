#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/EdgeModCommandHandler.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>

#include <string>

namespace VelaMediaLib {

/// Gives one clip copies of another's edge modifications ("apply these fades
/// there too"): each left modification of the source clip (of the group, when
/// one is named) is copied onto the target's left edge, each right one onto
/// its right edge, in order, after the target's own. The copies are
/// independent objects: editing one leaves the original alone. A group is
/// one change, so on each edge the target's modifications of a group being
/// copied there give way to the copies (removed first). Made of
/// RemoveLeft/RightEdgeModCmd and AddLeft/RightEdgeModCmd: all or nothing (a
/// copy longer than the target throws ValueException<VelaTime> with the target
/// as it was), undo exact, and redo puts back the same copy objects, so later
/// commands naming a copy still find it. A source with nothing to copy
/// reports false.
class VELAMEDIALIB_API EdgeModCloneCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException "no clip for an edge modification" for a
    /// null clip and AddRemoveException "a clip's edge modifications cannot be
    /// cloned onto itself".
    static boost::shared_ptr<EdgeModCloneCmd> create(const MediaPtr& from, const MediaPtr& to,
                                                     const std::string& group = std::string(),
                                                     const EdgeModCommandHandlerPtr& handler = {});

    using MultiCommand::execute;
    bool execute(CommandHandler* handler) override;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    EdgeModCloneCmd(const MediaPtr& from, const MediaPtr& to, const std::string& group,
                    const EdgeModCommandHandlerPtr& handler)
        : from_(from), to_(to), group_(group), handler_(handler) {}
    /// The source's modifications on the edge that are to be copied.
    EdgeModifiable::EdgeModifications copied(EdgeModCommandHandler::Edge edge) const;
    bool cloneEdge(EdgeModCommandHandler::Edge edge);

    MediaPtr from_, to_;
    std::string group_;
    EdgeModCommandHandlerPtr handler_;
};

} // namespace VelaMediaLib

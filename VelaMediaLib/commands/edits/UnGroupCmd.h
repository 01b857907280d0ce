#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/media/Group.h>

namespace VelaMediaLib {

/// Puts a group's clips back where they play. The group leaves its track;
/// the clips of each of its tracks, trimmed to the part the group shows, go
/// onto a track of the group's mixer at the global time they played at: the
/// first track, from the group's own in the mixer's order, that no earlier
/// track of the group took and where they collide with nothing, or else a
/// new track at the end. Clips the group shows nothing of stay inside it.
/// Each step is a sub-command, so undo gives the group back exactly.
class VELAMEDIALIB_API UnGroupCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException "no group to ungroup". Execution throws,
    /// changing nothing, "the group to ungroup lies on no track", "only a
    /// group playing whole ticks at normal speed can be ungrouped" and, for
    /// a group of another project than the handler's, "the group belongs to
    /// another project".
    static boost::shared_ptr<UnGroupCmd> create(const GroupPtr& group);
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit UnGroupCmd(const GroupPtr& group) : group_(group) {}

    GroupPtr group_;
};

} // namespace VelaMediaLib

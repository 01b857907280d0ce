#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/media/Group.h>

#include <vector>

namespace VelaMediaLib {

/// Groups clips of tracks of one mixer into a new group that stands where
/// they stood: on the first of their tracks in the mixer's order, from the
/// earliest clip's start to the latest clip's end, at scalar 1. The group has
/// one track for each track the clips came from (in the mixer's order, with
/// that track's flags), holding its clips at their distance from the group's
/// start, so every clip plays at the same global time with the same content.
/// The clips leave their tracks, go onto the group's, and the group takes
/// their place, each step a sub-command: undo gives every clip back its
/// track, timing and transitions. Refused (false, nothing changed) when the
/// group would collide with a clip left on its track. The canvas is left
/// unset (see GroupCmd).
class VELAMEDIALIB_API CreateGroupCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException, changing nothing: "no clips to group"
    /// (an empty list, a null or a clip named twice), "a clip to group lies
    /// on no track", "a clip cannot be grouped with a group that holds it",
    /// "the clips to group lie on tracks of more than one mixer". Execution
    /// checks again, and refuses clips of another project than the
    /// handler's: "the clips to group belong to another project".
    static boost::shared_ptr<CreateGroupCmd> create(const std::vector<MediaPtr>& clips);
    /// The group the first execution made; null before.
    const GroupPtr& createdGroup() const { return group_; }
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit CreateGroupCmd(const std::vector<MediaPtr>& clips) : clips_(clips) {}

    std::vector<MediaPtr> clips_;
    GroupPtr group_;
};

} // namespace VelaMediaLib

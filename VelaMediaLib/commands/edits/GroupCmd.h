#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/media/Group.h>

#include <vector>

namespace VelaMediaLib {

/// Groups the selected clips as a user asks it: CreateGroupCmd, then
/// ResizeGroupCmd giving the new group the canvas its clips were placed on
/// (the group holding their mixer, when it has a size, else the timeline's),
/// so that they show as before. Refusals and exceptions are CreateGroupCmd's.
class VELAMEDIALIB_API GroupCmd : public MultiCommand {
public:
    static boost::shared_ptr<GroupCmd> create(const std::vector<MediaPtr>& clips);
    /// The group the first execution made; null before.
    const GroupPtr& createdGroup() const { return group_; }

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit GroupCmd(const std::vector<MediaPtr>& clips) : clips_(clips) {}

    std::vector<MediaPtr> clips_;
    GroupPtr group_;
};

} // namespace VelaMediaLib

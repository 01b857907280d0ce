#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>
#include <VelaMediaLib/model/media/Group.h>

namespace VelaMediaLib {

/// Gives a group a canvas size; undo gives back the size it had (0 where it
/// had none). A group that has the size already leaves nothing to record (false).
class VELAMEDIALIB_API ResizeGroupCmd : public Command {
public:
    /// Throws VelaMediaLibException "no group to resize" and ValueException<int>
    /// "a group's size must not be negative".
    static boost::shared_ptr<ResizeGroupCmd> create(const GroupPtr& group, int width, int height);
    bool execute(CommandHandler*) override;
    bool unexecute(CommandHandler*) override;

private:
    ResizeGroupCmd(const GroupPtr& group, int width, int height)
        : group_(group), width_(width), height_(height) {}

    GroupPtr group_;
    int width_, height_;
    int oldWidth_ = 0, oldHeight_ = 0;
};

} // namespace VelaMediaLib

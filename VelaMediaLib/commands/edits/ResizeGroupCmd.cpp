#include <VelaMediaLib/commands/edits/ResizeGroupCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<ResizeGroupCmd> ResizeGroupCmd::create(const GroupPtr& group, int width, int height) {
    if (!group) throw VelaMediaLibException("no group to resize");
    for (const int side : {width, height})
        if (side < 0) throw ValueException<int>("a group's size must not be negative", side);
    const boost::shared_ptr<ResizeGroupCmd> command(new ResizeGroupCmd(group, width, height));
    command->setName("Resize Group");
    return command;
}

bool ResizeGroupCmd::execute(CommandHandler*) {
    oldWidth_ = group_->width();
    oldHeight_ = group_->height();
    if (oldWidth_ == width_ && oldHeight_ == height_) return false;
    group_->setGroupWidthAndHeight(width_, height_);
    return true;
}

bool ResizeGroupCmd::unexecute(CommandHandler*) {
    group_->setGroupWidthAndHeight(oldWidth_, oldHeight_);
    return true;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/RemoveAnimationCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<RemoveAnimationCmd>
RemoveAnimationCmd::create(const MediaPtr& media, const std::string& parameterName, VelaTime start) {
    boost::shared_ptr<RemoveAnimationCmd> command(new RemoveAnimationCmd(media, parameterName, start));
    command->setName("Remove Animation");
    return command;
}

bool RemoveAnimationCmd::edit(AnimationLists& lists) const {
    const Animation* found = find(lists, name_, start_);
    if (!found) return false;
    Animations& list = lists[name_];
    list.erase(list.begin() + (found - list.data()));
    return true;
}

boost::shared_ptr<RemoveAllAnimationsCmd> RemoveAllAnimationsCmd::create(const MediaPtr& media,
                                                                         const std::string& parameterName) {
    boost::shared_ptr<RemoveAllAnimationsCmd> command(new RemoveAllAnimationsCmd(media, parameterName));
    command->setName("Remove All Animations");
    return command;
}

bool RemoveAllAnimationsCmd::edit(AnimationLists& lists) const {
    if (name_.empty())
        lists.clear();
    else
        lists.erase(name_);
    return true; // removing nothing changes nothing, which refuses the command
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/MergeAnimationsCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<MergeAnimationsCmd> MergeAnimationsCmd::create(const MediaPtr& media,
                                                                 const std::string& parameterName,
                                                                 VelaTime firstStart, VelaTime secondStart) {
    if (firstStart >= secondStart)
        throw ValueException<long long>("the first animation to merge starts before the second", firstStart);
    boost::shared_ptr<MergeAnimationsCmd> command(
        new MergeAnimationsCmd(media, parameterName, firstStart, secondStart));
    command->setName("Merge Animations");
    return command;
}

bool MergeAnimationsCmd::edit(AnimationLists& lists) const {
    Animation* first = find(lists, name_, first_);
    const Animation* second = find(lists, name_, second_);
    if (!first || !second) return false;
    for (const Animation& other : lists[name_])
        if (other.range.start() > first_ && other.range.start() < second_) return false;
    const VelaTime end = second->range.end();
    first->keyframes = second->keyframes;
    first->duration = end - first_;
    reshape(*first, first_, end - first_);
    Animations& list = lists[name_];
    list.erase(list.begin() + (second - list.data()));
    return true;
}

} // namespace VelaMediaLib

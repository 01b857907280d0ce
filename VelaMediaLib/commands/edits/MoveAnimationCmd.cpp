#include <VelaMediaLib/commands/edits/MoveAnimationCmd.h>

#include <algorithm>

namespace VelaMediaLib {

boost::shared_ptr<MoveAnimationsCmd> MoveAnimationsCmd::create(const MediaPtr& media,
                                                               const std::string& parameterName,
                                                               const std::vector<VelaTime>& starts,
                                                               VelaTime delta) {
    if (starts.empty()) throw VelaMediaLibException("no animations to move");
    boost::shared_ptr<MoveAnimationsCmd> command(new MoveAnimationsCmd(media, parameterName, starts, delta));
    command->setName("Move Animations");
    return command;
}

// Each animation is found before any moves, so one moved onto another's old
// start is not taken for it.
bool MoveAnimationsCmd::edit(AnimationLists& lists) const {
    std::vector<Animation*> moved;
    for (VelaTime start : starts_) {
        Animation* found = find(lists, name_, start);
        if (!found) return false;
        if (std::find(moved.begin(), moved.end(), found) == moved.end()) moved.push_back(found);
    }
    for (Animation* animation : moved) {
        const VelaTime start = animation->range.start() + delta_;
        if (start < 0) return false;
        animation->range = Range<long long>(start, animation->range.duration());
        animation->endTime += delta_;
    }
    return true; // an overlap refuses the changed track, a delta of 0 changes nothing
}

boost::shared_ptr<MoveAnimationCmd> MoveAnimationCmd::create(const MediaPtr& media,
                                                             const std::string& parameterName, VelaTime start,
                                                             VelaTime delta) {
    boost::shared_ptr<MoveAnimationCmd> command(new MoveAnimationCmd(media, parameterName, start, delta));
    command->setName("Move Animation");
    return command;
}

} // namespace VelaMediaLib

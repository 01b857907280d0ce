#include <VelaMediaLib/commands/edits/SplitAnimationCmd.h>

#include <algorithm>

namespace VelaMediaLib {

boost::shared_ptr<SplitAnimationCmd> SplitAnimationCmd::create(const MediaPtr& media,
                                                               const std::string& parameterName,
                                                               VelaTime start, VelaTime splitTime) {
    boost::shared_ptr<SplitAnimationCmd> command(
        new SplitAnimationCmd(media, parameterName, start, splitTime));
    command->setName("Split Animation");
    return command;
}

// The transition runs over [end - lead-in, end]; each part keeps the piece
// of it that lies within the part.
bool SplitAnimationCmd::edit(AnimationLists& lists) const {
    Animation* found = find(lists, name_, start_);
    if (!found || at_ <= start_ || at_ >= found->range.end()) return false;
    const VelaTime end = found->range.end();
    const VelaTime transitionStart = found->endTime - found->duration;
    Animation second = *found;
    second.duration = std::min<VelaTime>(found->duration, end - at_);
    reshape(second, at_, end - at_);
    found->duration = std::max<VelaTime>(0, at_ - transitionStart);
    reshape(*found, start_, at_ - start_);
    lists[name_].push_back(second);
    return true;
}

} // namespace VelaMediaLib

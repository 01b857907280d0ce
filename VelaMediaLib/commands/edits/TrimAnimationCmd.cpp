#include <VelaMediaLib/commands/edits/TrimAnimationCmd.h>

#include <algorithm>

namespace VelaMediaLib {

boost::shared_ptr<TrimAnimationStartCmd> TrimAnimationStartCmd::create(const MediaPtr& media,
                                                                       const std::string& parameterName,
                                                                       VelaTime start, VelaTime delta) {
    boost::shared_ptr<TrimAnimationStartCmd> command(
        new TrimAnimationStartCmd(media, parameterName, start, delta));
    command->setName("Trim Animation Start");
    return command;
}

bool TrimAnimationStartCmd::edit(AnimationLists& lists) const {
    Animation* found = find(lists, name_, start_);
    if (!found) return false;
    const VelaTime start = start_ + delta_, length = found->range.end() - start;
    if (start < 0 || length < 1) return false;
    reshape(*found, start, length);
    return true;
}

boost::shared_ptr<TrimAnimationEndCmd> TrimAnimationEndCmd::create(const MediaPtr& media,
                                                                   const std::string& parameterName,
                                                                   VelaTime start, VelaTime delta) {
    boost::shared_ptr<TrimAnimationEndCmd> command(
        new TrimAnimationEndCmd(media, parameterName, start, delta));
    command->setName("Trim Animation End");
    return command;
}

bool TrimAnimationEndCmd::edit(AnimationLists& lists) const {
    Animation* found = find(lists, name_, start_);
    if (!found) return false;
    const VelaTime length = found->range.duration() - delta_;
    if (length < 1) return false;
    found->duration = std::max<VelaTime>(0, found->duration - delta_);
    reshape(*found, start_, length);
    return true;
}

} // namespace VelaMediaLib

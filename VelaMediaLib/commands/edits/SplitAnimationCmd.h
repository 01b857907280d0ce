#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

namespace VelaMediaLib {

/// Splits the animation of a parameter that starts at a tick into two at a
/// tick strictly inside it. Both parts keep its interpolater code and
/// description; its transition is cut where it lies, so the first part leads
/// in over what of the transition came before the cut (none when it began
/// after) and the second over the rest. Refused (false) when none starts
/// there or the cut is not inside it.
class VELAMEDIALIB_API SplitAnimationCmd : public AnimationTracksEditCmd {
public:
    static boost::shared_ptr<SplitAnimationCmd>
    create(const MediaPtr& media, const std::string& parameterName, VelaTime start, VelaTime splitTime);

private:
    SplitAnimationCmd(const MediaPtr& media, const std::string& name, VelaTime start, VelaTime at)
        : AnimationTracksEditCmd(media), name_(name), start_(start), at_(at) {}
    bool edit(AnimationLists& lists) const override;

    std::string name_;
    VelaTime start_, at_;
};

} // namespace VelaMediaLib

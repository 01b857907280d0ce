#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

namespace VelaMediaLib {

/// Moves the start edge of the animation of a parameter that starts at a
/// tick by a tick delta (positive shortens it), its end staying; the lead-in
/// is cut to the new length. Refused (false) when none starts there, when it
/// would last less than a tick, start before the clip's start or overlap the
/// animation before it, and for a delta of 0.
class VELAMEDIALIB_API TrimAnimationStartCmd : public AnimationTracksEditCmd {
public:
    static boost::shared_ptr<TrimAnimationStartCmd>
    create(const MediaPtr& media, const std::string& parameterName, VelaTime start, VelaTime delta);

private:
    TrimAnimationStartCmd(const MediaPtr& media, const std::string& name, VelaTime start, VelaTime delta)
        : AnimationTracksEditCmd(media), name_(name), start_(start), delta_(delta) {}
    bool edit(AnimationLists& lists) const override;

    std::string name_;
    VelaTime start_, delta_;
};

/// Moves the end edge of the animation of a parameter that starts at a tick
/// in by a tick delta (positive shortens it, negative lengthens it), its
/// start staying; the transition keeps its start, so the lead-in shrinks or
/// grows by the delta (never below 0). Refused (false) when none starts
/// there, when it would last less than a tick or overlap the animation after
/// it, and for a delta of 0.
class VELAMEDIALIB_API TrimAnimationEndCmd : public AnimationTracksEditCmd {
public:
    static boost::shared_ptr<TrimAnimationEndCmd>
    create(const MediaPtr& media, const std::string& parameterName, VelaTime start, VelaTime delta);

private:
    TrimAnimationEndCmd(const MediaPtr& media, const std::string& name, VelaTime start, VelaTime delta)
        : AnimationTracksEditCmd(media), name_(name), start_(start), delta_(delta) {}
    bool edit(AnimationLists& lists) const override;

    std::string name_;
    VelaTime start_, delta_;
};

} // namespace VelaMediaLib

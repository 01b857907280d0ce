#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

namespace VelaMediaLib {

/// Adds an animation of one of the clip's parameters over a tick range of the
/// clip's parametric time (from 0, the clip's start): one transition over the
/// whole range ("duration" its length) with an interpolater code ("linr"
/// unless given; empty for the automatic curve) and no keyframe description.
/// create throws for a parameter the clip does not have, a range starting
/// before 0 or shorter than a tick, and an unknown code; execute is refused
/// (false) when the range overlaps an animation of that parameter.
class VELAMEDIALIB_API AddAnimationCmd : public AnimationTracksEditCmd {
public:
    static boost::shared_ptr<AddAnimationCmd> create(const MediaPtr& media, const std::string& parameterName,
                                                     const Range<VelaTime>& range,
                                                     const std::string& interpolater = "linr");

protected:
    AddAnimationCmd(const MediaPtr& media, const std::string& name, const Animation& animation)
        : AnimationTracksEditCmd(media), name_(name), animation_(animation) {}
    bool edit(AnimationLists& lists) const override;
    /// The checks both additions share.
    static void checkAddition(const MediaPtr& media, const std::string& name, const Animation& animation);

    std::string name_;
    Animation animation_;
};

/// Adds a whole animation as described (a preset): its range, its end
/// ("endTime", which must be the range's end), its lead-in ("duration",
/// from 0 to its length), its interpolater code, and its keyframes, each
/// naming a parameter of the clip, the value that parameter reaches (in that
/// parameter's document form) and the code leading into it. create throws as
/// AddAnimationCmd's does, and for a description naming a parameter the clip
/// lacks, an unknown code, or an inconsistent end or lead-in; execute is
/// refused (false) when the range overlaps an animation of that parameter.
class VELAMEDIALIB_API AddAnimationWithDescriptionCmd : public AddAnimationCmd {
public:
    static boost::shared_ptr<AddAnimationWithDescriptionCmd>
    create(const MediaPtr& media, const std::string& parameterName,
           const AnimationTrack::Animation& animation);

private:
    AddAnimationWithDescriptionCmd(const MediaPtr& media, const std::string& name, const Animation& animation)
        : AddAnimationCmd(media, name, animation) {}
};

} // namespace VelaMediaLib

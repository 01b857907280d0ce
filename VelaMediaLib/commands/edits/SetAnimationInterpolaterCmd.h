#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

namespace VelaMediaLib {

/// Gives the animation of a parameter that starts at a tick another
/// interpolater code ("linr", "esIn", ...; empty for the automatic curve).
/// create throws for an unknown code; execute is refused (false) when none
/// starts there or it has that code already.
class VELAMEDIALIB_API SetAnimationInterpolaterCmd : public AnimationTracksEditCmd {
public:
    static boost::shared_ptr<SetAnimationInterpolaterCmd> create(const MediaPtr& media,
                                                                 const std::string& parameterName,
                                                                 VelaTime start,
                                                                 const std::string& interpolater);

private:
    SetAnimationInterpolaterCmd(const MediaPtr& media, const std::string& name, VelaTime start,
                                const std::string& code)
        : AnimationTracksEditCmd(media), name_(name), start_(start), code_(code) {}
    bool edit(AnimationLists& lists) const override;

    std::string name_;
    VelaTime start_;
    std::string code_;
};

/// Turns automatic interpolation of a parameter's animations on or off. An
/// animation without an interpolater code takes the automatic curve; turning
/// it on clears the code of every animation of the parameter, turning it off
/// gives those without a code the fixed one (linear, "linr", unless given).
/// create throws for an unknown or empty fixed code; execute is refused
/// (false) when nothing changes.
class VELAMEDIALIB_API SetAnimationAutoInterpolationCmd : public AnimationTracksEditCmd {
public:
    static boost::shared_ptr<SetAnimationAutoInterpolationCmd> create(const MediaPtr& media,
                                                                      const std::string& parameterName,
                                                                      bool automatic,
                                                                      const std::string& fixed = "linr");

private:
    SetAnimationAutoInterpolationCmd(const MediaPtr& media, const std::string& name, bool automatic,
                                     const std::string& fixed)
        : AnimationTracksEditCmd(media), name_(name), automatic_(automatic), fixed_(fixed) {}
    bool edit(AnimationLists& lists) const override;

    std::string name_;
    bool automatic_;
    std::string fixed_;
};

} // namespace VelaMediaLib

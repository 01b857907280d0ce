#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

namespace VelaMediaLib {

/// Moves several animations of a parameter, named by their start ticks, by
/// one tick delta together, keeping their lengths and lead-ins: all or none.
/// Refused (false) when one of them is missing, when any would start before
/// the clip's start or overlap another animation afterwards (the moved ones
/// may pass where others stood), and for a delta of 0. create throws for an
/// empty list.
class VELAMEDIALIB_API MoveAnimationsCmd : public AnimationTracksEditCmd {
public:
    static boost::shared_ptr<MoveAnimationsCmd> create(const MediaPtr& media,
                                                       const std::string& parameterName,
                                                       const std::vector<VelaTime>& starts, VelaTime delta);

protected:
    MoveAnimationsCmd(const MediaPtr& media, const std::string& name, const std::vector<VelaTime>& starts,
                      VelaTime delta)
        : AnimationTracksEditCmd(media), name_(name), starts_(starts), delta_(delta) {}
    bool edit(AnimationLists& lists) const override;

private:
    std::string name_;
    std::vector<VelaTime> starts_;
    VelaTime delta_;
};

/// Moves the animation of a parameter that starts at a tick by a tick delta,
/// as MoveAnimationsCmd moves one.
class VELAMEDIALIB_API MoveAnimationCmd : public MoveAnimationsCmd {
public:
    static boost::shared_ptr<MoveAnimationCmd> create(const MediaPtr& media, const std::string& parameterName,
                                                      VelaTime start, VelaTime delta);

private:
    MoveAnimationCmd(const MediaPtr& media, const std::string& name, VelaTime start, VelaTime delta)
        : MoveAnimationsCmd(media, name, {start}, delta) {}
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

namespace VelaMediaLib {

/// Removes the animation of a parameter that starts at a tick; refused
/// (false) when none starts there.
class VELAMEDIALIB_API RemoveAnimationCmd : public AnimationTracksEditCmd {
public:
    static boost::shared_ptr<RemoveAnimationCmd> create(const MediaPtr& media,
                                                        const std::string& parameterName, VelaTime start);

private:
    RemoveAnimationCmd(const MediaPtr& media, const std::string& name, VelaTime start)
        : AnimationTracksEditCmd(media), name_(name), start_(start) {}
    bool edit(AnimationLists& lists) const override;

    std::string name_;
    VelaTime start_;
};

/// Removes every animation of a parameter, or of all the clip's parameters
/// when the name is empty; refused (false) when there is none.
class VELAMEDIALIB_API RemoveAllAnimationsCmd : public AnimationTracksEditCmd {
public:
    static boost::shared_ptr<RemoveAllAnimationsCmd> create(const MediaPtr& media,
                                                            const std::string& parameterName = std::string());

private:
    RemoveAllAnimationsCmd(const MediaPtr& media, const std::string& name)
        : AnimationTracksEditCmd(media), name_(name) {}
    bool edit(AnimationLists& lists) const override;

    std::string name_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

namespace VelaMediaLib {

/// Merges two neighbouring animations of a parameter (named by their start
/// ticks, the first earlier) into one from the first's start to the second's
/// end: one transition over the whole span with the first's interpolater
/// code, reaching the values the second describes. Refused (false) when
/// either is missing or another animation of the parameter lies between.
/// create throws when the first does not start before the second.
class VELAMEDIALIB_API MergeAnimationsCmd : public AnimationTracksEditCmd {
public:
    static boost::shared_ptr<MergeAnimationsCmd> create(const MediaPtr& media,
                                                        const std::string& parameterName, VelaTime firstStart,
                                                        VelaTime secondStart);

private:
    MergeAnimationsCmd(const MediaPtr& media, const std::string& name, VelaTime first, VelaTime second)
        : AnimationTracksEditCmd(media), name_(name), first_(first), second_(second) {}
    bool edit(AnimationLists& lists) const override;

    std::string name_;
    VelaTime first_, second_;
};

} // namespace VelaMediaLib

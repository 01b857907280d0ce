#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

namespace VelaMediaLib {

/// Moves a parameter's keyframe from one end time to another, keeping its
/// value, lead-in and interpolater. Refused (false) when no keyframe ends at
/// the first time, one already ends at the second, or the parameter does not
/// let it stand there; create throws for a null parameter.
class VELAMEDIALIB_API MoveParameterKeyFrameCmd : public ParameterCurvesEditCmd {
public:
    static boost::shared_ptr<MoveParameterKeyFrameCmd>
    create(const ParameterPtr& parameter, const RationalTime& from, const RationalTime& to);

private:
    MoveParameterKeyFrameCmd(const ParameterPtr& parameter, const RationalTime& from, const RationalTime& to)
        : parameter_(parameter), from_(from), to_(to) {}
    bool edit() override;

    ParameterPtr parameter_;
    RationalTime from_, to_;
};

} // namespace VelaMediaLib

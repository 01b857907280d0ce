#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

namespace VelaMediaLib {

/// Removes the keyframe of a parameter that ends at a time. Refused (false)
/// when none ends there or it is the parameter's only keyframe (a parameter
/// always keeps one); create throws for a null parameter.
class VELAMEDIALIB_API RemoveParameterKeyFrameCmd : public ParameterCurvesEditCmd {
public:
    static boost::shared_ptr<RemoveParameterKeyFrameCmd> create(const ParameterPtr& parameter,
                                                                const RationalTime& time);

private:
    RemoveParameterKeyFrameCmd(const ParameterPtr& parameter, const RationalTime& time)
        : parameter_(parameter), time_(time) {}
    bool edit() override;

    ParameterPtr parameter_;
    RationalTime time_;
};

/// Removes every keyframe of a parameter: it becomes constant, holding the
/// value it had at the given time (0 unless given) as its only keyframe, at
/// time 0. Refused (false) when it already holds just that; create throws
/// for a null parameter.
class VELAMEDIALIB_API RemoveAllKeyFramesCmd : public ParameterCurvesEditCmd {
public:
    static boost::shared_ptr<RemoveAllKeyFramesCmd> create(const ParameterPtr& parameter,
                                                           const RationalTime& valueAt = RationalTime(0));

private:
    RemoveAllKeyFramesCmd(const ParameterPtr& parameter, const RationalTime& valueAt)
        : parameter_(parameter), valueAt_(valueAt) {}
    bool edit() override;

    ParameterPtr parameter_;
    RationalTime valueAt_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

namespace VelaMediaLib {

/// Adds a copy of a keyframe (its end time, lead-in, value, interpolater and
/// metadata, as it was when the command was made) to a parameter of the same
/// value type; a keyframe already at that time is replaced, and undo gives it
/// back. create throws for a null parameter or keyframe and TypeException for
/// a keyframe of another value type; execute is refused (false) where the
/// parameter does not let the keyframe stand (its placement rule).
class VELAMEDIALIB_API AddParameterKeyFrameInterfaceCmd : public ParameterCurvesEditCmd {
public:
    static boost::shared_ptr<AddParameterKeyFrameInterfaceCmd>
    create(const ParameterPtr& parameter, const boost::shared_ptr<KeyFrameInterface>& keyframe);

private:
    AddParameterKeyFrameInterfaceCmd(const ParameterPtr& parameter,
                                     const boost::shared_ptr<KeyFrameInterface>& keyframe)
        : parameter_(parameter), keyframe_(keyframe) {}
    bool edit() override;

    ParameterPtr parameter_;
    boost::shared_ptr<KeyFrameInterface> keyframe_;
};

} // namespace VelaMediaLib

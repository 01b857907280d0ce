#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

namespace VelaMediaLib {

/// Makes a number parameter hold a value over a range [start, start +
/// duration) of its time, leaving the curve's keyframes outside the range:
/// the keyframes inside are removed, one at the start takes the value and one
/// at the end the value the curve had there, each with a step into it (the
/// "left" interpolater), so the value changes exactly at the range's edges.
/// The segment leading into the range holds its earlier keyframe's value up
/// to the start, so a constant curve stays constant outside the range.
/// create throws for a null parameter, a range without length and a value
/// that is not a number; execute is refused (false) when the parameter does
/// not let a keyframe stand at an edge (a lead-in from a keyframe after the
/// range reaching into it, or a parameter whose keyframes need lead-ins).
class VELAMEDIALIB_API SetDoubleParameterValueInRangeCmd : public ParameterCurvesEditCmd {
public:
    static boost::shared_ptr<SetDoubleParameterValueInRangeCmd>
    create(const boost::shared_ptr<Parameter<double>>& parameter, const Range<RationalTime>& range,
           double value);

    /// The edit itself, on a parameter already recorded.
    static void setInRange(Parameter<double>& parameter, const Range<RationalTime>& range, double value);
    /// The checks of create, the parameter aside.
    static void checkRange(const Range<RationalTime>& range, double value);

private:
    SetDoubleParameterValueInRangeCmd(const boost::shared_ptr<Parameter<double>>& parameter,
                                      const Range<RationalTime>& range, double value)
        : parameter_(parameter), range_(range), value_(value) {}
    bool edit() override;

    boost::shared_ptr<Parameter<double>> parameter_;
    Range<RationalTime> range_;
    double value_;
};

/// Sets a clip's volume over a tick range of its parametric time, as
/// SetDoubleParameterValueInRangeCmd sets a parameter. The volume parameter
/// is made when the command runs if the clip had not made it, and forgotten
/// again on undo. create throws for a clip without a volume, a range without
/// length and a volume below 0 or not a number.
class VELAMEDIALIB_API SetVolumeInRangeCmd : public ParameterCurvesEditCmd {
public:
    static boost::shared_ptr<SetVolumeInRangeCmd> create(const MediaPtr& media, const Range<VelaTime>& range,
                                                         double volume);

private:
    SetVolumeInRangeCmd(const MediaPtr& media, const Range<VelaTime>& range, double volume)
        : media_(media), range_(range), volume_(volume) {}
    bool edit() override;

    MediaPtr media_;
    Range<VelaTime> range_;
    double volume_;
};

} // namespace VelaMediaLib

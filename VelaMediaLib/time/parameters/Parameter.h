#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/TimeExceptions.h>
#include <VelaMediaLib/time/parameters/KeyFrame.h>
#include <VelaMediaLib/time/parameters/ParameterInterface.h>

namespace VelaMediaLib {

/// The typed operations of a keyframed parameter of value type T.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API Parameter : public ParameterInterface {
public:
    typedef T ValueType;
    typedef KeyFrame<T> KeyFrameType;
    typedef boost::shared_ptr<KeyFrame<T>> KeyFramePtr;
    typedef boost::shared_ptr<const KeyFrame<T>> ConstKeyFramePtr;
    typedef boost::shared_ptr<Interpolater<T>> InterpolaterPtr;

    using ParameterInterface::ParameterInterface;

    /// Throws KeyFrameException (time 0) when the parameter has no keyframe.
    virtual T valueAtTime(const RationalTime& time) const = 0;
    virtual KeyFramePtr keyframeAtTime(const RationalTime& time) = 0;
    virtual ConstKeyFramePtr keyframeAtTime(const RationalTime& time) const = 0;
    /// The interpolater of the segment that ends at the keyframe.
    virtual InterpolaterPtr interpolaterForKeyFrame(const ConstKeyFramePtr& keyframe) const = 0;

    /// Makes the parameter constant: one keyframe at time 0 holding the value.
    /// Returns the value it had at time 0.
    virtual T setDefaultValue(const T& value) = 0;
    /// Sets the keyframe at exactly that time; throws VelaMediaLibException
    /// "error" when there is none. Returns the value it had.
    virtual T setValueAtTime(const T& value, const RationalTime& time) = 0;
    /// Throws KeyFrameException when the keyframe may not stand there with that
    /// lead-in; a keyframe already at that time takes the value and lead-in.
    virtual void addKeyFrame(const RationalTime& time, const T& value, const RationalTime& leadIn) = 0;
    virtual void addKeyFrame(const KeyFramePtr& keyframe) = 0;
    /// The removed keyframe, or null when there was none or it was the only one.
    virtual KeyFramePtr removeKeyFrame(const RationalTime& time) = 0;
    /// Throws KeyFrameException when there is no keyframe at that time. Returns the value it had.
    virtual T changeKeyFrame(const RationalTime& time, const T& value) = 0;
    virtual T changeKeyFrame(const ConstKeyFramePtr& keyframe, const T& value) = 0;
    /// Puts the keyframe in place at the time; returns the keyframe it replaced, if any.
    virtual KeyFramePtr changeKeyFrame(const RationalTime& time, const KeyFramePtr& keyframe) = 0;

    /// The part of the curve inside the range, with times counted from the range's start.
    virtual boost::shared_ptr<Parameter<T>> copyPortion(const Range<RationalTime>& range) const = 0;

    /// Same type name and the same keyframes (times, lead-ins, values, interpolaters).
    virtual bool operator==(const Parameter<T>& other) const = 0;
    bool operator!=(const Parameter<T>& other) const { return !(*this == other); }
};

} // namespace VelaMediaLib

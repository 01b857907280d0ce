#pragma once

#include <VelaMediaLib/time/InterpolaterNameConstants.h>
#include <VelaMediaLib/time/InterpolaterUtil.h>
#include <VelaMediaLib/time/TweenableInterpolater.h>

namespace VelaMediaLib {

/// A quadratic in-out curve.
template <typename T>
class EaseInOutDoubleExponentialSigmoidInterpolater
    : public TweenableInterpolater<T>,
      public SharedInterpolaterInstance<EaseInOutDoubleExponentialSigmoidInterpolater<T>> {
public:
    double ease(double u) const override { return InterpolaterUtil::easeInOutDoubleExponentialSigmoid(u); }

private:
    friend class SharedInterpolaterInstance<EaseInOutDoubleExponentialSigmoidInterpolater<T>>;
    EaseInOutDoubleExponentialSigmoidInterpolater()
        : TweenableInterpolater<T>(InterpolaterNameConstants::s_easeInOutDoubleExponentialSigmoidName) {}
};

} // namespace VelaMediaLib

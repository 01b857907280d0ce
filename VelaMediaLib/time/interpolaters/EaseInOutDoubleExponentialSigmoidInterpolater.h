#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterNameConstants.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterUtil.h>
#include <VelaMediaLib/time/interpolaters/TweenableInterpolater.h>

namespace VelaMediaLib {

/// A quadratic in-out curve.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API EaseInOutDoubleExponentialSigmoidInterpolater
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

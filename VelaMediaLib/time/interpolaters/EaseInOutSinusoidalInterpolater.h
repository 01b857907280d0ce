#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterNameConstants.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterUtil.h>
#include <VelaMediaLib/time/interpolaters/TweenableInterpolater.h>

namespace VelaMediaLib {

/// Half a sine wave: slow, fast, slow.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API EaseInOutSinusoidalInterpolater
    : public TweenableInterpolater<T>,
      public SharedInterpolaterInstance<EaseInOutSinusoidalInterpolater<T>> {
public:
    double ease(double u) const override { return InterpolaterUtil::easeInOutSinusoidal(u); }

private:
    friend class SharedInterpolaterInstance<EaseInOutSinusoidalInterpolater<T>>;
    EaseInOutSinusoidalInterpolater()
        : TweenableInterpolater<T>(InterpolaterNameConstants::s_easeInOutSinusoidalName) {}
};

} // namespace VelaMediaLib

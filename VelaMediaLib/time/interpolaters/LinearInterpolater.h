#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterNameConstants.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterUtil.h>
#include <VelaMediaLib/time/interpolaters/TweenableInterpolater.h>

namespace VelaMediaLib {

/// Straight-line motion.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API LinearInterpolater
    : public TweenableInterpolater<T>,
      public SharedInterpolaterInstance<LinearInterpolater<T>> {
public:
    double ease(double u) const override { return InterpolaterUtil::linear(u); }

private:
    friend class SharedInterpolaterInstance<LinearInterpolater<T>>;
    LinearInterpolater() : TweenableInterpolater<T>(InterpolaterNameConstants::s_linearName) {}
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterNameConstants.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterUtil.h>
#include <VelaMediaLib/time/interpolaters/TweenableInterpolater.h>

namespace VelaMediaLib {

/// Arrives like a dropped ball, bouncing on the value.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API BounceInterpolater
    : public TweenableInterpolater<T>,
      public SharedInterpolaterInstance<BounceInterpolater<T>> {
public:
    double ease(double u) const override { return InterpolaterUtil::bounce(u); }

private:
    friend class SharedInterpolaterInstance<BounceInterpolater<T>>;
    BounceInterpolater() : TweenableInterpolater<T>(InterpolaterNameConstants::s_bounceName) {}
};

} // namespace VelaMediaLib

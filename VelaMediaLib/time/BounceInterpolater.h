#pragma once

#include <VelaMediaLib/time/InterpolaterNameConstants.h>
#include <VelaMediaLib/time/InterpolaterUtil.h>
#include <VelaMediaLib/time/TweenableInterpolater.h>

namespace VelaMediaLib {

/// Arrives like a dropped ball, bouncing on the value.
template <typename T>
class BounceInterpolater : public TweenableInterpolater<T>,
                           public SharedInterpolaterInstance<BounceInterpolater<T>> {
public:
    double ease(double u) const override { return InterpolaterUtil::bounce(u); }

private:
    friend class SharedInterpolaterInstance<BounceInterpolater<T>>;
    BounceInterpolater() : TweenableInterpolater<T>(InterpolaterNameConstants::s_bounceName) {}
};

} // namespace VelaMediaLib

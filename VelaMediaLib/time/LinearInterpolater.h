#pragma once

#include <VelaMediaLib/time/InterpolaterNameConstants.h>
#include <VelaMediaLib/time/InterpolaterUtil.h>
#include <VelaMediaLib/time/TweenableInterpolater.h>

namespace VelaMediaLib {

/// Straight-line motion.
template <typename T>
class LinearInterpolater : public TweenableInterpolater<T>,
                           public SharedInterpolaterInstance<LinearInterpolater<T>> {
public:
    double ease(double u) const override { return InterpolaterUtil::linear(u); }

private:
    friend class SharedInterpolaterInstance<LinearInterpolater<T>>;
    LinearInterpolater() : TweenableInterpolater<T>(InterpolaterNameConstants::s_linearName) {}
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/interpolaters/Interpolater.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterNameConstants.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterUtil.h>

namespace VelaMediaLib {

/// A step: the value stays at the earlier keyframe's until the next is reached.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API LeftInterpolater : public Interpolater<T>,
                                                   public SharedInterpolaterInstance<LeftInterpolater<T>> {
public:
    T doInterpolate(const T& a, const T&, const RationalTime&, const RationalTime&, double) const override {
        return a;
    }
    double ease(double u) const override { return InterpolaterUtil::left(u); }

private:
    friend class SharedInterpolaterInstance<LeftInterpolater<T>>;
    LeftInterpolater() : Interpolater<T>(InterpolaterNameConstants::s_leftName) {}
};

} // namespace VelaMediaLib

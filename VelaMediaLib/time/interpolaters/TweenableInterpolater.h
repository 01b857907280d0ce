#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/interpolaters/Interpolater.h>
#include <VelaMediaLib/time/parameters/ValueTraits.h>

namespace VelaMediaLib {

/// The kinds that blend the two values by an easing weight:
/// u = (t - t0) / (t1 - t0), w = ease(u), value = w*b + (1 - w)*a.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API TweenableInterpolater : public Interpolater<T> {
    static_assert(ValueTraits<T>::interpolation != Interpolation::Step, "the value type does not tween");

public:
    T doInterpolate(const T& a, const T& b, const RationalTime& t0, const RationalTime& t1,
                    double t) const override {
        const double start = t0.asDouble(), end = t1.asDouble();
        const double u = end == start ? 1.0 : (t - start) / (end - start);
        return ValueTraits<T>::blend(a, b, this->ease(u));
    }

protected:
    using Interpolater<T>::Interpolater;
};

} // namespace VelaMediaLib

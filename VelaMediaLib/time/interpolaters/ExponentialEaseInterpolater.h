#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterUtil.h>
#include <VelaMediaLib/time/interpolaters/TweenableInterpolater.h>

namespace VelaMediaLib {

/// Ease in and ease out differ only in the exponent of u.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API ExponentialEaseInterpolater : public TweenableInterpolater<T> {
public:
    double exponent() const { return exponent_; }
    double ease(double u) const override { return InterpolaterUtil::easeExponential(u, exponent_); }
    bool sameAs(const Interpolater<T>& other) const override {
        return TweenableInterpolater<T>::sameAs(other) &&
               static_cast<const ExponentialEaseInterpolater&>(other).exponent_ == exponent_;
    }

protected:
    ExponentialEaseInterpolater(const char* name, double exponent)
        : TweenableInterpolater<T>(name), exponent_(exponent) {}

private:
    const double exponent_;
};

} // namespace VelaMediaLib

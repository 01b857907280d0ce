#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterNameConstants.h>
#include <VelaMediaLib/time/interpolaters/SpringResponse.h>
#include <VelaMediaLib/time/interpolaters/TweenableInterpolater.h>

namespace VelaMediaLib {

/// Arrives like a mass on a spring (damping 10, stiffness 100 for the shared
/// instance), overshooting the value and settling on it.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API SpringInterpolater
    : public TweenableInterpolater<T>,
      public SharedInterpolaterInstance<SpringInterpolater<T>> {
public:
    /// Throws ValueException<double> when damping or stiffness is zero or less.
    SpringInterpolater(double damping, double stiffness)
        : TweenableInterpolater<T>(InterpolaterNameConstants::s_springName), spring_(damping, stiffness) {}

    double ease(double u) const override { return spring_.weight(u); }
    const SpringResponse& spring() const { return spring_; }
    bool sameAs(const Interpolater<T>& other) const override {
        if (!TweenableInterpolater<T>::sameAs(other)) return false;
        const SpringResponse& theirs = static_cast<const SpringInterpolater&>(other).spring_;
        return theirs.damping() == spring_.damping() && theirs.stiffness() == spring_.stiffness();
    }

private:
    friend class SharedInterpolaterInstance<SpringInterpolater<T>>;
    SpringInterpolater() : SpringInterpolater(10.0, 100.0) {}

    const SpringResponse spring_;
};

} // namespace VelaMediaLib

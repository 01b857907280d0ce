#pragma once

#include <VelaMediaLib/base/Export.h>

namespace VelaMediaLib {

/// The step response of a damped harmonic oscillator (mass 1), scaled so that
/// an easing weight runs from 0 at u = 0 to exactly 1 at u = 1: u is mapped
/// onto the settling time, the first time after which the response stays
/// within one thousandth of 1, and the response is divided by its value there.
class VELAMEDIALIB_API SpringResponse {
public:
    static constexpr double kSettlingTolerance = 0.001;

    /// Throws ValueException<double> when damping or stiffness is zero or less.
    SpringResponse(double damping, double stiffness);

    double damping() const { return damping_; }
    double stiffness() const { return stiffness_; }
    double settlingTime() const { return settlingTime_; }
    /// The response at time tau; a NaN oscillation term counts as 0.
    double response(double tau) const;
    /// The easing weight at u.
    double weight(double u) const { return response(u * settlingTime_) / normaliser_; }

private:
    /// How far the response may still be from 1 at tau (a bound that only falls).
    double deviationBound(double tau) const;

    double damping_, stiffness_;
    double half_;         // damping / 2
    double discriminant_; // stiffness - half^2: > 0 underdamped, 0 critical, < 0 overdamped
    double omega_;        // sqrt(|discriminant|)
    double settlingTime_ = 1.0;
    double normaliser_ = 1.0;
};

} // namespace VelaMediaLib

#include <VelaMediaLib/time/interpolaters/SpringResponse.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <cmath>

namespace VelaMediaLib {

SpringResponse::SpringResponse(double damping, double stiffness)
    : damping_(damping), stiffness_(stiffness), half_(damping / 2.0),
      discriminant_(stiffness - half_ * half_), omega_(std::sqrt(std::fabs(discriminant_))) {
    if (!(damping > 0.0)) throw ValueException<double>("spring damping must be greater than zero", damping);
    if (!(stiffness > 0.0))
        throw ValueException<double>("spring stiffness must be greater than zero", stiffness);
    // Bisection on the falling deviation bound for where it meets the tolerance.
    double lo = 0.0, hi = 1.0;
    while (deviationBound(hi) > kSettlingTolerance) hi *= 2.0;
    for (int i = 0; i < 200 && hi - lo > 1e-12; ++i) {
        const double middle = 0.5 * (lo + hi);
        (deviationBound(middle) > kSettlingTolerance ? lo : hi) = middle;
    }
    settlingTime_ = hi;
    normaliser_ = response(settlingTime_);
}

double SpringResponse::response(double tau) const {
    double oscillation;
    if (discriminant_ > 0.0) {
        oscillation =
            std::exp(-half_ * tau) * (std::cos(omega_ * tau) + (half_ / omega_) * std::sin(omega_ * tau));
    } else if (discriminant_ == 0.0) {
        oscillation = std::exp(-half_ * tau) * (1.0 + half_ * tau);
    } else {
        const double slow = half_ - omega_, fast = half_ + omega_;
        oscillation = (fast * std::exp(-slow * tau) - slow * std::exp(-fast * tau)) / (fast - slow);
    }
    return 1.0 - (std::isnan(oscillation) ? 0.0 : oscillation);
}

double SpringResponse::deviationBound(double tau) const {
    if (discriminant_ > 0.0)
        return std::exp(-half_ * tau) * std::sqrt(1.0 + (half_ / omega_) * (half_ / omega_));
    return std::fabs(1.0 - response(tau)); // without oscillation the deviation itself only falls
}

} // namespace VelaMediaLib

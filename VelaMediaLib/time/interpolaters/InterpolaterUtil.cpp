#include <VelaMediaLib/time/interpolaters/InterpolaterUtil.h>

#include <algorithm>
#include <cmath>
#include <cstdint>

namespace VelaMediaLib {

double InterpolaterUtil::easeExponential(double u, double exponent) { return std::pow(u, exponent); }

double InterpolaterUtil::easeInOutSinusoidal(double u) { return 0.5 + 0.5 * std::sin(M_PI * u - M_PI / 2.0); }

double InterpolaterUtil::easeInOutDoubleExponentialSigmoid(double u) {
    if (u < 0.5) return 0.5 * std::pow(2.0 * u, 2.0);
    return 1.0 - 0.5 * std::pow(2.0 * (1.0 - u), 2.0);
}

double InterpolaterUtil::bounce(double u) {
    const double elasticity = 0.45, offset = 0.5;
    const double e = std::max(0.0, std::min(0.999999, elasticity));
    const double logE = std::log(e);
    const double d = e - 1.0;
    const int32_t bounces = int32_t(std::ceil(std::log(0.0002) / logE));
    const double total = (std::pow(e, bounces) - 1.0) / d;
    double v = (total - offset) * u + offset;
    const double p = std::pow(e, std::floor(std::log(v * d + 1.0) / logE));
    v = v - (p - 1.0) / d;
    const double g = 8.0 * (0.5 * p * v - 0.5 * v * v);
    return 1.0 - g;
}

} // namespace VelaMediaLib

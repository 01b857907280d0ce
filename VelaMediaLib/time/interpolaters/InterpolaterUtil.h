#pragma once

#include <VelaMediaLib/base/Export.h>

namespace VelaMediaLib {

/// The easing curves, each mapping u in [0, 1] to a weight.
class VELAMEDIALIB_API InterpolaterUtil {
public:
    static double linear(double u) { return u; }
    /// The same function as linear: the real ease-out curve is the exponent of EaseOutInterpolater.
    static double easeOut(double u) { return u; }
    static double left(double) { return 0.0; }
    static double easeExponential(double u, double exponent);
    static double easeInOutSinusoidal(double u);
    /// A quadratic in-out curve (exponent 2), whatever the name suggests.
    static double easeInOutDoubleExponentialSigmoid(double u);
    /// A ball dropped with elasticity 0.45; overshoots are not clipped.
    static double bounce(double u);
};

} // namespace VelaMediaLib

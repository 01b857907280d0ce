#pragma once
// Exact rounding of rationals and conversions to ticks and doubles.

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/SafeRational.h>

#include <string>

namespace VelaMediaLib {

class VELAMEDIALIB_API RationalUtil {
public:
    /// Greatest integer not above x.
    static SafeRational Floor(const SafeRational& x);
    /// Least integer not below x.
    static SafeRational Ceil(const SafeRational& x);
    /// Nearest integer; halves round away from zero.
    static SafeRational Round(const SafeRational& x);
    /// num % den, with the sign of the numerator.
    static long long Mod(const SafeRational& x);
    /// Numerator distance to the next multiple of the denominator (for x >= 0).
    static long long Res(const SafeRational& x);

    /// num / den truncated toward zero.
    static long long toVelaTime(const SafeRational& x);
    static Range<long long> toVelaTimeRange(const Range<SafeRational>& range);
    static double toDouble(const SafeRational& x);
    static float toFloat(const SafeRational& x);
    static Range<double> toDoubleRange(const Range<SafeRational>& range);

    /// Closest ten-thousandth found by a bisection; the last candidate is
    /// kept as it stands, so the error can reach a few ten-thousandths.
    static SafeRational fromDoubleApprox(double x);
    /// "n/d" or an integer; anything else throws boost::bad_lexical_cast.
    static SafeRational fromString(const std::string& text);
};

} // namespace VelaMediaLib

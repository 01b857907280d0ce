#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <boost/lexical_cast.hpp>
#include <cmath>

namespace VelaMediaLib {

SafeRational RationalUtil::Floor(const SafeRational& x) {
    if (x < 0) return -Ceil(abs(x));
    return x - SafeRational(x.numerator() % x.denominator(), x.denominator());
}

SafeRational RationalUtil::Ceil(const SafeRational& x) {
    if (x < 0) return -Floor(abs(x));
    const long long r = x.numerator() % x.denominator();
    return r == 0 ? x : x + SafeRational(x.denominator() - r, x.denominator());
}

SafeRational RationalUtil::Round(const SafeRational& x) {
    const SafeRational rounded = Floor(abs(x) + SafeRational(1, 2));
    return x < 0 ? -rounded : rounded;
}

long long RationalUtil::Mod(const SafeRational& x) { return x.numerator() % x.denominator(); }

long long RationalUtil::Res(const SafeRational& x) {
    const long long r = x.numerator() % x.denominator();
    return r == 0 ? 0 : x.denominator() - r;
}

long long RationalUtil::toVelaTime(const SafeRational& x) { return x.numerator() / x.denominator(); }

Range<long long> RationalUtil::toVelaTimeRange(const Range<SafeRational>& range) {
    return Range<long long>(toVelaTime(range.first()), toVelaTime(range.second()));
}

double RationalUtil::toDouble(const SafeRational& x) { return x.asDouble(); }

float RationalUtil::toFloat(const SafeRational& x) { return float(x.numerator()) / float(x.denominator()); }

Range<double> RationalUtil::toDoubleRange(const Range<SafeRational>& range) {
    return Range<double>(toDouble(range.first()), toDouble(range.second()));
}

SafeRational RationalUtil::fromDoubleApprox(double x) {
    double integral = 0.0;
    const double fraction = std::modf(x, &integral);
    const long long whole = (long long)integral;
    if (fraction == 0.0) return SafeRational(whole);

    const double target = std::fabs(fraction);
    long long lo = 1, hi = 10000;
    SafeRational candidate;
    double value = 0.0;
    do {
        const long long middle = (lo + hi) / 2;
        candidate = SafeRational(middle, 10000);
        value = candidate.asDouble();
        if (target > value)
            lo = middle + 1;
        else
            hi = middle - 1;
    } while (value != target && lo < hi);

    const SafeRational magnitude = SafeRational(whole < 0 ? -whole : whole) + candidate;
    return (whole < 0 || fraction < 0) ? -magnitude : magnitude;
}

SafeRational RationalUtil::fromString(const std::string& text) {
    if (text.find('/') == std::string::npos) return SafeRational(boost::lexical_cast<long long>(text));
    try {
        return boost::lexical_cast<SafeRational>(text);
    } catch (const boost::bad_rational&) {
        throw boost::bad_lexical_cast(typeid(std::string), typeid(SafeRational));
    }
}

} // namespace VelaMediaLib

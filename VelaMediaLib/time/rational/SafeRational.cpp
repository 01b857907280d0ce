#include <VelaMediaLib/time/rational/SafeRational.h>

#include <VelaMediaLib/base/detail/Int128.h>

#include <boost/integer/common_factor_rt.hpp>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <istream>
#include <limits>
#include <ostream>

namespace VelaMediaLib {
namespace {

// 128-bit intermediates keep products of two 64-bit values exact.
using detail::Int128;
typedef unsigned long long Bits;

// Plain wrapping 64-bit arithmetic, as the unchecked formulas need, without
// the undefined behaviour of signed overflow.
inline long long wrapAdd(long long a, long long b) { return (long long)(Bits(a) + Bits(b)); }
inline long long wrapSub(long long a, long long b) { return (long long)(Bits(a) - Bits(b)); }
inline long long wrapMul(long long a, long long b) { return (long long)(Bits(a) * Bits(b)); }
inline long long wrapNeg(long long a) { return (long long)(Bits(0) - Bits(a)); }
inline long long wrapDiv(long long a, long long b) { return b == -1 ? wrapNeg(a) : a / b; }

inline Bits magnitude(long long a) { return a < 0 ? Bits(0) - Bits(a) : Bits(a); }

// gcd of the magnitudes, gcd(0, b) = |b|; unsigned so that the most negative
// value has a magnitude.
inline long long gcd(long long a, long long b) {
    return (long long)boost::integer::gcd(magnitude(a), magnitude(b));
}

long long saturatedTruncation(double x) {
    if (x >= 9223372036854775808.0) return std::numeric_limits<long long>::max();
    if (x <= -9223372036854775808.0) return std::numeric_limits<long long>::min();
    return (long long)x;
}

// How "%f" separates the fraction in the current locale.
char decimalSeparator() {
    char text[16];
    std::snprintf(text, sizeof text, "%f", 0.5);
    return text[1];
}

} // namespace

SafeRational::SafeRational(long long n, long long d) { assign(n, d); }

void SafeRational::assign(const long long& n, const long long& d) {
    const boost::rational<long long> reduced(n, d); // throws bad_rational as boost does
    num_ = reduced.numerator();
    den_ = reduced.denominator();
}

boost::rational<long long> SafeRational::get() const { return boost::rational<long long>(num_, den_); }

boost::rational<long long> SafeRational::fromDouble(double x) {
    if (x >= 9223372036854775808.0) return boost::rational<long long>(std::numeric_limits<long long>::max());
    if (x <= -9223372036854775808.0) return boost::rational<long long>(std::numeric_limits<long long>::min());
    if (std::isnan(x)) return boost::rational<long long>(0);
    char text[400];
    std::snprintf(text, sizeof text, "%f", x);
    const char* separator = std::strchr(text, decimalSeparator());
    const double fraction = separator ? std::strtod(separator, nullptr) : 0.0;
    const long long denominator = fraction == 0.0 ? 1 : 1000000;
    const long long numerator = saturatedTruncation(std::strtod(text, nullptr) * double(denominator));
    return boost::rational<long long>(numerator, denominator);
}

// Keeps the exactly computed num/den unless it left the valid range or moved
// away from the double computation of the same operation.
SafeRational guardedResult(long long num, long long den, double expected) {
    if (den > 0) {
        const double exact = double(num) / double(den);
        const bool close =
            std::fabs(expected) > 1e-8 ? std::fabs(exact / expected - 1.0) < 0.01 : (num == 0 && den == 1);
        if (close) return SafeRational(num, den, SafeRational::Unreduced());
    }
    return SafeRational(SafeRational::fromDouble(expected));
}

SafeRational operator+(const SafeRational& a, const SafeRational& b) {
    const long long g = gcd(a.denominator(), b.denominator());
    const long long num =
        wrapAdd(wrapMul(a.numerator(), b.denominator() / g), wrapMul(b.numerator(), a.denominator() / g));
    const long long g2 = gcd(num, g);
    const long long den = wrapMul(a.denominator() / g, wrapDiv(b.denominator(), g2));
    return guardedResult(wrapDiv(num, g2), den, a.asDouble() + b.asDouble());
}

SafeRational operator-(const SafeRational& a, const SafeRational& b) {
    const long long g = gcd(a.denominator(), b.denominator());
    const long long num =
        wrapSub(wrapMul(a.numerator(), b.denominator() / g), wrapMul(b.numerator(), a.denominator() / g));
    const long long g2 = gcd(num, g);
    const long long den = wrapMul(a.denominator() / g, wrapDiv(b.denominator(), g2));
    return guardedResult(wrapDiv(num, g2), den, a.asDouble() - b.asDouble());
}

SafeRational operator*(const SafeRational& a, const SafeRational& b) {
    const long long g1 = gcd(a.numerator(), b.denominator());
    const long long g2 = gcd(b.numerator(), a.denominator());
    const long long num = wrapMul(wrapDiv(a.numerator(), g1), wrapDiv(b.numerator(), g2));
    const long long den = wrapMul(wrapDiv(a.denominator(), g2), wrapDiv(b.denominator(), g1));
    return guardedResult(num, den, a.asDouble() * b.asDouble());
}

SafeRational operator/(const SafeRational& a, const SafeRational& b) {
    if (b.numerator() == 0) throw boost::bad_rational();
    if (a.numerator() == 0) return SafeRational();
    const long long g1 = gcd(a.numerator(), b.numerator());
    const long long g2 = gcd(b.denominator(), a.denominator());
    long long num = wrapMul(wrapDiv(a.numerator(), g1), wrapDiv(b.denominator(), g2));
    long long den = wrapMul(wrapDiv(a.denominator(), g2), wrapDiv(b.numerator(), g1));
    if (den < 0) {
        num = wrapNeg(num);
        den = wrapNeg(den);
    }
    return guardedResult(num, den, a.asDouble() / b.asDouble());
}

SafeRational SafeRational::operator-() const { return guardedResult(wrapNeg(num_), den_, -asDouble()); }

SafeRational& SafeRational::operator+=(const SafeRational& other) { return *this = *this + other; }
SafeRational& SafeRational::operator-=(const SafeRational& other) { return *this = *this - other; }
SafeRational& SafeRational::operator*=(const SafeRational& other) { return *this = *this * other; }
SafeRational& SafeRational::operator/=(const SafeRational& other) { return *this = *this / other; }

SafeRational abs(const SafeRational& x) { return x.numerator() < 0 ? -x : x; }

int compare(const SafeRational& a, const SafeRational& b) {
    const Int128 left = (Int128)a.numerator() * b.denominator();
    const Int128 right = (Int128)b.numerator() * a.denominator();
    return left < right ? -1 : (left > right ? 1 : 0);
}

std::ostream& operator<<(std::ostream& out, const SafeRational& value) {
    return out << value.numerator() << '/' << value.denominator();
}

std::istream& operator>>(std::istream& in, SafeRational& value) {
    long long numerator = 0, denominator = 1;
    if (!(in >> numerator)) return in;
    if (!in.eof() && in.peek() == '/') { // peek at end of input would fail the stream
        in.get();
        if (!(in >> denominator)) return in;
    }
    value.assign(numerator, denominator);
    return in;
}

} // namespace VelaMediaLib

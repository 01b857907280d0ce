#pragma once
// Exact signed 64-bit rational with an overflow guard on every operator: a
// result that overflowed (or drifted by one per cent or more from the double
// computation of the same operation) is replaced by a decimal approximation
// rather than reported.

#include <VelaMediaLib/base/Export.h>

#include <boost/rational.hpp>
#include <iosfwd>

namespace VelaMediaLib {

class VELAMEDIALIB_API SafeRational {
public:
    SafeRational() : num_(0), den_(1) {}
    SafeRational(long long n) : num_(n), den_(1) {} // NOLINT: integers are rationals
    /// Reduced; throws boost::bad_rational on a zero or singular denominator.
    SafeRational(long long n, long long d);
    SafeRational(const boost::rational<long long>& r) // NOLINT: already normal
        : num_(r.numerator()), den_(r.denominator()) {}

    void assign(const long long& n, const long long& d);

    long long numerator() const { return num_; }
    long long denominator() const { return den_; }
    boost::rational<long long> get() const;

    /// numerator / denominator truncated toward zero.
    long long asVelaTime() const { return num_ / den_; }
    double asDouble() const { return double(num_) / double(den_); }
    SafeRational invert() const { return SafeRational(den_, num_); }

    SafeRational operator-() const;
    SafeRational& operator+=(const SafeRational& other);
    SafeRational& operator-=(const SafeRational& other);
    SafeRational& operator*=(const SafeRational& other);
    SafeRational& operator/=(const SafeRational& other);

    /// The decimal approximation taken when exact arithmetic overflows:
    /// six printed decimals, saturated at the 64-bit range.
    static boost::rational<long long> fromDouble(double x);

private:
    struct Unreduced {};
    SafeRational(long long n, long long d, Unreduced) : num_(n), den_(d) {}
    friend SafeRational guardedResult(long long num, long long den, double expected);

    long long num_;
    long long den_;
};

VELAMEDIALIB_API SafeRational operator+(const SafeRational& a, const SafeRational& b);
VELAMEDIALIB_API SafeRational operator-(const SafeRational& a, const SafeRational& b);
VELAMEDIALIB_API SafeRational operator*(const SafeRational& a, const SafeRational& b);
VELAMEDIALIB_API SafeRational operator/(const SafeRational& a, const SafeRational& b);
VELAMEDIALIB_API SafeRational abs(const SafeRational& x);

/// Exact three-way comparison: negative, zero or positive.
VELAMEDIALIB_API int compare(const SafeRational& a, const SafeRational& b);

inline bool operator==(const SafeRational& a, const SafeRational& b) {
    return a.numerator() == b.numerator() && a.denominator() == b.denominator();
}
inline bool operator!=(const SafeRational& a, const SafeRational& b) { return !(a == b); }
inline bool operator<(const SafeRational& a, const SafeRational& b) { return compare(a, b) < 0; }
inline bool operator<=(const SafeRational& a, const SafeRational& b) { return compare(a, b) <= 0; }
inline bool operator>(const SafeRational& a, const SafeRational& b) { return compare(a, b) > 0; }
inline bool operator>=(const SafeRational& a, const SafeRational& b) { return compare(a, b) >= 0; }

// Mixed comparisons take the integer as n/1.
inline bool operator==(const SafeRational& a, long long b) { return a == SafeRational(b); }
inline bool operator<(const SafeRational& a, long long b) { return a < SafeRational(b); }
inline bool operator<=(const SafeRational& a, long long b) { return a <= SafeRational(b); }
inline bool operator>(const SafeRational& a, long long b) { return a > SafeRational(b); }
inline bool operator>=(const SafeRational& a, long long b) { return a >= SafeRational(b); }
inline bool operator==(long long a, const SafeRational& b) { return SafeRational(a) == b; }
inline bool operator<(long long a, const SafeRational& b) { return SafeRational(a) < b; }
inline bool operator<=(long long a, const SafeRational& b) { return SafeRational(a) <= b; }
inline bool operator>(long long a, const SafeRational& b) { return SafeRational(a) > b; }
inline bool operator>=(long long a, const SafeRational& b) { return SafeRational(a) >= b; }

/// Written as numerator '/' denominator ("1/30", "0/1").
VELAMEDIALIB_API std::ostream& operator<<(std::ostream& out, const SafeRational& value);
/// Reads an integer and, when a '/' follows, a denominator (1 when missing).
VELAMEDIALIB_API std::istream& operator>>(std::istream& in, SafeRational& value);

} // namespace VelaMediaLib

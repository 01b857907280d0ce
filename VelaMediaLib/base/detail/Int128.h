#pragma once
// Signed 128-bit intermediates for exact products of two 64-bit values: the
// compiler's own type where it has one, else a small portable one with the
// few operations the time code needs.

#include <cstdint>

namespace VelaMediaLib {
namespace detail {

/// Two's-complement 128-bit integer built from two 64-bit halves.
class PortableInt128 {
public:
    PortableInt128(long long value = 0)
        : high_(value < 0 ? ~0ULL : 0ULL), low_(static_cast<unsigned long long>(value)) {}

    explicit operator long long() const { return static_cast<long long>(low_); }

    friend PortableInt128 operator+(PortableInt128 a, PortableInt128 b) {
        const unsigned long long low = a.low_ + b.low_;
        return PortableInt128(a.high_ + b.high_ + (low < a.low_ ? 1 : 0), low);
    }
    friend PortableInt128 operator-(PortableInt128 a) { return PortableInt128(~a.high_, ~a.low_) + 1; }
    friend PortableInt128 operator-(PortableInt128 a, PortableInt128 b) { return a + -b; }
    friend PortableInt128 operator*(PortableInt128 a, PortableInt128 b) {
        const bool negative = a.negative() != b.negative();
        const PortableInt128 product = multiplyMagnitudes(a.magnitude(), b.magnitude());
        return negative ? -product : product;
    }
    /// Truncates towards zero, as the built-in division does.
    friend PortableInt128 operator/(PortableInt128 a, PortableInt128 b) {
        const PortableInt128 quotient = divideMagnitudes(a.magnitude(), b.magnitude(), nullptr);
        return a.negative() != b.negative() ? -quotient : quotient;
    }
    /// Takes the dividend's sign, as the built-in remainder does.
    friend PortableInt128 operator%(PortableInt128 a, PortableInt128 b) {
        PortableInt128 remainder;
        divideMagnitudes(a.magnitude(), b.magnitude(), &remainder);
        return a.negative() ? -remainder : remainder;
    }
    friend bool operator==(PortableInt128 a, PortableInt128 b) {
        return a.high_ == b.high_ && a.low_ == b.low_;
    }
    friend bool operator!=(PortableInt128 a, PortableInt128 b) { return !(a == b); }
    friend bool operator<(PortableInt128 a, PortableInt128 b) {
        if (a.high_ != b.high_) return static_cast<long long>(a.high_) < static_cast<long long>(b.high_);
        return a.low_ < b.low_;
    }
    friend bool operator>(PortableInt128 a, PortableInt128 b) { return b < a; }
    friend bool operator<=(PortableInt128 a, PortableInt128 b) { return !(b < a); }
    friend bool operator>=(PortableInt128 a, PortableInt128 b) { return !(a < b); }

private:
    PortableInt128(unsigned long long high, unsigned long long low) : high_(high), low_(low) {}
    bool negative() const { return (high_ >> 63) != 0; }
    PortableInt128 magnitude() const { return negative() ? -*this : *this; }
    bool bit(int i) const { return ((i < 64 ? low_ >> i : high_ >> (i - 64)) & 1ULL) != 0; }
    PortableInt128 shiftedLeft() const { return PortableInt128((high_ << 1) | (low_ >> 63), low_ << 1); }

    static PortableInt128 multiplyMagnitudes(PortableInt128 a, PortableInt128 b) {
        const unsigned long long mask = 0xffffffffULL;
        const unsigned long long a0 = a.low_ & mask, a1 = a.low_ >> 32, b0 = b.low_ & mask, b1 = b.low_ >> 32;
        const unsigned long long p00 = a0 * b0, p01 = a0 * b1, p10 = a1 * b0, p11 = a1 * b1;
        const unsigned long long middle = (p00 >> 32) + (p01 & mask) + (p10 & mask);
        const unsigned long long low = (middle << 32) | (p00 & mask);
        const unsigned long long high =
            p11 + (p01 >> 32) + (p10 >> 32) + (middle >> 32) + a.low_ * b.high_ + a.high_ * b.low_;
        return PortableInt128(high, low);
    }
    // Shift-and-subtract long division of non-negative values.
    static PortableInt128 divideMagnitudes(PortableInt128 a, PortableInt128 b, PortableInt128* remainder) {
        PortableInt128 quotient, rest;
        for (int i = 127; i >= 0; --i) {
            rest = rest.shiftedLeft();
            if (a.bit(i)) rest.low_ |= 1ULL;
            quotient = quotient.shiftedLeft();
            if (!(rest < b)) {
                rest = rest - b;
                quotient.low_ |= 1ULL;
            }
        }
        if (remainder) *remainder = rest;
        return quotient;
    }

    unsigned long long high_, low_;
};

#if defined(__SIZEOF_INT128__) && !defined(VELA_PORTABLE_INT128)
__extension__ typedef __int128 Int128;
#else
typedef PortableInt128 Int128;
#endif

} // namespace detail
} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/SafeRational.h>

#include <ostream>

namespace VelaMediaLib {

/// A time held as an exact rational: the time of keyframes and parameters.
class VELAMEDIALIB_API RationalTime {
public:
    RationalTime() = default;
    RationalTime(long long numerator, long long denominator) : value_(numerator, denominator) {}
    RationalTime(long long ticks) : value_(ticks) {}           // NOLINT: n/1
    RationalTime(const SafeRational& value) : value_(value) {} // NOLINT: same value

    SafeRational asRational() const { return value_; }
    double asDouble() const { return value_.asDouble(); }
    RationalTime operator-() const { return RationalTime(-value_); }

    bool operator==(const RationalTime& o) const { return value_ == o.value_; }
    bool operator!=(const RationalTime& o) const { return value_ != o.value_; }
    bool operator<(const RationalTime& o) const { return value_ < o.value_; }
    bool operator<=(const RationalTime& o) const { return value_ <= o.value_; }
    bool operator>(const RationalTime& o) const { return value_ > o.value_; }
    bool operator>=(const RationalTime& o) const { return value_ >= o.value_; }

private:
    SafeRational value_;
};

inline RationalTime operator+(const RationalTime& a, const RationalTime& b) {
    return RationalTime(a.asRational() + b.asRational());
}
inline RationalTime operator-(const RationalTime& a, const RationalTime& b) {
    return RationalTime(a.asRational() - b.asRational());
}

/// Written as its rational ("1/30").
inline std::ostream& operator<<(std::ostream& out, const RationalTime& time) {
    return out << time.asRational();
}

} // namespace VelaMediaLib

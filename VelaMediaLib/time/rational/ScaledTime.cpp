#include <VelaMediaLib/time/rational/ScaledTime.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/base/detail/Int128.h>

#include <ostream>

namespace VelaMediaLib {
namespace {

// 128-bit intermediates keep products of two 64-bit values exact.
using detail::Int128;
long long magnitude(long long t) { return t < 0 ? -t : t; }
long long withSign(long long value, long long signSource) { return signSource < 0 ? -value : value; }

// Grid helpers on a non-negative time a at scale s with grid g.
long long floorOnGrid(long long a, long long s, long long g) {
    const Int128 ag = (Int128)a * g;
    return (long long)((ag - ag % s) / g);
}

long long ceilOnGrid(long long a, long long s, long long g) {
    const Int128 ag = (Int128)a * g;
    if (ag % s == 0) return a;
    const Int128 b = (Int128)(s / g + a) * g;
    return (long long)((b - b % s) / g);
}

} // namespace

ScaledTime::ScaledTime(long long scale, long long time) : time_(time), scale_(scale) {
    if (scale <= 0) throw ValueException<long long>("Invalid scale for ScaledTime", scale);
}

long long ScaledTime::convertTimeToScale(const long long& time, long long fromScale, long long toScale) {
    return (long long)((Int128)toScale * time / fromScale);
}

ScaledTime ScaledTime::toScale(long long newScale) const {
    if (newScale == scale_) return *this;
    return ScaledTime(newScale, convertTimeToScale(time_, scale_, newScale));
}

long long ScaledTime::toFlicks() const {
    return scale_ == kFlickScale ? time_ : convertTimeToScale(time_, scale_, kFlickScale);
}

ScaledTime ScaledTime::alignedFloored(long long g) const {
    if (g == scale_) return *this;
    const long long a = magnitude(time_);
    const long long t = time_ >= 0 ? floorOnGrid(a, scale_, g) : ceilOnGrid(a, scale_, g);
    return ScaledTime(scale_, withSign(t, time_));
}

ScaledTime ScaledTime::alignedCeiled(long long g) const {
    if (g == scale_) return *this;
    const long long a = magnitude(time_);
    const long long t = time_ >= 0 ? ceilOnGrid(a, scale_, g) : floorOnGrid(a, scale_, g);
    return ScaledTime(scale_, withSign(t, time_));
}

ScaledTime ScaledTime::alignedRounded(long long g) const {
    if (g == scale_) return *this;
    const Int128 b = (Int128)(scale_ / g / 2 + magnitude(time_)) * g;
    return ScaledTime(scale_, withSign((long long)((b - b % scale_) / g), time_));
}

std::ostream& operator<<(std::ostream& out, const ScaledTime& value) {
    return out << "{ time: " << value.time() << ", scale: " << value.scale() << "}";
}

} // namespace VelaMediaLib

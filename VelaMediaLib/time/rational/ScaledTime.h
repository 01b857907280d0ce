#pragma once

#include <VelaMediaLib/base/Export.h>

#include <iosfwd>

namespace VelaMediaLib {

/// An integer time with its own scale (ticks per second).
class VELAMEDIALIB_API ScaledTime {
public:
    /// Ticks per second of a flick, the scale that divides every common frame and sample rate.
    static const long long kFlickScale = 705600000;

    /// Throws ValueException<long long> "Invalid scale for ScaledTime" for a scale of zero or less.
    ScaledTime(long long scale, long long time);
    virtual ~ScaledTime() = default;
    ScaledTime(const ScaledTime&) = default;
    ScaledTime& operator=(const ScaledTime&) = default;

    long long time() const { return time_; }
    long long scale() const { return scale_; }

    ScaledTime toScale(long long newScale) const;
    /// Moves the time onto the grid of whole 1/gridScale-second steps, keeping the scale.
    ScaledTime alignedFloored(long long gridScale) const;
    ScaledTime alignedCeiled(long long gridScale) const;
    /// Halves go away from zero.
    ScaledTime alignedRounded(long long gridScale) const;

    long long toFlicks() const;
    operator long long() const { return toFlicks(); } // NOLINT: a time in flicks

    /// (toScale * time) / fromScale, truncated toward zero; the product is
    /// formed in 128 bits so long recordings at the flick scale do not wrap.
    static long long convertTimeToScale(const long long& time, long long fromScale, long long toScale);

    bool operator==(const ScaledTime& other) const { return time_ == other.time_ && scale_ == other.scale_; }
    bool operator!=(const ScaledTime& other) const { return !(*this == other); }

private:
    long long time_;
    long long scale_;
};

inline bool operator==(const ScaledTime& a, long long flicks) { return a.toFlicks() == flicks; }
inline bool operator==(long long flicks, const ScaledTime& a) { return a.toFlicks() == flicks; }

/// "{ time: 1, scale: 30}"
VELAMEDIALIB_API std::ostream& operator<<(std::ostream& out, const ScaledTime& value);

} // namespace VelaMediaLib

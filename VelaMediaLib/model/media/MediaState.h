#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/RationalTime.h>
#include <VelaMediaLib/time/rational/SafeRational.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

#include <limits>

namespace VelaMediaLib {

/// The timing state of a clip: where it stands on its track (start and
/// duration in ticks), which slice of its media it plays (media start and
/// duration, exact), how fast (scalar: track length per unit of media
/// length), the media's limits, and, for static clips, an attached start
/// offset. A limit at the 64-bit extreme means there is none on that side.
struct VELAMEDIALIB_API MediaState {
    VelaTime start = 0;
    VelaTime duration = 0;
    SafeRational mediaStart;
    SafeRational mediaDuration;
    SafeRational scalar = SafeRational(1);
    SafeRational minMediaStart = unboundedStart();
    SafeRational maxMediaEnd = unboundedEnd();
    bool hasStartOffset = false;
    RationalTime startOffset;

    /// The state of a clip without media extent (generated content, stills)
    /// on its track from start for duration ticks, without limits.
    static MediaState unbounded(VelaTime start, VelaTime duration) {
        MediaState state;
        state.start = start;
        state.duration = duration;
        state.mediaDuration = SafeRational(duration);
        return state;
    }

    /// The state of a clip playing the slice at the scalar from start, its
    /// limits the slice's ends; the duration is the slice's length times the
    /// scalar, rounded to the nearest tick.
    static MediaState ofSlice(VelaTime start, const SafeRational& mediaStart,
                              const SafeRational& mediaDuration, const SafeRational& scalar);

    static SafeRational unboundedStart() { return SafeRational(std::numeric_limits<long long>::min()); }
    static SafeRational unboundedEnd() { return SafeRational(std::numeric_limits<long long>::max()); }

    Range<VelaTime> trackRange() const { return Range<VelaTime>(start, duration); }
    Range<SafeRational> mediaRange() const { return Range<SafeRational>(mediaStart, mediaDuration); }
    SafeRational mediaEnd() const { return mediaStart + mediaDuration; }
    bool minUnbounded() const { return minMediaStart.asVelaTime() == std::numeric_limits<long long>::min(); }
    bool maxUnbounded() const { return maxMediaEnd.asVelaTime() == std::numeric_limits<long long>::max(); }
    /// The longest slice the limits allow.
    SafeRational fullMediaLength() const { return maxMediaEnd - minMediaStart; }

    bool operator==(const MediaState& o) const {
        return start == o.start && duration == o.duration && mediaStart == o.mediaStart &&
               mediaDuration == o.mediaDuration && scalar == o.scalar && minMediaStart == o.minMediaStart &&
               maxMediaEnd == o.maxMediaEnd && hasStartOffset == o.hasStartOffset &&
               startOffset == o.startOffset;
    }
    bool operator!=(const MediaState& o) const { return !(*this == o); }
};

} // namespace VelaMediaLib

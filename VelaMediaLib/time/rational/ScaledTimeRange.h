#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/ScaledTime.h>

namespace VelaMediaLib {

/// A start and a duration sharing one scale.
class VELAMEDIALIB_API ScaledTimeRange {
public:
    ScaledTimeRange(long long scale, long long start, long long duration);
    ScaledTimeRange(long long scale, const Range<long long>& startAndDuration);
    virtual ~ScaledTimeRange() = default;
    ScaledTimeRange(const ScaledTimeRange&) = default;
    ScaledTimeRange& operator=(const ScaledTimeRange&) = default;

    static ScaledTimeRange fromStartEnd(long long scale, long long start, long long end);

    const ScaledTime& start() const { return start_; }
    const ScaledTime& duration() const { return duration_; }
    ScaledTime end() const { return ScaledTime(scale(), start_.time() + duration_.time()); }
    long long scale() const { return start_.scale(); }
    Range<long long> range() const { return Range<long long>(start_.time(), duration_.time()); }
    operator Range<long long>() const { return range(); } // NOLINT: (start, duration)

    /// Converts start and duration each; the converted end may lose a tick to truncation.
    ScaledTimeRange toScale(long long newScale) const;
    Range<long long> toFlicks() const { return toScale(ScaledTime::kFlickScale).range(); }

    static Range<long long> convertRangeToScale(const Range<long long>& range, long long fromScale,
                                                long long toScale);

    bool operator==(const ScaledTimeRange& o) const { return start_ == o.start_ && duration_ == o.duration_; }
    bool operator!=(const ScaledTimeRange& o) const { return !(*this == o); }

private:
    ScaledTime start_;
    ScaledTime duration_;
};

inline bool operator==(const ScaledTimeRange& a, const Range<long long>& b) { return a.range() == b; }
inline bool operator==(const Range<long long>& a, const ScaledTimeRange& b) { return a == b.range(); }

/// "{ start: { time: 0, scale: 30}, duration: { time: 30, scale: 30}}"
VELAMEDIALIB_API std::ostream& operator<<(std::ostream& out, const ScaledTimeRange& value);

} // namespace VelaMediaLib

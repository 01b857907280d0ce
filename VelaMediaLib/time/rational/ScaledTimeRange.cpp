#include <VelaMediaLib/time/rational/ScaledTimeRange.h>

#include <ostream>

namespace VelaMediaLib {

ScaledTimeRange::ScaledTimeRange(long long scale, long long start, long long duration)
    : start_(scale, start), duration_(scale, duration) {}

ScaledTimeRange::ScaledTimeRange(long long scale, const Range<long long>& startAndDuration)
    : ScaledTimeRange(scale, startAndDuration.first(), startAndDuration.second()) {}

ScaledTimeRange ScaledTimeRange::fromStartEnd(long long scale, long long start, long long end) {
    return ScaledTimeRange(scale, start, end - start);
}

ScaledTimeRange ScaledTimeRange::toScale(long long newScale) const {
    return ScaledTimeRange(newScale, start_.toScale(newScale).time(), duration_.toScale(newScale).time());
}

Range<long long> ScaledTimeRange::convertRangeToScale(const Range<long long>& range, long long fromScale,
                                                      long long toScale) {
    return Range<long long>(ScaledTime::convertTimeToScale(range.first(), fromScale, toScale),
                            ScaledTime::convertTimeToScale(range.second(), fromScale, toScale));
}

std::ostream& operator<<(std::ostream& out, const ScaledTimeRange& value) {
    return out << "{ start: " << value.start() << ", duration: " << value.duration() << "}";
}

} // namespace VelaMediaLib

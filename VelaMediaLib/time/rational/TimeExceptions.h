#pragma once
// The exceptions that carry a time or a range of ticks.

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/RationalTime.h>

namespace VelaMediaLib {

/// A trim that would leave the clip outside its limits: the offset asked for
/// and the clip's track range (start, duration) at the time.
class VELAMEDIALIB_API InvalidTrimRangeException : public ValueException<long long> {
public:
    InvalidTrimRangeException(std::string message, long long offset,
                              Range<long long> trackRange = Range<long long>())
        : ValueException<long long>(std::move(message), offset), trackRange_(trackRange) {}
    const Range<long long>& trackRange() const { return trackRange_; }

private:
    Range<long long> trackRange_;
};

/// A keyframe operation that could not be carried out: the time it was asked
/// for and the identifying text of the parameter.
class VELAMEDIALIB_API KeyFrameException : public VelaMediaLibException {
public:
    explicit KeyFrameException(std::string message, RationalTime time = RationalTime(),
                               std::string identifier = std::string())
        : VelaMediaLibException(std::move(message)), time_(time), identifier_(std::move(identifier)) {}
    const RationalTime& time() const { return time_; }
    const std::string& identifier() const { return identifier_; }

private:
    RationalTime time_;
    std::string identifier_;
};

} // namespace VelaMediaLib

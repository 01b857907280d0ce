#pragma once
// The exceptions that carry a time or a range of ticks.

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/RationalTime.h>

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

class Media;

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

/// A clip refused by a track because it would overlap another: which range
/// collided, the clip that was being placed and the start asked for.
class VELAMEDIALIB_API CollisionException : public VelaMediaLibException {
public:
    CollisionException(Range<long long> range = Range<long long>(),
                       boost::shared_ptr<Media> clip = boost::shared_ptr<Media>(), long long start = 0)
        : VelaMediaLibException("Collision exception."), range_(range), clip_(std::move(clip)),
          start_(start) {}
    const Range<long long>& range() const { return range_; }
    const boost::shared_ptr<Media>& clip() const { return clip_; }
    long long start() const { return start_; }

private:
    Range<long long> range_;
    boost::shared_ptr<Media> clip_;
    long long start_;
};

} // namespace VelaMediaLib

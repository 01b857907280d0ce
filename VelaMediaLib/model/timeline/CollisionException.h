#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/TimeExceptions.h>

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

class Media;

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

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

namespace VelaMediaLib {

/// Something placed in ticks: a start, an end and a duration.
class VELAMEDIALIB_API Temporal {
public:
    virtual ~Temporal() = default;
    virtual VelaTime startTime() const = 0;
    virtual VelaTime endTime() const = 0;
    virtual VelaTime duration() const = 0;
    /// Start and duration.
    virtual Range<VelaTime> timeRange() const = 0;
};

} // namespace VelaMediaLib

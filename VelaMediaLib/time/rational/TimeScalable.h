#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/SafeRational.h>

namespace VelaMediaLib {

/// Something whose parametric time maps onto ticks: a parameter asks its
/// owner how many ticks one unit of its time is, to snap queries that fall
/// less than one tick before a keyframe onto that keyframe.
class VELAMEDIALIB_API TimeScalable {
public:
    virtual ~TimeScalable() = default;
    /// Ticks per unit of parametric time.
    virtual SafeRational timeScale() const = 0;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/TimeConverter.h>

namespace VelaMediaLib {

/// The containers that pass their container's time through unchanged
/// (tracks, mixers, the timeline).
class VELAMEDIALIB_API IdentityTimeConverter : public TimeConverter {
public:
    SafeRational parentParametricTimeToThisParametricTime(const SafeRational& time) const override {
        return time;
    }
    SafeRational clippingParentParametricTimeToThisParametricTime(const SafeRational& time) const override {
        return time;
    }
    SafeRational thisParametricTimeToParentParametricTime(const SafeRational& time) const override {
        return time;
    }
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/interpolaters/ExponentialEaseInterpolater.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterNameConstants.h>

namespace VelaMediaLib {

/// Ends slowly: the square root of u.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API EaseOutInterpolater
    : public ExponentialEaseInterpolater<T>,
      public SharedInterpolaterInstance<EaseOutInterpolater<T>> {
private:
    friend class SharedInterpolaterInstance<EaseOutInterpolater<T>>;
    EaseOutInterpolater() : ExponentialEaseInterpolater<T>(InterpolaterNameConstants::s_easeOutName, 0.5) {}
};

} // namespace VelaMediaLib

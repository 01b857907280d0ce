#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/interpolaters/ExponentialEaseInterpolater.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterNameConstants.h>

namespace VelaMediaLib {

/// Starts slowly: u squared.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API EaseInInterpolater
    : public ExponentialEaseInterpolater<T>,
      public SharedInterpolaterInstance<EaseInInterpolater<T>> {
private:
    friend class SharedInterpolaterInstance<EaseInInterpolater<T>>;
    EaseInInterpolater() : ExponentialEaseInterpolater<T>(InterpolaterNameConstants::s_easeInName, 2.0) {}
};

} // namespace VelaMediaLib

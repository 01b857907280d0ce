#pragma once

#include <VelaMediaLib/time/interpolaters/ExponentialEaseInterpolater.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterNameConstants.h>

namespace VelaMediaLib {

/// Starts slowly: u squared.
template <typename T>
class EaseInInterpolater : public ExponentialEaseInterpolater<T>,
                           public SharedInterpolaterInstance<EaseInInterpolater<T>> {
private:
    friend class SharedInterpolaterInstance<EaseInInterpolater<T>>;
    EaseInInterpolater() : ExponentialEaseInterpolater<T>(InterpolaterNameConstants::s_easeInName, 2.0) {}
};

} // namespace VelaMediaLib

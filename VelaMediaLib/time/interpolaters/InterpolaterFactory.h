#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/time/interpolaters/BezierInterpolater.h>
#include <VelaMediaLib/time/interpolaters/BounceInterpolater.h>
#include <VelaMediaLib/time/interpolaters/EaseInInterpolater.h>
#include <VelaMediaLib/time/interpolaters/EaseInOutDoubleExponentialSigmoidInterpolater.h>
#include <VelaMediaLib/time/interpolaters/EaseInOutSinusoidalInterpolater.h>
#include <VelaMediaLib/time/interpolaters/EaseOutInterpolater.h>
#include <VelaMediaLib/time/interpolaters/LeftInterpolater.h>
#include <VelaMediaLib/time/interpolaters/LinearInterpolater.h>
#include <VelaMediaLib/time/interpolaters/SpringInterpolater.h>
#include <VelaMediaLib/time/parameters/ValueTraits.h>

namespace VelaMediaLib {

/// The shared interpolater of a name for a value type, among the kinds its
/// ValueTraits<T>::interpolation gives it. A name the type does not have
/// throws ParserException "trying to read an unknown interpolater".
template <typename T>
class VELAMEDIALIB_TEMPLATE_API InterpolaterFactory {
public:
    typedef boost::shared_ptr<Interpolater<T>> Pointer;

    static Pointer byName(const std::string& name) {
        if (const Pointer found = find(name)) return found;
        throw ParserException("trying to read an unknown interpolater");
    }

    /// The same, or null for an unknown name.
    static Pointer find(const std::string& name) {
        typedef InterpolaterNameConstants N;
        if (name == N::s_leftName) return LeftInterpolater<T>::getInstance();
        constexpr Interpolation kinds = ValueTraits<T>::interpolation;
        if constexpr (kinds >= Interpolation::Eases) {
            if (name == N::s_linearName) return LinearInterpolater<T>::getInstance();
            if (name == N::s_easeInName) return EaseInInterpolater<T>::getInstance();
            if (name == N::s_easeOutName) return EaseOutInterpolater<T>::getInstance();
        }
        if constexpr (kinds >= Interpolation::Curves) {
            if (name == N::s_easeInOutSinusoidalName)
                return EaseInOutSinusoidalInterpolater<T>::getInstance();
            if (name == N::s_easeInOutDoubleExponentialSigmoidName)
                return EaseInOutDoubleExponentialSigmoidInterpolater<T>::getInstance();
            if (name == N::s_bounceName) return BounceInterpolater<T>::getInstance();
            if (name == N::s_springName) return SpringInterpolater<T>::getInstance();
        }
        if constexpr (kinds == Interpolation::Paths) return BezierInterpolater::fromName(name); // positions
        return Pointer();
    }

    /// The kind new keyframes get: linear where the type tweens, a step otherwise.
    static const Pointer& defaultInterpolater() {
        static const Pointer instance = makeDefault();
        return instance;
    }

private:
    static Pointer makeDefault() {
        if constexpr (ValueTraits<T>::interpolation != Interpolation::Step)
            return LinearInterpolater<T>::getInstance();
        else
            return LeftInterpolater<T>::getInstance();
    }
};

} // namespace VelaMediaLib

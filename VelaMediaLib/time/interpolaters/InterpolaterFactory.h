#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/AudioPosition.h>
#include <VelaMediaLib/base/Point3d.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/base/TemplatedColor.h>
#include <VelaMediaLib/base/TransformMatrix.h>
#include <VelaMediaLib/time/interpolaters/BezierInterpolater.h>
#include <VelaMediaLib/time/interpolaters/BounceInterpolater.h>
#include <VelaMediaLib/time/interpolaters/EaseInInterpolater.h>
#include <VelaMediaLib/time/interpolaters/EaseInOutDoubleExponentialSigmoidInterpolater.h>
#include <VelaMediaLib/time/interpolaters/EaseInOutSinusoidalInterpolater.h>
#include <VelaMediaLib/time/interpolaters/EaseOutInterpolater.h>
#include <VelaMediaLib/time/interpolaters/LeftInterpolater.h>
#include <VelaMediaLib/time/interpolaters/LinearInterpolater.h>
#include <VelaMediaLib/time/interpolaters/SpringInterpolater.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <type_traits>

namespace VelaMediaLib {

/// Which interpolater kinds a value type has: every type steps ("left");
/// numeric and geometric types tween linearly and with the exponential
/// eases; some of those also have the in-out, bounce and spring curves.
template <typename T>
struct VELAMEDIALIB_TEMPLATE_API InterpolaterKinds {
    static constexpr bool linear =
        std::is_same<T, int>::value || std::is_same<T, float>::value || std::is_same<T, double>::value ||
        std::is_same<T, long long>::value || std::is_same<T, Rect<float>>::value ||
        std::is_same<T, TemplatedColor<int>>::value || std::is_same<T, AudioPosition>::value ||
        std::is_same<T, Point3d>::value || std::is_same<T, TransformMatrix>::value;
    static constexpr bool inOut = std::is_same<T, int>::value || std::is_same<T, float>::value ||
                                  std::is_same<T, double>::value || std::is_same<T, Rect<float>>::value ||
                                  std::is_same<T, TemplatedColor<int>>::value ||
                                  std::is_same<T, Point3d>::value;
};

/// The shared interpolater of a name for a value type. A name the type does
/// not have throws ParserException "trying to read an unknown interpolater".
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
        if constexpr (InterpolaterKinds<T>::linear) {
            if (name == N::s_linearName) return LinearInterpolater<T>::getInstance();
            if (name == N::s_easeInName) return EaseInInterpolater<T>::getInstance();
            if (name == N::s_easeOutName) return EaseOutInterpolater<T>::getInstance();
        }
        if constexpr (InterpolaterKinds<T>::inOut) {
            if (name == N::s_easeInOutSinusoidalName)
                return EaseInOutSinusoidalInterpolater<T>::getInstance();
            if (name == N::s_easeInOutDoubleExponentialSigmoidName)
                return EaseInOutDoubleExponentialSigmoidInterpolater<T>::getInstance();
            if (name == N::s_bounceName) return BounceInterpolater<T>::getInstance();
            if (name == N::s_springName) return SpringInterpolater<T>::getInstance();
        }
        if constexpr (std::is_same<T, Point3d>::value) return BezierInterpolater::fromName(name);
        return Pointer();
    }

    /// The kind new keyframes get: linear where the type tweens, a step otherwise.
    static const Pointer& defaultInterpolater() {
        static const Pointer instance = makeDefault();
        return instance;
    }

private:
    static Pointer makeDefault() {
        if constexpr (InterpolaterKinds<T>::linear)
            return LinearInterpolater<T>::getInstance();
        else
            return LeftInterpolater<T>::getInstance();
    }
};

} // namespace VelaMediaLib

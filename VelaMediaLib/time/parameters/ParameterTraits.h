#pragma once
// What parameters need to know of each value type: the type name written
// into documents, and when two values count as the same (within a tolerance
// for real numbers: a millionth relative for float members, a billionth
// relative for double members; other values compare exactly).

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/AudioPosition.h>
#include <VelaMediaLib/base/CaptionData.h>
#include <VelaMediaLib/base/KeystrokeData.h>
#include <VelaMediaLib/base/Point3d.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/base/TemplatedColor.h>
#include <VelaMediaLib/base/TextAttributeList.h>
#include <VelaMediaLib/base/TransformMatrix.h>
#include <VelaMediaLib/time/interpolaters/Interpolater.h>
#include <VelaMediaLib/time/rational/SafeRational.h>

#include <algorithm>
#include <cmath>
#include <list>
#include <string>
#include <vector>

namespace VelaMediaLib {
namespace Similarity {

inline bool close(double a, double b, double relative) {
    if (a == b) return true;
    return std::fabs(a - b) <= relative * std::max(1.0, std::max(std::fabs(a), std::fabs(b)));
}
inline bool similar(double a, double b) { return close(a, b, 1e-9); }
inline bool similar(float a, float b) { return close(a, b, 1e-6); }
inline bool similar(const Rect<float>& a, const Rect<float>& b) {
    return similar(a.x, b.x) && similar(a.y, b.y) && similar(a.width, b.width) && similar(a.height, b.height);
}
inline bool similar(const Point3d& a, const Point3d& b) {
    return similar(a.x, b.x) && similar(a.y, b.y) && similar(a.z, b.z);
}
inline bool similar(const AudioPosition& a, const AudioPosition& b) {
    return similar(a.pan, b.pan) && similar(a.depth, b.depth);
}
inline bool similar(const TransformMatrix& a, const TransformMatrix& b) {
    for (size_t i = 0; i < 16; ++i)
        if (!similar(a.elements()[i], b.elements()[i])) return false;
    return true;
}
inline bool similar(const std::vector<double>& a, const std::vector<double>& b) {
    return a.size() == b.size() &&
           std::equal(a.begin(), a.end(), b.begin(), [](double x, double y) { return similar(x, y); });
}
inline bool similar(const std::list<Rect<float>>& a, const std::list<Rect<float>>& b) {
    return a.size() == b.size() &&
           std::equal(a.begin(), a.end(), b.begin(),
                      [](const Rect<float>& x, const Rect<float>& y) { return similar(x, y); });
}
template <typename T>
bool similar(const T& a, const T& b) {
    return a == b;
}

/// Exact equality of values; interpolaters are the same when their document
/// forms are (a Bézier read back is a new instance of the same curve).
template <typename T>
bool same(const T& a, const T& b) {
    return a == b;
}
template <typename X>
bool same(const boost::shared_ptr<Interpolater<X>>& a, const boost::shared_ptr<Interpolater<X>>& b) {
    if (!a || !b) return a == b;
    return a == b || a->asJson() == b->asJson();
}
template <typename X>
bool similar(const boost::shared_ptr<Interpolater<X>>& a, const boost::shared_ptr<Interpolater<X>>& b) {
    return same(a, b);
}

} // namespace Similarity

template <typename T>
struct ParameterTraits;

#define VELA_PARAMETER_TYPE_NAME(Type, Name)                                                                 \
    template <>                                                                                              \
    struct VELAMEDIALIB_API ParameterTraits<Type> {                                                          \
        static const char* typeName() { return Name; }                                                       \
    }

VELA_PARAMETER_TYPE_NAME(int, "int");
VELA_PARAMETER_TYPE_NAME(float, "?");
VELA_PARAMETER_TYPE_NAME(double, "double");
VELA_PARAMETER_TYPE_NAME(std::string, "string");
VELA_PARAMETER_TYPE_NAME(CaptionData, "caption");
VELA_PARAMETER_TYPE_NAME(Point3d, "point");
VELA_PARAMETER_TYPE_NAME(TextAttributeList, "textAttributeList");
VELA_PARAMETER_TYPE_NAME(long long, "int64");
VELA_PARAMETER_TYPE_NAME(Rect<float>, "rect");
VELA_PARAMETER_TYPE_NAME(TemplatedColor<int>, "color");
VELA_PARAMETER_TYPE_NAME(std::list<Rect<float>>, "rectList");
VELA_PARAMETER_TYPE_NAME(SafeRational, "rational");
VELA_PARAMETER_TYPE_NAME(TransformMatrix, "matrix");
VELA_PARAMETER_TYPE_NAME(AudioPosition, "audioPosition");
VELA_PARAMETER_TYPE_NAME(KeystrokeData, "keystroke");
VELA_PARAMETER_TYPE_NAME(std::vector<double>, "vector");

#undef VELA_PARAMETER_TYPE_NAME

/// Parameters whose value is itself an interpolater.
template <typename X>
struct VELAMEDIALIB_TEMPLATE_API ParameterTraits<boost::shared_ptr<Interpolater<X>>> {
    static const char* typeName() { return "interpolater"; }
};

} // namespace VelaMediaLib

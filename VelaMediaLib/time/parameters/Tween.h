#pragma once
// Blending two values with a weight w, always as w*b + (1 - w)*a. Integer
// kinds round the blend to the nearest whole value; compound values blend
// member by member (a matrix element by element).

#include <VelaMediaLib/base/AudioPosition.h>
#include <VelaMediaLib/base/Point3d.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/base/TemplatedColor.h>
#include <VelaMediaLib/base/TransformMatrix.h>

#include <cmath>

namespace VelaMediaLib {
namespace Tween {

inline double blend(double a, double b, double w) { return w * b + (1.0 - w) * a; }
inline float blend(float a, float b, double w) { return float(w * b + (1.0 - w) * a); }
inline int blend(int a, int b, double w) { return int(std::lround(w * b + (1.0 - w) * a)); }
inline long long blend(long long a, long long b, double w) {
    return std::llround(w * double(b) + (1.0 - w) * double(a));
}

inline Rect<float> blend(const Rect<float>& a, const Rect<float>& b, double w) {
    return Rect<float>(blend(a.x, b.x, w), blend(a.y, b.y, w), blend(a.width, b.width, w),
                       blend(a.height, b.height, w));
}

inline TemplatedColor<int> blend(const TemplatedColor<int>& a, const TemplatedColor<int>& b, double w) {
    return TemplatedColor<int>(blend(a.red, b.red, w), blend(a.green, b.green, w), blend(a.blue, b.blue, w),
                               blend(a.alpha, b.alpha, w));
}

inline Point3d blend(const Point3d& a, const Point3d& b, double w) {
    return Point3d(blend(a.x, b.x, w), blend(a.y, b.y, w), blend(a.z, b.z, w));
}

inline AudioPosition blend(const AudioPosition& a, const AudioPosition& b, double w) {
    return AudioPosition(blend(a.pan, b.pan, w), blend(a.depth, b.depth, w));
}

inline TransformMatrix blend(const TransformMatrix& a, const TransformMatrix& b, double w) {
    TransformMatrix::Elements elements;
    for (size_t i = 0; i < elements.size(); ++i) elements[i] = blend(a.elements()[i], b.elements()[i], w);
    return TransformMatrix(elements);
}

} // namespace Tween
} // namespace VelaMediaLib

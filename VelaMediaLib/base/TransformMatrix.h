#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/Point3d.h>

#include <array>
#include <ostream>

namespace VelaMediaLib {

/// A 4x4 affine transform, row-major, acting on column vectors (x, y, z, 1).
class VELAMEDIALIB_API TransformMatrix {
public:
    typedef std::array<double, 16> Elements;

    /// The identity.
    TransformMatrix();
    explicit TransformMatrix(const Elements& elements) : m_(elements) {}

    static TransformMatrix identity() { return TransformMatrix(); }
    static TransformMatrix translation(double x, double y, double z);
    static TransformMatrix scaling(double x, double y, double z);
    /// Rotations about each axis, in radians, counter-clockwise looking down the axis.
    static TransformMatrix rotationX(double radians);
    static TransformMatrix rotationY(double radians);
    static TransformMatrix rotationZ(double radians);
    /// x moves by xByY times y, y by yByX times x.
    static TransformMatrix shearing(double xByY, double yByX);

    double at(int row, int column) const { return m_[row * 4 + column]; }
    void set(int row, int column, double value) { m_[row * 4 + column] = value; }
    const Elements& elements() const { return m_; }

    /// this * other: other is applied first.
    TransformMatrix operator*(const TransformMatrix& other) const;
    Point3d apply(const Point3d& point) const;

    bool operator==(const TransformMatrix& o) const { return m_ == o.m_; }
    bool operator!=(const TransformMatrix& o) const { return !(*this == o); }

private:
    Elements m_;
};

VELAMEDIALIB_API std::ostream& operator<<(std::ostream& out, const TransformMatrix& matrix);

} // namespace VelaMediaLib

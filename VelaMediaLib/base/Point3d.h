#pragma once

#include <VelaMediaLib/base/Export.h>

#include <ostream>

namespace VelaMediaLib {

/// A point or vector in three dimensions.
struct VELAMEDIALIB_API Point3d {
    double x = 0.0, y = 0.0, z = 0.0;

    Point3d() = default;
    Point3d(double x_, double y_, double z_) : x(x_), y(y_), z(z_) {}

    bool operator==(const Point3d& o) const { return x == o.x && y == o.y && z == o.z; }
    bool operator!=(const Point3d& o) const { return !(*this == o); }
};

inline std::ostream& operator<<(std::ostream& out, const Point3d& p) {
    return out << "Point3d(" << p.x << ", " << p.y << ", " << p.z << ")";
}

} // namespace VelaMediaLib

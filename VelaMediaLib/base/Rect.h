#pragma once

#include <VelaMediaLib/base/Export.h>

#include <ostream>

namespace VelaMediaLib {

/// An axis-aligned rectangle: origin and size.
template <typename T>
struct VELAMEDIALIB_TEMPLATE_API Rect {
    T x{}, y{}, width{}, height{};

    Rect() = default;
    Rect(T x_, T y_, T width_, T height_) : x(x_), y(y_), width(width_), height(height_) {}

    bool operator==(const Rect& o) const {
        return x == o.x && y == o.y && width == o.width && height == o.height;
    }
    bool operator!=(const Rect& o) const { return !(*this == o); }
};

template <typename T>
std::ostream& operator<<(std::ostream& out, const Rect<T>& r) {
    return out << "Rect(" << r.x << ", " << r.y << ", " << r.width << ", " << r.height << ")";
}

} // namespace VelaMediaLib

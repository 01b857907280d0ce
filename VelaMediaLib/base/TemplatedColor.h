#pragma once

#include <VelaMediaLib/base/Export.h>

#include <ostream>

namespace VelaMediaLib {

/// A colour as red, green, blue and alpha channels (0-255 for int channels).
template <typename T>
struct VELAMEDIALIB_TEMPLATE_API TemplatedColor {
    T red{}, green{}, blue{}, alpha{};

    TemplatedColor() = default;
    TemplatedColor(T r, T g, T b, T a) : red(r), green(g), blue(b), alpha(a) {}

    bool operator==(const TemplatedColor& o) const {
        return red == o.red && green == o.green && blue == o.blue && alpha == o.alpha;
    }
    bool operator!=(const TemplatedColor& o) const { return !(*this == o); }
};

template <typename T>
std::ostream& operator<<(std::ostream& out, const TemplatedColor<T>& c) {
    return out << "Color(" << c.red << ", " << c.green << ", " << c.blue << ", " << c.alpha << ")";
}

} // namespace VelaMediaLib

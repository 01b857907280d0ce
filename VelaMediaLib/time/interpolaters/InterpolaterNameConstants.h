#pragma once

#include <VelaMediaLib/base/Export.h>

namespace VelaMediaLib {

/// The four-character names by which documents refer to interpolater kinds.
struct VELAMEDIALIB_API InterpolaterNameConstants {
    static constexpr const char* s_leftName = "left";
    static constexpr const char* s_linearName = "linr";
    static constexpr const char* s_easeInName = "esIn";
    static constexpr const char* s_easeOutName = "esOt";
    static constexpr const char* s_easeInOutSinusoidalName = "eios";
    static constexpr const char* s_easeInOutDoubleExponentialSigmoidName = "eioe";
    static constexpr const char* s_bounceName = "bnce";
    static constexpr const char* s_springName = "sprg";
    /// Spatial Bézier curves for positions; their documents carry control points after the name.
    static constexpr const char* s_bezierName = "bezr";
};

} // namespace VelaMediaLib

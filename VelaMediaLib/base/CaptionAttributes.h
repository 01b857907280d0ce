#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/TemplatedColor.h>

#include <string>

namespace VelaMediaLib {

/// How the timeline's captions are shown.
struct VELAMEDIALIB_API CaptionAttributes {
    bool enabled = false;
    std::string fontName = "Arial";
    double fontSize = 32.0;
    TemplatedColor<int> backgroundColor = TemplatedColor<int>(0, 0, 0, 255);
    TemplatedColor<int> foregroundColor = TemplatedColor<int>(255, 255, 255, 255);
    std::string lang = "en";
    std::string alignment = "center";
    double defaultFontSize = 32.0;
    double opacity = 1.0;
    bool backgroundEnabled = true;
    bool backgroundOnlyAroundText = false;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/TemplatedColor.h>

#include <string>

namespace VelaMediaLib {

class XMLOptions;

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

    /// The object, closed at indent, members in the order above (written in
    /// time/parameters/CaptionAttributesDocument.cpp).
    void toJSON(XMLOptions& options, int indent) const;
    /// The same for the given attributes.
    static void toJSON(XMLOptions& options, int indent, const CaptionAttributes& attributes) {
        attributes.toJSON(options, indent);
    }
};

} // namespace VelaMediaLib

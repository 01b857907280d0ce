#pragma once

#include <VelaMediaLib/base/Export.h>

#include <ostream>
#include <string>

namespace VelaMediaLib {

/// The content of one caption: its text and the language it is written in
/// (a BCP 47 tag such as "en-US"; empty when unknown).
struct VELAMEDIALIB_API CaptionData {
    std::string text;
    std::string language;

    CaptionData() = default;
    CaptionData(std::string text_, std::string language_ = std::string())
        : text(std::move(text_)), language(std::move(language_)) {}

    bool operator==(const CaptionData& o) const { return text == o.text && language == o.language; }
    bool operator!=(const CaptionData& o) const { return !(*this == o); }
};

inline std::ostream& operator<<(std::ostream& out, const CaptionData& c) {
    return out << "CaptionData(" << c.text << ", " << c.language << ")";
}

} // namespace VelaMediaLib

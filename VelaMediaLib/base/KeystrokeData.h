#pragma once

#include <VelaMediaLib/base/Export.h>

#include <ostream>
#include <string>

namespace VelaMediaLib {

/// A keystroke shown by a screen recording: the key's label and the modifier
/// keys held with it.
struct VELAMEDIALIB_API KeystrokeData {
    enum Modifier { Shift = 1, Control = 2, Alt = 4, Command = 8 };

    std::string key;
    int modifiers = 0;

    KeystrokeData() = default;
    KeystrokeData(std::string key_, int modifiers_ = 0) : key(std::move(key_)), modifiers(modifiers_) {}

    bool operator==(const KeystrokeData& o) const { return key == o.key && modifiers == o.modifiers; }
    bool operator!=(const KeystrokeData& o) const { return !(*this == o); }
};

inline std::ostream& operator<<(std::ostream& out, const KeystrokeData& k) {
    return out << "KeystrokeData(" << k.key << ", " << k.modifiers << ")";
}

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>

#include <string>

namespace VelaMediaLib {

/// Who wrote a document, and in which version of its format.
struct VELAMEDIALIB_API VersionInfo {
    std::string version;
    std::string clientName;
    std::string clientVersion;
    std::string platform;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>

#include <string>

namespace VelaMediaLib {

/// Asked by the project parser about each file a document refers to that
/// cannot be reached. True lets the load go on (the source loads offline);
/// false cancels it.
class VELAMEDIALIB_API MissingFileHandler {
public:
    virtual ~MissingFileHandler() = default;
    virtual bool handleInaccessibleFile(const std::string& path) = 0;
};

} // namespace VelaMediaLib

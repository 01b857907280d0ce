#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/format/VersionInfo.h>

namespace VelaMediaLib {

/// A parser of a whole document kind.
class VELAMEDIALIB_API ParserInterface {
public:
    virtual ~ParserInterface() = default;
    /// The version information of the document (see each parser).
    virtual VersionInfo versionInfo() const = 0;
};

} // namespace VelaMediaLib

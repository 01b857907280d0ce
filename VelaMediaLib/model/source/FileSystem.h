#pragma once

#include <VelaMediaLib/base/Export.h>

#include <string>

namespace VelaMediaLib {

/// What sources ask about their files, behind an interface so that a host
/// (or a test) can answer for a file system of its own.
class VELAMEDIALIB_API FileSystem {
public:
    virtual ~FileSystem() = default;
    virtual bool exists(const std::string& path) const = 0;
    /// Whether the file exists and its contents can be read.
    virtual bool isReadable(const std::string& path) const = 0;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>

#include <string>

namespace VelaMediaLib {

/// Something with a name the user gives it (the document's "ident").
class VELAMEDIALIB_API Identified {
public:
    virtual ~Identified() = default;
    virtual std::string identifier() const = 0;
    virtual void setIdentifier(const std::string& identifier) = 0;
};

} // namespace VelaMediaLib

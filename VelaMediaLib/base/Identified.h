#pragma once

#include <string>

namespace VelaMediaLib {

/// Something with a name the user gives it (the document's "ident").
class Identified {
public:
    virtual ~Identified() = default;
    virtual std::string identifier() const = 0;
    virtual void setIdentifier(const std::string& identifier) = 0;
};

} // namespace VelaMediaLib

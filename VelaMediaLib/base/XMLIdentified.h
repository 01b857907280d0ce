#pragma once

#include <VelaMediaLib/base/Export.h>

#include <cstdint>

namespace VelaMediaLib {

/// An object that documents refer to by number. It takes an identifier from
/// the process's IdentManager when made and retires it when destroyed.
class VELAMEDIALIB_API XMLIdentified {
public:
    XMLIdentified() : ident_(newXMLIdent()) {}
    XMLIdentified(const XMLIdentified&) : ident_(newXMLIdent()) {} // a copy is another object
    XMLIdentified& operator=(const XMLIdentified&) { return *this; }
    virtual ~XMLIdentified() { retireXMLIdent(ident_); }

    uint32_t xmlIdent() const { return ident_; }

    static uint32_t newXMLIdent();
    static void retireXMLIdent(uint32_t ident);

private:
    const uint32_t ident_;
};

/// What writes itself into the project document.
class VELAMEDIALIB_API XMLable : public virtual XMLIdentified {};

} // namespace VelaMediaLib

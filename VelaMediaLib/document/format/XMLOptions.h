#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/function.hpp>
#include <map>
#include <ostream>
#include <string>

namespace VelaMediaLib {

/// The context of one document write: where the text goes, how deep one
/// indentation level is, the identity table that gives every written object
/// a fresh "id" (so references name ids of the same write), and the modifier
/// applied to every file path written.
class VELAMEDIALIB_API XMLOptions {
public:
    typedef boost::function<std::string(const std::string&)> PathModifier;

    explicit XMLOptions(std::ostream& stream, int indentWidth = 2);

    std::ostream& stream() { return stream_; }
    int indentWidth() const { return indentWidth_; }
    /// The blanks that open a line at the given level.
    std::string indentation(int level) const;

    /// A fresh identifier for the object, remembered for findIdent. Identifiers
    /// count from 1 within one write.
    unsigned assignNewIdent(const void* object);
    /// The identifier assigned to the object in this write, or 0 when none was.
    unsigned findIdent(const void* object) const;

    void setPathModifier(const PathModifier& modifier) { pathModifier_ = modifier; }
    /// The path as it should be written; unchanged without a modifier.
    std::string modifyPath(const std::string& path) const;

private:
    std::ostream& stream_;
    int indentWidth_;
    unsigned nextIdent_ = 1;
    std::map<const void*, unsigned> idents_;
    PathModifier pathModifier_;
};

} // namespace VelaMediaLib

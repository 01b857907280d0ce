#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/function.hpp>
#include <map>
#include <ostream>
#include <string>
#include <vector>

namespace VelaMediaLib {

/// The context of one document write: where the text goes, how deep one
/// indentation level is, the objects and arrays open at the moment (so a
/// writer knows whether a separator comes before the next member), the
/// identity table that gives every written object a fresh "id" (so references
/// name ids of the same write), and the modifier applied to every file path
/// written. One options object serves one document: its identifiers count
/// on and its table is never cleared.
class VELAMEDIALIB_API XMLOptions {
public:
    typedef boost::function<std::string(const std::string&)> PathModifier;

    explicit XMLOptions(std::ostream& stream, int indentWidth = 2);

    std::ostream& stream() { return stream_; }
    int indentWidth() const { return indentWidth_; }
    /// The blanks that open a line at the given level.
    std::string indentation(int level) const;

    /// Starts the next member of the innermost open object: separator,
    /// indentation and key. With nothing open, the key alone. Throws
    /// VelaMediaLibException inside an open array (the text would not be JSON).
    std::ostream& key(const std::string& name);
    /// Starts the next element of the innermost open array: separator and
    /// indentation. With nothing open, nothing. Throws VelaMediaLibException
    /// inside an open object.
    std::ostream& element();

    /// A fresh identifier for the object, remembered for findIdent. Identifiers
    /// count from 1 within one write.
    unsigned assignNewIdent(const void* object);
    /// The identifier assigned to the object in this write, or 0 when none was.
    unsigned findIdent(const void* object) const;

    void setPathModifier(const PathModifier& modifier) { pathModifier_ = modifier; }
    /// The path as it should be written; unchanged without a modifier.
    std::string modifyPath(const std::string& path) const;

private:
    friend class JSONWriter;
    /// Opens an object or array whose closing bracket stands at the level.
    void openContainer(int level, bool array);
    void closeContainer();

    struct Container {
        int level;
        bool array;
        bool empty;
    };
    void separate(bool array);

    std::ostream& stream_;
    int indentWidth_;
    std::vector<Container> open_;
    unsigned nextIdent_ = 1;
    std::map<const void*, unsigned> idents_;
    PathModifier pathModifier_;
};

} // namespace VelaMediaLib

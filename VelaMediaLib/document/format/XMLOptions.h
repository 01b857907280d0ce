#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/function.hpp>
#include <map>
#include <ostream>
#include <string>
#include <type_traits>
#include <vector>

namespace VelaMediaLib {

/// The context of one document write: where the text goes, how deep one
/// indentation level is, the objects and arrays open at the moment (so a
/// writer knows whether a separator comes before the next member), the
/// identity table that gives every written object a fresh "id" (so references
/// name ids of the same write), and the modifier applied to every file path
/// written. One options object serves one document: its identifiers count
/// on and its table is never cleared.
///
/// An indent width of 0 writes the compact form: no line breaks, no
/// indentation, members separated by "," alone and keys written as "\"key\":".
class VELAMEDIALIB_API XMLOptions {
public:
    typedef boost::function<std::string(const std::string&)> PathModifier;

    explicit XMLOptions(std::ostream& stream, int indentWidth = 2);

    std::ostream& stream() { return stream_; }
    int indentWidth() const { return indentWidth_; }
    /// Whether the compact form is written (indent width 0).
    bool compact() const { return indentWidth_ <= 0; }
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

    /// The key and the separator of values written on one line inside a
    /// value (a caption's "text" and "lang"): "\"key\" : " and ", ", or
    /// "\"key\":" and "," in the compact form.
    std::string inlineKey(const std::string& name) const;
    const char* inlineSeparator() const { return compact() ? "," : ", "; }

    /// The object's identifier in this write: the one it already has, or else
    /// a fresh one, remembered for findIdent. An object referred to before it
    /// is written (a hotspot's marker target) takes its identifier there and
    /// keeps it when written. Fresh identifiers count from 1 in the order
    /// they are asked for, so one model always gives the same ids.
    unsigned assignNewIdent(const void* object);
    /// The identifier assigned to the object in this write, or 0 when none was.
    unsigned findIdent(const void* object) const;
    /// The same for a typed object: a polymorphic object is known by its
    /// whole object's address, so a clip has one identifier whether it is
    /// reached as a Media, a MediaImpl or a Parametric.
    template <typename T>
    unsigned assignNewIdent(const T* object) {
        return assignNewIdent(identityOf(object));
    }
    template <typename T>
    unsigned findIdent(const T* object) const {
        return findIdent(identityOf(object));
    }
    template <typename T>
    static const void* identityOf(const T* object) {
        if constexpr (std::is_polymorphic<T>::value)
            return dynamic_cast<const void*>(object);
        else
            return object;
    }

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

#pragma once

#include <VelaMediaLib/base/Export.h>

#include <memory>
#include <string>

namespace Json {
class Value;
} // namespace Json

namespace VelaMediaLib {

class XMLOptions;
struct JSONTreeAccess;

/// A piece of a document kept whole as it was read (an effect's parameters, a
/// transition's attributes), for parts the model does not take apart. It is
/// immutable: copies share the one parsed tree, so copying is cheap and a copy
/// may be read on any thread. A default-made tree is null.
///
/// Written in the library's own form: integers as integers, real numbers as
/// formatDouble gives them, strings escaped, object members in the order the
/// parsed tree holds them (sorted by key), so a second write gives the same
/// bytes as the first.
class VELAMEDIALIB_API JSONTree {
public:
    JSONTree();

    bool isNull() const;
    /// Null, or an object or array without members.
    bool isEmpty() const;
    /// Writes the value where the text stands; an object or array is closed at indent.
    void write(XMLOptions& options, int indent) const;
    /// The value on one line, without blanks.
    std::string toCompactString() const;

    bool operator==(const JSONTree& other) const;
    bool operator!=(const JSONTree& other) const { return !(*this == other); }

private:
    friend struct JSONTreeAccess; // detail/JSONTreeAccess.h

    std::shared_ptr<const Json::Value> value_;
};

} // namespace VelaMediaLib

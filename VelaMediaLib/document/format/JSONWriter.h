#pragma once
// The indenting writer every toJSON uses: objects open with "{" and a line
// break, members are separated by "," and a line break, a key is written as
// "\"key\" : ", and closing brackets stand on their own line at the level of
// the opening key.
//
// Every writer has one shape: f(XMLOptions& options, int indent, ...), where
// indent is the level it writes at. A writer of a whole object or array
// (Media::toJSON, KeyFrameInterface::toJSON) opens it where the text stands,
// puts its members at indent + 1 and its closing bracket at indent; a writer
// of members (toJSONTemporalValues, toJSONParameterList, MetaDatable::toJSON)
// or of a value writes at indent, the level of the object's members. The
// options keep the objects and arrays open, so options.key() and
// options.element() put the separator and the indentation in.

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/XMLOptions.h>

#include <string>

namespace VelaMediaLib {

/// The quoted, escaped key followed by " : ".
VELAMEDIALIB_API std::string keyName(const std::string& key);
/// The text as a JSON string literal, quotes included.
VELAMEDIALIB_API std::string quotedJSONString(const std::string& text);

/// One member of the open object: its key and its value in the value's form.
template <typename T>
void writeJSONMember(XMLOptions& options, int indent, const std::string& key, const T& value) {
    options.key(key);
    writeJSONValue(options, indent, value);
}

/// Keeps one JSON object or array open, its members at level + 1: opens it on
/// construction and closes it by close() or, failing that, the destructor.
class VELAMEDIALIB_API JSONWriter {
public:
    enum Kind { Object, Array };

    JSONWriter(XMLOptions& options, int level, Kind kind = Object);
    ~JSONWriter();
    JSONWriter(const JSONWriter&) = delete;
    JSONWriter& operator=(const JSONWriter&) = delete;

    /// The level of the members, for the writers of the members.
    int memberLevel() const { return level_ + 1; }
    void close();

private:
    XMLOptions& options_;
    int level_;
    bool closed_ = false;
};

} // namespace VelaMediaLib

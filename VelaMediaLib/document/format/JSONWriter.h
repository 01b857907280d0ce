#pragma once
// The indenting writer every toJSON uses: objects open with "{" and a line
// break, members are separated by "," and a line break, a key is written as
// "\"key\" : ", and closing brackets stand on their own line at the level of
// the opening key.

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/format/XMLOptions.h>

#include <string>

namespace VelaMediaLib {

/// The quoted, escaped key followed by " : ".
VELAMEDIALIB_API std::string keyName(const std::string& key);
/// The text as a JSON string literal, quotes included.
VELAMEDIALIB_API std::string quotedJSONString(const std::string& text);

/// Writes one JSON object or array whose members stand at level + 1. The
/// closing bracket is written by close() or, failing that, the destructor.
class VELAMEDIALIB_API JSONWriter {
public:
    enum Kind { Object, Array };

    JSONWriter(XMLOptions& options, int level, Kind kind = Object);
    ~JSONWriter();
    JSONWriter(const JSONWriter&) = delete;
    JSONWriter& operator=(const JSONWriter&) = delete;

    /// Starts the next object member: separator, indentation and key.
    std::ostream& key(const std::string& name);
    /// Starts the next array element: separator and indentation.
    std::ostream& element();
    /// The level of the members, for nested writers.
    int memberLevel() const { return level_ + 1; }
    XMLOptions& options() { return options_; }
    void close();

private:
    void separate();

    XMLOptions& options_;
    int level_;
    Kind kind_;
    bool empty_ = true;
    bool closed_ = false;
};

} // namespace VelaMediaLib

#include <VelaMediaLib/document/format/JSONWriter.h>

#include <cstdio>

namespace VelaMediaLib {

std::string quotedJSONString(const std::string& text) {
    std::string quoted = "\"";
    for (const char c : text) {
        switch (c) {
        case '"':
            quoted += "\\\"";
            break;
        case '\\':
            quoted += "\\\\";
            break;
        case '\b':
            quoted += "\\b";
            break;
        case '\f':
            quoted += "\\f";
            break;
        case '\n':
            quoted += "\\n";
            break;
        case '\r':
            quoted += "\\r";
            break;
        case '\t':
            quoted += "\\t";
            break;
        default:
            if ((unsigned char)c < 0x20) {
                char escaped[8];
                std::snprintf(escaped, sizeof escaped, "\\u%04x", (unsigned)(unsigned char)c);
                quoted += escaped;
            } else {
                quoted += c; // UTF-8 passes through as it is
            }
        }
    }
    return quoted + "\"";
}

std::string keyName(const std::string& key) { return quotedJSONString(key) + " : "; }

JSONWriter::JSONWriter(XMLOptions& options, int level, Kind kind) : options_(options), level_(level) {
    options_.openContainer(level_, kind == Array);
}

JSONWriter::~JSONWriter() { close(); }

void JSONWriter::close() {
    if (closed_) return;
    closed_ = true;
    options_.closeContainer();
}

} // namespace VelaMediaLib

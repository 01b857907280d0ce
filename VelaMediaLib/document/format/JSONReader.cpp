#include <VelaMediaLib/document/format/JSONReader.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <json/value.h>
#include <stdexcept>

namespace VelaMediaLib {
namespace {

// std::stoll that must consume the whole text.
long long wholeInteger(const std::string& text) {
    size_t used = 0;
    const long long value = std::stoll(text, &used, 10);
    if (used != text.size()) throw std::invalid_argument("stoll");
    return value;
}

} // namespace

SafeRational JSONReader::jsonValueAsVelaRational(const Json::Value& value) {
    if (value.isInt64() || value.isUInt64()) return SafeRational(value.asInt64());
    if (value.isString()) {
        const std::string text = value.asString();
        const size_t slash = text.find('/');
        if (slash == std::string::npos) return SafeRational(wholeInteger(text));
        return SafeRational(wholeInteger(text.substr(0, slash)), wholeInteger(text.substr(slash + 1)));
    }
    throw ParserException("Invalid project json - unsupported json type for VelaRational: " +
                          compactJSON(value));
}

RationalTime JSONReader::jsonValueAsRationalTime(const Json::Value& value) {
    return RationalTime(jsonValueAsVelaRational(value));
}

long long JSONReader::jsonValueAsVelaTime(const Json::Value& value) {
    if (value.isInt64()) return value.asInt64();
    return jsonValueAsVelaRational(value).asVelaTime();
}

} // namespace VelaMediaLib

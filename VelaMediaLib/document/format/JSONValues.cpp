#include <VelaMediaLib/document/format/JSONValues.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/document/format/JSONWriter.h>

#include <charconv>
#include <cmath>
#include <json/writer.h>
#include <limits>

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

SafeRational jsonValueAsVelaRational(const Json::Value& value) {
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

RationalTime jsonValueAsRationalTime(const Json::Value& value) {
    return RationalTime(jsonValueAsVelaRational(value));
}

long long jsonValueAsVelaTime(const Json::Value& value) {
    if (value.isInt64()) return value.asInt64();
    return jsonValueAsVelaRational(value).asVelaTime();
}
namespace {

template <typename Number>
std::string shortest(Number value) {
    if (!std::isfinite(value)) return "null";
    char text[64];
    const std::to_chars_result result = std::to_chars(text, text + sizeof text, value);
    std::string written(text, result.ptr);
    if (written.find_first_of(".e") == std::string::npos) written += ".0"; // visibly a real number
    return written;
}

} // namespace

std::string formatDouble(double value) { return shortest(value); }
std::string formatFloat(float value) { return shortest(value); }

std::string compactJSON(const Json::Value& value) {
    Json::StreamWriterBuilder builder;
    builder["indentation"] = "";
    return Json::writeString(builder, value);
}

void refuseJSONValue(const char* expected, const Json::Value& json) {
    throw ParserException(std::string("Invalid project json - expected ") + expected + ": " +
                          compactJSON(json));
}

const Json::Value& jsonArrayOf(const Json::Value& json, unsigned count, const char* what) {
    if (!json.isArray() || json.size() != count) refuseJSONValue(what, json);
    return json;
}

const Json::Value& jsonMemberOf(const Json::Value& json, const char* key, const char* what) {
    if (!json.isObject()) refuseJSONValue(what, json);
    return json[key];
}

void writeJSONValue(XMLOptions& options, int, bool value) { options.stream() << (value ? "true" : "false"); }
void writeJSONValue(XMLOptions& options, int, int value) { options.stream() << value; }
void writeJSONValue(XMLOptions& options, int, long long value) { options.stream() << value; }
void writeJSONValue(XMLOptions& options, int, float value) { options.stream() << formatFloat(value); }
void writeJSONValue(XMLOptions& options, int, double value) { options.stream() << formatDouble(value); }
void writeJSONValue(XMLOptions& options, int, const std::string& value) {
    options.stream() << quotedJSONString(value);
}

void writeJSONValue(XMLOptions& options, int, const SafeRational& value) {
    if (value.denominator() == 1)
        options.stream() << value.numerator();
    else
        options.stream() << '"' << value << '"';
}

void writeJSONValue(XMLOptions& options, int indent, const RationalTime& value) {
    writeJSONValue(options, indent, value.asRational());
}

void writeJSONValue(XMLOptions& options, int, const Range<long long>& value) {
    options.stream() << "[" << value.first() << options.inlineSeparator() << value.second() << "]";
}

bool jsonValueAsBool(const Json::Value& json) {
    if (!json.isBool()) refuseJSONValue("a boolean", json);
    return json.asBool();
}

int jsonValueAsInt(const Json::Value& json) {
    if (!json.isInt()) refuseJSONValue("an integer", json);
    return json.asInt();
}

long long jsonValueAsInt64(const Json::Value& json) {
    if (!json.isInt64()) refuseJSONValue("a 64-bit integer", json);
    return json.asInt64();
}

double jsonValueAsDouble(const Json::Value& json) {
    if (json.isNull()) return std::numeric_limits<double>::quiet_NaN();
    if (!json.isNumeric()) refuseJSONValue("a number", json);
    return json.asDouble();
}

float jsonValueAsFloat(const Json::Value& json) { return float(jsonValueAsDouble(json)); }

bool jsonValueIsNull(const Json::Value& json) { return json.isNull(); }

std::string jsonValueAsString(const Json::Value& json) {
    if (json.isNull()) return std::string();
    if (!json.isString()) refuseJSONValue("a string", json);
    return json.asString();
}

Range<long long> jsonValueAsTickRange(const Json::Value& json) {
    jsonArrayOf(json, 2, "a tick range [start, duration]");
    return Range<long long>(jsonValueAsVelaTime(json[0]), jsonValueAsVelaTime(json[1]));
}

} // namespace VelaMediaLib

#pragma once
// The document forms of the primitive values every other form is built from:
// booleans, integers, real numbers, strings, rationals and tick ranges. Each
// writer has the shape of every writer (see JSONWriter.h); the value stands on
// one line, so the level is not used. Doubles are written in their shortest
// form that reads back as the same double (with ".0" when whole); a value that
// is not finite is written as null and read back as NaN. A value of the wrong
// JSON type is refused with ParserException "Invalid project json - expected "
// and what was expected.

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/RationalTime.h>
#include <VelaMediaLib/time/rational/SafeRational.h>

#include <string>

// Documents are read from jsoncpp values; only the library needs their definition.
namespace Json {
class Value;
} // namespace Json

namespace VelaMediaLib {

class XMLOptions;

VELAMEDIALIB_API void writeJSONValue(XMLOptions& options, int indent, bool value);
VELAMEDIALIB_API void writeJSONValue(XMLOptions& options, int indent, int value);
VELAMEDIALIB_API void writeJSONValue(XMLOptions& options, int indent, long long value);
VELAMEDIALIB_API void writeJSONValue(XMLOptions& options, int indent, float value);
VELAMEDIALIB_API void writeJSONValue(XMLOptions& options, int indent, double value);
VELAMEDIALIB_API void writeJSONValue(XMLOptions& options, int indent, const std::string& value);
VELAMEDIALIB_API void writeJSONValue(XMLOptions& options, int indent,
                                     const char* value) = delete; // would pass as a bool
/// Whole numbers as integers, others as "n/d".
VELAMEDIALIB_API void writeJSONValue(XMLOptions& options, int indent, const SafeRational& value);
VELAMEDIALIB_API void writeJSONValue(XMLOptions& options, int indent, const RationalTime& value);
/// A tick range as [start, duration].
VELAMEDIALIB_API void writeJSONValue(XMLOptions& options, int indent, const Range<long long>& value);

/// An integer (n/1) or a string "n/d" whose halves are base-10 64-bit
/// integers. A malformed half throws std::invalid_argument or
/// std::out_of_range, a zero denominator boost::bad_rational, any other JSON
/// type ParserException "Invalid project json - unsupported json type for
/// VelaRational: " and the value.
VELAMEDIALIB_API SafeRational jsonValueAsVelaRational(const Json::Value& value);
VELAMEDIALIB_API RationalTime jsonValueAsRationalTime(const Json::Value& value);
/// A count of ticks: a 64-bit integer (a whole-valued rational is accepted too).
VELAMEDIALIB_API long long jsonValueAsVelaTime(const Json::Value& value);
VELAMEDIALIB_API bool jsonValueAsBool(const Json::Value& json);
VELAMEDIALIB_API int jsonValueAsInt(const Json::Value& json);
VELAMEDIALIB_API long long jsonValueAsInt64(const Json::Value& json);
/// A number; null reads as NaN.
VELAMEDIALIB_API double jsonValueAsDouble(const Json::Value& json);
VELAMEDIALIB_API float jsonValueAsFloat(const Json::Value& json);
/// A string; null reads as the empty string.
VELAMEDIALIB_API std::string jsonValueAsString(const Json::Value& json);
VELAMEDIALIB_API bool jsonValueIsNull(const Json::Value& json);
VELAMEDIALIB_API Range<long long> jsonValueAsTickRange(const Json::Value& json);

VELAMEDIALIB_API std::string formatDouble(double value);
VELAMEDIALIB_API std::string formatFloat(float value);
/// The value on one line, for messages.
VELAMEDIALIB_API std::string compactJSON(const Json::Value& value);

/// Throws the ParserException of a value that is not what was expected.
[[noreturn]] void refuseJSONValue(const char* expected, const Json::Value& json);
/// The array, when it holds exactly count elements; refused otherwise.
VELAMEDIALIB_API const Json::Value& jsonArrayOf(const Json::Value& json, unsigned count, const char* what);
/// The member of the object (null when absent); refused when json is no object.
VELAMEDIALIB_API const Json::Value& jsonMemberOf(const Json::Value& json, const char* key, const char* what);

} // namespace VelaMediaLib

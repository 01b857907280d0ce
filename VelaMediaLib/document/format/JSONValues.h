#pragma once
// The document forms of the primitive values every other form is built from:
// booleans, integers, real numbers, strings, rationals and tick ranges. Each
// writer has the shape of every writer (see JSONWriter.h); the value stands on
// one line, so the level is not used. Doubles are written in their shortest
// form that reads back as the same double (with ".0" when whole); a value that
// is not finite is written as null and read back as NaN. A value of the wrong
// JSON type is refused with ParserException "Invalid project json - expected "
// and what was expected.

#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/RationalTime.h>
#include <VelaMediaLib/time/rational/SafeRational.h>

#include <json/value.h>
#include <string>

namespace VelaMediaLib {

class XMLOptions;

void writeJSONValue(XMLOptions& options, int indent, bool value);
void writeJSONValue(XMLOptions& options, int indent, int value);
void writeJSONValue(XMLOptions& options, int indent, long long value);
void writeJSONValue(XMLOptions& options, int indent, float value);
void writeJSONValue(XMLOptions& options, int indent, double value);
void writeJSONValue(XMLOptions& options, int indent, const std::string& value);
void writeJSONValue(XMLOptions& options, int indent, const char* value) = delete; // would pass as a bool
/// Whole numbers as integers, others as "n/d".
void writeJSONValue(XMLOptions& options, int indent, const SafeRational& value);
void writeJSONValue(XMLOptions& options, int indent, const RationalTime& value);
/// A tick range as [start, duration].
void writeJSONValue(XMLOptions& options, int indent, const Range<long long>& value);

bool jsonValueAsBool(const Json::Value& json);
int jsonValueAsInt(const Json::Value& json);
long long jsonValueAsInt64(const Json::Value& json);
/// A number; null reads as NaN.
double jsonValueAsDouble(const Json::Value& json);
float jsonValueAsFloat(const Json::Value& json);
/// A string; null reads as the empty string.
std::string jsonValueAsString(const Json::Value& json);
Range<long long> jsonValueAsTickRange(const Json::Value& json);

std::string formatDouble(double value);
std::string formatFloat(float value);
/// The value on one line, for messages.
std::string compactJSON(const Json::Value& value);

/// Throws the ParserException of a value that is not what was expected.
[[noreturn]] void refuseJSONValue(const char* expected, const Json::Value& json);
/// The array, when it holds exactly count elements; refused otherwise.
const Json::Value& jsonArrayOf(const Json::Value& json, unsigned count, const char* what);
/// The member of the object (null when absent); refused when json is no object.
const Json::Value& jsonMemberOf(const Json::Value& json, const char* key, const char* what);

} // namespace VelaMediaLib

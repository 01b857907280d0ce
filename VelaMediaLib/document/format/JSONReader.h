#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/RationalTime.h>
#include <VelaMediaLib/time/rational/SafeRational.h>

#include <string>

// Documents are read from jsoncpp values; only the library needs their definition.
namespace Json {
class Value;
} // namespace Json

namespace VelaMediaLib {

/// The base of the document readers and the conversions they share.
class VELAMEDIALIB_API JSONReader {
public:
    virtual ~JSONReader() = default;

    /// An integer (n/1) or a string "n/d" whose halves are base-10 64-bit
    /// integers. A malformed half throws std::invalid_argument or
    /// std::out_of_range, a zero denominator boost::bad_rational, any other
    /// JSON type ParserException "Invalid project json - unsupported json
    /// type for VelaRational: " and the value.
    static SafeRational jsonValueAsVelaRational(const Json::Value& value);
    static RationalTime jsonValueAsRationalTime(const Json::Value& value);
    /// A count of ticks: a 64-bit integer (a whole-valued rational is accepted too).
    static long long jsonValueAsVelaTime(const Json::Value& value);
    static SafeRational asRational(const Json::Value& value) { return jsonValueAsVelaRational(value); }
    static long long asLongLong(const Json::Value& value) { return jsonValueAsVelaTime(value); }

    static const char* idTagName() { return "id"; }
    static const char* parametersTagName() { return "parameters"; }
};

} // namespace VelaMediaLib

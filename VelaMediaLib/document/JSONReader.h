#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/format/JSONValues.h>

#include <string>

namespace VelaMediaLib {

/// The base of the project document readers and the conversions they share.
class VELAMEDIALIB_API JSONReader {
public:
    virtual ~JSONReader() = default;

    /// The conversions every reader shares (see JSONValues.h).
    static SafeRational jsonValueAsVelaRational(const Json::Value& value) {
        return VelaMediaLib::jsonValueAsVelaRational(value);
    }
    static RationalTime jsonValueAsRationalTime(const Json::Value& value) {
        return VelaMediaLib::jsonValueAsRationalTime(value);
    }
    static long long jsonValueAsVelaTime(const Json::Value& value) {
        return VelaMediaLib::jsonValueAsVelaTime(value);
    }
    static SafeRational asRational(const Json::Value& value) { return jsonValueAsVelaRational(value); }
    static long long asLongLong(const Json::Value& value) { return jsonValueAsVelaTime(value); }

    static const char* idTagName() { return "id"; }
    static const char* parametersTagName() { return "parameters"; }
};

} // namespace VelaMediaLib

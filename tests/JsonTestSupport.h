#pragma once
// Parsing document text, and reading what a step throws, in tests.

#include <gtest/gtest.h>
#include <json/reader.h>
#include <sstream>
#include <string>

namespace VelaMediaLib {
namespace testing {

inline Json::Value parseJson(const std::string& text) {
    Json::Value value;
    Json::CharReaderBuilder builder;
    std::string errors;
    std::istringstream in(text);
    if (!Json::parseFromStream(builder, in, &value, &errors)) ADD_FAILURE() << errors << "\n" << text;
    return value;
}

/// The message of the E the step throws, or "no exception" (another kind escapes).
template <typename E, typename Step>
std::string thrown(const Step& step) {
    try {
        step();
    } catch (const E& e) {
        return e.what();
    }
    return "no exception";
}

} // namespace testing
} // namespace VelaMediaLib

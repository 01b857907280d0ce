#pragma once
// Parsing document text in tests.

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

} // namespace testing
} // namespace VelaMediaLib

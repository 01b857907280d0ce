#pragma once
// Parsing document text with the limits every parser of the library sets.

#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/document/format/VersionInfo.h>

#include <json/value.h>

#include <istream>
#include <string>

namespace VelaMediaLib {

/// The stream's text as a JSON object; ParserException "Invalid project json"
/// for text that is not JSON (or nested deeper than jsoncpp is let go).
Json::Value parseDocument(std::istream& in);
/// The root's version information ("6.0" without "version").
VersionInfo documentVersionInfo(const Json::Value& root);

/// Turns what the step throws into the parsers' one kind of failure: as
/// refusingOtherFaults, the text being the exception's own.
template <typename Step>
auto parsingDocument(const Step& step) -> decltype(step()) {
    return refusingOtherFaults([](const char* what) { return std::string(what); }, step);
}

} // namespace VelaMediaLib

#pragma once
// Parsing document text with the limits every parser of the library sets.

#include <VelaMediaLib/document/format/VersionInfo.h>

#include <json/value.h>

#include <istream>

namespace VelaMediaLib {

/// The stream's text as a JSON object; ParserException "Invalid project json"
/// for text that is not JSON (or nested deeper than jsoncpp is let go).
Json::Value parseDocument(std::istream& in);
/// The root's version information ("6.0" without "version").
VersionInfo documentVersionInfo(const Json::Value& root);
/// Turns what the step throws into the parsers' one kind of failure.
template <typename Step>
auto parsingDocument(const Step& step) -> decltype(step());

} // namespace VelaMediaLib

#include <VelaMediaLib/document/detail/ReadSupport.h>

namespace VelaMediaLib {

template <typename Step>
auto parsingDocument(const Step& step) -> decltype(step()) {
    try {
        return step();
    } catch (const ParserException&) {
        throw;
    } catch (const std::bad_alloc&) {
        throw;
    } catch (const std::exception& e) {
        refuseDocument(e.what());
    }
}

} // namespace VelaMediaLib

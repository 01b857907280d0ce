// libFuzzer target over the project parser. Every input must end in a
// project or in one of the exceptions the reader documents for a refused
// document; anything else (another exception, a crash, a leak, undefined
// behaviour, a hang) is a finding. A document that reads must also write,
// and its text must read back to the same text.
#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/document/ProjectDocument.h>
#include <VelaMediaLib/document/RemixParser.h>

#include <boost/rational.hpp>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <sstream>
#include <stdexcept>
#include <string>

using namespace VelaMediaLib;

namespace {

/// The project of the text, or null when the parser refused it as it documents.
ProjectPtr parseOrRefuse(const std::string& text) {
    std::istringstream in(text);
    RemixParser parser;
    try {
        if (!parser.parse(in)) return ProjectPtr();
        return parser.project();
    } catch (const VelaMediaLibException&) { // ParserException and the model's own refusals
    } catch (const std::invalid_argument&) { // a malformed integer in a fraction
    } catch (const std::out_of_range&) {     // an integer beyond 64 bits in a fraction
    } catch (const boost::bad_rational&) {   // a zero denominator
    }
    return ProjectPtr();
}

[[noreturn]] void finding(const char* what, const std::string& detail) {
    std::fprintf(stderr, "ParseFuzzer: %s\n%s\n", what, detail.c_str());
    std::abort();
}

/// What the library writes must read back and write the same text again.
void checkRoundTrip(const Project& project) {
    const std::string written = projectToJSONString(project);
    const ProjectPtr reread = parseOrRefuse(written);
    if (!reread) finding("the written document does not read back", written);
    if (projectToJSONString(*reread) != written)
        finding("the written document reads back different", written);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const ProjectPtr project = parseOrRefuse(std::string(reinterpret_cast<const char*>(data), size));
    if (project) checkRoundTrip(*project);
    return 0;
}

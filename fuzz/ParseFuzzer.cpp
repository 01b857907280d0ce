// libFuzzer target over the project parser. Every input must end in a
// project or in ParserException, the parser's one refusal; anything else (another exception, a crash, a leak,
// undefined behaviour, a hang) is a finding. A document that reads must also write, and its text must read
// back to the same text.
#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/document/ProjectDocument.h>
#include <VelaMediaLib/document/RemixParser.h>
#include <VelaMediaLib/model/project/Project.h>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <sstream>
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
    } catch (const ParserException&) { // the one refusal the parser documents
        return ProjectPtr();
    }
}

[[noreturn]] void finding(const std::string& what, const std::string& detail) {
    std::fprintf(stderr, "ParseFuzzer: %s\n%s\n", what.c_str(), detail.c_str());
    std::abort();
}

/// What the library writes must read back and write the same text again.
void checkRoundTrip(const Project& project) {
    const std::string written = projectToJSONString(project);
    ProjectPtr reread;
    try {
        reread = projectFromJSONString(written);
    } catch (const ParserException& refused) {
        finding(std::string("the written document does not read back: ") + refused.what(), written);
    }
    if (projectToJSONString(*reread) != written)
        finding("the written document reads back different", written);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const ProjectPtr project = parseOrRefuse(std::string(reinterpret_cast<const char*>(data), size));
    if (project) checkRoundTrip(*project);
    return 0;
}

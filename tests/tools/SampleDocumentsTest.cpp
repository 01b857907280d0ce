// The hand-written sample documents are in the library's own form: each
// reads, and writing it again gives the same bytes, in both forms.
#include "TextDifference.h"
#include "ToolTestSupport.h"

#include <VelaMediaLib/document/ProjectDocument.h>
#include <VelaMediaLib/document/RemixParser.h>
#include <VelaMediaLib/model/project/Project.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <sstream>

using namespace VelaMediaLib;
using namespace VelaToolTesting;

namespace {

std::vector<std::string> samples() {
    std::vector<std::string> paths;
    for (const auto& entry : std::filesystem::directory_iterator(VELA_SAMPLES_DIR))
        if (entry.path().extension() == ".json") paths.push_back(entry.path().string());
    std::sort(paths.begin(), paths.end());
    return paths;
}

ProjectPtr readFile(const std::string& path) {
    RemixParser parser;
    EXPECT_TRUE(parser.parse(path)) << path;
    return parser.project();
}

void expectSameText(const std::string& expected, const std::string& actual, const std::string& path) {
    const VelaTool::TextDifference difference(expected, actual);
    std::ostringstream shown;
    difference.print(shown, "file   ", "written");
    EXPECT_TRUE(difference.equal()) << path << ": " << shown.str();
}

} // namespace

TEST(SampleDocuments, ThereAreSamplesToCheck) { EXPECT_LE(3u, samples().size()); }

TEST(SampleDocuments, ReadThenWriteGivesTheSameBytes) {
    for (const std::string& path : samples()) {
        const ProjectPtr project = readFile(path);
        ASSERT_TRUE(project) << path;
        expectSameText(readText(path), projectToJSONString(*project), path);
    }
}

TEST(SampleDocuments, CompactFormReadsBackToTheSameProject) {
    for (const std::string& path : samples()) {
        const ProjectPtr project = readFile(path);
        ASSERT_TRUE(project) << path;
        const std::string compact = projectToJSONString(*project, true);
        EXPECT_EQ(std::string::npos, compact.find('\n')) << "one line: " << path;
        const ProjectPtr reread = projectFromJSONString(compact);
        expectSameText(compact, projectToJSONString(*reread, true), path);
        expectSameText(readText(path), projectToJSONString(*reread), path);
    }
}

// The hand-written sample documents are in the library's own form: each
// reads, and writing it again gives the same bytes, in both forms.
#include "ToolTestSupport.h"

#include <VelaMediaLib/document/ProjectDocument.h>
#include <VelaMediaLib/document/RemixParser.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>

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

} // namespace

TEST(SampleDocuments, ThereAreSamplesToCheck) { EXPECT_LE(3u, samples().size()); }

TEST(SampleDocuments, ReadThenWriteGivesTheSameBytes) {
    for (const std::string& path : samples()) {
        const ProjectPtr project = readFile(path);
        ASSERT_TRUE(project) << path;
        EXPECT_EQ(readText(path), projectToJSONString(*project) + "\n") << path;
    }
}

TEST(SampleDocuments, CompactFormReadsBackToTheSameProject) {
    for (const std::string& path : samples()) {
        const ProjectPtr project = readFile(path);
        ASSERT_TRUE(project) << path;
        const std::string compact = projectToJSONString(*project, true);
        EXPECT_EQ(std::string::npos, compact.find('\n')) << path;
        const ProjectPtr reread = projectFromJSONString(compact);
        EXPECT_EQ(compact, projectToJSONString(*reread, true)) << path;
        EXPECT_EQ(readText(path), projectToJSONString(*reread) + "\n") << path;
    }
}

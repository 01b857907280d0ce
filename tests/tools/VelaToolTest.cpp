#include "ToolTestSupport.h"

#include "../JsonTestSupport.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <fstream>

using namespace VelaToolTesting;
using VelaMediaLib::testing::parseJson;

namespace {

const char* const kSubcommands[] = {"info", "validate", "at", "roundtrip", "fmt"};

bool contains(const std::string& text, const std::string& part) {
    return text.find(part) != std::string::npos;
}

std::string scratchPath(const std::string& name) { return ::testing::TempDir() + "vela-tool-" + name; }

/// A sample made large by a long description, still a valid document.
std::string largeDocument() {
    std::string text = readText(samplePath("every-kind.json"));
    const std::string empty = "\"description\" : \"\"";
    return text.replace(text.find(empty), empty.size(),
                        "\"description\" : \"" + std::string(11 * 1024 * 1024, 'x') + "\"");
}

} // namespace

TEST(VelaToolCommandLine, HelpOnTheToolAndEverySubcommand) {
    const ToolRun help = runVela({"--help"});
    EXPECT_EQ(0, help.status);
    for (const char* name : kSubcommands) {
        EXPECT_TRUE(contains(help.out, std::string("  ") + name + " ")) << name;
        const ToolRun own = runVela({name, "--help"});
        EXPECT_EQ(0, own.status) << name;
        EXPECT_TRUE(contains(own.out, std::string("usage: vela ") + name)) << own.out;
        EXPECT_EQ("", own.err);
    }
}

TEST(VelaToolCommandLine, WrongCommandLinesExitTwoWithTheUsage) {
    EXPECT_EQ(2, runVela({}).status);
    const ToolRun unknown = runVela({"frobnicate"});
    EXPECT_EQ(2, unknown.status);
    EXPECT_TRUE(contains(unknown.err, "unknown command \"frobnicate\""));
    const ToolRun missing = runVela({"info"});
    EXPECT_EQ(2, missing.status);
    EXPECT_TRUE(contains(missing.err, "vela info: expected 1 operand, got 0"));
    EXPECT_TRUE(contains(missing.err, "usage: vela info"));
    EXPECT_EQ(2, runVela({"info", samplePath("every-kind.json"), "--yaml"}).status);
    EXPECT_EQ(2, runVela({"fmt", samplePath("every-kind.json"), "-o"}).status);
    const ToolRun tick = runVela({"at", samplePath("every-kind.json"), "12x"});
    EXPECT_EQ(2, tick.status);
    EXPECT_TRUE(contains(tick.err, "TICK must be an integer, not \"12x\""));
    EXPECT_EQ("", tick.out);
}

TEST(VelaToolInfo, JSONHoldsTheSameAsTheText) {
    const ToolRun text = runVela({"info", samplePath("every-kind.json")});
    const ToolRun json = runVela({"info", samplePath("every-kind.json"), "--json"});
    ASSERT_EQ(0, json.status) << json.err;
    ASSERT_EQ(0, text.status) << text.err;
    const Json::Value info = parseJson(json.out);
    EXPECT_EQ(1u, std::count(json.out.begin(), json.out.end(), '\n'));
    for (const char* member : {"editRate", "width", "height", "duration", "tracks", "clips", "sources"})
        EXPECT_TRUE(info.isMember(member)) << member;
    EXPECT_TRUE(contains(text.out, "edit rate  " + info["editRate"].asString() + " ticks per second"));
    EXPECT_TRUE(
        contains(text.out, "canvas     " + info["width"].asString() + " x " + info["height"].asString()));
    EXPECT_TRUE(contains(text.out, "duration   " + info["duration"].asString() + " ticks"));
    EXPECT_TRUE(contains(text.out, "tracks     " + info["tracks"].asString() + "\n"));
    for (const std::string& kind : info["clips"].getMemberNames())
        EXPECT_TRUE(contains(text.out, kind)) << kind;
    EXPECT_TRUE(contains(text.out, "sources    " + std::to_string(info["sources"].size()) + "\n"));
}

TEST(VelaToolInfo, CountsEveryKindAndTellsSourcesOffline) {
    const ToolRun json = runVela({"info", samplePath("every-kind.json"), "--json"});
    ASSERT_EQ(0, json.status) << json.err;
    const Json::Value info = parseJson(json.out);
    for (const char* kind : {"AMFile", "Callout", "Caption", "Group", "IMFile", "ScreenIMFile",
                             "ScreenVMFile", "StitchedMedia", "UnifiedMedia", "VMFile", "PlaceholderMedia"})
        EXPECT_LE(1, info["clips"][kind].asInt()) << kind;
    EXPECT_EQ("30/1", info["editRate"].asString());
    ASSERT_LE(1u, info["sources"].size());
    for (const Json::Value& source : info["sources"]) {
        EXPECT_FALSE(source["online"].asBool()); // the sample's files are nowhere on this machine
        EXPECT_EQ("file missing", source["status"].asString());
    }
}

TEST(VelaToolInfo, ReadsStandardInputForDash) {
    const std::string path = samplePath("nested.json");
    const ToolRun fromFile = runVela({"info", path, "--json"});
    const ToolRun fromInput = runVela({"info", "-", "--json"}, readText(path));
    ASSERT_EQ(0, fromInput.status) << fromInput.err;
    EXPECT_EQ(fromFile.out, fromInput.out);
    EXPECT_EQ("30000/1001", parseJson(fromInput.out)["editRate"].asString());
}

TEST(VelaToolValidate, ValidDocumentExitsZero) {
    const ToolRun run = runVela({"validate", samplePath("animated.json")});
    EXPECT_EQ(0, run.status);
    EXPECT_EQ(samplePath("animated.json") + ": valid\n", run.out);
    EXPECT_EQ("", run.err);
}

TEST(VelaToolValidate, RefusedDocumentsGiveTheReadersMessageAndExitOne) {
    const std::pair<std::string, std::string> cases[] = {
        {"{ not json", "-: Invalid project json"},
        {"{\"version\": \"0.4\"}", "-: Unsupported project version : 0.4"},
    };
    for (const auto& refused : cases) {
        const ToolRun run = runVela({"validate", "-"}, refused.first);
        EXPECT_EQ(1, run.status) << refused.first;
        EXPECT_EQ("", run.out);
        EXPECT_TRUE(contains(run.err, refused.second)) << run.err;
    }
    const ToolRun missing = runVela({"validate", "/nonexistent/project.json"});
    EXPECT_EQ(1, missing.status);
    EXPECT_TRUE(contains(missing.err, "cannot open /nonexistent/project.json")) << missing.err;
}

TEST(VelaToolErrors, EverySubcommandReportsARefusedDocumentOnStandardError) {
    for (const char* name : {"info", "roundtrip", "fmt"}) {
        const ToolRun run = runVela({name, "-"}, "[1, 2");
        EXPECT_EQ(1, run.status) << name;
        EXPECT_EQ("", run.out) << name;
        EXPECT_TRUE(contains(run.err, std::string("vela ") + name + ": Invalid project json")) << run.err;
    }
    const ToolRun at = runVela({"at", "-", "0"}, "[1, 2");
    EXPECT_EQ(1, at.status);
    EXPECT_TRUE(contains(at.err, "vela at: Invalid project json"));
}

TEST(VelaToolRoundtrip, SampleIsEqualAndAChangedOneShowsTheFirstDifference) {
    const std::string text = readText(samplePath("animated.json"));
    const ToolRun equal = runVela({"roundtrip", "-"}, text);
    EXPECT_EQ(0, equal.status) << equal.out << equal.err;
    EXPECT_EQ("equal: " + std::to_string(text.size()) + " bytes read and written\n", equal.out);

    std::string spaced = text;
    spaced.insert(spaced.find('\n') + 1, " "); // the second line indented one blank more: at its third column
    const ToolRun differs = runVela({"roundtrip", "-"}, spaced);
    EXPECT_EQ(1, differs.status);
    EXPECT_TRUE(contains(differs.out, "first difference at line 2, column 3:")) << differs.out;
}

TEST(VelaToolFmt, RewritesInTheLibrarysFormToOutputOrFile) {
    const std::string text = readText(samplePath("every-kind.json"));
    const ToolRun indented = runVela({"fmt", "-"}, text);
    EXPECT_EQ(0, indented.status) << indented.err;
    EXPECT_EQ(text, indented.out);

    const ToolRun compact = runVela({"fmt", "-", "--compact"}, text);
    EXPECT_EQ(0, compact.status);
    EXPECT_EQ(1u, std::count(compact.out.begin(), compact.out.end(), '\n')) << "one line";
    EXPECT_LT(compact.out.size(), text.size());
    EXPECT_EQ(0, runVela({"roundtrip", "-"}, compact.out).status) << "a compact document keeps its form";
    EXPECT_EQ(text, runVela({"fmt", "-"}, compact.out).out);

    const std::string out = scratchPath("fmt.json");
    std::remove(out.c_str());
    const ToolRun toFile = runVela({"fmt", samplePath("every-kind.json"), "-o", out, "--compact"});
    EXPECT_EQ(0, toFile.status);
    EXPECT_EQ("", toFile.out);
    EXPECT_EQ(compact.out, readText(out));
}

TEST(VelaToolFmt, ARefusedDocumentWritesNoFile) {
    const std::string out = scratchPath("refused.json");
    std::remove(out.c_str());
    EXPECT_EQ(1, runVela({"fmt", "-", "-o", out}, "{\"version\": \"0.1\"}").status);
    EXPECT_FALSE(std::ifstream(out).good());
    const ToolRun unwritable =
        runVela({"fmt", samplePath("every-kind.json"), "-o", "/nonexistent/dir/out.json"});
    EXPECT_EQ(1, unwritable.status);
    EXPECT_TRUE(contains(unwritable.err, "cannot write /nonexistent/dir/out.json"));
}

TEST(VelaToolProgress, OnlyADocumentOverTenMegabytesGetsAProgressLine) {
    const ToolRun small = runVela({"validate", samplePath("every-kind.json")});
    EXPECT_EQ("", small.err);
    const std::string path = scratchPath("large.json");
    writeText(path, largeDocument());
    for (const ToolRun& large : {runVela({"validate", path}), runVela({"validate", "-"}, readText(path))}) {
        EXPECT_EQ(0, large.status) << large.err.substr(0, 300);
        EXPECT_TRUE(contains(large.err, "vela: loading ")) << large.err;
        EXPECT_TRUE(contains(large.err, "parsing done in ")) << large.err;
        EXPECT_EQ(1u, std::count(large.err.begin(), large.err.end(), '\n')) << "one line";
    }
    std::remove(path.c_str());
}

TEST(VelaToolAt, ClipsAtATickWithTheirMediaTimeInsideEveryContainer) {
    const ToolRun run = runVela({"at", samplePath("nested.json"), "50"});
    EXPECT_EQ(0, run.status) << run.err;
    EXPECT_EQ("track 0 \"composites\":\n"
              "  Group \"outer\" [0, 120) media time 50\n"
              "    Group \"middle\" [0, 120) media time 50\n"
              "      Group \"inner\" [10, 110) media time 40\n"
              "        VMFile \"speaker\" [0, 100) media time 960\n" // 900 + 40 / (2/3)
              "        IMFile \"slide\" [20, 100) media time 20\n"
              "    PlaceholderMedia \"lower third\" [30, 90) media time 20\n"
              "track 1 \"lecture\":\n"
              "  UnifiedMedia \"lecture\" [0, 240) media time 6050\n"
              "    VMFile \"lecture picture\" [0, 240) media time 6050\n"
              "    AMFile \"lecture sound\" [0, 240) media time 6050\n",
              run.out);
}

TEST(VelaToolAt, BothClipsAtACutAndNothingPastTheEnd) {
    const ToolRun cut = runVela({"at", samplePath("animated.json"), "100"});
    EXPECT_TRUE(contains(cut.out, "  VMFile \"opening\" [0, 100) media time 100\n"
                                  "  VMFile \"main part\" [100, 250) media time 500\n"))
        << cut.out;
    const ToolRun slow = runVela({"at", samplePath("animated.json"), "200"});
    EXPECT_TRUE(
        contains(slow.out, "  VMFile \"main part\" [100, 250) media time 1700/3\n")) // 500 + 100 / (3/2)
        << slow.out;
    const ToolRun past = runVela({"at", samplePath("animated.json"), "1000"});
    EXPECT_EQ("track 0 \"\": nothing\ntrack 1 \"\": nothing\ntrack 2 \"\": nothing\n", past.out);
    const ToolRun before = runVela({"at", samplePath("animated.json"), "-5"}); // a tick, not an option
    EXPECT_EQ(0, before.status) << before.err;
    EXPECT_EQ(past.out, before.out);
}

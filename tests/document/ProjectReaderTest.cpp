#include "../JsonTestSupport.h"
#include "DocumentTestSupport.h"

#include <VelaMediaLib/document/ChangedFileHandler.h>
#include <VelaMediaLib/document/MissingFileHandler.h>

#include <gtest/gtest.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

std::string deepGroups(int levels) {
    std::string clip = "{\"_type\": \"PlaceholderMedia\", \"start\": 0, \"duration\": 10}";
    for (int i = 0; i < levels; ++i)
        clip = "{\"_type\": \"Group\", \"start\": 0, \"duration\": 10, \"mediaStart\": 0, \"mediaDuration\": "
               "10, "
               "\"tracks\": [{\"medias\": [" +
               clip + "]}]}";
    return "[{\"medias\": [" + clip + "]}]";
}

} // namespace

TEST(ProjectReaderEdgeCases, EditRateDefaultsAndBothRationalForms) {
    EXPECT_EQ(parseText("{\"version\": \"1.0\"}")->editRate(), boost::rational<unsigned long>(30, 1));
    EXPECT_EQ(parseText("{\"editRate\": \"60000/1001\"}")->editRate(),
              boost::rational<unsigned long>(60000, 1001));
    EXPECT_EQ(parseText("{\"editRate\": 30}")->editRate(), boost::rational<unsigned long>(30, 1));
}

TEST(ProjectReaderEdgeCases, AnUnknownKindIsSkippedCaseSensitively) {
    const std::string wrongCase = "{\"id\": 9, \"_type\": \"vmfile\", \"start\": 0, \"duration\": 10}";
    const auto project = parseText(smallDocument("[" + wrongCase + ", " + videoClip(3, 20, 30) + "]"));
    const auto clips = project->timeline()->allMedias();
    ASSERT_EQ(clips.size(), 1u);
    EXPECT_EQ(clips.front()->startTime(), 20);
}

TEST(ProjectReaderEdgeCases, VersionsAreComparedPartByPart) {
    EXPECT_EQ(parseFailure("{\"version\": \"0.4\"}"), "Unsupported project version : 0.4");
    EXPECT_EQ(parseFailure("{\"version\": 0.4}"), "Unsupported project version : 0.4");
    EXPECT_EQ(parseFailure("{\"version\": \"0.5\"}"), "no exception");
    EXPECT_EQ(parseFailure("{\"version\": \"10.0\"}"), "no exception");
    EXPECT_TRUE(RemixParser::versionPasses(">=0.5", "0.10"));
    EXPECT_TRUE(RemixParser::versionPasses(">=0.5", "0.5.0"));
    EXPECT_FALSE(RemixParser::versionPasses(">=0.5", "0.4.9"));
    EXPECT_FALSE(RemixParser::versionPasses(">=0.5", "one"));
    EXPECT_TRUE(RemixParser::versionPasses("1.0", "1.0"));
    EXPECT_FALSE(RemixParser::versionPasses("1.0", "1.0.0"));
}

TEST(ProjectReaderEdgeCases, VersionInfoComesFromTheRootOrDefaults) {
    std::istringstream none("{}");
    EXPECT_EQ(RemixParser::parseVersionInfo(none).version, "6.0");
    std::istringstream client("{\"version\": \"1.0\", \"authoringClientName\": {\"name\": \"P\", "
                              "\"version\": \"2\", \"platform\": \"x\"}}");
    const VersionInfo info = RemixParser::parseVersionInfo(client);
    EXPECT_EQ(info.version, "1.0");
    EXPECT_EQ(info.clientName, "P");
    EXPECT_EQ(info.clientVersion, "2");
    EXPECT_EQ(info.platform, "x");
    RemixParser parser;
    parseText("{\"version\": \"2.5\"}", parser);
    EXPECT_EQ(parser.versionInfo().version, "2.5");
}

TEST(ProjectReaderEdgeCases, ReferencesResolveToTheRightObjects) {
    const std::string fade = "[{\"name\": \"Fade\", \"duration\": 4, \"leftMedia\": 3, \"rightMedia\": 4}]";
    const auto project =
        parseText(smallDocument("[" + videoClip(3, 0, 30) + ", " + videoClip(4, 30, 20) + "]", "", fade));
    const auto clips = project->timeline()->allMedias();
    ASSERT_EQ(clips.size(), 2u);
    ASSERT_TRUE(clips[0]->rightTransition());
    EXPECT_EQ(clips[0]->rightTransition(), clips[1]->leftTransition());
    EXPECT_EQ(clips[0]->rightTransition()->rightMedia(), clips[1]);
    EXPECT_EQ(boost::dynamic_pointer_cast<FileMedia>(clips[0])->source(),
              project->sourceBin()->sources().front());
    EXPECT_FALSE(project->parsingProject());
}

// Each row of the failure table, byte for byte.
TEST(ProjectReaderFailures, TheFailureTable) {
    EXPECT_EQ(parseFailure("{\"version\": "), "Invalid project json");
    EXPECT_EQ(parseFailure("{\"editRate\": true}"),
              "Invalid project json - unsupported json type for VelaRational: true");
    EXPECT_EQ(parseFailure("{\"version\": \"0.1\"}"), "Unsupported project version : 0.1");
    const std::string badInterp =
        "\"animationTracks\": {\"opacity\": [{\"range\": [0, 5], \"interp\": \"nope\"}]}, ";
    EXPECT_EQ(parseFailure(smallDocument("[" + videoClip(3, 0, 30, badInterp) + "]")),
              "trying to read an unknown interpolater");
    const std::string badFunc = "\"leftEdgeMods\": [{\"duration\": 5, \"group\": \"g\", \"func\": {\"name\": "
                                "\"Warp\", \"value\": 1}}], ";
    EXPECT_EQ(parseFailure(smallDocument("[" + videoClip(3, 0, 30, badFunc) + "]")),
              "Unknown edge mod func Warp");
    RemixParser parser;
    EXPECT_FALSE(parser.parse(std::string("/no/such/dir/project.json")));
}

TEST(ProjectReaderFailures, MalformedDocumentsNameWhatWasWrong) {
    EXPECT_EQ(
        parseFailure(smallDocument("[{\"id\": 3, \"_type\": \"VMFile\", \"src\": 1, \"trackNumber\": 0}]")),
        "Invalid project json - missing member \"start\" in media 3");
    EXPECT_EQ(parseFailure(smallDocument("[" + videoClip(3, 0, 30) + ", " + videoClip(3, 40, 30) + "]")),
              "Invalid project json - duplicate id: 3");
    EXPECT_EQ(
        parseFailure(smallDocument("[{\"id\": 3, \"_type\": \"VMFile\", \"src\": 7, \"trackNumber\": 0, "
                                   "\"start\": 0, \"duration\": 5, \"mediaDuration\": 5}]")),
        "Invalid project json - unknown source id: 7");
    EXPECT_EQ(parseFailure(smallDocument("[" + videoClip(3, 0, 30) + "]", "",
                                         "[{\"name\": \"Fade\", \"duration\": 4, \"leftMedia\": 99}]")),
              "Invalid project json - unknown media id: 99");
    EXPECT_EQ(parseFailure(smallDocument("[" + videoClip(3, 0, -30) + "]")),
              "Invalid project json - media 3: duration not greater than 0");
    EXPECT_EQ(parseFailure(smallDocument("[" + videoClip(3, 0, 0) + "]")),
              "Invalid project json - media 3: duration not greater than 0");
    EXPECT_EQ(parseFailure(smallDocument("[" + videoClip(3, 0, 30) + ", " + videoClip(4, 20, 30) + "]")),
              "Invalid project json - media 4: Collision exception.");
    EXPECT_EQ(parseFailure(smallDocument("[" + videoClip(3, 4611686018427387904LL, 30) + "]")),
              "Invalid project json - media 3: start out of range");
    EXPECT_EQ(parseFailure(smallDocument("[" + videoClip(3, 0, 30, "\"attributes\": [1], ") + "]")),
              "Invalid project json - expected an object of attributes: [1]");
    EXPECT_EQ(parseFailure("{\"timeline\": {\"sceneTrack\": {\"scenes\": [{\"velaml\": {\"tracks\": " +
                           deepGroups(70) + "}}]}}}")
                  .substr(0, 60),
              std::string("Invalid project json - nesting too deep").substr(0, 60));
    EXPECT_EQ(parseFailure(std::string(100000, '[') + std::string(100000, ']')), "Invalid project json");
    EXPECT_EQ(parseFailure("[1, 2]"), "Invalid project json - expected a document object");
}

TEST(ProjectReaderFailures, AbsurdNumbersAreRefusedNotOverflowed) {
    const std::string clip =
        "{\"id\": 3, \"_type\": \"VMFile\", \"src\": 1, \"trackNumber\": 0, \"start\": 0, "
        "\"duration\": 30, \"mediaDuration\": \"9223372036854775807/2\", \"scalar\": "
        "\"9223372036854775807/3\"}";
    const std::string failure = parseFailure(smallDocument("[" + clip + "]"));
    EXPECT_EQ(failure.rfind("Invalid project json - media 3: ", 0), 0u) << failure;
    EXPECT_EQ(parseFailure("{\"editRate\": \"1/0\"}").rfind("Invalid project json - ", 0), 0u);
    EXPECT_EQ(parseFailure("{\"editRate\": \"x/3\"}").rfind("Invalid project json - ", 0), 0u);
}

TEST(ProjectReaderFailures, AFailedParseKeepsNothing) {
    RemixParser parser;
    const auto first = parseText(smallDocument("[" + videoClip(3, 0, 30) + "]"), parser);
    ASSERT_TRUE(first);
    EXPECT_THROW(
        parseText(smallDocument("[" + videoClip(3, 0, 30) + ", " + videoClip(4, 10, 30) + "]"), parser),
        ParserException);
    EXPECT_EQ(parser.project(), first);
    EXPECT_EQ(first->timeline()->allMedias().size(), 1u);
    EXPECT_EQ(parser.versionInfo().version, "1.0");
}

namespace {

struct Answering : MissingFileHandler, ChangedFileHandler {
    explicit Answering(bool answer_) : answer(answer_) {}
    bool handleInaccessibleFile(const std::string& path) override {
        missing.push_back(path);
        return answer;
    }
    bool handleChangedFile(const std::string& path, const MediaFileStats& recorded,
                           const MediaFileStats& present) override {
        changed.push_back(path);
        recordedTracks = recorded.numTracks();
        presentTracks = present.numTracks();
        return answer;
    }
    bool answer;
    std::vector<std::string> missing, changed;
    int recordedTracks = 0, presentTracks = 0;
};

} // namespace

class FileHandlerTest : public DocumentFixture {};

TEST_F(FileHandlerTest, AMissingFileLoadsOfflineOrCancels) {
    const std::string text = projectToJSONString(*richProject(files));
    files->present.erase("/m/still.png");
    const auto goOn = boost::make_shared<Answering>(true);
    RemixParser parser(goOn, goOn);
    parser.setFileSystem(files);
    const auto project = parseText(text, parser);
    EXPECT_EQ(goOn->missing, std::vector<std::string>{"/m/still.png"});
    EXPECT_FALSE(project->sourceBin()->sourceForFile("/m/still.png")->isOnline());
    EXPECT_TRUE(project->sourceBin()->sourceForFile("/m/video.mp4")->isOnline());

    const auto stop = boost::make_shared<Answering>(false);
    RemixParser cancelling(stop, stop);
    cancelling.setFileSystem(files);
    EXPECT_EQ(thrown<ParserException>([&] { parseText(text, cancelling); }), "Load cancelled: /m/still.png");
    EXPECT_FALSE(cancelling.project());
}

TEST_F(FileHandlerTest, AChangedFileIsReportedWithBothStats) {
    const std::string text = projectToJSONString(*richProject(files));
    table->set("/m/video.mp4", {stream(TrackType::Video, 0, 6000, 30)});
    const auto goOn = boost::make_shared<Answering>(true);
    RemixParser parser(goOn, goOn);
    parser.setFileSystem(files);
    const auto project = parseText(text, parser);
    EXPECT_EQ(goOn->changed, std::vector<std::string>{"/m/video.mp4"});
    EXPECT_EQ(goOn->recordedTracks, 2);
    EXPECT_EQ(goOn->presentTracks, 1);
    EXPECT_EQ(project->sourceBin()->sourceForFile("/m/video.mp4")->numTracks(), 2); // the recorded stats

    const auto stop = boost::make_shared<Answering>(false);
    RemixParser cancelling(stop, stop);
    cancelling.setFileSystem(files);
    EXPECT_EQ(thrown<ParserException>([&] { parseText(text, cancelling); }), "Load cancelled: /m/video.mp4");
}

TEST_F(FileHandlerTest, WithoutHandlersTheLoadGoesOn) {
    const std::string text = projectToJSONString(*richProject(files));
    files->present.clear();
    RemixParser parser;
    parser.setFileSystem(files);
    const auto project = parseText(text, parser);
    for (const SourcePtr& source : project->sourceBin()->sources()) EXPECT_FALSE(source->isOnline());
}

#include "../JsonTestSupport.h"
#include "DocumentTestSupport.h"

#include <VelaMediaLib/document/ClippingParser.h>
#include <VelaMediaLib/document/ProjectAssetParser.h>

#include <gtest/gtest.h>
#include <json/writer.h>
#include <random>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

/// The value with every object's members in another order: jsoncpp keeps
/// members sorted, so the text is written by hand.
std::string shuffled(const Json::Value& value, std::mt19937& random) {
    if (value.isObject()) {
        std::vector<std::string> names = value.getMemberNames();
        std::shuffle(names.begin(), names.end(), random);
        std::string text = "{";
        for (size_t i = 0; i < names.size(); ++i)
            text +=
                (i ? "," : "") + compactJSON(Json::Value(names[i])) + ":" + shuffled(value[names[i]], random);
        return text + "}";
    }
    if (value.isArray()) {
        std::string text = "[";
        for (Json::ArrayIndex i = 0; i < value.size(); ++i)
            text += (i ? "," : "") + shuffled(value[i], random);
        return text + "]";
    }
    return compactJSON(value);
}

} // namespace

class DocumentRoundTrip : public DocumentFixture {};

TEST_F(DocumentRoundTrip, ReadThenWriteGivesTheSameBytes) {
    const std::string written = projectToJSONString(*richProject(files));
    RemixParser parser;
    parser.setFileSystem(files);
    const auto read = parseText(written, parser);
    EXPECT_EQ(projectToJSONString(*read), written);
    const std::string compact = projectToJSONString(*read, true);
    EXPECT_EQ(projectToJSONString(*parseText(compact, parser), true), compact);
}

TEST_F(DocumentRoundTrip, TheReadProjectHoldsWhatWasWritten) {
    const auto original = richProject(files);
    RemixParser parser;
    parser.setFileSystem(files);
    const auto read = parseText(projectToJSONString(*original), parser);
    EXPECT_EQ(read->editRate(), boost::rational<unsigned long>(30000, 1001));
    EXPECT_EQ(read->titleAttribute()->value(), "Rich");
    EXPECT_EQ(read->authorVersionInfo().clientName, "Pelorus");
    EXPECT_EQ(read->sourceBin()->numSources(), 4u);
    const auto mixer = read->timeline()->mixer();
    ASSERT_TRUE(mixer);
    ASSERT_EQ(mixer->numTracks(), 3u);
    EXPECT_EQ(read->timeline()->allMedias().size(), original->timeline()->allMedias().size());
    const auto callouts = read->timeline()->instancesOf<Callout>();
    ASSERT_EQ(callouts.size(), 1u);
    const auto hotspot = callouts.front()->hotspot();
    ASSERT_TRUE(hotspot);
    EXPECT_EQ(hotspot->markerTarget.lock(),
              boost::dynamic_pointer_cast<Parametric>(read->timeline()->instancesOf<IMFile>().front()));
    const auto groups = read->timeline()->instancesOf<Group>();
    EXPECT_EQ(groups.size(), 3u);
    EXPECT_EQ(read->timeline()->instancesOf<ScreenVMFile>().size(), 1u);
}

TEST_F(DocumentRoundTrip, MembersInAnyOrderReadTheSame) {
    const std::string written = projectToJSONString(*richProject(files));
    std::mt19937 random(14);
    const Json::Value tree = parseJson(written);
    RemixParser parser;
    parser.setFileSystem(files);
    for (int round = 0; round < 3; ++round)
        EXPECT_EQ(projectToJSONString(*parseText(shuffled(tree, random), parser)), written) << round;
}

TEST_F(DocumentRoundTrip, CloneIsAProjectOfItsOwnWithTheSameDocument) {
    const auto original = richProject(files);
    original->dropSourceOffline(original->sourceBin()->sourceForFile("/m/still.png"));
    const auto copy = original->clone();
    ASSERT_TRUE(copy);
    EXPECT_NE(copy, original);
    EXPECT_EQ(projectToJSONString(*copy), projectToJSONString(*original));
    EXPECT_FALSE(copy->sourceBin()->sourceForFile("/m/still.png")->isOnline());
    EXPECT_TRUE(copy->sourceBin()->sourceForFile("/m/video.mp4")->isOnline());
    copy->titleAttribute()->setValue("Changed");
    EXPECT_EQ(original->titleAttribute()->value(), "Rich");
}

TEST_F(DocumentRoundTrip, AClippingGoesToTheClipboardAllOrNothing) {
    const auto project = richProject(files);
    const std::string clip =
        "{\"version\": \"1.0\", \"editRate\": \"30000/1001\", \"sourceBin\": [{\"id\": 1, "
        "\"src\": \"/m/video.mp4\"}, {\"id\": 2, \"src\": \"/m/new.mp4\", \"sourceTracks\": "
        "[{\"type\": \"video\", \"range\": [0, 90], \"editRate\": \"30000/1001\"}]}], "
        "\"tracks\": [{\"medias\": [" +
        videoClip(3, 0, 30).replace(videoClip(3, 0, 30).find("\"src\": 1"), 8, "\"src\": 2") + "]}]}";
    ClippingParser parser(project);
    std::istringstream in(clip);
    ASSERT_TRUE(parser.parse(in));
    EXPECT_EQ(project->clipBoard()->clippings().size(), 1u);
    EXPECT_TRUE(project->sourceBin()->sourceForFile("/m/new.mp4"));
    EXPECT_EQ(project->sourceBin()->sourceForFile("/m/video.mp4"), project->sourceBin()->sources().front());

    const size_t sources = project->sourceBin()->numSources();
    std::string broken = clip;
    broken.replace(broken.find("/m/new.mp4"), 10, "/m/new2.mp4");
    broken.replace(broken.find("\"src\": 2, \"trackNumber\""), 8, "\"src\": 9");
    std::istringstream bad(broken);
    EXPECT_THROW(parser.parse(bad), ParserException);
    EXPECT_EQ(project->sourceBin()->numSources(), sources);
    EXPECT_EQ(project->clipBoard()->clippings().size(), 1u);
}

TEST(ScreenDataReading, CursorClicksAndKeystrokesAreRead) {
    std::string text =
        "{\"sourceBin\": [{\"id\": 1, \"src\": \"/s.trec\", \"sourceTracks\": [{\"type\": \"screenVideo\", "
        "\"range\": [0, 90], \"editRate\": 30}]}], \"timeline\": {\"sceneTrack\": {\"scenes\": [{\"velaml\": "
        "{\"tracks\": [{\"medias\": [{\"_type\": \"ScreenVMFile\", \"src\": 1, \"trackNumber\": 0, "
        "\"start\": 0, "
        "\"duration\": 30, \"mediaDuration\": 30, \"screenData\": {\"rect\": [0, 0, 800, 600], \"cursor\": "
        "[[\"5/2\", 10, 20]], \"clicks\": [[3, 1, 2, 1]], \"keystrokes\": [[4, \"K\", 1]]}}]}]}}]}}}";
    const auto screens = parseText(text)->timeline()->instancesOf<ScreenVMFile>();
    ASSERT_EQ(screens.size(), 1u);
    const auto data = screens.front()->screenData();
    ASSERT_TRUE(data);
    EXPECT_EQ(data->recordingRect(), Rect<int>(0, 0, 800, 600));
    ASSERT_EQ(data->clicks().size(), 1u);
    EXPECT_EQ(data->clicks().front().button, ScreenClick::Right);
    EXPECT_EQ(data->cursorSamples().front().time, RationalTime(SafeRational(5, 2)));
    EXPECT_EQ(data->keystrokes().front().keystroke, KeystrokeData("K", KeystrokeData::Shift));
    EXPECT_EQ(parseFailure(text.replace(text.find("[3, 1, 2, 1]"), 12, "[3, 7]")),
              "Invalid project json - expected a click button (0, 1 or 2): 7");
}

TEST_F(DocumentRoundTrip, AnAssetDocumentReadsIntoAProject) {
    std::istringstream in("{\"version\": \"1.0\", \"clientName\": \"Pelorus\", \"editRate\": 60, \"ident\": "
                          "\"Intro\", \"duration\": 90, \"width\": 640, \"height\": 360, \"timeline\": {}}");
    ProjectAssetParser parser;
    ASSERT_TRUE(parser.parse(in));
    EXPECT_EQ(parser.versionInfo().version, "6.0");
    EXPECT_EQ(parser.ident(), "Intro");
    EXPECT_EQ(parser.duration(), 90);
    EXPECT_EQ(parser.project()->editRate(), boost::rational<unsigned long>(60));
    EXPECT_EQ(parser.project()->timeline()->attributeValue<int>("width", 0), 640);
}

#include "../JsonTestSupport.h"
#include "../ThreadTestSupport.h"
#include "../model/SourceTestSupport.h"
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/document/format/detail/JSONTreeAccess.h>
#include <VelaMediaLib/effects/StoredEffect.h>
#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/media/ScreenRecordingData.h>
#include <VelaMediaLib/model/media/ScreenVMFile.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/source/Source.h>

#include <gtest/gtest.h>
#include <json/writer.h>
#include <set>
#include <sstream>
#include <thread>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

JSONTree tree(const std::string& text) { return jsonTreeFromValue(parseJson(text)); }

std::string projectText(const Project& project, int indentWidth = 2,
                        const XMLOptions::PathModifier& modifier = {}) {
    std::ostringstream out;
    XMLOptions options(out, indentWidth);
    if (modifier) options.setPathModifier(modifier);
    project.toJSON(options);
    return out.str();
}

template <typename Writable>
std::string objectText(const Writable& object) {
    std::ostringstream out;
    XMLOptions options(out);
    object.toJSON(options, 0);
    return out.str();
}

// The keys of the object's own members (one level in) in written order.
std::vector<std::string> topKeys(const std::string& text) {
    std::vector<std::string> keys;
    std::istringstream lines(text);
    for (std::string line; std::getline(lines, line);)
        if (line.size() > 3 && line.compare(0, 3, "  \"") == 0)
            keys.push_back(line.substr(3, line.find('"', 3) - 3));
    return keys;
}

StoredEffect::Fields effectFields(const std::string& name) {
    StoredEffect::Fields fields;
    fields.type = "VisualEffect";
    fields.effectName = name;
    fields.category = "categoryVisualEffects";
    fields.start = 5;
    fields.duration = 20;
    fields.parameters = tree(R"({"radius": {"defaultValue": 2.5}})");
    return fields;
}

} // namespace

// A small project: a video clip of a file, a placeholder touching it with a
// transition between them, and a hotspot on the video clip that jumps to the
// placeholder's marker (written after it).
class ProjectWriterTest : public ::testing::Test {
protected:
    ProjectWriterTest() {
        loader->set("media/a.mov", {stream(TrackType::Video, 0, 3000, 600)});
        project->sourceBin()->setFileSystem(files);
        project->timeline()->addTrack(project->newMixer("main"), track);
        source = project->loadSource("media/a.mov");
        source->removeMetaData(Source::timeAddedMetaDataKey()); // the clock's
        video = VMFile::create(source, 0, 0);
        video->setIdentifier("video");
        placeholder = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 30);
        placeholder->setIdentifier("card");
        track->addMedia(video, 0);
        track->addMedia(placeholder, 150);
        const TransitionPtr fade(new Transition("Fade", 10));
        fade->setLeftMedia(video);
        fade->setRightMedia(placeholder);
        video->setRightTransition(fade);
        placeholder->setLeftTransition(fade);
        HotspotInfo hotspot;
        hotspot.action = "jump";
        hotspot.markerTarget = boost::shared_ptr<Parametric>(placeholder);
        hotspot.markerTime = 7;
        video->setHotspot(hotspot);
        project->setAuthorVersionInfo(VersionInfo{"", "Pelorus", "2.1", "linux"});
    }

    RegisteredTableLoader loader;
    boost::shared_ptr<FakeFileSystem> files = boost::make_shared<FakeFileSystem>();
    ProjectPtr project = Project::create(30, 1);
    boost::shared_ptr<GenericTrack> track = project->timeline()->newTrack();
    boost::shared_ptr<Source> source;
    boost::shared_ptr<VMFile> video;
    boost::shared_ptr<PlaceholderMedia> placeholder;
};

// The whole document, indented: every member in its place and order, ids
// counted in write order, the hotspot naming a clip written after it.
TEST_F(ProjectWriterTest, TheIndentedDocumentIsWrittenByteForByte) {
    const std::string expected = R"({
  "title" : "",
  "description" : "",
  "author" : "",
  "targetLoudness" : -18.0,
  "shouldApplyLoudnessNormalization" : false,
  "videoFormatFrameRate" : 30,
  "audioFormatSampleRate" : 44100,
  "allowSubFrameEditing" : true,
  "width" : 1920,
  "height" : 1080,
  "version" : "1.0",
  "editRate" : 30,
  "authoringClientName" : {
    "name" : "Pelorus",
    "platform" : "linux",
    "version" : "2.1"
  },
  "sourceBin" : [
    {
      "id" : 1,
      "src" : "media/a.mov",
      "rect" : [0, 0, 0, 0],
      "lastMod" : 0,
      "sourceTracks" : [
        {
          "type" : "video",
          "range" : [0, 3000],
          "editRate" : 600,
          "trackRect" : [0, 0, 640, 480],
          "sampleRate" : 600,
          "bitDepth" : 0,
          "numChannels" : 0,
          "integratedLUFS" : 0.0,
          "peakLevel" : 0.0,
          "metaData" : [
          ],
          "orientation" : 0,
          "fileTrackNumber" : 0
        }
      ],
      "loudnessNormalization" : false
    }
  ],
  "timeline" : {
    "id" : 2,
    "sceneTrack" : {
      "scenes" : [
        {
          "velaml" : {
            "tracks" : [
              {
                "trackIndex" : 0,
                "medias" : [
                  {
                    "id" : 3,
                    "_type" : "VMFile",
                    "src" : 1,
                    "trackNumber" : 0,
                    "attributes" : {
                      "ident" : "video"
                    },
                    "start" : 0,
                    "duration" : 150,
                    "mediaStart" : 0,
                    "mediaDuration" : 150,
                    "scalar" : 1,
                    "parameters" : {
                    },
                    "hotspot" : {
                      "action" : "jump",
                      "pauseAtEnd" : false,
                      "url" : "",
                      "gotoTime" : 0,
                      "openURLInNewWindow" : false,
                      "markerParametricId" : 4,
                      "markerTime" : 7,
                      "lastMarkerGlobalTime" : 0
                    }
                  },
                  {
                    "id" : 4,
                    "_type" : "PlaceholderMedia",
                    "attributes" : {
                      "ident" : "card",
                      "height" : 1080,
                      "note" : "",
                      "width" : 1920
                    },
                    "start" : 150,
                    "duration" : 30,
                    "mediaStart" : 0,
                    "mediaDuration" : 30,
                    "scalar" : 1,
                    "parameters" : {
                    }
                  }
                ],
                "transitions" : [
                  {
                    "name" : "Fade",
                    "duration" : 10,
                    "leftMedia" : 3,
                    "rightMedia" : 4
                  }
                ]
              }
            ]
          },
          "ident" : "main"
        }
      ]
    },
    "trackAttributes" : [
      {
        "ident" : "",
        "audioMuted" : false,
        "videoHidden" : false,
        "magnetic" : false,
        "matte" : false,
        "solo" : false
      }
    ],
    "captionAttributes" : {
      "enabled" : false,
      "fontName" : "Arial",
      "fontSize" : 32.0,
      "backgroundColor" : [0, 0, 0, 255],
      "foregroundColor" : [255, 255, 255, 255],
      "lang" : "en",
      "alignment" : "center",
      "defaultFontSize" : 32.0,
      "opacity" : 1.0,
      "backgroundEnabled" : true,
      "backgroundOnlyAroundText" : false
    },
    "backgroundColor" : [0, 0, 0, 255],
    "gain" : 1.0,
    "legacyAttenuateAudioMix" : false,
    "parameters" : {
    }
  }
}
)";
    EXPECT_EQ(projectText(*project), expected);
}

// The compact form: no line breaks or indentation, "," between members and
// inside ranges and colours, keys without blanks.
TEST_F(ProjectWriterTest, TheCompactDocumentIsWrittenByteForByte) {
    const std::string expected =
        R"({"title":"","description":"","author":"","targetLoudness":-18.0,"shouldApplyLoudnessNormalization":false,"videoFormatFrameRate":30,"audioFormatSampleRate":44100,"allowSubFrameEditing":true,"width":1920,"height":1080,"version":"1.0","editRate":30,"authoringClientName":{"name":"Pelorus","platform":"linux","version":"2.1"},"sourceBin":[{"id":1,"src":"media/a.mov","rect":[0,0,0,0],"lastMod":0,"sourceTracks":[{"type":"video","range":[0,3000],"editRate":600,"trackRect":[0,0,640,480],"sampleRate":600,"bitDepth":0,"numChannels":0,"integratedLUFS":0.0,"peakLevel":0.0,"metaData":[],"orientation":0,"fileTrackNumber":0}],"loudnessNormalization":false}],"timeline":{"id":2,"sceneTrack":{"scenes":[{"velaml":{"tracks":[{"trackIndex":0,"medias":[{"id":3,"_type":"VMFile","src":1,"trackNumber":0,"attributes":{"ident":"video"},"start":0,"duration":150,"mediaStart":0,"mediaDuration":150,"scalar":1,"parameters":{},"hotspot":{"action":"jump","pauseAtEnd":false,"url":"","gotoTime":0,"openURLInNewWindow":false,"markerParametricId":4,"markerTime":7,"lastMarkerGlobalTime":0}},{"id":4,"_type":"PlaceholderMedia","attributes":{"ident":"card","height":1080,"note":"","width":1920},"start":150,"duration":30,"mediaStart":0,"mediaDuration":30,"scalar":1,"parameters":{}}],"transitions":[{"name":"Fade","duration":10,"leftMedia":3,"rightMedia":4}]}]},"ident":"main"}]},"trackAttributes":[{"ident":"","audioMuted":false,"videoHidden":false,"magnetic":false,"matte":false,"solo":false}],"captionAttributes":{"enabled":false,"fontName":"Arial","fontSize":32.0,"backgroundColor":[0,0,0,255],"foregroundColor":[255,255,255,255],"lang":"en","alignment":"center","defaultFontSize":32.0,"opacity":1.0,"backgroundEnabled":true,"backgroundOnlyAroundText":false},"backgroundColor":[0,0,0,255],"gain":1.0,"legacyAttenuateAudioMix":false,"parameters":{}}})";
    EXPECT_EQ(projectText(*project, 0), expected);
    EXPECT_EQ(parseJson(projectText(*project, 0)), parseJson(projectText(*project)));
}

TEST_F(ProjectWriterTest, RootAndSourceMembersComeInTheirOrder) {
    project->addMetaData("note", "kept");
    EXPECT_EQ(topKeys(projectText(*project)),
              (std::vector<std::string>{
                  "title", "description", "author", "targetLoudness", "shouldApplyLoudnessNormalization",
                  "videoFormatFrameRate", "audioFormatSampleRate", "allowSubFrameEditing", "width", "height",
                  "version", "editRate", "authoringClientName", "sourceBin", "timeline", "metadata"}));
    EXPECT_EQ(
        topKeys(objectText(*source)),
        (std::vector<std::string>{"id", "src", "rect", "lastMod", "sourceTracks", "loudnessNormalization"}));
    // The client keys travel in "authoringClientName" only, so a read project
    // (which holds them even when empty) writes the same metadata.
    EXPECT_EQ(parseJson(projectText(*project))["metadata"], parseJson(R"({"note": "kept"})"));
}

// Every optional part of a clip present: each comes in its fixed place.
TEST_F(ProjectWriterTest, AClipWithEveryPartWritesThemInOrder) {
    AnimationTrack::Animation animation;
    animation.range = Range<long long>(0, 10);
    animation.interp = "eioe";
    animation.keyframes.push_back({"opacity", tree("0.5"), "linr"});
    video->setAnimationTrack("opacity", AnimationTrack("ignored", {animation}));
    video->addEffect(StoredEffect::create(effectFields("Blur")));
    video->addLeftEdgeModification(EdgeModificationPtr(new EdgeModification(5, "fade", 0.0)));
    video->addRightEdgeModification(EdgeModificationPtr(new EdgeModification(5, "fade", 0.0)));
    video->setSourceEffect(StoredEffect::create(effectFields("Denoise")));
    video->addMetaData("k", "v");
    EXPECT_EQ(topKeys(objectText(*video)),
              (std::vector<std::string>{"id", "_type", "src", "trackNumber", "attributes", "start",
                                        "duration", "mediaStart", "mediaDuration", "scalar",
                                        "animationTracks", "parameters", "effects", "hotspot", "leftEdgeMods",
                                        "rightEdgeMods", "sourceEffect", "metadata"}));
    const Json::Value written = parseJson(objectText(*video));
    EXPECT_TRUE(written["animationTracks"]["opacity"].isArray())
        << "a track is kept under the name it is set with";
    EXPECT_EQ(written["effects"][0]["parameters"], parseJson(R"({"radius": {"defaultValue": 2.5}})"));
    EXPECT_EQ(written["sourceEffect"]["effectName"], "Denoise");
    std::ostringstream trackText;
    XMLOptions options(trackText);
    track->toJSON(options, 0, 0);
    EXPECT_EQ(topKeys(trackText.str()), (std::vector<std::string>{"trackIndex", "medias", "transitions"}));
}

// "src", "leftMedia", "rightMedia" and the hotspot's marker name the objects
// they stand for, and a second write gives the same ids.
TEST_F(ProjectWriterTest, ReferencesNameTheRightObjectsAndIdsAreDeterministic) {
    const std::string first = projectText(*project);
    EXPECT_EQ(projectText(*project), first);
    const Json::Value root = parseJson(first);
    const Json::Value& trackJson = root["timeline"]["sceneTrack"]["scenes"][0]["velaml"]["tracks"][0];
    const Json::Value& videoJson = trackJson["medias"][0];
    const Json::Value& cardJson = trackJson["medias"][1];
    ASSERT_EQ(videoJson["attributes"]["ident"], "video");
    ASSERT_EQ(cardJson["attributes"]["ident"], "card");
    EXPECT_EQ(videoJson["src"], root["sourceBin"][0]["id"]);
    EXPECT_EQ(trackJson["transitions"].size(), 1u) << "a shared transition is written once";
    EXPECT_EQ(trackJson["transitions"][0]["leftMedia"], videoJson["id"]);
    EXPECT_EQ(trackJson["transitions"][0]["rightMedia"], cardJson["id"]);
    EXPECT_EQ(videoJson["hotspot"]["markerParametricId"], cardJson["id"]);
    std::set<unsigned> ids;
    for (const Json::Value* object : {&root["sourceBin"][0], &root["timeline"], &videoJson, &cardJson})
        EXPECT_TRUE(ids.insert((*object)["id"].asUInt()).second) << "duplicate id " << (*object)["id"];
}

// A marker on an object the document does not hold names nothing rather
// than an id no object has.
TEST_F(ProjectWriterTest, AMarkerOffTheTimelineIsWrittenAsNone) {
    const auto stray = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 30);
    HotspotInfo hotspot = *video->hotspot();
    hotspot.markerTarget = boost::shared_ptr<Parametric>(stray);
    video->setHotspot(hotspot);
    EXPECT_EQ(parseJson(objectText(*project->timeline()))["sceneTrack"]["scenes"][0]["velaml"]["tracks"][0]
                                                         ["medias"][0]["hotspot"]["markerParametricId"],
              0);
    hotspot.markerTarget = boost::shared_ptr<Parametric>(project->timeline());
    video->setHotspot(hotspot);
    const Json::Value timeline = parseJson(objectText(*project->timeline()));
    EXPECT_EQ(timeline["sceneTrack"]["scenes"][0]["velaml"]["tracks"][0]["medias"][0]["hotspot"]
                      ["markerParametricId"],
              timeline["id"]);
}

TEST_F(ProjectWriterTest, ThePathModifierReachesEveryPath) {
    MediaFileStats::Contents contents = source->stats()->contents();
    contents.tracks[0].filename = "media/b.wav";
    source->stats()->setContents(contents);
    const Json::Value root =
        parseJson(projectText(*project, 2, [](const std::string& path) { return "../" + path; }));
    EXPECT_EQ(root["sourceBin"][0]["src"], "../media/a.mov");
    EXPECT_EQ(root["sourceBin"][0]["sourceTracks"][0]["filename"], "../media/b.wav");
}

// A clip's copy keeps what the document keeps of it.
TEST_F(ProjectWriterTest, AClonedClipKeepsHotspotAnimationsAndSourceEffect) {
    video->setAnimationTrack("scale", AnimationTrack("scale", {AnimationTrack::Animation()}));
    video->setSourceEffect(StoredEffect::create(effectFields("Denoise")));
    const auto copy = boost::dynamic_pointer_cast<VMFile>(video->clone());
    ASSERT_TRUE(copy);
    EXPECT_TRUE(copy->hotspot() && copy->hotspot() == video->hotspot());
    EXPECT_TRUE(copy->animationTracks() == video->animationTracks());
    ASSERT_TRUE(copy->sourceEffect());
    EXPECT_EQ(copy->sourceEffect()->effectName(), "Denoise");
}

TEST(JSONTree, WritesWhatItReadInTheLibrarysForm) {
    const JSONTree read = tree(R"({"b": [1, 2.5, "x\"y", true, null, {"a": -3}], "a": 18446744073709551615,
                                   "c": {}})");
    EXPECT_EQ(read.toCompactString(),
              R"({"a":18446744073709551615,"b":[1,2.5,"x\"y",true,null,{"a":-3}],"c":{}})");
    std::ostringstream out;
    XMLOptions options(out);
    read.write(options, 0);
    EXPECT_EQ(tree(out.str()), read) << out.str();
    EXPECT_NE(tree(R"({"a": 1.0})"), tree(R"({"a": 2.0})"));
    EXPECT_TRUE(JSONTree().isNull());
    EXPECT_TRUE(tree("{}").isEmpty());
    EXPECT_FALSE(tree("[0]").isEmpty());
}

// An id given to an object before its own write stays its id.
TEST(XMLOptions, AnObjectKeepsTheIdItWasGivenFirst) {
    std::ostringstream out;
    XMLOptions options(out);
    int a = 0, b = 0;
    EXPECT_EQ(options.assignNewIdent(&a), 1u);
    EXPECT_EQ(options.assignNewIdent(&b), 2u);
    EXPECT_EQ(options.assignNewIdent(&a), 1u);
    EXPECT_EQ(options.findIdent(&b), 2u);
}

// The writer reads under the read lock alone: it finishes while another
// thread holds a read lock, and changes nothing anyone observes.
// Suites named "...Concurrency" also run under ThreadSanitizer.
class ProjectWriterConcurrencyTest : public ProjectWriterTest {};

TEST_F(ProjectWriterConcurrencyTest, WritingTakesOnlyTheReadLock) {
    Deadline deadline;
    CountingObserver observer;
    video->attach(&observer);
    project->timeline()->attach(&observer);
    std::string written;
    {
        ScopedReadLock held(project->token());
        std::thread writer([&] { written = projectText(*project); });
        writer.join();
    }
    EXPECT_FALSE(written.empty());
    EXPECT_EQ(observer.count, 0);
    video->detach(&observer);
    project->timeline()->detach(&observer);
}

// Writers and readers run together; every write is whole and the same.
TEST_F(ProjectWriterConcurrencyTest, WritersAndReadersRunTogether) {
    Deadline deadline;
    const std::string expected = projectText(*project);
    std::atomic<bool> stop{false};
    std::thread reader([&] {
        while (!stop.load()) {
            EXPECT_EQ(project->timeline()->allMedias().size(), 2u);
            EXPECT_TRUE(video->hotspot());
            EXPECT_EQ(track->medias().front()->state().duration, 150);
        }
    });
    std::vector<std::string> texts(2);
    std::thread other([&] {
        for (int i = 0; i < 20; ++i) texts[0] = projectText(*project);
    });
    for (int i = 0; i < 20; ++i) texts[1] = projectText(*project, 2);
    other.join();
    stop = true;
    reader.join();
    EXPECT_EQ(texts[0], expected);
    EXPECT_EQ(texts[1], expected);
}

// A screen recording's clip carries its cursor, clicks and keys.
TEST_F(ProjectWriterTest, AScreenRecordingWritesItsScreenData) {
    loader->set("media/s.trec", {stream(TrackType::ScreenVideo, 0, 3000, 600)});
    const auto recording = ScreenVMFile::create(project->loadSource("media/s.trec"), 0, 0);
    EXPECT_FALSE(parseJson(objectText(*recording)).isMember("screenData")) << "nothing to write";
    const auto data = boost::make_shared<ScreenRecordingData>(Rect<int>(0, 0, 800, 600));
    data->addCursorSample(RationalTime(SafeRational(1, 2)), Point3d(10, 20, 0));
    data->addClick(RationalTime(3), ScreenClick::Right);
    data->addKeystroke(RationalTime(4), KeystrokeData("a", 2));
    recording->setScreenData(data);
    EXPECT_EQ(parseJson(objectText(*recording))["screenData"],
              parseJson(R"({"recordingRect": [0, 0, 800, 600], "cursor": [["1/2", 10.0, 20.0]],
                            "clicks": [[3, 1]], "keystrokes": [[4, {"key": "a", "modifiers": 2}]]})"));
}

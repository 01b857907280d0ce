#include "../JsonTestSupport.h"
#include "DocumentTestSupport.h"

#include <VelaMediaLib/document/ProjectReader.h>

#include <json/writer.h>

#include <gtest/gtest.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

std::string twoTrackDocument(const std::string& firstMedias, const std::string& secondMedias,
                             const std::string& secondTransitions) {
    return "{\"version\": \"1.0\", \"editRate\": 30, \"sourceBin\": [{\"id\": 1, \"src\": "
           "\"/media/a.mp4\", \"rect\": [0, 0, 640, 480], \"sourceTracks\": [{\"type\": \"video\", "
           "\"range\": [0, 300], \"editRate\": 30, \"sampleRate\": 30}]}], \"timeline\": {\"id\": 2, "
           "\"sceneTrack\": {\"scenes\": [{\"velaml\": {\"tracks\": [{\"trackIndex\": 0, \"medias\": " +
           firstMedias + ", \"transitions\": []}, {\"trackIndex\": 1, \"medias\": " + secondMedias +
           ", \"transitions\": " + secondTransitions + "}]}}]}}}";
}

} // namespace

// A track lists the transitions at its own clips: one naming a clip of
// another track is a bad document.
TEST(DocumentConsistency, ATransitionNamingAClipOfAnotherTrackIsRefused) {
    const std::string text =
        twoTrackDocument("[" + videoClip(3, 0, 30) + "]", "[" + videoClip(4, 30, 30) + "]",
                         "[{\"name\": \"Fade\", \"duration\": 5, \"leftMedia\": 3, \"rightMedia\": 4}]");
    EXPECT_EQ(parseFailure(text), "Invalid project json - transition Fade names a clip of another track");
}

// Edits may pull two clips sharing a transition apart, onto two tracks, or
// leave a clip shorter than its transition: what the model holds, the
// document gives back, and a transition is written once.
TEST(DocumentConsistency, TransitionsEditsLeaveBehindReadBackAsWritten) {
    const auto project = Project::create(30, 1);
    const auto mixer = project->newMixer("main");
    const auto first = project->timeline()->newTrack(), second = project->timeline()->newTrack();
    mixer->addTrack(first);
    mixer->addTrack(second);
    const auto clip = [&](VelaTime length) {
        return PlaceholderMedia::create(project->token(), project->editRateToken(), 0, length);
    };
    const MediaPtr a = clip(30), b = clip(30), c = clip(4), d = clip(30), e = clip(30);
    first->addMedia(a, 0);
    first->addMedia(b, 30);
    const TransitionPtr apart(new Transition("apart", 5)), across(new Transition("across", 5)),
        longer(new Transition("longer", 10));
    a->setRightTransition(apart);
    Transition::mergeMediaPairTransitions({a, b});
    first->removeMedia(b);
    first->addMedia(b, 100); // still sharing "apart", no longer touching
    first->addMedia(c, 200);
    c->setLeftTransition(longer); // longer than its clip
    first->addMedia(d, 300);
    d->setRightTransition(across);
    second->addMedia(e, 330);
    e->setLeftTransition(across); // its clips on two tracks
    ASSERT_EQ(apart->rightMedia(), b);

    const std::string written = projectToJSONString(*project);
    EXPECT_EQ(projectToJSONString(*parseText(written)), written);
    size_t named = 0;
    for (size_t at = written.find("\"across\""); at != std::string::npos;
         at = written.find("\"across\"", at + 1))
        ++named;
    EXPECT_EQ(named, 2u) << "one side on each track";
}

// A track's volume is a keyframable parameter of the track: it must survive a write and a read.
TEST(DocumentConsistency, ATracksVolumeSurvivesTheDocument) {
    const auto project = Project::create(30, 1);
    const auto mixer = project->newMixer("main");
    const auto track = project->timeline()->newTrack();
    mixer->addTrack(track);
    const auto volume = track->typedParameter<double>("volume");
    ASSERT_TRUE(volume);
    volume->addKeyFrame(RationalTime(0), 0.25, RationalTime(0));
    volume->addKeyFrame(RationalTime(30), 0.75, RationalTime(10));
    const std::string written = projectToJSONString(*project);
    const auto read = parseText(written);
    const auto readTrack = read->timeline()->mixer()->tracks().front();
    const auto readVolume = readTrack->typedParameter<double>("volume");
    ASSERT_TRUE(readVolume);
    EXPECT_DOUBLE_EQ(readVolume->valueAtTime(RationalTime(0)), 0.25) << written;
    EXPECT_DOUBLE_EQ(readVolume->valueAtTime(RationalTime(30)), 0.75);
}

// A hotspot may jump to a clip inside a group; the reader resolves such ids,
// so the writer must name them too.
TEST(DocumentConsistency, AHotspotMarkerOnAClipInsideAGroupSurvives) {
    const auto project = Project::create(30, 1);
    const auto token = project->token();
    const auto rate = project->editRateToken();
    const auto mixer = project->newMixer("main");
    const auto outer = project->timeline()->newTrack();
    mixer->addTrack(outer);
    const auto innerMixer = GenericMixer::create(token);
    const auto innerTrack = GenericTrack::create(token);
    innerMixer->addTrack(innerTrack);
    const auto inner = PlaceholderMedia::create(token, rate, 0, 20);
    innerTrack->addMedia(inner, 0);
    const auto group = Group::create(token, rate, innerMixer, 0);
    outer->addMedia(group, 0);
    const auto callout = Callout::create(token, rate, 100, 30, TextAttributeList());
    HotspotInfo hotspot;
    hotspot.action = "jump";
    hotspot.markerTarget = inner;
    callout->setHotspot(hotspot);
    outer->addMedia(callout, 100);
    const std::string written = projectToJSONString(*project);
    EXPECT_EQ(written.find("\"markerParametricId\" : 0"), std::string::npos) << written;
    const auto read = parseText(written);
    MediaPtr readCallout;
    for (const MediaPtr& media : read->timeline()->allMedias())
        if (boost::dynamic_pointer_cast<Callout>(media)) readCallout = media;
    ASSERT_TRUE(readCallout);
    const auto info = boost::dynamic_pointer_cast<VisualMediaImpl>(readCallout)->hotspot();
    ASSERT_TRUE(info);
    EXPECT_TRUE(info->markerTarget.lock());
}

// Every value of a written document replaced by every wrong JSON type: the
// parse either succeeds (and what it read then reads back the same) or ends
// in one ParserException. Nothing else may escape.
namespace {

void mutations(const Json::Value& value, std::vector<std::vector<std::string>>& paths,
               std::vector<std::string>& path) {
    paths.push_back(path);
    if (value.isObject())
        for (const std::string& name : value.getMemberNames()) {
            path.push_back(name);
            mutations(value[name], paths, path);
            path.pop_back();
        }
    else if (value.isArray())
        for (Json::ArrayIndex i = 0; i < value.size(); ++i) {
            path.push_back("#" + std::to_string(i));
            mutations(value[i], paths, path);
            path.pop_back();
        }
}

Json::Value& at(Json::Value& root, const std::vector<std::string>& path) {
    Json::Value* node = &root;
    for (const std::string& step : path)
        node = step[0] == '#' ? &(*node)[Json::ArrayIndex(std::stoul(step.substr(1)))] : &(*node)[step];
    return *node;
}

std::string joined(const std::vector<std::string>& path) {
    std::string text;
    for (const std::string& step : path) text += "/" + step;
    return text;
}

} // namespace

class DocumentWrongTypes : public DocumentFixture {};

TEST_F(DocumentWrongTypes, EveryValueOfEveryWrongTypeEndsInOneParserException) {
    const std::string written = projectToJSONString(*richProject(files));
    const Json::Value root = parseJson(written);
    std::vector<std::vector<std::string>> paths;
    std::vector<std::string> path;
    mutations(root, paths, path);
    const std::vector<Json::Value> wrong = {Json::Value(),
                                            Json::Value(true),
                                            Json::Value("x"),
                                            Json::Value(Json::arrayValue),
                                            Json::Value(Json::objectValue),
                                            Json::Value(-1),
                                            Json::Value(1e300),
                                            Json::Value(Json::Int64(9223372036854775807LL))};
    Json::StreamWriterBuilder builder;
    builder["indentation"] = "";
    std::vector<std::string> escaped, unstable;
    for (const auto& where : paths) {
        if (where.empty()) continue;
        for (const Json::Value& replacement : wrong) {
            Json::Value changed = root;
            at(changed, where) = replacement;
            const std::string text = Json::writeString(builder, changed);
            boost::shared_ptr<Project> read;
            try {
                RemixParser parser;
                parser.setFileSystem(files);
                std::istringstream in(text);
                parser.parse(in);
                read = parser.project();
            } catch (const ParserException&) {
                continue;
            } catch (const std::exception& e) {
                escaped.push_back(joined(where) + " = " + Json::writeString(builder, replacement) + ": " +
                                  typeid(e).name() + " " + e.what());
                continue;
            }
            const std::string label = joined(where) + " = " + Json::writeString(builder, replacement);
            try {
                const std::string once = projectToJSONString(*read);
                RemixParser again;
                again.setFileSystem(files);
                std::istringstream back(once);
                again.parse(back);
                if (projectToJSONString(*again.project()) != once) unstable.push_back(label);
            } catch (const std::exception& e) {
                unstable.push_back(label + ": written, then unreadable: " + e.what());
            }
        }
    }
    std::string report;
    for (const std::string& line : escaped) report += "escaped " + line + "\n";
    for (const std::string& line : unstable) report += "unstable " + line + "\n";
    EXPECT_TRUE(escaped.empty() && unstable.empty()) << report;
}

// A reader given the caller's tree reads it as it is: only a parser that owns
// its tree lets each track's part go once built.
TEST(DocumentConsistency, AReaderLeavesTheCallersTreeAsItWas) {
    const Json::Value root = parseJson(smallDocument("[" + videoClip(3, 0, 30) + "]"));
    const Json::Value before = root;
    ProjectReader reader;
    ASSERT_TRUE(reader.read(root));
    EXPECT_EQ(root, before);
    EXPECT_EQ(reader.project()->timeline()->allMedias().size(), 1u);
}

// Every mixer of the timeline is a scene of its own, read back by name with its clips.
TEST(DocumentConsistency, EveryMixerReadsBackAsItsOwnScene) {
    const auto project = Project::create(30, 1);
    for (const char* name : {"main", "second", "third"}) {
        const auto mixer = project->newMixer(name);
        const auto track = project->timeline()->newTrack();
        mixer->addTrack(track);
        track->addMedia(PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 20), 10);
    }
    const std::string written = projectToJSONString(*project);
    const auto read = parseText(written);
    ASSERT_EQ(read->timeline()->mixers().size(), 3u);
    for (const char* name : {"main", "second", "third"}) {
        const MixerPtr mixer = read->timeline()->mixer(name);
        ASSERT_TRUE(mixer) << name;
        ASSERT_EQ(mixer->numTracks(), 1u);
        EXPECT_EQ(mixer->trackAtIndex(0)->medias().size(), 1u) << name;
    }
    EXPECT_EQ(projectToJSONString(*read), written);
}

#pragma once
// Documents for the reader tests: a small valid project as text, and a rich
// project holding every kind of content the document carries.

#include "../model/SourceTestSupport.h"

#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/document/ProjectDocument.h>
#include <VelaMediaLib/document/RemixParser.h>
#include <VelaMediaLib/effects/StoredEffect.h>
#include <VelaMediaLib/model/media/AMFile.h>
#include <VelaMediaLib/model/media/Callout.h>
#include <VelaMediaLib/model/media/Caption.h>
#include <VelaMediaLib/model/media/EdgeModification.h>
#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/IMFile.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/media/ScreenIMFile.h>
#include <VelaMediaLib/model/media/ScreenRecordingData.h>
#include <VelaMediaLib/model/media/ScreenVMFile.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/model/timeline/GenericMixer.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>

#include <boost/make_shared.hpp>
#include <sstream>
#include <string>

namespace VelaMediaLib {
namespace testing {

/// A document of one video source and one track, with the pieces a test swaps in.
inline std::string smallDocument(const std::string& medias, const std::string& extraRoot = "",
                                 const std::string& transitions = "[]") {
    return "{" + extraRoot +
           "\"version\": \"1.0\", \"editRate\": 30, \"sourceBin\": [{\"id\": 1, \"src\": "
           "\"/media/a.mp4\", \"rect\": [0, 0, 640, 480], \"sourceTracks\": [{\"type\": \"video\", "
           "\"range\": "
           "[0, 300], \"editRate\": 30, \"sampleRate\": 30}]}], \"timeline\": {\"id\": 2, \"sceneTrack\": "
           "{\"scenes\": [{\"velaml\": {\"tracks\": [{\"trackIndex\": 0, \"medias\": " +
           medias + ", \"transitions\": " + transitions + "}]}}]}}}";
}

/// A video clip object of the small document's source.
inline std::string videoClip(int id, long long start, long long duration, const std::string& extra = "") {
    return "{\"id\": " + std::to_string(id) + ", \"_type\": \"VMFile\", \"src\": 1, \"trackNumber\": 0, " +
           extra + "\"start\": " + std::to_string(start) + ", \"duration\": " + std::to_string(duration) +
           ", \"mediaStart\": 0, \"mediaDuration\": " + std::to_string(duration) + ", \"scalar\": 1}";
}

inline boost::shared_ptr<Project> parseText(const std::string& text, RemixParser& parser) {
    std::istringstream in(text);
    parser.parse(in);
    return parser.project();
}

inline boost::shared_ptr<Project> parseText(const std::string& text) {
    RemixParser parser;
    return parseText(text, parser);
}

/// The message of the parse's failure, or "no exception".
inline std::string parseFailure(const std::string& text) {
    try {
        parseText(text);
    } catch (const std::exception& e) {
        return e.what();
    }
    return "no exception";
}

/// Sources answered by a table, files present in a fake file system.
class DocumentFixture : public ::testing::Test {
protected:
    void SetUp() override {
        table->set("/m/video.mp4",
                   {stream(TrackType::Video, 0, 3000, 30), stream(TrackType::Audio, 0, 3000, 30, 2)});
        table->set("/m/still.png", {stream(TrackType::Image, 0, 1, 30)});
        table->set("/m/screen.trec", {stream(TrackType::ScreenVideo, 0, 3000, 30)});
        table->set("/m/frame.trec", {stream(TrackType::ScreenImage, 0, 1, 30)});
        files->present = {"/m/video.mp4", "/m/still.png", "/m/screen.trec", "/m/frame.trec"};
    }

    RegisteredTableLoader table;
    boost::shared_ptr<FakeFileSystem> files = boost::make_shared<FakeFileSystem>();
};

/// A project with every media kind, groups three deep, stitched and unified
/// clips, transitions, animation tracks, hotspots, edge modifications,
/// effects, metadata, and rationals in both forms.
inline boost::shared_ptr<Project> richProject(const boost::shared_ptr<FileSystem>& files) {
    const auto project = Project::create(30000, 1001);
    project->sourceBin()->setFileSystem(files);
    project->titleAttribute()->setValue("Rich");
    project->addMetaData("note", "kept");
    VersionInfo client;
    client.clientName = "Pelorus";
    client.clientVersion = "2.1";
    client.platform = "linux";
    project->setAuthorVersionInfo(client);
    const SourcePtr video = project->loadSource("/m/video.mp4");
    const SourcePtr still = project->loadSource("/m/still.png");
    const SourcePtr screen = project->loadSource("/m/screen.trec");
    const SourcePtr frame = project->loadSource("/m/frame.trec");
    const auto token = project->token();
    const auto rate = project->editRateToken();
    const TimelinePtr timeline = project->timeline();
    const auto mixer = project->newMixer("main");
    const auto newTrack = [&](const boost::shared_ptr<GenericMixer>& into) {
        const auto track = timeline->newTrack();
        into->addTrack(track);
        return track;
    };

    // Track 0: two video slices joined by a transition, a still, a screen recording.
    const auto first = newTrack(mixer);
    const auto a = VMFile::create(video, 0, 0, SafeRational(10), SafeRational(90), SafeRational(1));
    const auto b = VMFile::create(video, 0, 90, SafeRational(1, 3), SafeRational(60), SafeRational(3, 2));
    first->addMedia(a, a->startTime());
    first->addMedia(b, b->startTime());
    const TransitionPtr fade(new Transition("Fade", 10));
    a->setRightTransition(fade);
    b->setLeftTransition(fade);
    const auto picture = IMFile::create(still, 0, 300, 40);
    first->addMedia(picture, 300);
    const auto recording = ScreenVMFile::create(screen, 0, 400, SafeRational(0), SafeRational(50));
    const auto data = boost::make_shared<ScreenRecordingData>(Rect<int>(0, 0, 1280, 720));
    data->addCursorSample(RationalTime(SafeRational(5, 2)), Point3d(10, 20, 0));
    data->addClick(RationalTime(3), ScreenClick::Right);
    data->addKeystroke(RationalTime(4), KeystrokeData("K", KeystrokeData::Shift));
    recording->setScreenData(data);
    first->addMedia(recording, 400);
    const auto shot = ScreenIMFile::create(frame, 0, 500, 20);
    first->addMedia(shot, 500);

    // Track 1: audio with edge modifications, effects and a hotspot'd callout.
    const auto second = newTrack(mixer);
    const auto sound = AMFile::create(video, 1, 0);
    sound->setChannelNumber(1);
    sound->addLeftEdgeModification(boost::make_shared<EdgeModification>(15, "fade", 0.0));
    sound->addRightEdgeModification(boost::make_shared<EdgeModification>(20, "fade", 0.25));
    StoredEffect::Fields fields;
    fields.effectName = "Glow";
    fields.category = "visual";
    fields.bypassed = true;
    fields.start = 3;
    fields.duration = 30;
    sound->addEffect(StoredEffect::create(fields));
    second->addMedia(sound, 0);
    const auto callout = Callout::create(token, rate, 3100, 60, TextAttributeList());
    callout->setAutoRotateText(true);
    HotspotInfo hotspot;
    hotspot.action = "jump";
    hotspot.url = "https://example.com";
    hotspot.markerTarget = picture;
    hotspot.markerTime = 7;
    callout->setHotspot(hotspot);
    callout->addMetaData("color", "red");
    AnimationTrack bounce("opacity", {AnimationTrack::Animation()});
    callout->setAnimationTrack(bounce);
    second->addMedia(callout, 3100);
    const auto caption = Caption::create(token, rate, 3200, 40);
    caption->setMaxMediaDuration(500);
    caption->setAllowTrimOut(false);
    second->addMedia(caption, 3200);
    const auto holder = PlaceholderMedia::create(token, rate, 3300, 30, 800, 600, "later");
    second->addMedia(holder, 3300);

    // Track 2: groups three deep, a stitched clip and a unified clip.
    const auto third = newTrack(mixer);
    auto innermost = GenericMixer::create(token);
    newTrack(innermost)->addMedia(PlaceholderMedia::create(token, rate, 0, 20), 0);
    GroupPtr group = Group::create(token, rate, innermost, 0);
    for (int level = 0; level < 2; ++level) {
        const auto outer = GenericMixer::create(token);
        newTrack(outer)->addMedia(group, 5);
        group = Group::create(token, rate, outer, 0);
    }
    group->setGroupWidthAndHeight(640, 360);
    third->addMedia(group, 0);
    const auto stitched =
        StitchedMedia::create({VMFile::create(video, 0, 0, SafeRational(0), SafeRational(30)),
                               VMFile::create(video, 0, 0, SafeRational(100), SafeRational(30))},
                              100);
    third->addMedia(stitched, 100);
    const auto unified =
        UnifiedMedia::create(VMFile::create(video, 0, 300, SafeRational(500), SafeRational(40)),
                             AMFile::create(video, 1, 300, SafeRational(500), SafeRational(40)));
    third->addMedia(unified, 300);
    return project;
}

} // namespace testing
} // namespace VelaMediaLib

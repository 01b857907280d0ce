// Sources, the source bin and the clips that play a source's streams.
#include "MediaTestSupport.h"
#include "SourceTestSupport.h"

#include <VelaMediaLib/model/media/AMFile.h>
#include <VelaMediaLib/model/media/IMFile.h>
#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/media/ScreenIMFile.h>
#include <VelaMediaLib/model/media/ScreenVMFile.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/project/SourceBin.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/parameters/SymbolTable.h>

namespace VelaMediaLib {
namespace testing {
namespace {

class SourceTest : public ModelTest {
protected:
    SourceTest() {
        // 10 s of video at 600 ticks a second from 0.5 s on, and 2 s of stereo audio at 48 kHz.
        loader->set("movie.mov",
                    {stream(TrackType::Video, 300, 6000, 600), stream(TrackType::Audio, 0, 96000, 48000, 2)});
        loader->set("still.png", {stream(TrackType::Image, 0, 1, 1)});
        loader->set("voice.wav", {stream(TrackType::Audio, 0, 48000, 48000, 1)});
        bin->setFileSystem(files);
    }
    SourcePtr load(const std::string& path) { return bin->loadFile(path); }

    RegisteredTableLoader loader;
    boost::shared_ptr<FakeFileSystem> files = boost::make_shared<FakeFileSystem>();
    boost::shared_ptr<SourceBin> bin = boost::make_shared<SourceBin>(project, rate);
};

TEST_F(SourceTest, LoadingAFileTwiceGivesItsOneSource) {
    const SourcePtr movie = load("movie.mov");
    EXPECT_EQ(load("movie.mov"), movie);
    EXPECT_EQ(bin->loadFileAtIndex("./movie.mov", 0), movie);
    EXPECT_EQ(bin->numSources(), 1u);
    EXPECT_EQ(bin->sourceForFile("movie.mov"), movie);
    EXPECT_FALSE(bin->isFileLoaded("other.mov"));
    EXPECT_EQ(loader->asked, 1); // the second loads never read the file

    bool added = true;
    EXPECT_EQ(bin->loadFileAtIndex("movie.mov", 0, &added), movie);
    EXPECT_FALSE(added);
    const SourcePtr voice = bin->loadFileAtIndex("voice.wav", 0, &added);
    EXPECT_TRUE(added);
    const SourcePtr still = bin->loadFileAtIndex("still.png", 2); // the end is a place too
    EXPECT_EQ(bin->sources(), (SourceBin::Sources{voice, movie, still}));
    EXPECT_EQ(bin->indexOfSource(movie), 1);
    EXPECT_NE(movie->stats()->contents(), voice->stats()->contents());
}

TEST_F(SourceTest, BadFilesAndIndexesLeaveTheBinAsItWas) {
    load("movie.mov");
    EXPECT_THROW(load("unknown.mov"), IOException);
    loader->set("empty.mov", {});
    EXPECT_THROW(load("empty.mov"), IOException);
    EXPECT_THROW(bin->loadFileAtIndex("voice.wav", 2), IndexException);
    EXPECT_THROW(bin->loadFileAtIndex("voice.wav", -2), IndexException);
    EXPECT_EQ(bin->numSources(), 1u);
    EXPECT_THROW(bin->removeSource(Source::create(rate, project, "voice.wav")), AddRemoveException);
    EXPECT_THROW(bin->insertSource(Source::create(rate, project, "movie.mov"), -1), AddRemoveException);
    const auto otherProject = boost::make_shared<ThreadSafe>();
    EXPECT_THROW(bin->insertSource(Source::create(rate, otherProject, "voice.wav"), -1), AddRemoveException);
    EXPECT_EQ(bin->numSources(), 1u);
}

TEST_F(SourceTest, OfflineStatusFollowsTheFile) {
    const SourcePtr movie = load("movie.mov");
    EXPECT_EQ(movie->offlineStatus(), OfflineStatus::Online);
    movie->setOnline(false);
    EXPECT_EQ(movie->offlineStatus(), OfflineStatus::FileMissing);
    files->present.insert("movie.mov");
    files->unreadable.insert("movie.mov");
    EXPECT_EQ(movie->offlineStatus(), OfflineStatus::FileUnreadable);
    files->unreadable.clear();
    EXPECT_EQ(movie->offlineStatus(), OfflineStatus::Reconnectable);
    loader->forget("movie.mov");
    EXPECT_EQ(movie->offlineStatus(), OfflineStatus::StatsUnavailable);
    EXPECT_EQ(static_cast<int>(OfflineStatus::StatsUnavailable), 3);
}

TEST_F(SourceTest, StreamsAreMeasuredInTheProjectsTicksExactly) {
    const SourcePtr movie = load("movie.mov");
    EXPECT_EQ(movie->rationalTimeRangeForTrack(0), Range<SafeRational>(SafeRational(15), SafeRational(300)));
    EXPECT_EQ(movie->timeRangeForTrack(1), Range<VelaTime>(0, 60));
    EXPECT_EQ(movie->timeRange(), Range<VelaTime>(0, 315));
    loader->set("late.mov",
                {stream(TrackType::Video, 1200, 600, 600), stream(TrackType::Audio, 96000, 48000, 48000)});
    EXPECT_EQ(load("late.mov")->timeRange(), Range<VelaTime>(60, 30)); // both from 2 s to 3 s
    loader->set("odd.wav", {stream(TrackType::Audio, 1, 1000, 48000, 1)});
    const SourcePtr odd = load("odd.wav"); // 1000 samples: 0.625 ticks from 1/1600
    EXPECT_EQ(odd->rationalTimeRangeForTrack(0),
              Range<SafeRational>(SafeRational(1, 1600), SafeRational(5, 8)));
    EXPECT_EQ(odd->timeRangeForTrack(0), Range<VelaTime>(0, 1));
    EXPECT_EQ(movie->trackRect(0), Rect<int>(0, 0, 640, 480));
    EXPECT_THROW(movie->timeRangeForTrack(2), IndexException);
}

TEST_F(SourceTest, AVideoClipIsLimitedByItsStreamsRange) {
    const SourcePtr movie = load("movie.mov");
    const auto clip = VMFile::create(movie, 0, 100);
    EXPECT_EQ(clip->trackRange(), Range<VelaTime>(100, 300));
    EXPECT_EQ(clip->minRationalMediaStart(), SafeRational(15));
    EXPECT_EQ(clip->maxRationalMediaEnd(), SafeRational(315));
    EXPECT_EQ(clip->trimStartLimit(), 0);
    EXPECT_FALSE(clip->validTrimEnd(-1));
    clip->trimStart(30);
    EXPECT_EQ(clip->trimStartLimit(), -30);
    EXPECT_EQ(clip->rationalMediaRange(), Range<SafeRational>(SafeRational(45), SafeRational(270)));

    const auto slice = VMFile::create(movie, 0, 0, SafeRational(20), SafeRational(10), SafeRational(2));
    EXPECT_EQ(slice->trackRange(), Range<VelaTime>(0, 20));
    EXPECT_EQ(slice->trimEndLimit(), -570); // 285 ticks of media left, at half speed
    EXPECT_THROW(VMFile::create(movie, 0, 0, SafeRational(10), SafeRational(10)),
                 ValueException<const SafeRational>);
    EXPECT_THROW(VMFile::create(movie, 0, 0, SafeRational(310), SafeRational(10)),
                 ValueException<const SafeRational>);
    EXPECT_THROW(VMFile::create(movie, 1, 0), TypeException);
    EXPECT_THROW(VMFile::create(movie, 2, 0), IndexException);
    EXPECT_THROW(VMFile::create(SourcePtr(), 0, 0), VelaMediaLibException);
}

TEST_F(SourceTest, AudioAndStillClipsOfTheirStreams) {
    const SourcePtr movie = load("movie.mov");
    const auto sound = AMFile::create(movie, 1, 0);
    EXPECT_EQ(sound->channelNumber(), AMFile::allChannels);
    sound->setChannelNumber(1);
    EXPECT_THROW(sound->setChannelNumber(2), IndexException);
    EXPECT_EQ(sound->channelNumber(), 1);
    EXPECT_EQ(boost::dynamic_pointer_cast<AMFile>(sound->clone())->channelNumber(), 1);

    const auto still = IMFile::create(load("still.png"), 0, 10, 5000);
    still->trimEnd(-100000); // a still has no media extent
    EXPECT_EQ(still->duration(), 105000);
    EXPECT_THROW(IMFile::create(movie, 0, 0, 10), TypeException);
    EXPECT_THROW(IMFile::create(load("still.png"), 0, 0, 0), ValueException<const SafeRational>);
    EXPECT_EQ(MediaTypeFromMediaDispatcher::typeOf(*still), "IMFile");
    EXPECT_EQ(MediaTypeFromMediaDispatcher::typeOf(*sound), "AMFile");
}

TEST_F(SourceTest, ScreenRecordingsPlayThroughTheScreenKindsWithTheirData) {
    loader->set("session.trec",
                {stream(TrackType::ScreenVideo, 0, 600, 600), stream(TrackType::ScreenImage, 0, 1, 1)});
    const SourcePtr session = load("session.trec");
    EXPECT_TRUE(boost::dynamic_pointer_cast<ScreenVMFile>(session->mediaForTrackNumber(0)));
    EXPECT_TRUE(boost::dynamic_pointer_cast<ScreenIMFile>(session->mediaForTrackNumber(1)));
    EXPECT_NO_THROW(VMFile::create(session, 0, 0)); // a plain video clip may play it too
    EXPECT_THROW(ScreenVMFile::create(load("movie.mov"), 0, 0), TypeException);

    const auto clip = ScreenVMFile::create(session, 0, 0, SafeRational(5), SafeRational(10));
    const auto data = boost::make_shared<ScreenRecordingData>(Rect<int>(0, 0, 1920, 1080));
    data->addClick(RationalTime(7), ScreenClick::Left);
    clip->setScreenData(data);
    const auto copy = boost::dynamic_pointer_cast<ScreenVMFile>(clip->clone());
    EXPECT_EQ(copy->screenData(), clip->screenData());
    EXPECT_EQ(copy->rationalMediaRange(), clip->rationalMediaRange());
    EXPECT_EQ(copy->clicksInRange(Range<RationalTime>(RationalTime(0), RationalTime(30))).size(), 1u);
    EXPECT_EQ(MediaTypeFromMediaDispatcher::typeOf(*copy), "ScreenVMFile");
    const auto still = ScreenIMFile::create(session, 1, 0, 90);
    EXPECT_EQ(boost::dynamic_pointer_cast<ScreenIMFile>(still->clone())->source(), session);
}

TEST_F(SourceTest, ASourcePlaysEachStreamThroughAClipOfItsOwn) {
    const SourcePtr movie = load("movie.mov");
    EXPECT_TRUE(boost::dynamic_pointer_cast<VMFile>(movie->mediaForTrackNumber(0)));
    EXPECT_TRUE(boost::dynamic_pointer_cast<AMFile>(movie->mediaForTrackNumber(1)));
    EXPECT_EQ(movie->timeline()->allMedias().size(), 2u);
    std::vector<int> visual, audio, all;
    for (auto it = movie->mediaBegin<VisualMedia>(); it != movie->mediaEnd<VisualMedia>(); ++it)
        visual.push_back(it.trackIndex());
    for (auto it = movie->mediaBegin<AudioMedia>(); it != movie->mediaEnd<AudioMedia>(); ++it)
        audio.push_back((*it)->volume() ? it.trackIndex() : -1);
    for (auto it = movie->mediaBegin(); it != movie->mediaEnd(); ++it) all.push_back(it.trackIndex());
    EXPECT_EQ(visual, std::vector<int>{0});
    EXPECT_EQ(audio, std::vector<int>{1});
    EXPECT_EQ(all, (std::vector<int>{0, 1}));
    EXPECT_EQ(movie->paramWithName("volume", 1), movie->mediaForTrackNumber(1)->parameter("volume"));
    EXPECT_EQ(movie->parameterVector(0).size(), movie->mediaForTrackNumber(0)->parameterNames().size());
    EXPECT_TRUE(movie->hasMetaData(Source::timeAddedMetaDataKey()));
    EXPECT_FALSE(movie->shouldApplyLoudnessNormalizationAttribute()->value());
}

TEST_F(SourceTest, ClipsHoldTheirSourceButTheSourcesOwnClipsDoNot) {
    boost::weak_ptr<Source> watched;
    MediaPtr placed;
    {
        const SourcePtr movie = Source::create(rate, project, "movie.mov");
        watched = movie;
        placed = movie->mediaForTrackNumber(0)->clone();
    }
    ASSERT_FALSE(watched.expired()); // the placed clip keeps it
    EXPECT_EQ(boost::dynamic_pointer_cast<VMFile>(placed)->source(), watched.lock());
    EXPECT_FALSE(boost::dynamic_pointer_cast<VMFile>(placed)->isSourcesOwnMedia());
    placed.reset();
    EXPECT_TRUE(watched.expired());
}

TEST_F(SourceTest, AnotherFileMustMatchTheStreams) {
    const SourcePtr movie = load("movie.mov");
    const auto clip = VMFile::create(movie, 0, 0, SafeRational(200), SafeRational(100));
    loader->set("short.mov",
                {stream(TrackType::Video, 0, 1200, 600), stream(TrackType::Audio, 0, 4800, 48000, 2)});
    loader->set("mute.mov", {stream(TrackType::Video, 0, 6000, 600)});
    EXPECT_THROW(bin->changeSourcesFile(movie, "mute.mov"), VelaMediaLibException);
    EXPECT_EQ(movie->filename(), "movie.mov");

    bin->changeSourcesFile(movie, "short.mov");
    EXPECT_EQ(bin->sourceForFile("short.mov"), movie);
    EXPECT_FALSE(bin->isFileLoaded("movie.mov"));
    EXPECT_EQ(movie->mediaForTrackNumber(0)->trackRange(), Range<VelaTime>(0, 60));
    clip->mediaSourceChanged(); // a shorter file keeps the slice the clip plays
    EXPECT_EQ(clip->minRationalMediaStart(), SafeRational(0));
    EXPECT_EQ(clip->maxRationalMediaEnd(), SafeRational(300));

    bin->renameSourcesFile(movie, "moved.mov");
    EXPECT_EQ(bin->sourceForFile("moved.mov"), movie);
    EXPECT_EQ(movie->numTracks(), 2);
    EXPECT_THROW(bin->renameSourcesFile(movie, load("voice.wav")->filename()), AddRemoveException);
}

TEST_F(SourceTest, TheTimelineFindsTheClipsOfASource) {
    const SourcePtr movie = load("movie.mov"), voice = load("voice.wav");
    const auto timeline = Timeline::create(project);
    const auto mixer = timeline->newMixer("main");
    const auto track = timeline->newTrack();
    timeline->addTrack(mixer, track);
    track->addMedia(VMFile::create(movie, 0, 0), 0);
    track->addMedia(AMFile::create(voice, 0, 0), 500);
    track->addMedia(AMFile::create(movie, 1, 0), 1000);
    EXPECT_EQ(timeline->allSources(), (std::vector<boost::shared_ptr<const Source>>{movie, voice}));
    EXPECT_EQ(mixer->allSources().size(), 2u);
    EXPECT_EQ(timeline->instancesOf(movie).size(), 2u);
    EXPECT_FALSE(timeline->hasInstanceOf(load("still.png")));
}

TEST_F(SourceTest, TheSymbolTableKnowsSourcesAndFileClipsByKind) {
    SymbolTable table;
    const SourcePtr movie = load("movie.mov");
    table.addSymbol(1, movie);
    table.addSymbol(2, movie->mediaForTrackNumber(0));
    table.addSymbol(3, IMFile::create(load("still.png"), 0, 0, 10));
    EXPECT_EQ(table.symbolForIdent<Source>(1), movie);
    EXPECT_FALSE(table.symbolForIdent<Media>(1));
    EXPECT_TRUE(table.symbolForIdent<VMFile>(2));
    EXPECT_FALSE(table.symbolForIdent<AMFile>(2));
    EXPECT_TRUE(table.symbolForIdent<AbstractIMFile>(3));
}

} // namespace
} // namespace testing
} // namespace VelaMediaLib

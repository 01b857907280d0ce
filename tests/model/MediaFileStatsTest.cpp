// Stats records, the loaders that fill them in list order, the caching loader
// and the host file system.
#include "../ThreadTestSupport.h"

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/model/source/BoostFileSystem.h>
#include <VelaMediaLib/model/source/CachingStatsLoader.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/SimpleMediaFileStats.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <algorithm>
#include <boost/make_shared.hpp>
#include <filesystem>
#include <fstream>
#include <functional>
#include <gtest/gtest.h>
#include <random>
#ifndef _WIN32
#include <unistd.h>
#endif

using namespace VelaMediaLib;

namespace {

typedef std::function<bool(const std::string&, MediaFileStats&)> LoadBody;

struct LambdaLoader : StatsLoader {
    explicit LambdaLoader(LoadBody b) : body(std::move(b)) {}
    bool loadStats(const std::string& path, MediaFileStats& stats) override {
        ++calls;
        return body(path, stats);
    }
    LoadBody body;
    int calls = 0;
};

TrackStats stream(TrackType type, long long start = 0, long long duration = 100, unsigned long rate = 10) {
    TrackStats stats;
    stats.type = type;
    stats.range = Range<long long>(start, duration);
    stats.rangeEditRate = rate;
    return stats;
}

struct CountingCachingLoader : CachingStatsLoader {
    using CachingStatsLoader::CachingStatsLoader;
    int calls = 0;

protected:
    bool loadStatsUncached(const std::string&, MediaFileStats& stats) override {
        ++calls;
        stats.addTrackStats(stream(TrackType::Video));
        return true;
    }
};

boost::shared_ptr<MediaFileStats> record(const std::vector<TrackStats>& tracks,
                                         const boost::weak_ptr<const ThreadSafe>& token = {}) {
    const auto stats = MediaFileStats::create()->copy(token);
    for (const TrackStats& track : tracks) stats->addTrackStats(track);
    return stats;
}

/// Removes every loader it added, so the process-wide list is as it was.
class MediaFileStatsTest : public ::testing::Test {
protected:
    void TearDown() override {
        for (const auto& loader : added_) MediaFileStats::removeStatsLoader(loader);
    }
    template <typename Loader>
    boost::shared_ptr<Loader> add(const boost::shared_ptr<Loader>& loader, int priority = 0) {
        MediaFileStats::addStatsLoader(loader, priority);
        added_.push_back(loader);
        return loader;
    }
    boost::shared_ptr<LambdaLoader> add(LoadBody body, int priority = 0) {
        return add(boost::make_shared<LambdaLoader>(std::move(body)), priority);
    }
    /// Our loaders in list order.
    std::vector<boost::shared_ptr<StatsLoader>> ours() const {
        std::vector<boost::shared_ptr<StatsLoader>> result;
        for (const auto& loader : MediaFileStats::statsLoaders())
            if (std::find(added_.begin(), added_.end(), loader) != added_.end()) result.push_back(loader);
        return result;
    }

    std::vector<boost::shared_ptr<StatsLoader>> added_;
};

const LoadBody refuse = [](const std::string&, MediaFileStats&) { return false; };
const LoadBody oneVideo = [](const std::string&, MediaFileStats& stats) {
    stats.addTrackStats(stream(TrackType::Video));
    return true;
};

template <typename Exception, typename Call>
std::string messageOf(Call call) {
    try {
        call();
    } catch (const Exception& e) {
        return e.what();
    }
    return "nothing thrown";
}

} // namespace

TEST_F(MediaFileStatsTest, PriorityPutsALoaderFirstAndZeroLastAndAddingAgainMovesIt) {
    const auto a = add(refuse), b = add(refuse), c = add(refuse, HighStatsLoaderPriority);
    EXPECT_EQ(ours(), (std::vector<boost::shared_ptr<StatsLoader>>{c, a, b}));
    add(b, 7);
    EXPECT_EQ(ours(), (std::vector<boost::shared_ptr<StatsLoader>>{b, c, a}));
    EXPECT_TRUE(MediaFileStats::removeStatsLoader(c));
    EXPECT_FALSE(MediaFileStats::removeStatsLoader(c));
    EXPECT_EQ(ours(), (std::vector<boost::shared_ptr<StatsLoader>>{b, a}));
    EXPECT_THROW(MediaFileStats::addStatsLoader(nullptr), VelaMediaLibException);
}

TEST_F(MediaFileStatsTest, TheFirstLoaderThatAnswersFillsAFreshRecordNamedAfterThePath) {
    const auto refusing = add(refuse);
    add([](const std::string&, MediaFileStats& stats) -> bool { // half fills its record, then throws
        stats.addTrackStats(stream(TrackType::Audio));
        throw IOException("bad header");
    });
    add(oneVideo);
    const auto later = add(oneVideo);
    const auto project = boost::make_shared<ThreadSafe>();
    const auto stats = MediaFileStats::create("clip.mp4", project);
    EXPECT_EQ(refusing->calls, 1);
    EXPECT_EQ(later->calls, 0);
    ASSERT_EQ(stats->numTracks(), 1);
    EXPECT_EQ(stats->trackType(0), TrackType::Video);
    EXPECT_EQ(stats->filename(), "clip.mp4");
    EXPECT_EQ(stats->filename(0), "clip.mp4");
    EXPECT_EQ(stats->projectMutex().lock(), project);
}

TEST_F(MediaFileStatsTest, WhenNoLoaderAnswersTheFirstErrorIsReported) {
    add(refuse);
    EXPECT_EQ(messageOf<IOException>([] { MediaFileStats::create("x.mov"); }),
              "no stats loader could read file: x.mov");
    add([](const std::string&, MediaFileStats&) -> bool { throw IOException("truncated"); });
    add([](const std::string&, MediaFileStats&) -> bool { throw IOException("second"); });
    EXPECT_EQ(messageOf<IOException>([] { MediaFileStats::create("x.mov"); }),
              "no stats loader could read file: x.mov (truncated)");
    EXPECT_FALSE(MediaFileStats::isFileOpenable("x.mov"));
}

TEST_F(MediaFileStatsTest, AnAnswerWithoutStreamsIsRefused) {
    add([](const std::string& path, MediaFileStats&) { return path == "empty.wav"; },
        HighStatsLoaderPriority);
    add(oneVideo);
    EXPECT_EQ(messageOf<IOException>([] { MediaFileStats::create("empty.wav"); }),
              "file has no streams: empty.wav");
    EXPECT_FALSE(MediaFileStats::isFileOpenable("empty.wav"));
    EXPECT_TRUE(MediaFileStats::isFileOpenable("full.mov"));
}

TEST_F(MediaFileStatsTest, ABadStreamIndexThrowsAndChangesNothing) {
    const auto stats = record({stream(TrackType::Audio)});
    const auto before = stats->contents();
    EXPECT_EQ(messageOf<IndexException>([&] { stats->trackRange(-1); }), "stream index out of range");
    EXPECT_THROW(stats->numChannels(1), IndexException);
    EXPECT_THROW(stats->filename(1), IndexException);
    EXPECT_THROW(stats->setTrackStats(1, stream(TrackType::Video)), IndexException);
    EXPECT_EQ(stats->contents(), before);
}

TEST_F(MediaFileStatsTest, ObserversHearRealChangesOnly) {
    const auto project = boost::make_shared<ThreadSafe>();
    const auto stats = record({stream(TrackType::Video)}, project);
    VelaMediaLib::testing::CountingObserver observer;
    stats->attach(&observer);
    stats->setRect(Rect<int>(0, 0, 640, 480));
    stats->setRect(Rect<int>(0, 0, 640, 480));
    stats->setTrackStats(0, stream(TrackType::Video));
    EXPECT_EQ(observer.count, 1);
    stats->setTrackStats(0, stream(TrackType::Image));
    stats->addTrackStats(stream(TrackType::Audio));
    stats->setFilename("b.mov");
    EXPECT_EQ(observer.count, 4);
    EXPECT_EQ(observer.last, stats.get());
    EXPECT_EQ(stats->trackType(0), TrackType::Image);
    MediaFileStats::Contents contents = stats->contents();
    stats->setContents(contents); // the same: nothing to hear
    contents.filename = "c.mov";
    stats->setContents(contents);
    EXPECT_EQ(observer.count, 5);
    stats->detach(&observer);
}

TEST_F(MediaFileStatsTest, MediaRangeSpansAllStreamsInSecondsAndFirstRatesComeFromTheirKind) {
    EXPECT_EQ(MediaFileStats::create()->mediaRangeInSeconds(), Range<double>(0, 0));
    TrackStats image = stream(TrackType::Image, 0, 1, 1), video = stream(TrackType::Video, 60, 300, 30);
    TrackStats audio = stream(TrackType::Audio, 44100, 441000, 44100), second = video;
    image.sampleRate = 1;
    video.sampleRate = 25;
    audio.sampleRate = 48000;
    second.sampleRate = 30;
    const auto stats = record({image, video, audio, second});
    EXPECT_EQ(stats->mediaRangeInSeconds(), Range<double>(0, 12)); // image 0..1, video 2..12, audio 1..11
    stats->setTrackStats(0, stream(TrackType::Image, 0, 0, 0));    // no rate: no time
    EXPECT_EQ(stats->mediaRangeInSeconds(), Range<double>(1, 11));
    EXPECT_EQ(stats->videoFrameRateOfFirstVideoTrack(), SafeRational(25));
    EXPECT_EQ(stats->audioSampleRateOfFirstAudioTrack(), SafeRational(48000));
    EXPECT_EQ(record({image})->audioSampleRateOfFirstAudioTrack(), SafeRational(0));

    const SimpleMediaFileStats simple = SimpleMediaFileStats::from(*stats);
    EXPECT_EQ(simple.duration, 11);
    EXPECT_EQ(simple.numTracks, 4);
    EXPECT_EQ(simple.videoFrameRate, SafeRational(25));
}

TEST_F(MediaFileStatsTest, ThePictureIsTheFilesOrElseTheFirstVisualStreams) {
    TrackStats audio = stream(TrackType::Audio), screen = stream(TrackType::ScreenVideo);
    audio.rect = Rect<int>(0, 0, 1, 1); // no picture, whatever it says
    screen.rect = Rect<int>(0, 0, 1280, 720);
    const auto stats = record({audio, screen});
    EXPECT_EQ(SimpleMediaFileStats::from(*stats).width, 1280);
    for (const Rect<int>& rect : {Rect<int>(0, 0, 640, 0), Rect<int>(0, 0, 0, 480)}) {
        stats->setRect(rect);
        EXPECT_EQ(SimpleMediaFileStats::from(*stats).width, rect.width);
        EXPECT_EQ(SimpleMediaFileStats::from(*stats).height, rect.height);
    }
    const std::vector<TrackType> visual = {TrackType::Video, TrackType::Image, TrackType::ScreenVideo,
                                           TrackType::ScreenImage};
    for (TrackType type : visual) EXPECT_TRUE(isVisualTrackType(type) && !isAudioTrackType(type));
    EXPECT_FALSE(isVisualTrackType(TrackType::Audio) || isVisualTrackType(TrackType::Unknown));
    EXPECT_TRUE(isAudioTrackType(TrackType::Audio));
}

TEST_F(MediaFileStatsTest, CompatibleForChangeNeedsTheSameStreamKindsAndChannels) {
    TrackStats stereo = stream(TrackType::Audio), mono = stereo;
    stereo.numChannels = 2;
    mono.numChannels = 1;
    const auto original = record({stream(TrackType::Video), stereo});
    EXPECT_TRUE(record({})->areCompatibleForChange(*record({})));
    EXPECT_TRUE(original->areCompatibleForChange(*record({stream(TrackType::Video, 5, 900, 24), stereo})));
    EXPECT_FALSE(original->areCompatibleForChange(*record({stream(TrackType::Video)})));
    EXPECT_FALSE(original->areCompatibleForChange(*record({stream(TrackType::Video), stereo, stereo})));
    EXPECT_FALSE(original->areCompatibleForChange(*record({stream(TrackType::Image), stereo})));
    EXPECT_FALSE(original->areCompatibleForChange(*record({stream(TrackType::Video), mono})));
    EXPECT_FALSE(record({})->areCompatibleForChange(*original));
}

TEST_F(MediaFileStatsTest, TheCachingLoaderAnswersARepeatedRequestFromItsMap) {
    const auto loader = add(boost::make_shared<CountingCachingLoader>());
    const auto first = MediaFileStats::create("a.mov");
    const auto second = MediaFileStats::create("a.mov");
    EXPECT_EQ(loader->calls, 1);
    EXPECT_EQ(second->contents(), first->contents());
    MediaFileStats::create("b.mov");
    EXPECT_EQ(loader->calls, 2);

    loader->clearStatsMap();
    MediaFileStats::create("a.mov");
    EXPECT_EQ(loader->calls, 3);

    loader->setCachingEnabled(false);
    MediaFileStats::create("c.mov");
    MediaFileStats::create("c.mov");
    EXPECT_EQ(loader->calls, 5);
    EXPECT_FALSE(loader->isCached("c.mov"));
}

TEST_F(MediaFileStatsTest, UpdatedDurationsReachTheCachedEntryOfTheFile) {
    const auto loader = add(boost::make_shared<CountingCachingLoader>());
    const auto stats = MediaFileStats::create("a.mov");
    TrackStats longer = stats->trackStats(0);
    longer.range = Range<long long>(0, 400);
    longer.rangeEditRate = 20;
    stats->setTrackStats(0, longer);
    MediaFileStats::updateCachedDurationsFromStats(*stats);
    const auto again = MediaFileStats::create("a.mov");
    EXPECT_EQ(loader->calls, 1);
    EXPECT_EQ(again->trackRange(0), Range<long long>(0, 400));
    EXPECT_EQ(again->rangeEditRate(0), boost::rational<unsigned long>(20));

    const auto other = record({stream(TrackType::Video, 0, 1)});
    other->setFilename("b.mov"); // not cached: nothing to update, nothing added
    MediaFileStats::updateCachedDurationsFromStats(*other);
    EXPECT_FALSE(loader->isCached("b.mov"));
}

namespace {

/// A scratch folder with one small file in it.
class BoostFileSystemTest : public ::testing::Test {
protected:
    void SetUp() override {
        std::filesystem::create_directories(dir);
        std::ofstream(file) << "data";
    }
    void TearDown() override {
        std::filesystem::permissions(file, std::filesystem::perms::owner_all);
        std::filesystem::remove_all(dir);
    }
    const std::filesystem::path dir =
        std::filesystem::temp_directory_path() / ("vela-fs-" + std::to_string(std::random_device()()));
    const std::string file = (dir / "media.bin").string();
    const boost::shared_ptr<FileSystem> fileSystem = BoostFileSystem::instance();
};

} // namespace

TEST_F(BoostFileSystemTest, AnswersForAFileADirectoryAndAMissingPath) {
    EXPECT_EQ(BoostFileSystem::instance(), fileSystem);
    EXPECT_TRUE(fileSystem->exists(file));
    EXPECT_TRUE(fileSystem->isReadable(file));
    EXPECT_TRUE(fileSystem->exists(dir.string()));
    EXPECT_FALSE(fileSystem->isReadable(dir.string()));
    EXPECT_FALSE(fileSystem->exists((dir / "missing.bin").string()));
    EXPECT_FALSE(fileSystem->isReadable((dir / "missing.bin").string()));
}

TEST_F(BoostFileSystemTest, AFileWithoutReadPermissionExistsButIsNotReadable) {
#ifndef _WIN32
    if (::geteuid() == 0) GTEST_SKIP() << "root reads any file";
#endif
    std::filesystem::permissions(file, std::filesystem::perms::none);
    EXPECT_TRUE(fileSystem->exists(file));
    EXPECT_FALSE(fileSystem->isReadable(file));
}

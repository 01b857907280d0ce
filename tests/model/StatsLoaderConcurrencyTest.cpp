// Stats are loaded while another thread changes the loader list, and a shared
// record is read while another thread changes it: no load sees a list half
// changed, no reader a stream half written.
#include "../ThreadTestSupport.h"

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/model/source/CachingStatsLoader.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <atomic>
#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <string>
#include <thread>

using namespace VelaMediaLib;
using VelaMediaLib::testing::Deadline;

namespace {

TrackStats audio(long long duration) {
    TrackStats stats;
    stats.type = TrackType::Audio;
    stats.range = Range<long long>(1000 - duration, duration); // always ends at 1000
    stats.rangeEditRate = 100;
    stats.sampleRate = duration;
    stats.numChannels = 2;
    return stats;
}

/// Answers every path with two streams, from its map after the first time.
struct TwoStreams : CachingStatsLoader {
    std::atomic<int> uncached{0};

protected:
    bool loadStatsUncached(const std::string&, MediaFileStats& stats) override {
        ++uncached;
        stats.addTrackStats(audio(400));
        stats.addTrackStats(audio(600));
        return true;
    }
};

/// Refuses everything, or throws: either way the next loader is asked.
struct Unhelpful : StatsLoader {
    explicit Unhelpful(bool throws) : throws_(throws) {}
    bool loadStats(const std::string&, MediaFileStats&) override {
        if (throws_) throw IOException("not mine");
        return false;
    }
    const bool throws_;
};

} // namespace

TEST(StatsLoaderConcurrencyTest, LoadsAnswerWholeWhileTheListChanges) {
    Deadline deadline;
    const auto base = boost::make_shared<TwoStreams>();
    MediaFileStats::addStatsLoader(base);
    const boost::shared_ptr<StatsLoader> churn[] = {boost::make_shared<Unhelpful>(false),
                                                    boost::make_shared<Unhelpful>(true)};
    std::atomic<bool> done{false};
    std::atomic<int> wrong{0};
    auto load = [&](int thread) {
        for (int i = 0; i < 50 || !done.load(); ++i) { // each reader loads every file at least once
            const auto stats = MediaFileStats::create("file" + std::to_string((thread * 7 + i) % 10));
            if (stats->numTracks() != 2 || stats->trackRange(1) != Range<long long>(400, 600) ||
                stats->mediaRangeInSeconds() != Range<double>(4, 6))
                ++wrong;
        }
    };
    std::thread first(load, 0), second(load, 1);
    for (int i = 0; i < 500; ++i) {
        const auto& loader = churn[i % 2];
        MediaFileStats::addStatsLoader(loader,
                                       i % 3 == 0 ? HighStatsLoaderPriority : NormalStatsLoaderPriority);
        if (i % 50 == 0) base->clearStatsMap();
        MediaFileStats::removeStatsLoader(loader);
    }
    done = true;
    first.join();
    second.join();
    MediaFileStats::removeStatsLoader(base);
    EXPECT_EQ(wrong.load(), 0);
    EXPECT_GE(base->uncached.load(), 10);
}

TEST(StatsLoaderConcurrencyTest, ReadersOfASharedRecordSeeWholeStreams) {
    Deadline deadline;
    const auto project = boost::make_shared<ThreadSafe>();
    const auto stats = MediaFileStats::create()->copy(project);
    stats->addTrackStats(audio(100));
    const auto other = MediaFileStats::create();
    other->addTrackStats(audio(300));
    std::atomic<bool> done{false};
    std::atomic<int> torn{0};
    auto read = [&] {
        while (!done.load()) {
            const TrackStats track = stats->trackStats(0);
            if (track.range.end() != 1000 || track.sampleRate != track.range.duration()) ++torn;
            if (stats->mediaRangeInSeconds().end() != 10 || !stats->areCompatibleForChange(*other)) ++torn;
        }
    };
    std::thread first(read), second(read);
    for (int i = 0; i < 1000; ++i) stats->setTrackStats(0, audio(100 + i % 2 * 100));
    done = true;
    first.join();
    second.join();
    EXPECT_EQ(torn.load(), 0);
}

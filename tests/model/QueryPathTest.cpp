// The query path: a track answers time queries from an index beside its map,
// and every object locks through a share of its project's lock.
#include "../ThreadTestSupport.h"

#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <random>
#include <thread>

using namespace VelaMediaLib;

namespace {

// What mediaAtTime must answer, worked out from the clips themselves: the
// clip holding t, and before it a touching clip that ends where it starts.
Track::Pair expectedAt(const std::vector<MediaPtr>& clips, VelaTime t) {
    MediaPtr holding, ending;
    for (const MediaPtr& clip : clips) {
        if (clip->startTime() <= t && t < clip->endTime()) holding = clip;
        if (clip->endTime() == t) ending = clip;
    }
    if (holding && ending && holding->startTime() == t) return Track::Pair(ending, holding);
    return Track::Pair(holding, MediaPtr());
}

// After any run of edits, refused or not, the index and the clips must tell
// the same story at every tick.
TEST(ClipIndex, AgreesWithTheClipsAfterRandomEdits) {
    const auto project = boost::make_shared<ThreadSafe>();
    const boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
    const auto track = GenericTrack::create(project);
    std::mt19937 random(5);
    const auto pick = [&](int n) { return std::uniform_int_distribution<int>(0, n - 1)(random); };
    for (int step = 0; step < 400; ++step) {
        const std::vector<MediaPtr> clips = track->medias();
        const MediaPtr clip = clips.empty() ? MediaPtr() : clips[size_t(pick(int(clips.size())))];
        const VelaTime offset = pick(41) - 20;
        try {
            switch (clip ? pick(5) : 0) {
            case 0:
                track->addMedia(PlaceholderMedia::create(project, rate, 0, 1 + pick(15)), pick(200));
                break;
            case 1:
                track->removeMedia(clip);
                break;
            case 2:
                track->move(clip, offset * 5);
                break; // far enough to pass other clips
            case 3:
                track->trimStart(clip, offset);
                break;
            default:
                track->trimEnd(clip, offset);
                break;
            }
        } catch (const std::exception&) {
            // refused edits change nothing, which the check below also covers
        }
        const std::vector<MediaPtr> now = track->medias();
        ScopedReadLock held(track->projectLock());
        for (VelaTime t = -1; t <= 300; ++t) {
            const Track::Pair expected = expectedAt(now, t);
            ASSERT_EQ(track->mediaAtTime(t), expected) << t;
            ASSERT_EQ(track->mediaAtTimeUnderLock(t),
                      Track::RawPair(expected.first.get(), expected.second.get()));
        }
    }
}

} // namespace

namespace {

// Queries lock through the share of the lock an object holds: it must be the
// very lock edits take, and follow the object to another project.
TEST(QueryLock, IsTheProjectsLockAndFollowsTheToken) {
    auto first = boost::make_shared<ThreadSafe>();
    const auto second = boost::make_shared<ThreadSafe>();
    const auto track = GenericTrack::create(first);
    const auto parameter = InterpolatingParam<double>::create(first, "x", 0.0);
    const auto flag = track->attribute<bool>("solo");
    EXPECT_EQ(track->projectLock(), &first->mutex());
    EXPECT_EQ(parameter->projectLock(), &first->mutex());
    EXPECT_EQ(flag->projectLock(), &first->mutex());
    EXPECT_EQ(track->metaDataMutex(), &first->mutex());
    parameter->setProjectMutex(second);
    EXPECT_EQ(parameter->projectLock(), &second->mutex());
    ReadWriteMutex* const lock = &first->mutex();
    first.reset();
    EXPECT_EQ(track->projectLock(), lock); // kept alive by the track
    EXPECT_EQ(track->metaDataMutex(), nullptr);
}

// A reader under one read lock sees each answer agree with the clips' ranges
// while a writer moves clips back and forth.
TEST(QueryConcurrency, MediaAtTimeAgreesWithTheClipsWhileTheyMove) {
    VelaMediaLib::testing::Deadline deadline;
    const auto project = boost::make_shared<ThreadSafe>();
    const boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
    const auto track = GenericTrack::create(project);
    std::vector<MediaPtr> clips;
    for (int i = 0; i < 20; ++i) {
        clips.push_back(PlaceholderMedia::create(project, rate, 0, 10));
        track->addMedia(clips.back(), i * 20);
    }
    std::atomic<bool> done{false};
    std::thread writer([&] {
        for (int round = 0; round < 300; ++round)
            for (const MediaPtr& clip : clips) track->move(clip, round % 2 ? -5 : 5);
        done = true;
    });
    for (VelaTime t = 0; !done; t = (t + 7) % 400) {
        ScopedReadLock lock(track->projectLock());
        const Track::Pair pair = track->mediaAtTime(t);
        const bool agrees = pair.second
                                ? pair.first->endTime() == t && pair.second->startTime() == t
                                : !pair.first || (pair.first->startTime() <= t && t < pair.first->endTime());
        ASSERT_TRUE(agrees) << t;
    }
    writer.join();
}

} // namespace

// Readers see whole states while others edit, first uses inside a snapshot
// take no write lock, and walks never meet a mixer half gone.
#include "../ThreadTestSupport.h"
#include "MediaTestSupport.h"

#include <VelaMediaLib/model/media/MediaEditor.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

#include <atomic>
#include <chrono>
#include <thread>

using namespace VelaMediaLib;
using VelaMediaLib::testing::Deadline;

namespace {

const boost::weak_ptr<ProjectEditRate> noRate;
const auto kLimit = std::chrono::seconds(20);

bool before(std::chrono::steady_clock::time_point until) { return std::chrono::steady_clock::now() < until; }

} // namespace

TEST(MediaConcurrency, ReadersSeeWholeStatesWhileAWriterTrims) {
    Deadline deadline;
    const auto project = boost::make_shared<ThreadSafe>();
    const auto media = PlaceholderMedia::create(project, noRate, 0, 1000);
    std::atomic<bool> done{false};
    std::atomic<int> torn{0};
    auto read = [&] {
        while (!done.load()) {
            const MediaState state = media->state();
            if (state.start + state.duration != 1000 || state.mediaStart != SafeRational(state.start)) ++torn;
            media->validTrimStart(1);
            media->opacity()->valueAtTime(RationalTime(5));
        }
    };
    std::thread first(read), second(read);
    for (int i = 0; i < 2000; ++i) {
        media->trimStart(5);
        media->trimStart(-5);
    }
    done = true;
    first.join();
    second.join();
    EXPECT_EQ(torn.load(), 0);
}

// Another reader holds its share until this one is done: a write lock asked
// for meanwhile would wait for that share until the other gives up.
TEST(MediaConcurrency, TheOlderEditorIsMadeInsideAReadersSnapshotWithoutTheWriteLock) {
    Deadline deadline;
    const auto project = boost::make_shared<ThreadSafe>();
    const auto media = PlaceholderMedia::create(project, noRate, 0, 100);
    std::atomic<bool> otherReading{false}, done{false}, otherGaveUp{false};
    std::thread other([&] {
        ScopedReadLock lock(project);
        otherReading = true;
        otherGaveUp = !VelaMediaLib::testing::waitFor(done, kLimit);
    });
    while (!otherReading.load()) std::this_thread::yield();
    {
        ScopedReadLock snapshot(project);
        MediaEditor& editor = media->mediaEditor(); // first use, inside the snapshot
        EXPECT_EQ(&editor, &media->mediaEditor());
        EXPECT_EQ(editor.trimEndLimit(), 0);
        EXPECT_EQ(media->startTime(), 0);
    }
    done = true;
    other.join();
    EXPECT_FALSE(otherGaveUp) << "making the editor waited for the other reader";
}

TEST(MediaConcurrency, ThreadsMakingTheOlderEditorAtOnceShareOne) {
    Deadline deadline;
    const auto media = PlaceholderMedia::create(boost::make_shared<ThreadSafe>(), noRate, 0, 100);
    std::atomic<MediaEditor*> seen{nullptr};
    std::thread first([&] { seen = &media->mediaEditor(); });
    MediaEditor* const mine = &media->mediaEditor();
    first.join();
    EXPECT_EQ(seen.load(), mine);
}

TEST(TimelineConcurrency, WalksOverMixersSurviveMixersComingAndGoing) {
    Deadline deadline;
    const auto project = boost::make_shared<ThreadSafe>();
    const TimelinePtr timeline = Timeline::create(project);
    std::vector<MixerPtr> mixers;
    for (int i = 0; i < 3; ++i) {
        const auto mixer = GenericMixer::create(project);
        const auto track = GenericTrack::create(project);
        track->addMedia(PlaceholderMedia::create(project, noRate, 0, 10 * (i + 1)), 0);
        mixer->addTrack(track);
        mixers.push_back(mixer);
        timeline->addMixer("m" + std::to_string(i), mixer);
    }
    const auto until = std::chrono::steady_clock::now() + kLimit;
    std::atomic<bool> done{false};
    std::atomic<int> wrong{0};
    std::thread reader([&] {
        while (!done.load() && before(until)) {
            // Each walk sees two or three whole mixers, never a missing one.
            const size_t tracks = timeline->numTracks(), clips = timeline->allMedias().size();
            const VelaTime end = timeline->endTime(),
                           seen = timeline->endTimeNotIncludingHiddenAndMutedTracks();
            if (tracks < 2 || tracks > 3 || clips < 2 || clips > 3 || end < 20 || seen < 20) ++wrong;
        }
    });
    for (int i = 0; i < 3000 && before(until); ++i) {
        timeline->removeMixer(mixers[size_t(i % 3)]);
        timeline->addMixer("m" + std::to_string(i % 3), mixers[size_t(i % 3)]);
    }
    done = true;
    reader.join();
    EXPECT_EQ(wrong.load(), 0);
}

TEST(TrackConcurrency, EditsRacingForTheSameGapNeverOverlap) {
    Deadline deadline;
    const auto project = boost::make_shared<ThreadSafe>();
    const auto track = GenericTrack::create(project);
    const MediaPtr left = PlaceholderMedia::create(project, noRate, 0, 10);
    const MediaPtr right = PlaceholderMedia::create(project, noRate, 0, 10);
    track->addMedia(left, 0);
    track->addMedia(right, 12); // a two-tick gap both reach for
    const auto until = std::chrono::steady_clock::now() + kLimit;
    std::atomic<int> overlaps{0};
    auto jiggle = [&](const MediaPtr& clip, VelaTime towards) {
        for (int i = 0; i < 3000 && before(until); ++i) {
            for (const VelaTime step : {towards, -towards}) {
                try {
                    i % 2 ? clip->move(step) : (void)track->move(clip, step);
                } catch (const CollisionException&) {}
            }
            ScopedReadLock lock(project); // both ranges at one moment
            if (left->lockedTrackRange().end() > right->lockedTrackRange().start()) ++overlaps;
        }
    };
    std::thread other([&] { jiggle(right, -2); });
    jiggle(left, 2);
    other.join();
    EXPECT_EQ(overlaps.load(), 0);
    ScopedReadLock lock(project);
    for (auto entry = track->mediaBegin(); entry != track->mediaEnd(); ++entry)
        EXPECT_EQ(entry->first, entry->second->lockedTrackRange().start()); // keyed where they stand
}

#include "../ThreadTestSupport.h"

// Readers inside a snapshot take no write lock, and timeline walks never
// meet a mixer half gone. Each test carries its own deadline.
#include "MediaTestSupport.h"

#include <VelaMediaLib/model/media/MediaEditor.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <gtest/gtest.h>
#include <mutex>
#include <thread>

using namespace VelaMediaLib;

namespace {

const auto kDeadline = std::chrono::seconds(20);

} // namespace

TEST(MediaConcurrency, TheOlderEditorIsMadeInsideAReadersSnapshotWithoutTheWriteLock) {
    VelaMediaLib::testing::Deadline watchdog;
    const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    const auto media = PlaceholderMedia::create(project, boost::weak_ptr<ProjectEditRate>(), 0, 100);
    std::mutex mutex;
    std::condition_variable changed;
    bool otherReading = false, done = false, otherTimedOut = false;
    // Another reader holds its share until this one is done, or until its
    // deadline: a write lock asked for meanwhile waits for that share.
    std::thread other([&] {
        ScopedReadLock lock(project);
        std::unique_lock<std::mutex> guard(mutex);
        otherReading = true;
        changed.notify_all();
        otherTimedOut = !changed.wait_for(guard, kDeadline, [&] { return done; });
    });
    {
        std::unique_lock<std::mutex> guard(mutex);
        changed.wait(guard, [&] { return otherReading; });
    }
    {
        ScopedReadLock snapshot(project);
        const VelaTime before = media->startTime();
        MediaEditor& editor = media->mediaEditor(); // first use, inside the snapshot
        EXPECT_EQ(&editor, &media->mediaEditor());
        EXPECT_EQ(editor.trimEndLimit(), 0);
        EXPECT_EQ(media->startTime(), before);
    }
    {
        std::lock_guard<std::mutex> guard(mutex);
        done = true;
    }
    changed.notify_all();
    other.join();
    EXPECT_FALSE(otherTimedOut) << "making the editor waited for the other reader";
}

TEST(MediaConcurrency, ThreadsMakingTheOlderEditorAtOnceShareOne) {
    VelaMediaLib::testing::Deadline watchdog;
    const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    const auto media = PlaceholderMedia::create(project, boost::weak_ptr<ProjectEditRate>(), 0, 100);
    std::atomic<MediaEditor*> seen[2] = {{nullptr}, {nullptr}};
    std::thread first([&] { seen[0] = &media->mediaEditor(); });
    seen[1] = &media->mediaEditor();
    first.join();
    EXPECT_EQ(seen[0].load(), seen[1].load());
}

TEST(TimelineConcurrency, WalksOverMixersSurviveMixersComingAndGoing) {
    VelaMediaLib::testing::Deadline watchdog;
    const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    const TimelinePtr timeline = Timeline::create(project);
    const boost::weak_ptr<ProjectEditRate> noRate;
    std::vector<MixerPtr> mixers;
    for (int i = 0; i < 3; ++i) {
        const auto mixer = GenericMixer::create(project);
        const auto track = GenericTrack::create(project);
        track->addMedia(PlaceholderMedia::create(project, noRate, 0, 10 * (i + 1)), 0);
        mixer->addTrack(track);
        mixers.push_back(mixer);
        timeline->addMixer("m" + std::to_string(i), mixer);
    }
    const auto deadline = std::chrono::steady_clock::now() + kDeadline;
    std::atomic<bool> done{false};
    std::atomic<int> wrong{0};
    std::thread reader([&] {
        while (!done.load() && std::chrono::steady_clock::now() < deadline) {
            // Each walk sees two or three whole mixers, never a missing one.
            const size_t tracks = timeline->numTracks(), clips = timeline->allMedias().size();
            const VelaTime end = timeline->endTime();
            const VelaTime seen = timeline->endTimeNotIncludingHiddenAndMutedTracks();
            if (tracks < 2 || tracks > 3 || clips < 2 || clips > 3 || end < 20 || seen < 20) ++wrong;
        }
    });
    for (int i = 0; i < 3000 && std::chrono::steady_clock::now() < deadline; ++i) {
        const MixerPtr& mixer = mixers[size_t(i % 3)];
        timeline->removeMixer(mixer);
        timeline->addMixer("m" + std::to_string(i % 3), mixer);
    }
    done = true;
    reader.join();
    EXPECT_EQ(wrong.load(), 0);
}

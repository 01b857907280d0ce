#include "../ThreadTestSupport.h"

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/model/media/MediaEditor.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>

#include <atomic>
#include <gtest/gtest.h>
#include <thread>

using namespace VelaMediaLib;

namespace {

struct CountingObserver : Observer {
    std::atomic<int> heard{0};
    void update(Observable*) override { ++heard; }
};

struct Placed {
    MediaPtr clip;
    VelaTime start;
    bool operator==(const Placed& o) const { return clip == o.clip && start == o.start; }
};

std::vector<Placed> placement(const Track& track) {
    std::vector<Placed> placed;
    for (const MediaPtr& clip : track.medias()) placed.push_back({clip, clip->startTime()});
    return placed;
}

} // namespace

// A reader's snapshot stays one: first touching a clip's parameters, editor
// and metadata inside it must not let the editing thread in, while another
// thread attaches and detaches observers on the same clips.
TEST(SnapshotConcurrency, FirstUseInsideASnapshotKeepsItWhole) {
    VelaMediaLib::testing::Deadline deadline;
    const ProjectPtr project = Project::create(30, 1);
    const auto track = project->timeline()->newTrack();
    project->timeline()->addTrack(project->newMixer("main"), track);
    track->magneticAttribute()->setValue(true);

    std::atomic<bool> done{false};
    std::atomic<int> torn{0}, snapshots{0};
    auto reader = [&] {
        while (!done.load()) {
            ScopedReadLock snapshot(project->token());
            const std::vector<Placed> before = placement(*track);
            for (const Placed& placed : before) {
                const auto clip = boost::dynamic_pointer_cast<PlaceholderMedia>(placed.clip);
                clip->opacity()->valueAtTime(RationalTime(3));
                clip->mediaEditor();
                clip->metaDataValue("note");
            }
            if (!(placement(*track) == before)) ++torn;
            ++snapshots;
        }
    };
    CountingObserver observer;
    auto observing = [&] {
        while (!done.load()) {
            for (const MediaPtr& clip : track->medias()) clip->attach(&observer);
            track->attach(&observer);
            for (const MediaPtr& clip : track->medias()) clip->detach(&observer);
            track->detach(&observer);
        }
    };
    std::vector<std::thread> threads;
    threads.emplace_back(reader);
    threads.emplace_back(reader);
    threads.emplace_back(observing);
    for (int i = 0; i < 300; ++i) {
        const auto clip = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10);
        project->execute(AddMediaCmd::create(track, clip, track->endTime()));
        if (i % 2) project->execute(MoveCmd::create(track, clip, 3)); // the gap closes after it
        if (i % 3 == 0) project->undo();
    }
    done = true;
    for (std::thread& thread : threads) thread.join();
    for (const MediaPtr& clip : track->medias()) clip->detach(&observer);
    track->detach(&observer);

    EXPECT_EQ(torn.load(), 0);
    EXPECT_GT(snapshots.load(), 0);
    VelaTime expected = 0;
    for (const MediaPtr& clip : track->medias()) {
        EXPECT_EQ(clip->startTime(), expected);
        expected = clip->endTime();
    }
}

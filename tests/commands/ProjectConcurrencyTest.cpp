#include "../ThreadTestSupport.h"
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>

#include <atomic>
#include <thread>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

// A magnetic track, and threads that run a body over and over until the test is done with them.
class ProjectConcurrency : public EditTest {
protected:
    Deadline deadline;
    std::atomic<bool> done{false};
    std::vector<std::thread> threads;

    ProjectConcurrency() { track->magneticAttribute()->setValue(true); }
    void runMeanwhile(const std::function<void(int)>& body) {
        for (int which = 0; which < 2; ++which)
            threads.emplace_back([this, body, which] {
                for (int i = 0; !done.load(); ++i) body(which + 2 * i);
            });
    }
    void finish() {
        done = true;
        for (std::thread& thread : threads) thread.join();
    }
};

} // namespace

// Readers ask which clips are active and what parameters are worth while one
// thread executes, undoes and redoes moves. Under one read lock, a reader's
// answers agree: two clips at a tick touch there, and values stay within their curves.
TEST_F(ProjectConcurrency, ReadersQueryWhileOneThreadEditsThroughTheHistory) {
    for (int i = 0; i < 20; ++i) {
        opacityOf(clip(10))->addKeyFrame(RationalTime(10), 0.0, RationalTime(0));
        project->execute(AddMediaCmd::create(track, clips.back(), i * 10));
    }
    std::atomic<int> wrong{0};
    runMeanwhile([&](int n) {
        const long long tick = n * 7 % 260;
        ScopedReadLock snapshot(project->token());
        const Track::Pair pair = track->mediaAtTime(tick);
        if (pair.second && pair.first->endTime() != pair.second->startTime()) ++wrong;
        if (pair.first) {
            const double opacity =
                opacityOf(pair.first)
                    ->valueAtTime(pair.first->fromGlobalToParametricTime(RationalTime(tick)));
            if (opacity < 0.0 || opacity > 1.0) ++wrong;
        }
        project->timeline()->allMediasAtTime(tick);
    });
    for (int i = 0; i < 300; ++i) {
        project->execute(MoveCmd::create(track, clips.back(), 30)); // the magnetizer pulls it back
        project->undo();
        project->redo();
        project->undo();
        project->undo();
    }
    finish();
    EXPECT_EQ(wrong.load(), 0);
    EXPECT_EQ(clips.back()->startTime(), 190);
}

// The magnetizer hears clips renamed on two threads at once (under the read
// lock only) while this thread makes gaps directly and runs commands that drain
// the queued closings: ThreadSanitizer sees any unguarded request state.
TEST_F(ProjectConcurrency, AMagnetizerHeardOnSeveralThreadsQueuesSafely) {
    for (int i = 0; i < 3; ++i) track->addMedia(clip(10), 10 * i);
    const auto other = newTrack();
    const MediaPtr loose = clip(10);
    other->addMedia(loose, 0);
    runMeanwhile([&](int n) { clips[n % 2]->setIdentifier("c" + std::to_string(n)); });
    for (int i = 0; i < 300; ++i) {
        try {
            clips[2]->move(1); // a gap: the closing waits for the next command
        } catch (const CollisionException&) {}
        project->execute(MoveCmd::create(other, loose, i % 2 ? -1 : 1));
    }
    finish();
    project->commandHistory()->runFollowUps();
    EXPECT_EQ(clips[2]->startTime(), 20);
    EXPECT_FALSE(CloseGapsOnTrackCmd::hasGap(*track));
}

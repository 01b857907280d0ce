#include "../ThreadTestSupport.h"

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>

#include <atomic>
#include <gtest/gtest.h>
#include <thread>

using namespace VelaMediaLib;

// Readers ask which clips are active and what parameters are worth while
// one thread executes, undoes and redoes moves. Under one read lock, a
// reader's answers agree: two clips at a tick touch there, and values stay
// within their curves.
TEST(ProjectConcurrency, ReadersQueryWhileOneThreadEditsThroughTheHistory) {
    VelaMediaLib::testing::Deadline deadline;
    const ProjectPtr project = Project::create(30, 1);
    const auto mixer = project->newMixer("main");
    const auto track = project->timeline()->newTrack();
    project->timeline()->addTrack(mixer, track);
    track->magneticAttribute()->setValue(true);
    std::vector<boost::shared_ptr<PlaceholderMedia>> clips;
    for (int i = 0; i < 20; ++i) {
        clips.push_back(PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10));
        clips.back()->opacity()->addKeyFrame(RationalTime(10), 0.0, RationalTime(0));
        project->execute(AddMediaCmd::create(track, clips.back(), i * 10));
    }
    std::atomic<bool> done{false};
    std::atomic<int> wrong{0};
    std::vector<std::thread> readers;
    for (int r = 0; r < 2; ++r)
        readers.emplace_back([&, r] {
            for (long long tick = r; !done.load(); tick = (tick + 7) % 260) {
                // Several queries that must agree are read under one read lock.
                ScopedReadLock snapshot(project->token());
                const Track::Pair pair = track->mediaAtTime(tick);
                if (pair.second && pair.first->endTime() != pair.second->startTime()) ++wrong;
                if (pair.first) {
                    const double opacity =
                        boost::dynamic_pointer_cast<PlaceholderMedia>(pair.first)
                            ->opacity()
                            ->valueAtTime(pair.first->fromGlobalToParametricTime(RationalTime(tick)));
                    if (opacity < 0.0 || opacity > 1.0) ++wrong;
                }
                project->timeline()->allMediasAtTime(tick);
            }
        });
    for (int i = 0; i < 300; ++i) {
        const auto last = clips.back();
        project->execute(MoveCmd::create(track, last, 30)); // the magnetizer pulls it back
        project->undo();
        project->redo();
        project->undo();
        project->undo();
    }
    done = true;
    for (std::thread& reader : readers) reader.join();
    EXPECT_EQ(wrong.load(), 0);
    EXPECT_EQ(clips.back()->startTime(), 190);
}

// The magnetizer hears a clip on whichever thread edits it: two threads
// rename clips of a magnetic track (each hearing under the read lock only,
// so both may be heard at once) while the editing thread makes gaps directly
// and runs commands that drain the queued closings. ThreadSanitizer sees any
// unguarded request state; at the end the track has no gap.
TEST(ProjectConcurrency, AMagnetizerHeardOnSeveralThreadsQueuesSafely) {
    VelaMediaLib::testing::Deadline deadline;
    const ProjectPtr project = Project::create(30, 1);
    const auto mixer = project->newMixer("main");
    const auto magnetic = project->timeline()->newTrack(), other = project->timeline()->newTrack();
    project->timeline()->addTrack(mixer, magnetic);
    project->timeline()->addTrack(mixer, other);
    magnetic->magneticAttribute()->setValue(true);
    std::vector<MediaPtr> clips;
    for (int i = 0; i < 3; ++i) {
        clips.push_back(PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10));
        magnetic->addMedia(clips.back(), 10 * i);
    }
    const MediaPtr loose = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10);
    other->addMedia(loose, 0);
    std::atomic<bool> done{false};
    std::vector<std::thread> renamers;
    for (int which = 0; which < 2; ++which)
        renamers.emplace_back([&, which] {
            for (int i = 0; !done.load(); ++i) clips[which]->setIdentifier("c" + std::to_string(i));
        });
    for (int i = 0; i < 300; ++i) {
        try {
            clips[2]->move(1); // a gap: the closing waits for the next command
        } catch (const CollisionException&) {}
        project->execute(MoveCmd::create(other, loose, i % 2 ? -1 : 1));
    }
    done = true;
    for (std::thread& renamer : renamers) renamer.join();
    project->commandHistory()->runFollowUps();
    EXPECT_EQ(clips[2]->startTime(), 20);
    EXPECT_FALSE(CloseGapsOnTrackCmd::hasGap(*magnetic));
}

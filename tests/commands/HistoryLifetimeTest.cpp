// A host may keep the project's history, or a composite, past the project.
// What it keeps then refuses with a clear exception instead of reaching into
// the project that has gone (AddressSanitizer finds any such read).
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/framework/BatchCmd.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>

#include <gtest/gtest.h>

using namespace VelaMediaLib;

namespace {

struct Kept {
    boost::shared_ptr<CommandHistory> history;
    boost::shared_ptr<BatchCmd> batch;
    MediaPtr clip;
    boost::shared_ptr<GenericTrack> track;
};

// A project with one move and one batch done, of which the host keeps the
// history, the batch, a clip and its track.
Kept keepPastTheProject() {
    Kept kept;
    const ProjectPtr project = Project::create(30, 1);
    kept.track = project->timeline()->newTrack();
    project->timeline()->addTrack(project->newMixer("main"), kept.track);
    kept.clip = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10);
    kept.track->addMedia(kept.clip, 0);
    kept.history = project->commandHistory();
    EXPECT_TRUE(project->execute(MoveCmd::create(kept.track, kept.clip, 5)));
    kept.batch = BatchCmd::create(MoveCmd::create(kept.track, kept.clip, 5));
    EXPECT_TRUE(project->execute(kept.batch));
    return kept;
}

std::string refusal(const std::function<void()>& step) {
    try {
        step();
    } catch (const VelaMediaLibException& e) {
        return e.what();
    }
    return "no exception";
}

} // namespace

TEST(HistoryLifetime, AHistoryKeptPastItsProjectRefusesEveryStep) {
    const Kept kept = keepPastTheProject();
    const CommandHistoryState before = kept.history->state();
    const std::string gone = "the project of this command history has gone";
    EXPECT_EQ(refusal([&] { kept.history->undo(); }), gone);
    EXPECT_EQ(refusal([&] { kept.history->redo(); }), gone);
    EXPECT_EQ(refusal([&] { kept.history->undoAll(); }), gone);
    EXPECT_EQ(refusal([&] { kept.history->execute(MoveCmd::create(kept.track, kept.clip, 1)); }), gone);
    EXPECT_EQ(kept.history->undoStack(), before.undoStack);
    EXPECT_TRUE(kept.history->redoStack().empty());
    EXPECT_EQ(kept.clip->startTime(), 10);
}

// A composite hands its handler to its inner history only while it runs.
TEST(HistoryLifetime, ACompositesInnerHistoryKeepsNoHandlerBetweenRuns) {
    const Kept kept = keepPastTheProject();
    EXPECT_EQ(kept.batch->commandHistory().handler(), nullptr);
    EXPECT_EQ(refusal([&] { kept.batch->commandHistory().undo(); }), "no command handler");
    EXPECT_EQ(kept.clip->startTime(), 10);
}

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>
#include <VelaMediaLib/commands/edits/StretchCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>

#include <gtest/gtest.h>

using namespace VelaMediaLib;

namespace {

// Carries edits out like the project, but refuses every move of one clip.
class RefusingHandler : public ProjectIndependentCommandHandler {
public:
    MediaPtr refused;
    TrackAndMedia moveMedia(const TrackPtr& track, const MediaPtr& media, VelaTime delta) override {
        if (media == refused) return TrackAndMedia();
        return ProjectIndependentCommandHandler::moveMedia(track, media, delta);
    }
};

class TimingCommands : public ::testing::Test {
protected:
    ProjectPtr project = Project::create(30, 1);
    boost::shared_ptr<GenericTrack> track = project->timeline()->newTrack();

    TimingCommands() { project->timeline()->addTrack(project->newMixer("main"), track); }
    MediaPtr place(VelaTime start, const SafeRational& mediaDuration, const SafeRational& scalar = 1) {
        const MediaPtr media = PlaceholderMedia::createFromMediaRange(
            project->token(), project->editRateToken(), 0, 0, mediaDuration, scalar);
        track->addMedia(media, start);
        return media;
    }
    std::vector<VelaTime> starts() const {
        std::vector<VelaTime> result;
        for (const MediaPtr& media : track->medias()) result.push_back(media->startTime());
        return result;
    }
};

} // namespace

// At scalar 3/2 a 41-tick media lasts 62 ticks; trimmed at the end by 10 it
// plays 104/3 of media, and trimming back by -10 would reach 124/3, past 41.
TEST_F(TimingCommands, TrimsUndoToTheExactEarlierState) {
    const MediaPtr media = place(0, 41, SafeRational(3, 2));
    const MediaState before = media->state();
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, media, 10)));
    const MediaState trimmed = media->state();
    EXPECT_EQ(trimmed.duration, 52);
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(media->state(), before);
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(media->state(), trimmed);

    ASSERT_TRUE(project->execute(TrimStartCmd::create(track, media, 7)));
    EXPECT_EQ(media->startTime(), 7);
    project->undo();
    EXPECT_EQ(media->state(), trimmed);
    EXPECT_FALSE(project->execute(TrimStartCmd::create(track, media, -1))); // before the media's start
    EXPECT_FALSE(project->execute(TrimEndCmd::create(track, media, -20)));  // past its end
    EXPECT_EQ(media->state(), trimmed);
}

TEST_F(TimingCommands, StretchesSetTheScalarAndUndoExactly) {
    const MediaPtr media = place(0, 10);
    const MediaState before = media->state();
    ASSERT_TRUE(project->execute(StretchCmd::create(media, SafeRational(1, 3))));
    EXPECT_EQ(media->rationalMediaRange().duration(), SafeRational(10));
    EXPECT_EQ(media->duration(), 3);
    EXPECT_EQ(media->state().scalar, SafeRational(1, 3));
    project->undo();
    EXPECT_EQ(media->state(), before);
    project->redo();
    EXPECT_EQ(media->duration(), 3);
    EXPECT_FALSE(project->execute(StretchCmd::create(media, SafeRational(1, 100)))); // no tick left
    place(20, 10);
    EXPECT_FALSE(project->execute(StretchCmd::create(media, 3.0))); // onto the next clip
    const MediaPtr loose = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10);
    EXPECT_FALSE(project->execute(StretchCmd::create(loose, 2.0))); // on no track
    EXPECT_THROW(StretchCmd::create(media, 0.0), ValueException<double>);
}

TEST_F(TimingCommands, EditsOfAClipNotOnTheTrackAreRefused) {
    const MediaPtr media = place(0, 10);
    const auto other = project->timeline()->newTrack();
    EXPECT_FALSE(project->execute(MoveCmd::create(other, media, 5)));
    EXPECT_FALSE(project->execute(TrimEndCmd::create(other, media, 5)));
    EXPECT_TRUE(project->commandHistory()->undoStack().empty());
}

TEST_F(TimingCommands, ClosingGapsMovesInAnOrderWithoutCollisions) {
    const MediaPtr a = place(-25, 10), b = place(-15, 10), c = place(40, 10), d = place(50, 10);
    ASSERT_TRUE(project->execute(CloseGapsOnTrackCmd::create(track)));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 10, 20, 30}));
    EXPECT_EQ(d->startTime(), 30);
    project->undo();
    EXPECT_EQ(starts(), (std::vector<VelaTime>{-25, -15, 40, 50}));
    project->redo();
    EXPECT_FALSE(project->execute(CloseGapsOnTrackCmd::create(track))); // no gap: nothing to record
    EXPECT_EQ(project->commandHistory()->undoStack().size(), 1u);
    (void)a, (void)b, (void)c;
}

TEST_F(TimingCommands, ARefusedMoveRefusesTheWholeClosing) {
    place(5, 10);
    const MediaPtr second = place(30, 10);
    RefusingHandler handler;
    handler.refused = second;
    CommandHistory history(&handler);
    EXPECT_FALSE(history.execute(CloseGapsOnTrackCmd::create(track)));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{5, 30})); // the first clip's move rolled back
    EXPECT_TRUE(history.undoStack().empty());
}

TEST_F(TimingCommands, UndoingAnAddGivesTheClipBackItsEarlierState) {
    const MediaPtr loose = PlaceholderMedia::create(project->token(), project->editRateToken(), 3, 10);
    const MediaState before = loose->state();
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, loose, 50)));
    project->undo();
    EXPECT_FALSE(track->hasMedia(loose));
    EXPECT_EQ(loose->state(), before);
    project->redo();
    EXPECT_EQ(loose->startTime(), 50);
}

// Two moves of one clip fold into one move by their sum, which undoes to the
// state before the first; a move of another clip does not fold into a move.
TEST_F(TimingCommands, TwoMovesOfOneClipCombineIntoOneMoveByTheirSum) {
    const MediaPtr a = place(0, 10), b = place(50, 10);
    const auto first = MoveCmd::create(track, a, 5), second = MoveCmd::create(track, a, 7);
    ASSERT_TRUE(project->execute(first));
    ASSERT_TRUE(project->execute(second));
    const auto both = boost::dynamic_pointer_cast<MoveCmd>(first->combine(second));
    ASSERT_TRUE(both);
    CommandHandler& handler = project->edgeModCommandHandler();
    EXPECT_TRUE(both->unexecute(&handler));
    EXPECT_EQ(a->startTime(), 0);
    EXPECT_TRUE(both->execute(&handler));
    EXPECT_EQ(a->startTime(), 12);
    EXPECT_FALSE(boost::dynamic_pointer_cast<MoveCmd>(first->combine(MoveCmd::create(track, b, 1))));
}

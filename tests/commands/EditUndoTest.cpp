#include "../JsonTestSupport.h"
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>
#include <VelaMediaLib/commands/edits/StretchCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

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

using EditUndo = EditTest;

} // namespace

// At scalar 3/2 a 41-tick media lasts 62 ticks; trimmed at the end by 10 it
// plays 104/3 of media, and trimming back by -10 would reach 124/3, past 41.
TEST_F(EditUndo, TrimsAndStretchesUndoToTheExactEarlierState) {
    const MediaPtr media = slice(0, 41, SafeRational(3, 2));
    track->addMedia(media, 0);
    expectExactUndo(TrimEndCmd::create(track, media, 10));
    EXPECT_EQ(media->duration(), 52);
    expectExactUndo(TrimStartCmd::create(track, media, 7));
    EXPECT_EQ(media->startTime(), 7);
    expectRefused(TrimStartCmd::create(track, media, -8)); // before the media's start
    expectRefused(TrimEndCmd::create(track, media, -20));  // past its end

    const MediaPtr short10 = clip(10);
    track->addMedia(short10, 100);
    expectExactUndo(StretchCmd::create(short10, SafeRational(1, 3)));
    EXPECT_EQ(short10->state().mediaDuration, SafeRational(10));
    EXPECT_EQ(short10->duration(), 3);
    EXPECT_EQ(short10->state().scalar, SafeRational(1, 3));
    expectRefused(StretchCmd::create(short10, SafeRational(1, 100))); // no tick left
    track->addMedia(clip(10), 120);
    expectRefused(StretchCmd::create(short10, 3.0));  // onto the next clip
    expectRefused(StretchCmd::create(clip(10), 2.0)); // on no track
    EXPECT_THROW(StretchCmd::create(short10, 0.0), ValueException<double>);
}

TEST_F(EditUndo, AddsRemovesAndEditsOfAClipElsewhere) {
    const MediaPtr loose = PlaceholderMedia::create(project->token(), project->editRateToken(), 3, 10);
    clips.push_back(loose);
    expectExactUndo(AddMediaCmd::create(track, loose, 50));
    EXPECT_EQ(loose->startTime(), 50);
    expectRefused(AddMediaCmd::create(track, clip(10), 55)); // collides
    expectRefused(MoveCmd::create(track, place(0, 10), 45)); // onto it
    const auto outside = project->timeline()->newTrack();    // not in the project either
    expectRefused(MoveCmd::create(outside, loose, 5));
    expectRefused(TrimEndCmd::create(outside, loose, 5));
    expectExactUndo(RemoveMediaCmd::create(track, loose));
    EXPECT_FALSE(track->hasMedia(loose));
    expectRefused(RemoveMediaCmd::create(track, MediaPtr())); // no clip to take off
}

TEST_F(EditUndo, ClosingGapsMovesInAnOrderWithoutCollisions) {
    for (VelaTime start : {-25, -15, 40, 50}) track->addMedia(clip(10), start);
    expectExactUndo(CloseGapsOnTrackCmd::create(track));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 10, 20, 30}));
    expectRefused(CloseGapsOnTrackCmd::create(track)); // no gap: nothing to record
    EXPECT_EQ(thrown<VelaMediaLibException>([] { CloseGapsOnTrackCmd::create(TrackPtr()); }),
              "no track to close gaps on");
}

TEST_F(EditUndo, ARefusedMoveRefusesTheWholeClosing) {
    track->addMedia(clip(10), 5);
    RefusingHandler handler;
    handler.refused = clip(10);
    track->addMedia(handler.refused, 30);
    CommandHistory history(&handler);
    EXPECT_FALSE(history.execute(CloseGapsOnTrackCmd::create(track)));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{5, 30})); // the first clip's move rolled back
    EXPECT_TRUE(history.undoStack().empty());
}

// Two moves of one clip fold into one move by their sum, which undoes to the
// state before the first; a move of another clip does not fold into a move.
TEST_F(EditUndo, TwoMovesOfOneClipCombineIntoOneMoveByTheirSum) {
    const MediaPtr a = place(0, 10), b = place(50, 10);
    const auto first = MoveCmd::create(track, a, 5), second = MoveCmd::create(track, a, 7);
    ASSERT_TRUE(project->execute(first) && project->execute(second));
    const auto both = boost::dynamic_pointer_cast<MoveCmd>(first->combine(second));
    ASSERT_TRUE(both);
    CommandHandler& handler = dynamic_cast<InternalProject&>(*project);
    EXPECT_TRUE(both->unexecute(&handler));
    EXPECT_EQ(a->startTime(), 0);
    EXPECT_TRUE(both->execute(&handler));
    EXPECT_EQ(a->startTime(), 12);
    EXPECT_FALSE(boost::dynamic_pointer_cast<MoveCmd>(first->combine(MoveCmd::create(track, b, 1))));
}

// Adding a clip joins transitions with its touching neighbours; undoing the
// add, or a removal, must give every clip involved its own slots back, and
// every transition its own links.
TEST_F(EditUndo, TransitionsJoinedOrPartedByAnEditComeBackExactly) {
    const auto tenOfTwenty = [&] { // five more ticks to either side
        const MediaPtr made = slice(0, 20);
        made->trimStart(5);
        made->trimEnd(5);
        return made;
    };
    const MediaPtr a = tenOfTwenty(), b = tenOfTwenty(), c = tenOfTwenty();
    track->addMedia(a, 0);
    track->addMedia(c, 20);
    const TransitionPtr ta = transition(), tb2 = transition();
    a->setRightTransition(ta);
    c->setLeftTransition(transition());
    b->setLeftTransition(transition());
    b->setRightTransition(tb2);
    expectExactUndo(AddMediaCmd::create(track, b, 10));
    EXPECT_EQ(b->leftTransition(), ta);  // joined with a's
    EXPECT_EQ(c->leftTransition(), tb2); // b's joined with c

    // Two clips that meet with transitions of their own (set directly):
    // putting the removed one back would join them into one.
    const auto apart = newTrack();
    const MediaPtr d = tenOfTwenty(), e = tenOfTwenty();
    apart->addMedia(d, 0);
    apart->addMedia(e, 10);
    d->setRightTransition(transition());
    e->setLeftTransition(transition());
    expectExactUndo(RemoveMediaCmd::create(apart, e));

    // Moves and trims that part two clips sharing a transition, or bring two together.
    const auto shared = newTrack();
    const MediaPtr f = tenOfTwenty(), g = tenOfTwenty(), h = tenOfTwenty();
    f->setRightTransition(transition());
    ASSERT_TRUE(project->execute(AddMediaCmd::create(shared, f, 0)));
    ASSERT_TRUE(project->execute(AddMediaCmd::create(shared, g, 10)));
    h->setLeftTransition(transition());
    ASSERT_TRUE(project->execute(AddMediaCmd::create(shared, h, 25)));
    for (const CommandPtr& command :
         {CommandPtr(MoveCmd::create(shared, g, 5)), CommandPtr(TrimEndCmd::create(shared, g, -5)),
          CommandPtr(TrimStartCmd::create(shared, h, -5)), CommandPtr(MoveCmd::create(shared, f, -3))}) {
        expectExactUndo(command);
        project->undo();
    }
}

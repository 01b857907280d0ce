// The two rules every edit keeps for transitions: a transition has one clip on
// each side, and that clip holds it (its link and the clip's slot name each
// other); a clip keeps room for its transitions, at least their lengths
// together less one tick.
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/AddTransitionCmd.h>
#include <VelaMediaLib/commands/edits/ChangeProjectEditRateCmd.h>
#include <VelaMediaLib/commands/edits/RestoreDeletionPointAtTimeCmd.h>
#include <VelaMediaLib/commands/edits/RippleDeleteRangeAndCreateDeletionPointCmd.h>
#include <VelaMediaLib/commands/edits/SetMediaStateCmd.h>
#include <VelaMediaLib/commands/edits/StitchMediaCmd.h>
#include <VelaMediaLib/commands/edits/StretchCmd.h>
#include <VelaMediaLib/commands/edits/StretchTrimCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/commands/edits/UnstitchMediaCmd.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/commands/edits/CreateGroupCmd.h>
#include <VelaMediaLib/model/media/Group.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class TransitionRoom : public EditTest {
protected:
    TransitionPtr put(const MediaPtr& media, VelaTime length, TransitionEditCmd::Side side) {
        const TransitionPtr made = transition();
        made->setDuration(length);
        EXPECT_TRUE(project->execute(AddTransitionCmd::create(track, media, made, side)));
        return made;
    }
};

// b is pulled away from a, both keeping their shared transition; c placed
// against a takes it over, and b lets go. Undo gives b its slot back.
TEST_F(TransitionRoom, AClipTakingAHeldTransitionOverLeavesNoSlotBehind) {
    const MediaPtr a = place(0, 10), b = place(10, 10);
    const TransitionPtr shared = put(a, 4, TransitionEditCmd::Right);
    ASSERT_EQ(b->leftTransition(), shared);
    ASSERT_TRUE(project->execute(MoveCmd::create(track, b, 10)));
    ASSERT_EQ(b->leftTransition(), shared); // pulled apart, both hold it

    const MediaPtr c = clip(10);
    expectExactDocumentUndo(AddMediaCmd::create(track, c, 10));
    EXPECT_EQ(c->leftTransition(), shared);
    EXPECT_EQ(shared->rightMedia(), c);
    EXPECT_FALSE(b->leftTransition());
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(b->leftTransition(), shared);
    EXPECT_EQ(shared->rightMedia(), b);
    EXPECT_EQ(shared->leftMedia(), a);
}

// Placing a clip too short for the transition of its neighbour leaves both
// as they were; a clip holding transitions longer than it allows is refused.
TEST_F(TransitionRoom, PlacingJoinsOnlyWhereBothClipsHaveRoom) {
    const MediaPtr a = place(0, 20);
    const TransitionPtr fade = put(a, 8, TransitionEditCmd::Right);
    const MediaPtr shortOne = place(20, 5);
    EXPECT_FALSE(shortOne->leftTransition());
    EXPECT_EQ(fade->leftMedia(), a);
    EXPECT_FALSE(fade->rightMedia());

    const MediaPtr loose = clip(4);
    loose->setLeftTransition(TransitionPtr(new Transition("long", 6)));
    expectRefusedDocument(AddMediaCmd::create(track, loose, 40));
}

// A clip with 6-tick transitions on both edges keeps 11 ticks: a trim may
// leave that much, and no stretch, stretch trim or set state leaves less.
TEST_F(TransitionRoom, StretchesAndStatesKeepTheRoomATrimKeeps) {
    const MediaPtr a = place(0, 20);
    put(a, 6, TransitionEditCmd::Left);
    put(a, 6, TransitionEditCmd::Right);
    expectRefusedDocument(StretchCmd::create(a, SafeRational(1, 2)));
    // The model itself refuses it, to a host editing without commands too.
    EXPECT_THROW(track->stretch(a, SafeRational(1, 2)), ValueException<double>);
    EXPECT_THROW(a->trackRangeWithRationalStretch(SafeRational(1, 2)), ValueException<double>);
    EXPECT_EQ(a->duration(), 20);
    expectRefusedDocument(StretchTrimEndCmd::create(a, 10));
    expectRefusedDocument(StretchTrimStartCmd::create(a, 10));
    MediaState tooShort = a->state();
    tooShort.duration = 10;
    tooShort.mediaDuration = SafeRational(10);
    expectRefusedDocument(SetMediaStateCmd::create(a, tooShort));
    expectRefusedDocument(TrimEndCmd::create(track, a, 10));
    expectExactDocumentUndo(StretchTrimEndCmd::create(a, 9));
    ASSERT_TRUE(project->undo());
    expectExactDocumentUndo(TrimEndCmd::create(track, a, 9));
    EXPECT_EQ(a->duration(), 11);
    ASSERT_TRUE(project->undo());
    expectExactDocumentUndo(StretchCmd::create(a, SafeRational(11, 20))); // to the least exactly
    EXPECT_EQ(a->duration(), 11);
}

// The trim left the clip at its least: the finer rate rounds each length on
// its own, and the longer transition gives the missing tick back; the way
// back lands on the same ticks.
TEST_F(TransitionRoom, AnEditRateChangeFitsTheTransitionsAndGoesBackExactly) {
    const MediaPtr a = place(0, 20);
    const TransitionPtr left = put(a, 6, TransitionEditCmd::Left),
                        right = put(a, 6, TransitionEditCmd::Right);
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, a, 9)));
    const std::string atThirty = document();
    ASSERT_TRUE(project->execute(ChangeProjectEditRateCmd::create(60000, 1001)));
    EXPECT_EQ(a->duration(), 22);
    EXPECT_EQ(left->duration() + right->duration(), 23);
    ASSERT_TRUE(project->execute(ChangeProjectEditRateCmd::create(30, 1)));
    EXPECT_EQ(document(), atThirty);
}

// A transition whose clips stand on two tracks is held on both: a rate
// change scales it once.
TEST_F(TransitionRoom, ATransitionOnTwoTracksIsScaledOnce) {
    const MediaPtr a = place(0, 20);
    const TransitionPtr fade = put(a, 6, TransitionEditCmd::Right);
    const MediaPtr b = clip(20);
    ASSERT_TRUE(project->execute(AddMediaCmd::create(newTrack(), b, 20)));
    b->setLeftTransition(fade);
    ASSERT_TRUE(project->execute(ChangeProjectEditRateCmd::create(60, 1)));
    EXPECT_EQ(fade->duration(), 12);
}

// A clip r on the fixture's track, trimmed to its least, holding a 6-tick
// transition it shares with a clip on `upper` (pulled there from beside it)
// and a 6-tick one with the clip after it.
struct SharedAcross {
    MediaPtr r;
    TransitionPtr cross, local;
};

class TransitionAcross : public TransitionRoom {
protected:
    SharedAcross build(const boost::shared_ptr<GenericTrack>& upper) {
        SharedAcross made;
        const MediaPtr l = clip(20), n = clip(20);
        made.r = clip(20);
        made.cross = transition();
        made.cross->setDuration(6);
        EXPECT_TRUE(project->execute(AddMediaCmd::create(upper, l, 0)));
        EXPECT_TRUE(project->execute(AddMediaCmd::create(upper, made.r, 20)));
        EXPECT_TRUE(
            project->execute(AddTransitionCmd::create(upper, l, made.cross, TransitionEditCmd::Right)));
        EXPECT_TRUE(project->execute(RemoveMediaCmd::create(upper, made.r)));
        EXPECT_TRUE(project->execute(AddMediaCmd::create(track, made.r, 20)));
        EXPECT_TRUE(project->execute(AddMediaCmd::create(track, n, 40)));
        made.local = put(made.r, 6, TransitionEditCmd::Right);
        EXPECT_TRUE(project->execute(TrimEndCmd::create(track, made.r, 9)));
        return made;
    }
    // To the finer rate, where the clip is fitted, and back to 30.
    void expectFittedAndBack(const SharedAcross& made) {
        const std::string atThirty = document();
        ASSERT_TRUE(project->execute(ChangeProjectEditRateCmd::create(60000, 1001)));
        EXPECT_EQ(made.r->duration(), 22);
        EXPECT_EQ(made.cross->duration() + made.local->duration(), 23);
        ASSERT_TRUE(project->execute(ChangeProjectEditRateCmd::create(30, 1)));
        EXPECT_EQ(document(), atThirty);
    }
};

// The transition's right clip stands on the first track, its left clip on
// the second: it is scaled once, and only then fitted.
TEST_F(TransitionAcross, TwoTracks) {
    const SharedAcross made = build(newTrack());
    expectFittedAndBack(made);
    ASSERT_TRUE(project->execute(ChangeProjectEditRateCmd::create(15, 1)));
    EXPECT_EQ(made.cross->duration(), 3); // 6 → 12 → 11 (fitted) → 6 → 3: halved once
}

// The two tracks in two mixers: the project's change fits once every mixer
// is scaled.
TEST_F(TransitionAcross, TwoMixers) {
    const auto second = project->newMixer("second");
    tracks.push_back(project->timeline()->newTrack());
    project->timeline()->addTrack(second, tracks.back());
    expectFittedAndBack(build(tracks.back()));
}

// A cut whose pieces stand as the delete left them is joined again; a clip
// between a transition's pulled-apart clips keeps the transition it was
// given since, and the restore's undo needs no room the trims gave up.
TEST_F(TransitionRoom, RestoringADeletionPointLeavesOtherClipsTransitionsAlone) {
    const MediaPtr p = place(0, 20), n = place(20, 10);
    const TransitionPtr t = put(p, 4, TransitionEditCmd::Right);
    ASSERT_TRUE(project->execute(MoveCmd::create(track, n, 20))); // both keep t
    const MediaPtr m = place(25, 10);
    const auto cut = RippleDeleteRangeAndCreateDeletionPointCmd::create(Range<VelaTime>(5, 3));
    cut->addTrack(track);
    ASSERT_TRUE(project->execute(cut));
    const TransitionPtr x = put(m, 2, TransitionEditCmd::Left);
    const auto restore = RestoreDeletionPointAtTimeCmd::create(5);
    restore->addTrack(track);
    expectExactDocumentUndo(restore);
    EXPECT_EQ(m->leftTransition(), x);
    EXPECT_EQ(n->leftTransition(), t);
}

TEST_F(TransitionRoom, UndoingARestoreAsksForNoRoom) {
    const MediaPtr p = place(0, 20), n = place(20, 10);
    put(p, 4, TransitionEditCmd::Right);
    const auto cut = RippleDeleteRangeAndCreateDeletionPointCmd::create(Range<VelaTime>(5, 3));
    cut->addTrack(track);
    ASSERT_TRUE(project->execute(cut));
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, n, 7))); // 3 ticks for 4: a trim allows it
    const auto restore = RestoreDeletionPointAtTimeCmd::create(5);
    restore->addTrack(track);
    expectExactDocumentUndo(restore);
}

// The stitched clip's transitions go to its end parts only where they fit.
TEST_F(TransitionRoom, UnstitchingRefusesAnEndPartTooShortForItsTransition) {
    const MediaPtr a = place(0, 10), b = place(10, 10);
    const auto stitch = StitchMediaCmd::create(track, {a, b});
    ASSERT_TRUE(project->execute(stitch));
    const MediaPtr stitched = stitch->stitchedMedia();
    put(stitched, 15, TransitionEditCmd::Left);
    expectRefusedDocument(UnstitchMediaCmd::create(track, stitched));
}

struct StretchCounter : Observer {
    int count = 0;
    void update(Observable*) override { ++count; }
};

// A refused model stretch of a clip sharing a transition with a touching
// neighbour leaves the document, the neighbour and the observers alone.
TEST_F(TransitionRoom, ARefusedModelStretchLeavesEverythingAlone) {
    const MediaPtr a = place(0, 20), b = place(20, 20);
    const TransitionPtr shared = put(a, 6, TransitionEditCmd::Right);
    put(a, 6, TransitionEditCmd::Left);
    ASSERT_EQ(b->leftTransition(), shared);
    StretchCounter onA, onB;
    a->attach(&onA);
    b->attach(&onB);
    const std::string before = document();
    EXPECT_THROW(a->rationalStretch(SafeRational(1, 2)), ValueException<double>);
    EXPECT_THROW(track->stretch(a, 0.5), ValueException<double>);
    EXPECT_THROW(a->trackRangeWithStretch(0.5), ValueException<double>);
    EXPECT_EQ(document(), before);
    EXPECT_EQ(onA.count + onB.count, 0);
    EXPECT_EQ(track->mediaAtTime(20), Track::Pair(a, b));
    EXPECT_EQ(a->trackRangeWithRationalStretch(SafeRational(11, 20)).duration(), 11);
    a->detach(&onA);
    b->detach(&onB);
    // Off the track the clip refuses the same.
    ASSERT_TRUE(project->execute(RemoveMediaCmd::create(track, a)));
    const MediaState off = a->state();
    EXPECT_THROW(a->rationalStretch(SafeRational(1, 2)), ValueException<double>);
    EXPECT_TRUE(a->state() == off);
}

// A group and a stitched clip count their own transitions, not their parts'.
TEST_F(TransitionRoom, GroupsAndStitchedClipsKeepTheirOwnRoom) {
    const MediaPtr a = place(0, 10), b = place(10, 10);
    const auto group = CreateGroupCmd::create({a, b});
    ASSERT_TRUE(project->execute(group));
    const MediaPtr g = group->createdGroup();
    ASSERT_EQ(g->duration(), 20);
    put(g, 6, TransitionEditCmd::Left);
    put(g, 6, TransitionEditCmd::Right);
    expectRefusedDocument(StretchCmd::create(g, SafeRational(1, 2)));
    EXPECT_THROW(g->rationalStretch(SafeRational(1, 2)), ValueException<double>);
    expectExactDocumentUndo(StretchCmd::create(g, SafeRational(11, 20)));
    ASSERT_TRUE(project->undo());
    // Inside the group the clip's own transitions count (it has none).
    ASSERT_TRUE(project->execute(StretchCmd::create(a, SafeRational(1, 5))));
    EXPECT_EQ(a->duration(), 2);
    ASSERT_TRUE(project->undo());

    const MediaPtr c = place(40, 10), d = place(50, 10);
    const auto stitch = StitchMediaCmd::create(track, {c, d});
    ASSERT_TRUE(project->execute(stitch));
    const MediaPtr s = stitch->stitchedMedia();
    put(s, 6, TransitionEditCmd::Left);
    put(s, 6, TransitionEditCmd::Right);
    expectRefusedDocument(StretchCmd::create(s, SafeRational(1, 2)));
    expectExactDocumentUndo(StretchCmd::create(s, SafeRational(11, 20)));
}

// A redo and an undo put states back without asking for room: the host
// lengthens the transitions between them.
TEST_F(TransitionRoom, UndoAndRedoOfAStretchAskNoRoom) {
    const MediaPtr a = place(0, 20);
    const TransitionPtr l = put(a, 4, TransitionEditCmd::Left), r = put(a, 4, TransitionEditCmd::Right);
    ASSERT_TRUE(project->execute(StretchCmd::create(a, SafeRational(1, 2))));
    project->commandHistory()->combineNextCommand();
    ASSERT_TRUE(project->execute(StretchCmd::create(a, SafeRational(2, 5)))); // combined: 8 ticks
    EXPECT_EQ(steps(), 4u);
    EXPECT_EQ(a->duration(), 8);
    ASSERT_TRUE(project->undo());
    l->setDuration(9);
    r->setDuration(9);
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(a->duration(), 8);
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(a->duration(), 20);
}

} // namespace

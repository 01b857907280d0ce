// Trims with the effects that follow their edge, stretch trims, and the
// folding of two edits of the same kind into one undo step.
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/StretchCmd.h>
#include <VelaMediaLib/commands/edits/StretchTrimCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/effects/StoredEffect.h>
#include <VelaMediaLib/model/media/MediaImpl.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class TrimCommand : public EditTest {};

TEST_F(TrimCommand, MagnetizedEffectsFollowTheTrimmedEdge) {
    const MediaPtr media = place(10, 100);
    media->addEffect(storedEffect("CursorPath", 0, 100));        // follows both edges
    media->addEffect(storedEffect("DeviceFrameEffect", 20, 80)); // reaches the end only
    media->addEffect(storedEffect("Blur", 0, 100));              // not magnetized
    const EdgeEffects found = magneticEffectsForMedia(media);
    ASSERT_EQ(found.size(), 2u);
    EXPECT_EQ(found[1].range, Range<VelaTime>(30, 80)); // in project ticks

    expectExactDocumentUndo(TrimEndCmd::create(track, media, 30));
    EXPECT_EQ(media->allEffects()[0]->timeRange(), Range<VelaTime>(0, 70));
    EXPECT_EQ(media->allEffects()[1]->timeRange(), Range<VelaTime>(20, 50));
    EXPECT_EQ(media->allEffects()[2]->timeRange(), Range<VelaTime>(0, 100));

    expectExactDocumentUndo(TrimStartCmd::create(track, media, 10));
    EXPECT_EQ(media->allEffects()[0]->timeRange(), Range<VelaTime>(0, 60));
    // The others stay where they were on the time line: the clip's ticks now count from 20.
    EXPECT_EQ(media->allEffects()[1]->timeRange(), Range<VelaTime>(10, 50));
    EXPECT_EQ(media->allEffects()[2]->timeRange(), Range<VelaTime>(-10, 100));
}

TEST_F(TrimCommand, AStartTrimKeepsKeyframesAndAnimationsWithTheContent) {
    const MediaPtr media = place(0, 100);
    const auto opacity = opacityOf(media);
    opacity->addKeyFrame(RationalTime(40), 0.25, RationalTime(0));
    opacity->addKeyFrame(RationalTime(80), 1.0, RationalTime(40));
    const double at60 = opacity->valueAtTime(RationalTime(60));
    AnimationTrack::Animation animation;
    animation.range = Range<long long>(50, 20);
    animation.endTime = 70;
    animation.duration = 20;
    boost::dynamic_pointer_cast<MediaImpl>(media)->setAnimationTrack(AnimationTrack("opacity", {animation}));
    const std::string before = document();

    ASSERT_TRUE(project->execute(TrimStartCmd::create(track, media, 15)));
    ASSERT_TRUE(project->execute(TrimStartCmd::create(track, media, -5)));
    project->commandHistory()->combineLastCommands();
    EXPECT_EQ(opacity->valueAtTime(RationalTime(50)), at60); // the same tick of the time line
    const auto moved =
        boost::dynamic_pointer_cast<MediaImpl>(media)->animationTracks().at("opacity").animations().at(0);
    EXPECT_EQ(moved.range, Range<long long>(40, 20));
    const std::string after = document();
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), before);
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(document(), after);
    // A trim at the end moves nothing inside.
    expectExactDocumentUndo(TrimEndCmd::create(track, media, 10));
    EXPECT_EQ(opacity->valueAtTime(RationalTime(50)), at60);
}

TEST_F(TrimCommand, AnEffectTheEdgeWouldLeaveWithoutATickKeepsItsRange) {
    const MediaPtr media = place(0, 100);
    media->addEffect(storedEffect("CursorPath", 90, 10));
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, media, 20)));
    EXPECT_EQ(media->allEffects()[0]->timeRange(), Range<VelaTime>(90, 10));
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, media, -20, EdgeEffects())));
    EXPECT_EQ(media->allEffects()[0]->timeRange(), Range<VelaTime>(90, 10)); // no followers given
}

TEST_F(TrimCommand, TwoMovesOrTrimsOfOneClipFoldIntoOneUndoStep) {
    const MediaPtr media = place(0, 100);
    media->addEffect(storedEffect("CursorPath", 0, 100));
    const std::string start = document();
    const size_t before = steps();
    ASSERT_TRUE(project->execute(MoveCmd::create(track, media, 5)));
    ASSERT_TRUE(project->execute(MoveCmd::create(track, media, 7)));
    project->commandHistory()->combineLastCommands();
    EXPECT_EQ(steps(), before + 1);
    EXPECT_EQ(media->startTime(), 12);

    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, media, 10)));
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, media, 15)));
    project->commandHistory()->combineLastCommands();
    EXPECT_EQ(steps(), before + 2);
    const auto both = boost::dynamic_pointer_cast<TrimEndCmd>(project->commandHistory()->undoStack().back());
    ASSERT_TRUE(both);
    EXPECT_EQ(both->amount(), 25);
    const std::string trimmed = document();
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(12, 100));
    EXPECT_EQ(media->allEffects()[0]->timeRange(), Range<VelaTime>(0, 100));
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(document(), trimmed);

    // A trim of the other edge does not fold into one command of its kind.
    ASSERT_TRUE(project->execute(TrimStartCmd::create(track, media, 5)));
    project->commandHistory()->combineLastCommands();
    EXPECT_FALSE(boost::dynamic_pointer_cast<EdgeTrimCmd>(project->commandHistory()->undoStack().back()));
    while (steps() > before) ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), start);
}

TEST_F(TrimCommand, TwoStretchesFoldAndUndoExactly) {
    const MediaPtr media = slice(0, 30);
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, media, 0)));
    const std::string before = document();
    ASSERT_TRUE(project->execute(StretchCmd::create(media, SafeRational(2))));
    ASSERT_TRUE(project->execute(StretchCmd::create(media, 0.5)));
    project->commandHistory()->combineLastCommands();
    EXPECT_TRUE(boost::dynamic_pointer_cast<StretchCmd>(project->commandHistory()->undoStack().back()));
    EXPECT_EQ(media->duration(), 15);
    const std::string after = document();
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), before);
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(document(), after);
}

TEST_F(TrimCommand, StretchTrimsKeepTheSliceAndTheOtherEdge) {
    const MediaPtr media = slice(SafeRational(5), 30);
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, media, 20)));
    expectExactDocumentUndo(StretchTrimEndCmd::create(media, 10));
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(20, 20));
    EXPECT_EQ(media->state().mediaRange(), Range<SafeRational>(SafeRational(5), SafeRational(30)));
    EXPECT_EQ(media->rationalScalar(), SafeRational(2, 3));
    expectExactDocumentUndo(StretchTrimStartCmd::create(media, -15));
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(5, 35));
    EXPECT_EQ(media->rationalScalar(), SafeRational(35, 30));
    place(0, 5);
    expectRefused(StretchTrimStartCmd::create(media, -1)); // into the clip before
    expectRefused(StretchTrimEndCmd::create(media, 35));   // nothing left
    expectRefused(StretchTrimEndCmd::create(clip(10), 1)); // on no track
}

} // namespace

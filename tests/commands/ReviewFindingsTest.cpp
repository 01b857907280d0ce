// Edits in combination, checked on the written project: each is undone and
// redone twice with the document compared byte for byte, and what is written
// must read back to the same text.
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/AddEdgeModCmd.h>
#include <VelaMediaLib/commands/edits/AddTransitionCmd.h>
#include <VelaMediaLib/commands/edits/ApplySerializedParameterValuesToMediaCmd.h>
#include <VelaMediaLib/commands/edits/ChangeProjectEditRateCmd.h>
#include <VelaMediaLib/commands/edits/DuplicateMediaCmd.h>
#include <VelaMediaLib/commands/edits/EdgeModCloneCmd.h>
#include <VelaMediaLib/commands/edits/ExtendMediaCmd.h>
#include <VelaMediaLib/commands/edits/InsertTimeCmd.h>
#include <VelaMediaLib/commands/edits/MoveEdgeModCmd.h>
#include <VelaMediaLib/commands/edits/RemoveRangeMediaCmd.h>
#include <VelaMediaLib/commands/edits/RippleMoveCmd.h>
#include <VelaMediaLib/commands/edits/RemoveTransitionCmd.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>
#include <VelaMediaLib/commands/edits/StretchCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/document/CopyRangeClippingCmd.h>
#include <VelaMediaLib/document/PasteClippingCmd.h>
#include <VelaMediaLib/effects/StoredEffect.h>
#include <VelaMediaLib/model/media/MediaImpl.h>

#include <boost/make_shared.hpp>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

EdgeModificationPtr fade(VelaTime duration) {
    return boost::make_shared<EdgeModification>(duration, "fade", 0);
}

class ReviewFindings : public EditTest {
protected:
    // Execute, then undo and redo twice: the documents before and after each time.
    void expectTwiceExact(const CommandPtr& command) {
        const std::string before = document();
        ASSERT_TRUE(project->execute(command)) << command->name();
        const std::string after = document();
        EXPECT_NE(after, before);
        expectUndoRedoTwice(before, after, command->name());
    }
    // Undo gives `before` and redo `after`, twice over.
    void expectUndoRedoTwice(const std::string& before, const std::string& after,
                             const std::string& what = "") {
        for (int round = 0; round < 2; ++round) {
            ASSERT_TRUE(project->undo()) << what;
            EXPECT_EQ(document(), before) << what << " undo " << round;
            ASSERT_TRUE(project->redo()) << what;
            EXPECT_EQ(document(), after) << what << " redo " << round;
        }
    }
    void expectReadsBack() {
        const std::string written = document();
        const ProjectPtr read = projectFromJSONString(written);
        EXPECT_EQ(projectToJSONString(*read, true), written);
    }
    // A clip with keyframes, an animation, effects and fades, and a neighbour
    // sharing a transition with it.
    MediaPtr richClip() {
        const MediaPtr media = place(0, 90);
        place(90, 30);
        const auto opacity = opacityOf(media);
        opacity->addKeyFrame(RationalTime(5), 0.25, RationalTime(0));
        opacity->addKeyFrame(RationalTime(70), 1.0, RationalTime(30));
        AnimationTrack::Animation animation;
        animation.range = Range<long long>(10, 40);
        animation.endTime = 50;
        animation.duration = 20;
        boost::dynamic_pointer_cast<MediaImpl>(media)->setAnimationTrack(
            AnimationTrack("opacity", {animation}));
        media->addEffect(storedEffect("Glow", 20, 50));
        media->addEffect(storedEffect("DeviceFrameEffect", 0, 90));
        media->addLeftEdgeModification(fade(15));
        media->addRightEdgeModification(fade(12));
        EXPECT_TRUE(
            project->execute(AddTransitionCmd::create(track, media, transition(), TransitionEditCmd::Right)));
        return media;
    }
};

TEST_F(ReviewFindings, SplitOfARichClipUndoesAndRedoesTwiceAndReadsBack) {
    richClip();
    expectTwiceExact(SplitCmd::create(track, 40));
    expectReadsBack();
}

TEST_F(ReviewFindings, SplitThenCombinedTrimsUndoAsOneStep) {
    const MediaPtr media = richClip();
    ASSERT_TRUE(project->execute(SplitCmd::create(track, 40)));
    const std::string split = document();
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, media, 5)));
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, media, 4)));
    project->combineLastCommands();
    const std::string trimmed = document();
    expectUndoRedoTwice(split, trimmed);
    expectReadsBack();
}

TEST_F(ReviewFindings, RateChangeAfterASplitGoesBackExactly) {
    richClip();
    ASSERT_TRUE(project->execute(SplitCmd::create(track, 37)));
    const std::string split = document();
    expectTwiceExact(ChangeProjectEditRateCmd::create(60000, 1001));
    expectReadsBack();
    ASSERT_TRUE(project->execute(ChangeProjectEditRateCmd::create(30, 1)));
    EXPECT_EQ(document(), split);
}

TEST_F(ReviewFindings, StretchesCombinedUndoAndRedoTwice) {
    const MediaPtr media = place(0, 60);
    const std::string before = document();
    ASSERT_TRUE(project->execute(StretchCmd::create(media, SafeRational(3, 2))));
    ASSERT_TRUE(project->execute(StretchCmd::create(media, SafeRational(1, 2))));
    project->combineLastCommands();
    const std::string after = document();
    expectUndoRedoTwice(before, after);
}

TEST_F(ReviewFindings, ValuesOnAFreshClipUndoTwice) {
    const MediaPtr media = place(0, 60);
    expectTwiceExact(ApplySerializedParameterValuesToMediaCmd::create(media, "{\"opacity\": 0.5}"));
}

// A fade is one clip's: adding another clip's fade would share one object,
// so that moving it on one clip would change the other's document too.
TEST_F(ReviewFindings, AnotherClipsFadeIsNotAdded) {
    const MediaPtr a = place(0, 60), b = place(100, 60);
    const EdgeModificationPtr shared = fade(10);
    ASSERT_TRUE(project->execute(AddRightEdgeModCmd::create(a, shared)));
    const std::string before = document();
    const size_t stepsBefore = steps();
    EXPECT_THROW(project->execute(AddRightEdgeModCmd::create(b, shared)), AddRemoveException);
    EXPECT_EQ(document(), before);
    EXPECT_EQ(steps(), stepsBefore);
}

// A trim of a transition to the length it has changes nothing: no step.
TEST_F(ReviewFindings, TransitionTrimToItsOwnLengthIsRefused) {
    const MediaPtr a = place(0, 60);
    place(60, 60);
    const TransitionPtr t = transition();
    ASSERT_TRUE(project->execute(AddTransitionCmd::create(track, a, t, TransitionEditCmd::Right)));
    const std::string before = document();
    const size_t stepsBefore = steps();
    EXPECT_FALSE(project->execute(TrimTransitionCmd::create(track, t, t->duration())));
    EXPECT_EQ(document(), before);
    EXPECT_EQ(steps(), stepsBefore);
}

TEST_F(ReviewFindings, CutAndPasteOfARichClipUndoTwice) {
    richClip();
    const auto cut = CutRangeClippingCmd::create({track}, Range<VelaTime>(30, 40));
    expectTwiceExact(cut);
    expectReadsBack();
    expectTwiceExact(PasteClippingCmd::create(cut->clippingText(), {track}, 200));
    expectReadsBack();
}

TEST_F(ReviewFindings, SplitOnAMagneticTrackUndoesTwice) {
    track->magneticAttribute()->setValue(true);
    richClip();
    expectTwiceExact(SplitCmd::create(track, 40));
    expectReadsBack();
}

TEST_F(ReviewFindings, CompositesOnARichClipUndoTwiceAndReadBack) {
    const MediaPtr media = richClip();
    const auto insert = InsertTimeCmd::create(Range<VelaTime>(33, 17));
    insert->addTrack(track);
    expectTwiceExact(insert);
    expectReadsBack();
    const auto remove = RemoveRangeMediaCmd::create(Range<VelaTime>(20, 30));
    remove->addTrack(track);
    expectTwiceExact(remove);
    expectReadsBack();
    expectTwiceExact(DuplicateMediaCmd::create({media}));
    expectTwiceExact(RippleMoveCmd::create(track, media, 7));
    expectTwiceExact(EdgeModCloneCmd::create(media, track->medias().back(), ""));
    expectReadsBack();
}

TEST_F(ReviewFindings, ExtendAndReduceOfARichClipUndoTwice) {
    const MediaPtr media = slice(20, 200);
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, media, 50)));
    opacityOf(media)->addKeyFrame(RationalTime(10), 0.5, RationalTime(0));
    media->addEffect(storedEffect("DeviceFrameEffect", 0, 200));
    media->addRightEdgeModification(fade(12));
    expectTwiceExact(ReduceMediaCmd::create(media, 10, 15));
    expectTwiceExact(ExtendMediaCmd::create(media, 10, 15));
    expectReadsBack();
}

TEST_F(ReviewFindings, CombinedStartTrimsAndMovesUndoTwice) {
    const MediaPtr media = slice(0, 100);
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, media, 0)));
    media->addEffect(storedEffect("DeviceFrameEffect", 0, 100));
    opacityOf(media)->addKeyFrame(RationalTime(50), 0.5, RationalTime(10));
    const std::string before = document();
    ASSERT_TRUE(project->execute(TrimStartCmd::create(track, media, 10)));
    ASSERT_TRUE(project->execute(TrimStartCmd::create(track, media, 5)));
    project->combineLastCommands();
    ASSERT_TRUE(project->execute(MoveCmd::create(track, media, 7)));
    ASSERT_TRUE(project->execute(MoveCmd::create(track, media, 3)));
    project->combineLastCommands();
    project->combineLastCommands();
    ASSERT_EQ(steps(), 2u); // the placing, and the gesture
    const std::string after = document();
    expectUndoRedoTwice(before, after);
    expectReadsBack();
}

// A copied part cut at the range's end keeps its edge-following effects
// within it, as the left part of a split does.
TEST_F(ReviewFindings, ACopiedPartKeepsItsFrameWithinIt) {
    const MediaPtr media = place(0, 90);
    media->addEffect(storedEffect("DeviceFrameEffect", 0, 90));
    const MixerPtr clipping = CopyRangeClippingCmd::clippingOf({track}, Range<VelaTime>(30, 40));
    const MediaPtr copy = clipping->tracks().front()->medias().front();
    ASSERT_EQ(copy->duration(), 40);
    EXPECT_EQ(copy->allEffects().front()->timeRange(), Range<VelaTime>(0, 40));
}

TEST_F(ReviewFindings, ACopiedPartCutAtTheRangesEndLeavesItsFadeOutBehind) {
    const MediaPtr media = place(0, 90);
    media->addLeftEdgeModification(boost::make_shared<EdgeModification>(5, "audioFade", 0.0));
    media->addRightEdgeModification(boost::make_shared<EdgeModification>(10, "audioFade", 0.0));
    const MixerPtr clipping = CopyRangeClippingCmd::clippingOf({track}, Range<VelaTime>(0, 40));
    const MediaPtr copy = clipping->tracks().front()->medias().front();
    EXPECT_EQ(copy->leftEdgeModifications().size(), 1u); // its start is the clip's
    EXPECT_TRUE(copy->rightEdgeModifications().empty()); // a cut there leaves it outside
}

} // namespace

// Splitting a clip: two parts that add up to it and play on without a jump,
// its right transition moving to the right part, and an exact undo.
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/RemoveTransitionCmd.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>
#include <VelaMediaLib/effects/StoredEffect.h>
#include <VelaMediaLib/model/media/MediaImpl.h>

#include <boost/make_shared.hpp>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class SplitCommand : public EditTest {};

TEST_F(SplitCommand, PartsAddUpAndPlayOnWithoutAJump) {
    const MediaPtr media = slice(SafeRational(7, 2), 60, SafeRational(3, 2)); // 90 ticks
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, media, 10)));
    const auto opacity = opacityOf(media);
    opacity->addKeyFrame(RationalTime(0), 0.0, RationalTime(0));
    opacity->addKeyFrame(RationalTime(80), 1.0, RationalTime(80));
    const double atCut = opacity->valueAtTime(RationalTime(33));
    const MediaState before = media->state();

    const auto split = SplitCmd::create(track, 43);
    ASSERT_TRUE(project->execute(split));
    ASSERT_EQ(split->getCreatedMedias().size(), 1u);
    const MediaPtr right = split->getCreatedMedias()[0];
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(10, 33));
    EXPECT_EQ(right->trackRange(), Range<VelaTime>(43, 57));
    EXPECT_EQ(media->duration() + right->duration(), before.duration);
    // The right part's media begins where the left part's ends.
    EXPECT_EQ(right->state().mediaStart, media->state().mediaEnd());
    EXPECT_EQ(right->state().mediaEnd(), before.mediaEnd());
    EXPECT_EQ(opacityOf(right)->valueAtTime(RationalTime(0)), atCut);
    EXPECT_EQ(opacityOf(right)->valueAtTime(RationalTime(20)), opacity->valueAtTime(RationalTime(53)));
    EXPECT_EQ(track->numMedias(), 2u);
}

TEST_F(SplitCommand, AnimationsShiftAndEffectsAreCutForTheRightPart) {
    const MediaPtr media = place(0, 100);
    auto impl = boost::dynamic_pointer_cast<MediaImpl>(media);
    AnimationTrack::Animation animation;
    animation.range = Range<long long>(20, 50);
    animation.endTime = 70;
    animation.duration = 50;
    impl->setAnimationTrack(AnimationTrack("opacity", {animation}));
    media->addEffect(storedEffect("Blur", 0, 30));  // wholly before the cut: not on the right part
    media->addEffect(storedEffect("Glow", 30, 40)); // across the cut: cut
    media->addEffect(storedEffect("DeviceFrameEffect", 0, 100)); // follows the end edge of the left part
    const auto split = SplitCmd::create(track, 40);
    ASSERT_TRUE(project->execute(split));
    const auto right = boost::dynamic_pointer_cast<MediaImpl>(split->getCreatedMedias()[0]);
    const auto shifted = right->animationTracks().at("opacity").animations().at(0);
    EXPECT_EQ(shifted.range, Range<long long>(-20, 50));
    EXPECT_EQ(shifted.endTime, 30);
    const auto effects = right->allEffects();
    ASSERT_EQ(effects.size(), 2u);
    EXPECT_EQ(effects[0]->effectName(), "Glow");
    EXPECT_EQ(effects[0]->timeRange(), Range<VelaTime>(0, 30));
    EXPECT_EQ(effects[1]->timeRange(), Range<VelaTime>(0, 60));
    EXPECT_EQ(media->allEffects()[2]->timeRange(), Range<VelaTime>(0, 40));
    EXPECT_EQ(media->allEffects()[1]->timeRange(), Range<VelaTime>(30, 40)); // not magnetized: stays
}

TEST_F(SplitCommand, RightTransitionMovesToTheRightPartAndUndoRestoresIt) {
    const MediaPtr left = place(0, 60);
    const MediaPtr next = place(60, 60);
    const TransitionPtr fade = transition();
    fade->setDuration(50);
    ASSERT_TRUE(project->execute(AddTransitionCmd::create(track, left, fade, TransitionEditCmd::Right)));
    ASSERT_EQ(next->leftTransition(), fade);
    const Snapshot shot = snapshot(); // makes the opacity curves it prints: before the document
    const std::string before = document();

    const auto split = SplitCmd::create(track, 30);
    ASSERT_TRUE(project->execute(split));
    const MediaPtr right = split->getCreatedMedias()[0];
    EXPECT_FALSE(left->rightTransition());
    EXPECT_EQ(right->rightTransition(), fade);
    EXPECT_EQ(next->leftTransition(), fade);
    EXPECT_EQ(fade->duration(), 30); // fitted to the 30-tick right part

    const std::string after = document();
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), before);
    EXPECT_EQ(snapshot(), shot);
    EXPECT_EQ(left->rightTransition(), fade);
    EXPECT_EQ(fade->duration(), 50);
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(document(), after);
}

TEST_F(SplitCommand, FadesStayAtTheEdgesTheyBelongTo) {
    const MediaPtr media = place(0, 100);
    const auto fadeIn = boost::make_shared<EdgeModification>(10, "audioFade", 0.0);
    const auto fadeOut = boost::make_shared<EdgeModification>(15, "audioFade", 0.0);
    media->addLeftEdgeModification(fadeIn);
    media->addRightEdgeModification(fadeOut);
    const auto split = SplitCmd::create(track, 50);
    expectExactDocumentUndo(split);
    const MediaPtr right = split->getCreatedMedias().at(0);
    EXPECT_EQ(media->leftEdgeModifications(), EdgeModifiable::EdgeModifications{fadeIn});
    EXPECT_TRUE(media->rightEdgeModifications().empty());
    EXPECT_TRUE(right->leftEdgeModifications().empty());
    ASSERT_EQ(right->rightEdgeModifications().size(), 1u);
    EXPECT_EQ(right->rightEdgeModifications()[0]->duration(), 15);
}

TEST_F(SplitCommand, NothingToSplitIsRefused) {
    place(0, 30);
    place(30, 30);
    expectRefused(SplitCmd::create(track, 30)); // a cut between clips
    expectRefused(SplitCmd::create(track, 0));  // a clip's first tick
    expectRefused(SplitCmd::create(track, 60)); // past the end
    expectRefused(SplitCmd::create(track, -5));
}

TEST_F(SplitCommand, ARefusedSubEditLeavesTheDocumentByteIdentical) {
    const MediaPtr media = place(0, 60);
    // The handler refuses to place the right part after the left was trimmed.
    struct RefusingHandler : ProjectIndependentCommandHandler {
        TrackAndMedia addMedia(const TrackPtr&, const MediaPtr&, VelaTime) override {
            return TrackAndMedia();
        }
    } handler;
    const std::string before = document();
    const auto split = SplitCmd::create(track, 20);
    EXPECT_FALSE(split->execute(&handler));
    EXPECT_EQ(document(), before);
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(0, 60));
    EXPECT_TRUE(split->getCreatedMedias().empty());
}

TEST_F(SplitCommand, StretchedClipsAndLastTicksSplitExactly) {
    const MediaPtr stretched = slice(0, 41, SafeRational(2, 3)); // 27 ticks
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, stretched, 0)));
    expectExactDocumentUndo(SplitCmd::create(track, 13));
    const MediaPtr still = place(100, 50);
    expectExactDocumentUndo(SplitCmd::create(track, 149));
}

} // namespace

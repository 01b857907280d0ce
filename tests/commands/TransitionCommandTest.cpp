// Transition edits: shared between touching clips or one-sided, refused
// where they do not fit, and undone to the exact slots and links.
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/RemoveTransitionCmd.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class TransitionCommand : public EditTest {
protected:
    MediaPtr a = place(0, 20), b = place(20, 20), c = place(50, 10);
};

TEST_F(TransitionCommand, AddSharesWithATouchingClipAndUndoesExactly) {
    const TransitionPtr fade = transition();
    expectExactDocumentUndo(AddTransitionCmd::create(track, a, fade, TransitionEditCmd::Right));
    EXPECT_EQ(b->leftTransition(), fade);
    EXPECT_EQ(fade->leftMedia(), a);
    EXPECT_EQ(fade->rightMedia(), b);
    const TransitionPtr out = transition();
    expectExactUndo(AddTransitionCmd::create(track, c, out, TransitionEditCmd::Left)); // one-sided
    EXPECT_FALSE(out->leftMedia());
}

TEST_F(TransitionCommand, AddRefusesWhatDoesNotFit) {
    const TransitionPtr fade = transition();
    ASSERT_TRUE(project->execute(AddTransitionCmd::create(track, a, fade, TransitionEditCmd::Right)));
    expectRefused(AddTransitionCmd::create(track, b, transition(), TransitionEditCmd::Left)); // taken
    expectRefused(AddTransitionCmd::create(track, c, fade, TransitionEditCmd::Left));         // in use
    const TransitionPtr longOne = transition();
    longOne->setDuration(11);
    expectRefused(AddTransitionCmd::create(track, c, longOne, TransitionEditCmd::Right));
    expectRefused(AddTransitionCmd::create(newTrack(), c, transition(), TransitionEditCmd::Right));
}

TEST_F(TransitionCommand, RemoveReplaceSplitAndTrimUndoExactly) {
    const TransitionPtr fade = transition();
    ASSERT_TRUE(project->execute(AddTransitionCmd::create(track, a, fade, TransitionEditCmd::Right)));
    expectExactDocumentUndo(TrimTransitionCmd::create(track, fade, 7));
    expectRefused(TrimTransitionCmd::create(track, fade, 21)); // longer than its clips
    const TransitionPtr wipe = transition();
    expectExactUndo(ReplaceTransitionCmd::create(track, fade, wipe));
    EXPECT_EQ(b->leftTransition(), wipe);
    EXPECT_FALSE(fade->leftMedia() || fade->rightMedia());
    expectExactUndo(SplitTransitionCmd::create(track, wipe));
    EXPECT_EQ(a->rightTransition(), wipe);
    EXPECT_TRUE(b->leftTransition() && b->leftTransition() != wipe);
    const auto elsewhere = newTrack(); // the clips are not on it
    expectRefused(RemoveTransitionCmd::create(elsewhere, wipe));
    expectRefused(ReplaceTransitionCmd::create(elsewhere, wipe, transition()));
    expectExactUndo(RemoveTransitionCmd::create(track, wipe));
    EXPECT_FALSE(a->rightTransition());
    expectRefused(TrimTransitionCmd::create(track, fade, -1));
    expectRefused(SplitTransitionCmd::create(track, transition())); // on no clip
    expectRefused(RemoveTransitionCmd::create(track, transition()));
}

// The copy a split makes is the same on redo, so an edit of it redoes too.
TEST_F(TransitionCommand, ALaterEditOfASplitsCopyRedoes) {
    const TransitionPtr fade = transition();
    ASSERT_TRUE(project->execute(AddTransitionCmd::create(track, a, fade, TransitionEditCmd::Right)));
    ASSERT_TRUE(project->execute(SplitTransitionCmd::create(track, fade)));
    const TransitionPtr copy = b->leftTransition();
    ASSERT_TRUE(project->execute(TrimTransitionCmd::create(track, copy, 5)));
    const std::string after = document();
    ASSERT_TRUE(project->undo() && project->undo());
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(b->leftTransition(), copy);
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(document(), after);
}

TEST_F(TransitionCommand, AddToMediasTakesEveryFreeEdgeOnce) {
    const TransitionPtr model = transition();
    const std::vector<MediaPtr> all{a, b, c};
    expectExactDocumentUndo(AddTransitionToMediasCmd::create(track, all, model));
    EXPECT_TRUE(a->leftTransition() && a->rightTransition() && c->leftTransition() && c->rightTransition());
    EXPECT_EQ(a->rightTransition(), b->leftTransition());
    EXPECT_FALSE(model->leftMedia()); // copies stand on the clips, not the model
    expectRefused(AddTransitionToMediasCmd::create(track, all, model)); // nothing left to take
}

} // namespace

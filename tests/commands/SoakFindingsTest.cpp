// Faults the random-edit soak found in the family commands, each reduced to
// the smallest edit that showed it.
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/AddTransitionCmd.h>
#include <VelaMediaLib/commands/edits/ChangeProjectEditRateCmd.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>
#include <VelaMediaLib/commands/edits/RemoveTransitionCmd.h>
#include <VelaMediaLib/commands/edits/ReplaceMediaWithMediasCmd.h>
#include <VelaMediaLib/commands/edits/RestoreDeletionPointAtTimeCmd.h>
#include <VelaMediaLib/commands/edits/RippleDeleteRangeAndCreateDeletionPointCmd.h>
#include <VelaMediaLib/commands/edits/StitchMediaCmd.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class SoakFindings : public EditTest {};

// A part of a stitched media named on the stitched media's own track: taking
// it off was done, but its undo could not put it back (that track takes no
// clips), so a replacement refused part-way changed the parts for good.
TEST_F(SoakFindings, APartInsideAStitchedMediaIsNotTakenOffItsTrack) {
    const MediaPtr a = place(0, 20), b = place(20, 20);
    const auto stitch = StitchMediaCmd::create(track, {a, b});
    ASSERT_TRUE(project->execute(stitch));
    const TrackPtr inner = stitch->stitchedMedia()->track();
    expectRefusedDocument(RemoveMediaCmd::create(inner, a));
    expectRefusedDocument(ReplaceMediaWithMediasCmd::create(inner, b, {clip(10), clip(5)}));
    EXPECT_EQ(stitch->stitchedMedia()->medias(), (std::vector<MediaPtr>{a, b}));
}

// A ripple delete cuts a clip; a transition is then given to the cut's left
// piece; restoring the point joins the cut, and its undo cuts it again. Undoing
// the transition and then the delete must give back the clip as it was, with
// no transition it never had.
TEST_F(SoakFindings, UndoingARestoreLeavesTheDeletesOwnUndoAsItWas) {
    const MediaPtr before = place(0, 10), cut = place(10, 30);
    const std::string original = document();
    const auto del = RippleDeleteRangeAndCreateDeletionPointCmd::create(Range<VelaTime>(20, 5));
    del->addTrack(track);
    ASSERT_TRUE(project->execute(del));
    ASSERT_TRUE(
        project->execute(AddTransitionCmd::create(track, before, transition(), TransitionEditCmd::Right)));
    const auto restore = RestoreDeletionPointAtTimeCmd::create(20);
    restore->addTrack(track);
    expectExactDocumentUndo(restore);
    ASSERT_TRUE(project->undo()); // the restore
    ASSERT_TRUE(project->undo()); // the transition
    ASSERT_TRUE(project->undo()); // the delete
    EXPECT_EQ(document(), original);
    EXPECT_FALSE(cut->leftTransition());
}

// A clip's effects scaled by an edit rate change, then replaced by equal
// copies (a split redone after the change was redone): undoing the change
// must give back the effects it scaled, not add them beside the copies.
TEST_F(SoakFindings, UndoingAnEditRateChangeGivesBackEffectsThatWereCopiedSince) {
    const MediaPtr media = place(0, 40);
    media->addEffect(storedEffect("CursorPath", 0, 40));
    media->addEffect(storedEffect("Blur", 5, 10));
    const std::string original = document();
    ASSERT_TRUE(project->execute(ChangeProjectEditRateCmd::create(60000, 1001)));
    ASSERT_TRUE(project->execute(SplitCmd::create(track, 30)));
    for (int i = 0; i < 2; ++i) ASSERT_TRUE(project->undo());
    for (int i = 0; i < 2; ++i) ASSERT_TRUE(project->redo());
    for (int i = 0; i < 2; ++i) ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), original);
    EXPECT_EQ(media->numEffects(), 2u);
}

// A transition split in two, then an edit of the copy the split made: undone
// and redone, the split must give the same copy again, or the later edit's
// redo names a transition no clip holds.
TEST_F(SoakFindings, RedoingASplitTransitionGivesTheSameCopy) {
    const MediaPtr left = place(0, 20);
    place(20, 20);
    const TransitionPtr joined = transition();
    ASSERT_TRUE(project->execute(AddTransitionCmd::create(track, left, joined, TransitionEditCmd::Right)));
    ASSERT_TRUE(project->execute(SplitTransitionCmd::create(track, joined)));
    const TransitionPtr copy = clips[1]->leftTransition();
    ASSERT_TRUE(project->execute(TrimTransitionCmd::create(track, copy, 1)));
    const std::string after = document();
    for (int i = 0; i < 2; ++i) ASSERT_TRUE(project->undo());
    for (int i = 0; i < 2; ++i) ASSERT_TRUE(project->redo()) << i;
    EXPECT_EQ(document(), after);
    EXPECT_EQ(clips[1]->leftTransition(), copy);
}

} // namespace

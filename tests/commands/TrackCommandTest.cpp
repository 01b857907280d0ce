#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/NewMixerCmd.h>
#include <VelaMediaLib/commands/edits/NewTrackCmd.h>
#include <VelaMediaLib/document/ProjectDocument.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class TrackCommand : public EditTest {
protected:
    template <typename Exception>
    void expectThrowsUnchanged(const std::function<CommandPtr()>& make) {
        const std::string before = document();
        const size_t stepsBefore = steps();
        EXPECT_THROW(project->execute(make()), Exception);
        EXPECT_EQ(document(), before);
        EXPECT_EQ(steps(), stepsBefore);
    }
};

TEST_F(TrackCommand, NewTrackGoesWhereAskedAndRedoBringsTheSameTrack) {
    const auto second = newTrack();
    const auto command = NewTrackCmd::create(mixer, 1);
    expectExactDocumentUndo(command);
    EXPECT_EQ(mixer->tracks(), (Mixer::Tracks{track, command->track(), second}));
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(mixer->numTracks(), 2u);
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(mixer->trackAtIndex(1), command->track());
    expectExactDocumentUndo(NewTrackCmd::create(mixer, -1));
    EXPECT_EQ(mixer->numTracks(), 4u);
}

TEST_F(TrackCommand, BadInputIsRefusedAndChangesNothing) {
    const auto other = project->newMixer("other");
    const auto stranger = project->timeline()->newTrack();
    project->timeline()->addTrack(other, stranger);
    expectThrowsUnchanged<ValueException<int>>([&] { return NewTrackCmd::create(mixer, 2); });
    expectThrowsUnchanged<ValueException<int>>([&] { return NewTrackCmd::create(mixer, -2); });
    EXPECT_THROW(NewTrackCmd::create(MixerPtr()), TypeException);
    EXPECT_THROW(RemoveTrackCmd::create(mixer, stranger), AddRemoveException);
    EXPECT_THROW(RemoveTrackCmd::create(mixer, TrackPtr()), AddRemoveException);
    EXPECT_THROW(SwapTrackOrderCmd::create(mixer, track, stranger), AddRemoveException);
    EXPECT_THROW(SwapTrackOrderCmd::create(mixer, track, track), ValueException<int>);
    expectThrowsUnchanged<AddRemoveException>([&] { return NewMixerCmd::create("other"); });
    EXPECT_THROW(NewMixerCmd::create(""), ValueException<int>);

    // A track that left its mixer since the command was made is refused with false.
    const auto remove = RemoveTrackCmd::create(other, stranger);
    other->removeTrack(stranger);
    const std::string before = document();
    EXPECT_FALSE(project->execute(remove));
    EXPECT_EQ(document(), before);
}

// The same track object comes back at its index with its clips and flags.
TEST_F(TrackCommand, RemoveTrackUndoPutsTheSameTrackBack) {
    const auto middle = newTrack();
    newTrack();
    middle->addMedia(clip(10), 5);
    middle->videoHiddenAttribute()->setValue(true);
    const auto command = RemoveTrackCmd::create(mixer, middle);
    expectExactDocumentUndo(command);
    EXPECT_FALSE(mixer->hasTrack(middle));
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(mixer->trackAtIndex(1), middle);
    EXPECT_EQ(middle->numMedias(), 1u);
    EXPECT_TRUE(middle->attributeValue("videoHidden", false));
}

TEST_F(TrackCommand, SwapTrackOrderIsItsOwnInverse) {
    const auto second = newTrack(), third = newTrack();
    place(0, 10);
    expectExactDocumentUndo(SwapTrackOrderCmd::create(mixer, track, third));
    EXPECT_EQ(mixer->tracks(), (Mixer::Tracks{third, second, track}));
}

TEST_F(TrackCommand, NewMixerUndoTakesItOffAndRedoPutsTheSameMixerBack) {
    const auto command = NewMixerCmd::create("scene2");
    expectExactDocumentUndo(command);
    EXPECT_EQ(project->timeline()->mixer("scene2"), command->mixer());
    ASSERT_TRUE(project->undo());
    EXPECT_FALSE(project->timeline()->mixer("scene2"));
}

// A magnetic track taken out and put back by undo closes its gaps again.
TEST_F(TrackCommand, MagneticTrackKeepsItsMagnetizerThroughRemoveAndUndo) {
    const auto magnetic = newTrack();
    magnetic->magneticAttribute()->setValue(true);
    const MediaPtr a = clip(10), b = clip(10);
    ASSERT_TRUE(project->execute(AddMediaCmd::create(magnetic, a, 0)));
    ASSERT_TRUE(project->execute(AddMediaCmd::create(magnetic, b, 10)));
    ASSERT_TRUE(project->execute(RemoveTrackCmd::create(mixer, magnetic)));
    ASSERT_TRUE(project->undo());
    ASSERT_EQ(mixer->trackAtIndex(1), magnetic);
    ASSERT_TRUE(project->execute(RemoveMediaCmd::create(magnetic, a)));
    EXPECT_EQ(b->startTime(), 0); // the gap the removal left is closed
    ASSERT_TRUE(project->undo()); // the closing
    ASSERT_TRUE(project->undo()); // the removal
    EXPECT_EQ(a->startTime(), 0);
    EXPECT_EQ(b->startTime(), 10);
}

} // namespace

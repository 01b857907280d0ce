// Media placement: removing a range or the last clip, duplicating, cloning,
// repeating, replacing and displacing clips, each undone to the same
// document and refused whole.
#include "../model/SourceTestSupport.h"
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/AddTransitionCmd.h>
#include <VelaMediaLib/commands/edits/CloneAddMediasCmd.h>
#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>
#include <VelaMediaLib/commands/edits/DisplaceMediaOnUnifiedMixerCmd.h>
#include <VelaMediaLib/commands/edits/DuplicateMediaCmd.h>
#include <VelaMediaLib/commands/edits/RemoveLastMediaCmd.h>
#include <VelaMediaLib/commands/edits/RemoveRangeMediaCmd.h>
#include <VelaMediaLib/commands/edits/RepeatMediaToFillRangeCmd.h>
#include <VelaMediaLib/commands/edits/ReplaceMediaWithMediasCmd.h>
#include <VelaMediaLib/commands/edits/RippleReplaceMediaWithMediasCmd.h>
#include <VelaMediaLib/model/media/AMFile.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/project/SourceBin.h>
#include <VelaMediaLib/model/source/Source.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

typedef std::vector<VelaTime> Times;

class PlacementCommand : public EditTest {
protected:
    MediaPtr placeOn(const TrackPtr& on, VelaTime start, VelaTime duration) {
        const MediaPtr media = clip(duration);
        EXPECT_TRUE(project->execute(AddMediaCmd::create(on, media, start)));
        return media;
    }
    static std::vector<Range<VelaTime>> ranges(const TrackPtr& of) {
        std::vector<Range<VelaTime>> result;
        for (const MediaPtr& media : of->medias()) result.push_back(media->trackRange());
        return result;
    }
    // Refused by false: the written project and the history stay as they were.
    void expectRefusedWhole(const CommandPtr& command) {
        const std::string before = document();
        const size_t stepsBefore = steps();
        EXPECT_FALSE(project->execute(command)) << command->name();
        EXPECT_EQ(document(), before) << command->name();
        EXPECT_EQ(steps(), stepsBefore) << command->name();
    }
    void share(const MediaPtr& left) {
        ASSERT_TRUE(
            project->execute(AddTransitionCmd::create(track, left, transition(), TransitionEditCmd::Right)));
    }
};

typedef std::vector<Range<VelaTime>> Ranges;
Range<VelaTime> at(VelaTime start, VelaTime duration) { return Range<VelaTime>(start, duration); }

TEST_F(PlacementCommand, RemovingARangeCutsAtItsEdgesAndLeavesTheGap) {
    const MediaPtr first = place(0, 30);
    place(30, 30);
    place(70, 30);
    share(first); // the shared transition lies inside the range
    const auto other = newTrack();
    placeOn(other, 10, 100);
    const auto remove = RemoveRangeMediaCmd::create(at(20, 60));
    remove->addTracksOf(mixer);
    expectExactDocumentUndo(remove);
    EXPECT_EQ(ranges(track), (Ranges{at(0, 20), at(80, 20)}));
    EXPECT_EQ(ranges(other), (Ranges{at(10, 10), at(80, 30)}));
    EXPECT_EQ(remove->removedMedias().size(), 4u);
    EXPECT_EQ(first->rightTransition(), TransitionPtr()); // went with the cut part
}

TEST_F(PlacementCommand, RemovingARangeRefusesBadInput) {
    place(0, 10);
    EXPECT_THROW(RemoveRangeMediaCmd::create(at(5, 0)), VelaMediaLibException);
    EXPECT_THROW(RemoveRangeMediaCmd::create(at(0, 5))->addTrack(TrackPtr()), VelaMediaLibException);
    const std::string before = document();
    EXPECT_THROW(project->execute(RemoveRangeMediaCmd::create(at(0, 5))), VelaMediaLibException);
    EXPECT_EQ(document(), before);
    const auto empty = RemoveRangeMediaCmd::create(at(10, 50)); // nothing there
    empty->addTrack(track);
    expectRefusedWhole(empty);
}

TEST_F(PlacementCommand, RemovingTheLastClipTakesTheLatestOff) {
    place(0, 10);
    const MediaPtr last = place(30, 10);
    share(place(10, 10));
    const auto remove = RemoveLastMediaCmd::create(track);
    expectExactDocumentUndo(remove);
    EXPECT_EQ(remove->removedMedia(), last);
    EXPECT_EQ(starts(), (Times{0, 10}));
    expectRefusedWhole(RemoveLastMediaCmd::create(newTrack()));
    EXPECT_THROW(RemoveLastMediaCmd::create(TrackPtr()), VelaMediaLibException);
}

TEST_F(PlacementCommand, DuplicatesGoRightAfterTheClipOrToTheFirstPlaceThatFits) {
    const MediaPtr a = place(0, 10), b = place(10, 10);
    const MediaPtr c = place(30, 5);
    place(40, 10);
    share(a);
    const auto duplicate = DuplicateMediaCmd::create({b, a, c});
    expectExactDocumentUndo(duplicate);
    const auto& copies = duplicate->createdMedias();
    ASSERT_EQ(copies.size(), 3u);
    // a first: [20, 30) is free; then b: its copy does not fit before 50; c fits right after itself.
    EXPECT_EQ(copies[1]->trackRange(), at(20, 10));
    EXPECT_EQ(copies[0]->trackRange(), at(50, 10));
    EXPECT_EQ(copies[2]->trackRange(), at(35, 5));
    EXPECT_NE(copies[1], a);
    EXPECT_EQ(copies[1]->leftTransition(), TransitionPtr()); // a's transition stays a's
    EXPECT_EQ(DuplicateMediaCmd::firstFreeStart(*track, 0, 1), 60);
}

TEST_F(PlacementCommand, DuplicatingRefusesBadInput) {
    const MediaPtr a = place(0, 10);
    EXPECT_THROW(DuplicateMediaCmd::create({}), VelaMediaLibException);
    EXPECT_THROW(DuplicateMediaCmd::create({a, a}), VelaMediaLibException);
    EXPECT_THROW(DuplicateMediaCmd::create({MediaPtr()}), VelaMediaLibException);
    expectRefusedWhole(DuplicateMediaCmd::create({a, clip(5)})); // on no track
}

TEST_F(PlacementCommand, ClonesArePlacedAndACollisionPartWayChangesNothing) {
    const MediaPtr a = place(0, 10);
    const auto other = newTrack();
    const auto clone = CloneAddMediasCmd::create({{a, other, 5}, {a, track, 100}});
    expectExactDocumentUndo(clone);
    ASSERT_EQ(clone->createdMedias().size(), 2u);
    EXPECT_EQ(other->medias(), std::vector<MediaPtr>{clone->createdMedias()[0]});
    EXPECT_EQ(starts(), (Times{0, 100}));
    EXPECT_EQ(a->trackRange(), at(0, 10));
    // The third placement collides with the clip: the two before it go again.
    expectRefusedWhole(CloneAddMediasCmd::create({{a, other, 50}, {a, track, 20}, {a, track, 5}}));
    EXPECT_THROW(CloneAddMediasCmd::create(std::vector<CloneAddMediasCmd::Placement>()),
                 VelaMediaLibException);
    EXPECT_THROW(CloneAddMediasCmd::create(a, TrackPtr(), 0), VelaMediaLibException);
}

TEST_F(PlacementCommand, RepeatingFillsTheRangeAndCutsTheLastCopy) {
    const MediaPtr pattern = place(0, 10);
    place(45, 10); // right after the range: the last copy is cut before it is placed
    const auto repeat = RepeatMediaToFillRangeCmd::create(track, pattern, at(10, 35));
    expectExactDocumentUndo(repeat);
    EXPECT_EQ(ranges(track), (Ranges{at(0, 10), at(10, 10), at(20, 10), at(30, 10), at(40, 5), at(45, 10)}));
    EXPECT_EQ(repeat->createdMedias().size(), 4u);
    EXPECT_EQ(repeat->createdMedias().back()->state().mediaStart, pattern->state().mediaStart);
    expectRefusedWhole(RepeatMediaToFillRangeCmd::create(track, pattern, at(5, 10))); // over the pattern
    EXPECT_THROW(RepeatMediaToFillRangeCmd::create(track, pattern, at(60, 0)), VelaMediaLibException);
}

TEST_F(PlacementCommand, ReplacingPutsTheListWhereTheClipStarted) {
    place(0, 10);
    const MediaPtr b = place(10, 20);
    place(30, 10);
    share(b);
    const MediaPtr x = clip(5), y = clip(10);
    expectExactDocumentUndo(ReplaceMediaWithMediasCmd::create(track, b, {x, y}));
    EXPECT_EQ(ranges(track), (Ranges{at(0, 10), at(10, 5), at(15, 10), at(30, 10)}));
    EXPECT_EQ(b->parent(), nullptr);
}

TEST_F(PlacementCommand, ReplacingRefusesACollisionPartWayAndBadInput) {
    const MediaPtr a = place(0, 10);
    const MediaPtr b = place(10, 20);
    place(30, 10);
    // The second clip would reach into the third: the removal and the first placement go back.
    expectRefusedWhole(ReplaceMediaWithMediasCmd::create(track, b, {clip(15), clip(10)}));
    expectRefusedWhole(ReplaceMediaWithMediasCmd::create(track, clip(5), {clip(5)})); // not on the track
    expectRefusedWhole(ReplaceMediaWithMediasCmd::create(track, b, {a}));             // placed already
    EXPECT_THROW(ReplaceMediaWithMediasCmd::create(track, b, {}), VelaMediaLibException);
    EXPECT_THROW(ReplaceMediaWithMediasCmd::create(track, b, {b}), VelaMediaLibException);
    EXPECT_THROW(RippleReplaceMediaWithMediasCmd::create(track, b, {MediaPtr()}), VelaMediaLibException);
}

TEST_F(PlacementCommand, RippleReplacingMovesTheRestByTheChangeOfLength) {
    place(0, 10);
    const MediaPtr b = place(10, 20);
    place(35, 10);
    place(45, 5);
    expectExactDocumentUndo(RippleReplaceMediaWithMediasCmd::create(track, b, {clip(25)}));
    EXPECT_EQ(starts(), (Times{0, 10, 40, 50})); // longer: pushed, the gap kept
    ASSERT_TRUE(project->undo());
    expectExactDocumentUndo(RippleReplaceMediaWithMediasCmd::create(track, b, {clip(2), clip(3)}));
    EXPECT_EQ(starts(), (Times{0, 10, 12, 20, 30})); // shorter: pulled back
}

TEST_F(PlacementCommand, DisplacingPushesOnlyAsFarAsNeeded) {
    place(0, 20);
    place(25, 10);
    place(40, 10);
    place(70, 10);
    const MediaPtr placed = clip(10);
    const auto displace = DisplaceMediaOnUnifiedMixerCmd::create(track, placed, 15);
    expectExactDocumentUndo(displace);
    // Cut at 15, its tail and the next clip pushed; the gap before 40 takes the rest.
    EXPECT_EQ(ranges(track), (Ranges{at(0, 15), at(15, 10), at(25, 5), at(30, 10), at(40, 10), at(70, 10)}));
    EXPECT_EQ(displace->displacedMedias().size(), 2u);
    // Dragged from another track into the middle of the run.
    const auto other = newTrack();
    const MediaPtr dragged = placeOn(other, 0, 5);
    expectExactDocumentUndo(DisplaceMediaOnUnifiedMixerCmd::create(track, dragged, 25));
    EXPECT_EQ(starts(), (Times{0, 15, 25, 30, 35, 45, 70}));
    EXPECT_TRUE(other->medias().empty());
}

TEST_F(PlacementCommand, RemovingARangeOnAMagneticTrackClosesAsAStepOfItsOwn) {
    track->magneticAttribute()->setValue(true);
    place(0, 30);
    place(30, 30);
    place(60, 30);
    const std::string start = document();
    const size_t stepsBefore = steps();
    const auto remove = RemoveRangeMediaCmd::create(at(20, 20));
    remove->addTrack(track);
    ASSERT_TRUE(project->execute(remove));
    EXPECT_FALSE(CloseGapsOnTrackCmd::hasGap(*track));
    EXPECT_EQ(track->endTime(), 70);
    EXPECT_EQ(steps(), stepsBefore + 2); // the removal, then the closing
    while (steps() > stepsBefore) ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), start);
}

// A unified clip pushed aside takes its video and audio with it.
class UnifiedPlacement : public PlacementCommand {
protected:
    UnifiedPlacement() {
        loader->set("rec.mov",
                    {stream(TrackType::Video, 0, 300, 30), stream(TrackType::Audio, 0, 480000, 48000, 2)});
        const SourcePtr source = project->sourceBin()->loadFile("rec.mov");
        unified = UnifiedMedia::create(VMFile::create(source, 0, 0), AMFile::create(source, 1, 0));
    }
    RegisteredTableLoader loader;
    boost::shared_ptr<UnifiedMedia> unified;
};

TEST_F(UnifiedPlacement, DisplacingPushesAUnifiedClipWhole) {
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, unified, 10)));
    expectExactDocumentUndo(DisplaceMediaOnUnifiedMixerCmd::create(track, clip(10), 0));
    EXPECT_EQ(unified->startTime(), 10); // touching, not overlapped: stays
    ASSERT_TRUE(project->undo());
    expectExactDocumentUndo(DisplaceMediaOnUnifiedMixerCmd::create(track, clip(10), 5));
    EXPECT_EQ(unified->startTime(), 15);
    EXPECT_EQ(unified->internalAudioMedia()->state(), unified->internalVisualMedia()->state());
    // A part is inside the unified clip, not the track's to place.
    expectRefusedWhole(DisplaceMediaOnUnifiedMixerCmd::create(track, unified->internalAudioMedia(), 100));
    EXPECT_THROW(DisplaceMediaOnUnifiedMixerCmd::create(TrackPtr(), unified, 0), VelaMediaLibException);
}

} // namespace

// Ripple moves, inserted time, splitting ripple moves and closed gaps: what
// moves, in which order, and that a refusal part-way changes nothing.
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>
#include <VelaMediaLib/commands/edits/InsertTimeCmd.h>
#include <VelaMediaLib/commands/edits/RippleMoveCmd.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class RippleCommand : public EditTest {};

TEST_F(RippleCommand, MovesTheClipAndEverythingAfterIt) {
    place(0, 10);
    const MediaPtr second = place(10, 10);
    place(20, 10);
    place(35, 5);
    expectExactUndo(RippleMoveCmd::create(track, second, 7));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 17, 27, 42}));
    // Touching clips moved left, earliest first: each lands where the one before has gone.
    expectExactUndo(RippleMoveCmd::create(track, second, -7));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 10, 20, 35}));
}

TEST_F(RippleCommand, AMoveIntoAnEarlierClipRefusesTheWholeRipple) {
    place(0, 10);
    const MediaPtr second = place(12, 10);
    place(22, 10);
    const std::string before = document();
    EXPECT_FALSE(project->execute(RippleMoveCmd::create(track, second, -3)));
    EXPECT_EQ(document(), before);
    expectRefused(RippleMoveCmd::create(track, clip(5), 3)); // not on the track
    expectRefused(RippleMoveCmd::create(track, second, 0));
}

TEST_F(RippleCommand, InsertingTimeInAClipSplitsItAndMovesTheRest) {
    const MediaPtr media = place(0, 100);
    place(100, 20);
    const auto insert = InsertTimeCmd::create(Range<VelaTime>(40, 30));
    insert->addTrack(track);
    expectExactDocumentUndo(insert);
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 70, 130}));
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(0, 40));
    EXPECT_EQ(track->medias()[1]->duration(), 60);
}

TEST_F(RippleCommand, InsertingTimeOnSeveralTracksAndItsRefusals) {
    place(0, 50);
    const auto other = newTrack();
    ASSERT_TRUE(project->execute(AddMediaCmd::create(other, clip(10), 60)));
    const auto insert = InsertTimeCmd::create(Range<VelaTime>(50, 5));
    insert->addTrack(track);
    insert->addTrack(other);
    expectExactDocumentUndo(insert);
    EXPECT_EQ(other->medias()[0]->startTime(), 65);
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0})); // nothing at or after 50 on the first track
    EXPECT_THROW(InsertTimeCmd::create(Range<VelaTime>(0, 0)), VelaMediaLibException);
    const std::string before = document();
    EXPECT_THROW(project->execute(InsertTimeCmd::create(Range<VelaTime>(0, 5))), VelaMediaLibException);
    EXPECT_EQ(document(), before);
}

TEST_F(RippleCommand, SplittingRippleMoveSplitsEveryTrackOfTheMixer) {
    place(0, 40);
    const auto other = newTrack();
    ASSERT_TRUE(project->execute(AddMediaCmd::create(other, clip(40), 10)));
    expectExactDocumentUndo(SplittingRippleMoveCmd::create(mixer, 20, 15));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 35}));
    EXPECT_EQ(other->medias()[1]->trackRange(), Range<VelaTime>(35, 30));
    // Moving the cut parts left into the parts before them is refused whole.
    const std::string before = document();
    EXPECT_FALSE(project->execute(SplittingRippleMoveCmd::create(mixer, 36, -5)));
    EXPECT_EQ(document(), before);
    try {
        project->execute(SplittingRippleMoveCmd::create(MixerPtr(), 0, 5));
        FAIL() << "no exception";
    } catch (const VelaMediaLibException& e) {
        EXPECT_STREQ(e.what(), "can't perform a splitting ripple move without tracks");
    }
    EXPECT_EQ(document(), before);
}

TEST_F(RippleCommand, ClosingGapsMovesAFirstClipAt100ToZero) {
    const MediaPtr first = place(100, 10);
    place(120, 10);
    expectExactUndo(CloseGapsOnTrackCmd::create(track));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 10}));
}

TEST_F(RippleCommand, SplitsAndRipplesKeepAMagneticTrackClosed) {
    ASSERT_TRUE(track->magneticAttribute());
    track->magneticAttribute()->setValue(true);
    place(0, 30);
    place(30, 30);
    ASSERT_TRUE(project->execute(SplitCmd::create(track, 45)));
    const auto insert = InsertTimeCmd::create(Range<VelaTime>(10, 5));
    insert->addTrack(track);
    ASSERT_TRUE(project->execute(insert));
    // The magnet closes the inserted gap again, as its own step.
    EXPECT_FALSE(CloseGapsOnTrackCmd::hasGap(*track));
    EXPECT_EQ(track->endTime(), 60);
    while (steps() > 0) ASSERT_TRUE(project->undo());
    EXPECT_EQ(starts(), (std::vector<VelaTime>{}));
}

} // namespace

// Ripple deletes that leave deletion points, restoring them, and tidying a
// track: each undone byte for byte, and a delete then its restore giving the
// written project back.
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/AddTransitionCmd.h>
#include <VelaMediaLib/commands/edits/RestoreDeletionPointAtTimeCmd.h>
#include <VelaMediaLib/commands/edits/RippleDeleteMultipleRangesAndCreateDeletionPointCmd.h>
#include <VelaMediaLib/commands/edits/TrackCleanupCmd.h>
#include <VelaMediaLib/model/media/Group.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class DeletionCommand : public EditTest {
protected:
    boost::shared_ptr<RippleDeleteRangeAndCreateDeletionPointCmd> rippleDelete(VelaTime start,
                                                                               VelaTime length) {
        const auto command =
            RippleDeleteRangeAndCreateDeletionPointCmd::create(Range<VelaTime>(start, length));
        command->addTrack(track);
        return command;
    }
    boost::shared_ptr<RestoreDeletionPointAtTimeCmd> restoreAt(VelaTime time) {
        const auto command = RestoreDeletionPointAtTimeCmd::create(time);
        command->addTrack(track);
        return command;
    }
    std::vector<VelaTime> pointTimes() const {
        std::vector<VelaTime> times;
        for (const auto& point : project->timeline()->deletionPoints()->pointsOn(*track))
            times.push_back(point->time());
        return times;
    }
    void share(const MediaPtr& left) {
        ASSERT_TRUE(
            project->execute(AddTransitionCmd::create(track, left, transition(), TransitionEditCmd::Right)));
    }
};

TEST_F(DeletionCommand, ARangeInsideAClipIsCutOutAndRestoredWhole) {
    const MediaPtr media = place(0, 100);
    place(100, 50);
    const std::string original = document();
    const auto command = rippleDelete(40, 30);
    expectExactDocumentUndo(command);
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 40, 70}));
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(0, 40));
    EXPECT_EQ(track->medias()[1]->duration(), 30);
    ASSERT_EQ(command->createdDeletionPoints().size(), 1u);
    EXPECT_EQ(command->createdDeletionPoints()[0]->length(), 30);
    EXPECT_EQ(pointTimes(), (std::vector<VelaTime>{40}));

    expectExactDocumentUndo(restoreAt(40));
    EXPECT_EQ(document(), original); // the cuts joined again: one clip as before
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{media, clips[1]}));
    EXPECT_TRUE(pointTimes().empty());
}

TEST_F(DeletionCommand, ClipsAndTransitionsAcrossTheRangeComeBackAsTheyWere) {
    const MediaPtr first = place(0, 50);
    const MediaPtr second = place(50, 50);
    const MediaPtr third = place(100, 50);
    share(first);
    share(second);
    const Snapshot before = snapshot(); // first: it makes the clips' opacity, which is written
    const std::string original = document();
    expectExactDocumentUndo(rippleDelete(30, 90));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 30}));
    EXPECT_EQ(first->trackRange(), Range<VelaTime>(0, 30));
    EXPECT_FALSE(track->hasMedia(second));
    expectExactDocumentUndo(restoreAt(30));
    EXPECT_EQ(document(), original);
    EXPECT_EQ(snapshot(), before); // the same clip objects, timing and transitions
}

TEST_F(DeletionCommand, SeveralRangesLeaveAPointEachRestorableAlone) {
    const MediaPtr media = place(0, 200);
    const auto other = newTrack();
    ASSERT_TRUE(project->execute(AddMediaCmd::create(other, clip(50), 150)));
    const std::string original = document();
    const auto command = RippleDeleteMultipleRangesAndCreateDeletionPointCmd::create(
        {Range<VelaTime>(100, 30), Range<VelaTime>(20, 20)});
    command->addTrack(track);
    command->addTrack(other);
    expectExactDocumentUndo(command);
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 20, 80}));
    EXPECT_EQ(other->medias()[0]->startTime(), 100);
    EXPECT_EQ(pointTimes(), (std::vector<VelaTime>{20, 80}));
    EXPECT_EQ(command->createdDeletionPoints().size(), 4u); // the other track's clip moved: two points too

    // The later one alone: its content and timing come back, its cuts stay.
    const auto later = restoreAt(80);
    later->addTrack(other);
    expectExactDocumentUndo(later);
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 20, 80, 110}));
    EXPECT_EQ(other->medias()[0]->startTime(), 130);
    ASSERT_TRUE(project->undo());
    // Earliest first: every cut joins again and the project is as it was.
    const auto earlier = restoreAt(20);
    earlier->addTrack(other);
    ASSERT_TRUE(project->execute(earlier));
    EXPECT_EQ(pointTimes(), (std::vector<VelaTime>{100}));
    const auto last = restoreAt(100);
    last->addTrack(other);
    ASSERT_TRUE(project->execute(last));
    EXPECT_EQ(document(), original);
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{media}));
}

TEST_F(DeletionCommand, APointInsideALaterDeletionGoesWithItAndComesBack) {
    place(0, 100);
    const std::string original = document();
    ASSERT_TRUE(project->execute(rippleDelete(60, 10)));
    ASSERT_TRUE(project->execute(rippleDelete(50, 20))); // holds the point at 60
    EXPECT_EQ(pointTimes(), (std::vector<VelaTime>{50}));
    ASSERT_TRUE(project->execute(restoreAt(50)));
    EXPECT_EQ(pointTimes(), (std::vector<VelaTime>{60}));
    ASSERT_TRUE(project->execute(restoreAt(60)));
    EXPECT_EQ(document(), original);
    // A point after a deletion moves left with the content.
    ASSERT_TRUE(project->execute(rippleDelete(80, 5)));
    ASSERT_TRUE(project->execute(rippleDelete(10, 5)));
    EXPECT_EQ(pointTimes(), (std::vector<VelaTime>{10, 75}));
}

TEST_F(DeletionCommand, BadRangesAndMissingPointsAreRefusedChangingNothing) {
    place(0, 100);
    EXPECT_THROW(RippleDeleteRangeAndCreateDeletionPointCmd::create(Range<VelaTime>(10, 0)),
                 VelaMediaLibException);
    typedef std::vector<Range<VelaTime>> Ranges;
    const auto multiple = &RippleDeleteMultipleRangesAndCreateDeletionPointCmd::create;
    EXPECT_THROW(multiple(Ranges{}), VelaMediaLibException);
    EXPECT_THROW(multiple(Ranges{Range<VelaTime>(0, 10), Range<VelaTime>(5, 10)}), VelaMediaLibException);
    EXPECT_THROW(multiple(Ranges{Range<VelaTime>(10, 10), Range<VelaTime>(0, 10)}), VelaMediaLibException);
    EXPECT_THROW(multiple(Ranges{Range<VelaTime>(0, 10), Range<VelaTime>(20, -1)}), VelaMediaLibException);

    const std::string before = document();
    const size_t stepsBefore = steps();
    EXPECT_FALSE(project->execute(restoreAt(40)));         // no point there
    EXPECT_FALSE(project->execute(rippleDelete(100, 10))); // nothing in or after the range
    EXPECT_THROW(project->execute(RippleDeleteRangeAndCreateDeletionPointCmd::create(Range<VelaTime>(0, 5))),
                 VelaMediaLibException);                // no track
    const auto loose = project->timeline()->newTrack(); // on no timeline
    ASSERT_TRUE(loose->parentTimeline() == nullptr);
    const auto offTimeline = rippleDelete(10, 10);
    offTimeline->addTrack(loose);
    EXPECT_THROW(project->execute(offTimeline), VelaMediaLibException);
    EXPECT_EQ(document(), before);
    EXPECT_EQ(steps(), stepsBefore);
    EXPECT_TRUE(project->timeline()->deletionPoints()->allPoints().empty());
}

TEST_F(DeletionCommand, AMagneticTrackStaysClosedThroughDeleteAndRestore) {
    track->magneticAttribute()->setValue(true);
    place(0, 60);
    place(60, 40);
    const std::string original = document();
    expectExactDocumentUndo(rippleDelete(50, 20));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 50}));
    ASSERT_TRUE(project->execute(restoreAt(50)));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 60}));
    EXPECT_EQ(document(), original);
}

TEST_F(DeletionCommand, CleanupReleasesTransitionsWhoseOtherClipWent) {
    const MediaPtr first = place(0, 20);
    const MediaPtr second = place(20, 20);
    const MediaPtr third = place(40, 20);
    share(first);
    share(second);
    ASSERT_TRUE(project->execute(RemoveMediaCmd::create(track, third)));
    ASSERT_TRUE(project->execute(MoveCmd::create(track, second, 5))); // apart from the first
    expectExactDocumentUndo(TrackCleanupCmd::create(track));
    EXPECT_FALSE(first->rightTransition());
    EXPECT_FALSE(second->leftTransition());
    EXPECT_FALSE(second->rightTransition());
    EXPECT_EQ(third->leftTransition(), transitions[1]);                   // the removed clip keeps its side
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, third, 45))); // placed back: joined again
    EXPECT_EQ(second->rightTransition(), transitions[1]);
    expectRefused(TrackCleanupCmd::create(track)); // nothing left to tidy
}

TEST_F(DeletionCommand, CleanupTakesEmptyGroupsOffAndKeepsTransitionsThatStand) {
    const MediaPtr first = place(0, 20);
    place(20, 20);
    share(first);
    const auto group = Group::create(project->token(), project->editRateToken(), 0, 10);
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, group, 50)));
    expectExactDocumentUndo(TrackCleanupCmd::create(track));
    EXPECT_FALSE(track->hasMedia(group));
    EXPECT_EQ(first->rightTransition(), transitions[0]);
    EXPECT_THROW(TrackCleanupCmd::create(TrackPtr()), VelaMediaLibException);
}

TEST_F(DeletionCommand, AListHoldsOnePointPerTrackAndTick) {
    const auto list = project->timeline()->deletionPoints();
    const auto point = [&](const TrackPtr& on, VelaTime time) {
        return DeletionPointPtr(new DeletionPoint(on, time, 5, {}, {}, nullptr));
    };
    EXPECT_THROW(list->setPointsOn(*track, {point(track, 3), point(track, 3)}), VelaMediaLibException);
    EXPECT_THROW(list->setPointsOn(*track, {point(newTrack(), 3)}), VelaMediaLibException);
    list->setPointsOn(*track, {point(track, 9), point(track, 3)});
    EXPECT_EQ(pointTimes(), (std::vector<VelaTime>{3, 9}));
    EXPECT_EQ(list->pointAt(*track, 9)->time(), 9);
    EXPECT_FALSE(list->pointAt(*tracks[1], 9));
}

} // namespace

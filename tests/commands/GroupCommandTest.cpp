#include "../JsonTestSupport.h"
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/CreateGroupCmd.h>
#include <VelaMediaLib/commands/edits/GroupCmd.h>
#include <VelaMediaLib/commands/edits/ResizeGroupCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/commands/edits/UnGroupCmd.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class GroupCommand : public EditTest {
protected:
    MediaPtr placeOn(const boost::shared_ptr<GenericTrack>& on, VelaTime start, VelaTime duration) {
        const MediaPtr media = clip(duration);
        on->addMedia(media, start);
        return media;
    }
    SafeRational globalStartOf(const MediaPtr& media) const {
        return media->fromParametricToGlobalTime(RationalTime(0)).asRational();
    }
    GroupPtr grouped(const std::vector<MediaPtr>& selection) {
        const auto command = GroupCmd::create(selection);
        EXPECT_TRUE(project->execute(command));
        return command->createdGroup();
    }
    // The command throws the message and leaves every clip, track and the history as they were.
    void expectThrowsUnchanged(const std::string& message, const CommandPtr& command) {
        const Snapshot before = snapshot();
        const size_t stepsBefore = steps();
        try {
            project->execute(command);
            ADD_FAILURE() << "no exception: " << message;
        } catch (const VelaMediaLibException& e) {
            EXPECT_EQ(std::string(e.what()), message);
        }
        EXPECT_EQ(snapshot(), before) << message;
        EXPECT_EQ(steps(), stepsBefore) << message;
    }
};

// Clips of two tracks become one group where they stood, play at the same
// global times inside it, and come back to the same places when ungrouped.
TEST_F(GroupCommand, GroupThenUngroupGivesBackAnEqualTimeline) {
    const auto lower = newTrack();
    const MediaPtr a = place(10, 20), b = placeOn(lower, 20, 30), outside = place(100, 10);
    a->setRightTransition(transition());
    const Snapshot original = snapshot();
    const size_t originalSteps = steps();

    const auto group = GroupCmd::create({b, a});
    expectExactUndo(group);
    const GroupPtr made = group->createdGroup();
    ASSERT_TRUE(made);
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{made, outside}));
    EXPECT_TRUE(lower->medias().empty());
    EXPECT_EQ(made->trackRange(), Range<VelaTime>(10, 40));
    EXPECT_EQ(made->mixer()->numTracks(), 2u);
    EXPECT_EQ(globalStartOf(a), SafeRational(10));
    EXPECT_EQ(globalStartOf(b), SafeRational(20));
    EXPECT_EQ(project->timeline()->allMediasAtTime(25), (std::vector<MediaPtr>{made, a, b}));
    EXPECT_EQ(std::make_pair(made->width(), made->height()), std::make_pair(1920, 1080));
    EXPECT_TRUE(a->rightTransition()); // the clip's content goes with it

    expectExactUndo(UnGroupCmd::create(made));
    EXPECT_EQ(snapshot(), original);
    ASSERT_TRUE(project->undo() && project->undo());
    EXPECT_EQ(snapshot(), original);
    EXPECT_EQ(steps(), originalSteps);
}

// A transition shared with a clip left outside moves to the group's edge;
// the grouped clip keeps none that reaches out of the group. Undo is exact.
TEST_F(GroupCommand, ATransitionToAClipLeftOutsideGoesToTheGroupsEdge) {
    const MediaPtr before = place(0, 20), a = place(20, 20), b = place(40, 20);
    const TransitionPtr shared = transition(), inside = transition();
    before->setRightTransition(shared);
    Transition::mergeMediaPairTransitions({before, a});
    a->setRightTransition(inside);
    Transition::mergeMediaPairTransitions({a, b});
    ASSERT_EQ(shared->rightMedia(), a);

    const auto command = GroupCmd::create({a, b});
    expectExactUndo(command);
    const GroupPtr made = command->createdGroup();
    EXPECT_FALSE(a->leftTransition());
    EXPECT_EQ(made->leftTransition(), shared);
    EXPECT_EQ(shared->leftMedia(), before);
    EXPECT_EQ(shared->rightMedia(), made);
    EXPECT_EQ(a->rightTransition(), inside); // between two grouped clips: it stays
    EXPECT_EQ(b->leftTransition(), inside);
}

// A group of a group keeps the innermost clip's time, and ungrouping the
// outer one gives the inner group back its place.
TEST_F(GroupCommand, NestedGroupsKeepTimesAndUngroupOneLevel) {
    const MediaPtr a = place(0, 10), b = place(10, 10), c = place(30, 5);
    const GroupPtr inner = grouped({a, b});
    const Snapshot withInner = snapshot();
    const GroupPtr outer = grouped({inner, c});
    EXPECT_EQ(globalStartOf(b), SafeRational(10));
    EXPECT_EQ(globalStartOf(c), SafeRational(30));
    EXPECT_TRUE(outer->recursivelyContainsMedia(b));
    expectExactUndo(UnGroupCmd::create(outer));
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{inner, c}));
    EXPECT_EQ(snapshot(), withInner);
}

// Ungrouping shows only the group's window: clips are cut to it, a clip it
// hides stays inside, and a track that is taken sends a clip to a new one.
TEST_F(GroupCommand, UngroupCutsToTheWindowAndFindsFreeTracks) {
    const auto lower = newTrack();
    const MediaPtr a = place(0, 20), b = placeOn(lower, 5, 10), hidden = place(40, 10);
    const GroupPtr group = grouped({a, b, hidden});
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, group, 20))); // shows [0, 30)
    ASSERT_TRUE(project->execute(TrimStartCmd::create(track, group, 8)));
    placeOn(lower, 10, 3); // where b would go back
    const size_t tracksBefore = mixer->numTracks();

    expectExactUndo(UnGroupCmd::create(group));
    EXPECT_EQ(a->trackRange(), Range<VelaTime>(8, 12));
    EXPECT_EQ(a->state().mediaStart, SafeRational(8));
    EXPECT_EQ(b->trackRange(), Range<VelaTime>(8, 7));
    EXPECT_EQ(mixer->numTracks(), tracksBefore + 1);
    EXPECT_EQ(mixer->trackAtIndex(unsigned(tracksBefore))->medias(), std::vector<MediaPtr>{b});
    EXPECT_TRUE(group->recursivelyContainsMedia(hidden));
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(mixer->numTracks(), tracksBefore);
}

TEST_F(GroupCommand, RefusalsLeaveEverythingAsItWas) {
    const auto lower = newTrack();
    const MediaPtr a = place(10, 20), b = placeOn(lower, 40, 20);
    place(35, 5); // in the way of a group of a and b on the upper track
    expectRefused(CreateGroupCmd::create({a, b}));
    expectRefused(GroupCmd::create({a, b}));

    const ProjectPtr other = Project::create(30, 1);
    const auto foreignTrack = other->timeline()->newTrack();
    other->timeline()->addTrack(other->newMixer("main"), foreignTrack);
    const MediaPtr foreign = PlaceholderMedia::create(other->token(), other->editRateToken(), 0, 10);
    foreignTrack->addMedia(foreign, 0);
    expectThrowsUnchanged("the clips to group belong to another project", GroupCmd::create({foreign}));
    EXPECT_EQ(foreign->parent(), foreignTrack);

    const MediaPtr c = placeOn(lower, 0, 5);
    const GroupPtr group = grouped({c});
    const MediaPtr inside = group->mixer()->trackAtIndex(0)->medias().front();
    EXPECT_EQ(thrown<VelaMediaLibException>([&] {
                  CreateGroupCmd::create({group, inside});
              }),
              "a clip cannot be grouped with a group that holds it");
    EXPECT_EQ(thrown<VelaMediaLibException>([&] { GroupCmd::create({a, a}); }), "no clips to group");
    EXPECT_EQ(thrown<VelaMediaLibException>([&] { GroupCmd::create({clip(5)}); }),
              "a clip to group lies on no track");
    const auto elsewhere = project->newMixer("other");
    const auto otherTrack = project->timeline()->newTrack();
    project->timeline()->addTrack(elsewhere, otherTrack);
    otherTrack->addMedia(clip(5), 0);
    EXPECT_EQ(thrown<VelaMediaLibException>([&] {
                  CreateGroupCmd::create({a, otherTrack->medias().front()});
              }),
              "the clips to group lie on tracks of more than one mixer");
    expectThrowsUnchanged("the group belongs to another project",
                          UnGroupCmd::create(Group::create(other->token(), other->editRateToken(), 0, 10)));
    expectThrowsUnchanged(
        "the group to ungroup lies on no track",
        UnGroupCmd::create(Group::create(project->token(), project->editRateToken(), 0, 10)));
}

TEST_F(GroupCommand, ResizeUndoesToTheSizeBefore) {
    const GroupPtr group = Group::create(project->token(), project->editRateToken(), 0, 10);
    group->setGroupWidthAndHeight(300, 200);
    ASSERT_TRUE(project->execute(ResizeGroupCmd::create(group, 640, 360)));
    EXPECT_EQ(std::make_pair(group->width(), group->height()), std::make_pair(640, 360));
    EXPECT_FALSE(project->execute(ResizeGroupCmd::create(group, 640, 360))); // nothing to record
    EXPECT_EQ(steps(), 1u);
    ASSERT_TRUE(project->execute(ResizeGroupCmd::create(group, 1280, 360))); // the width alone
    EXPECT_EQ(group->width(), 1280);
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(std::make_pair(group->width(), group->height()), std::make_pair(640, 360));
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(group->groupMediaState().width, 300);
    EXPECT_EQ(group->groupMediaState().height, 200);
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(group->width(), 640);
    EXPECT_THROW(ResizeGroupCmd::create(group, -1, 5), ValueException<int>);
}

} // namespace

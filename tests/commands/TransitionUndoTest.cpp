// Adding a clip joins transitions with its touching neighbours; undoing the
// add, or a removal, must give every clip involved its own slots back, and
// every transition its own links.
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>

#include <gtest/gtest.h>
#include <sstream>

using namespace VelaMediaLib;

namespace {

class TransitionUndo : public ::testing::Test {
protected:
    ProjectPtr project = Project::create(30, 1);
    boost::shared_ptr<GenericTrack> track = project->timeline()->newTrack();

    TransitionUndo() { project->timeline()->addTrack(project->newMixer("main"), track); }
    // Ten ticks of a twenty-tick slice: five more to either side.
    MediaPtr clip() {
        const MediaPtr made =
            PlaceholderMedia::createFromMediaRange(project->token(), project->editRateToken(), 0, 0, 20);
        made->trimStart(5);
        made->trimEnd(5);
        return made;
    }
    static TransitionPtr transition(const char* name) { return TransitionPtr(new Transition(name, 2)); }

    // Each clip's slots and each transition's links, by name.
    static std::string slotsOf(const std::vector<MediaPtr>& clips, const std::vector<TransitionPtr>& all) {
        std::ostringstream out;
        const auto nameOf = [&](const MediaPtr& media) {
            for (size_t i = 0; i < clips.size(); ++i)
                if (clips[i] == media) return std::to_string(i);
            return std::string(media ? "?" : "-");
        };
        for (const MediaPtr& media : clips)
            out << (media->leftTransition() ? media->leftTransition()->name() : "-") << "|"
                << (media->rightTransition() ? media->rightTransition()->name() : "-") << " ";
        for (const TransitionPtr& t : all)
            out << t->name() << ":" << nameOf(t->leftMedia()) << ">" << nameOf(t->rightMedia()) << " ";
        return out.str();
    }
};

} // namespace

TEST_F(TransitionUndo, UndoingAnAddGivesTheClipAndItsNeighboursTheirOwnTransitions) {
    const MediaPtr a = clip(), b = clip(), c = clip();
    const TransitionPtr ta = transition("ta"), tb = transition("tb"), tb2 = transition("tb2"),
                        tc = transition("tc");
    track->addMedia(a, 0);
    track->addMedia(c, 20);
    a->setRightTransition(ta);
    c->setLeftTransition(tc);
    b->setLeftTransition(tb);
    b->setRightTransition(tb2);
    const std::vector<MediaPtr> clips{a, b, c};
    const std::vector<TransitionPtr> all{ta, tb, tb2, tc};
    const std::string before = slotsOf(clips, all);

    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, b, 10)));
    EXPECT_EQ(b->leftTransition(), ta);  // joined with a's
    EXPECT_EQ(c->leftTransition(), tb2); // b's joined with c
    const std::string joined = slotsOf(clips, all);
    ASSERT_TRUE(project->undo());
    EXPECT_FALSE(track->hasMedia(b));
    EXPECT_EQ(slotsOf(clips, all), before);
    EXPECT_EQ(tb->rightMedia(), b);
    EXPECT_NE(ta->rightMedia(), b);
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(slotsOf(clips, all), joined);
}

// Two clips that meet with transitions of their own (set directly): putting
// the removed clip back would join them into one.
TEST_F(TransitionUndo, UndoingARemovalGivesBackTheTransitionsTheClipsHad) {
    const MediaPtr a = clip(), b = clip();
    const TransitionPtr ta = transition("ta"), tb = transition("tb");
    track->addMedia(a, 0);
    track->addMedia(b, 10);
    a->setRightTransition(ta);
    b->setLeftTransition(tb);
    const std::vector<MediaPtr> clips{a, b};
    const std::vector<TransitionPtr> all{ta, tb};
    const std::string before = slotsOf(clips, all);
    ASSERT_TRUE(project->execute(RemoveMediaCmd::create(track, b)));
    ASSERT_TRUE(project->undo());
    EXPECT_TRUE(track->hasMedia(b));
    EXPECT_EQ(slotsOf(clips, all), before);
}

// A move or trim that parts two clips sharing a transition, and one that
// brings them together again, undo to the slots and links of before.
TEST_F(TransitionUndo, MovesAndTrimsThatPartOrJoinClipsUndoExactly) {
    const MediaPtr a = clip(), b = clip(), c = clip();
    a->setRightTransition(transition("ab"));
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, a, 0)));
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, b, 10)));
    c->setLeftTransition(transition("c"));
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, c, 25)));
    const std::vector<MediaPtr> clips{a, b, c};
    const std::vector<TransitionPtr> all{a->rightTransition(), c->leftTransition()};
    const std::string before = slotsOf(clips, all);
    for (const CommandPtr& command :
         {CommandPtr(MoveCmd::create(track, b, 5)), CommandPtr(TrimEndCmd::create(track, b, -5)),
          CommandPtr(TrimStartCmd::create(track, c, -5)), CommandPtr(MoveCmd::create(track, a, -3))}) {
        ASSERT_TRUE(project->execute(command));
        ASSERT_TRUE(project->undo());
        EXPECT_EQ(slotsOf(clips, all), before) << command->name();
    }
}

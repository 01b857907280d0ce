// Edge-modification commands, checked on the project's document: undo gives
// the text before byte for byte, redo the text after, and a refusal none other.

#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/AddEdgeModCmd.h>
#include <VelaMediaLib/commands/edits/EdgeModCloneCmd.h>
#include <VelaMediaLib/commands/edits/MoveEdgeModCmd.h>
#include <VelaMediaLib/commands/edits/RemoveEdgeModCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/document/ProjectDocument.h>

#include <boost/make_shared.hpp>
#include <type_traits>

namespace VelaMediaLib {
namespace testing {
namespace {

typedef EdgeModifiable::EdgeModifications Mods;

EdgeModificationPtr mod(VelaTime duration, const std::string& group = "audioFade", double value = 0) {
    return boost::make_shared<EdgeModification>(duration, group, value);
}

class EdgeModCommandTest : public EditTest {
protected:
    MediaPtr a = place(0, 100), b = place(100, 40);

    std::string document() const { return projectToJSONString(*project, true); }

    void expectExactUndo(const CommandPtr& command) {
        const std::string before = document();
        const size_t stepsBefore = steps();
        ASSERT_TRUE(project->execute(command)) << command->name();
        const std::string after = document();
        EXPECT_NE(after, before) << command->name();
        EXPECT_EQ(steps(), stepsBefore + 1) << command->name();
        ASSERT_TRUE(project->undo()) << command->name();
        EXPECT_EQ(document(), before) << command->name();
        ASSERT_TRUE(project->redo()) << command->name();
        EXPECT_EQ(document(), after) << command->name();
    }
    // Refused by exception E (or false when E is void): nothing changed, no step.
    template <typename E>
    void expectRefused(const CommandPtr& command) {
        const std::string before = document();
        const size_t stepsBefore = steps();
        if constexpr (std::is_void<E>::value)
            EXPECT_FALSE(project->execute(command)) << command->name();
        else
            EXPECT_THROW(project->execute(command), E) << command->name();
        EXPECT_EQ(document(), before) << command->name();
        EXPECT_EQ(steps(), stepsBefore) << command->name();
    }
};

TEST_F(EdgeModCommandTest, AddAppendsToItsEdgeAndUndoesExactly) {
    const EdgeModificationPtr first = mod(10, "first"), left = mod(20), right = mod(30);
    a->addLeftEdgeModification(first);
    expectExactUndo(AddLeftEdgeModCmd::create(a, left));
    EXPECT_EQ(a->leftEdgeModifications(), (Mods{first, left}));
    expectExactUndo(AddRightEdgeModCmd::create(a, right));
    EXPECT_EQ(a->rightEdgeModifications(), Mods{right});
    EXPECT_EQ(a->leftEdgeModifications(), (Mods{first, left}));
}

TEST_F(EdgeModCommandTest, AddRefusesWhatDoesNotFitTheClip) {
    const EdgeModificationPtr on = mod(10);
    a->addLeftEdgeModification(on);
    expectRefused<AddRemoveException>(AddLeftEdgeModCmd::create(a, on));
    expectRefused<AddRemoveException>(AddRightEdgeModCmd::create(a, on));
    expectRefused<ValueException<VelaTime>>(AddRightEdgeModCmd::create(b, mod(41)));
    expectRefused<ValueException<VelaTime>>(AddLeftEdgeModCmd::create(b, mod(-1)));
    expectExactUndo(AddRightEdgeModCmd::create(b, mod(40))); // the whole clip fits
    EXPECT_THROW(AddLeftEdgeModCmd::create(MediaPtr(), mod(1)), VelaMediaLibException);
    EXPECT_THROW(AddLeftEdgeModCmd::create(a, EdgeModificationPtr()), VelaMediaLibException);
    EXPECT_THROW(AddEdgeModCmd::create(a, EdgeModificationPtr(), EdgeModificationPtr()),
                 VelaMediaLibException);
}

// Both edges in one step, or neither: a right one that does not fit takes the
// left one back off.
TEST_F(EdgeModCommandTest, AddEdgeModAddsBothEdgesOrNeither) {
    const EdgeModificationPtr in = mod(10), out = mod(20);
    expectExactUndo(AddEdgeModCmd::create(b, in, out));
    EXPECT_EQ(b->leftEdgeModifications(), Mods{in});
    EXPECT_EQ(b->rightEdgeModifications(), Mods{out});
    expectRefused<ValueException<VelaTime>>(AddEdgeModCmd::create(a, mod(5), mod(101)));
    expectRefused<AddRemoveException>(AddEdgeModCmd::create(a, in, in)); // one object, one edge
    expectExactUndo(AddEdgeModCmd::create(a, EdgeModificationPtr(), mod(5)));
}

// Undo puts the modification back where it stood, so the edge's order returns.
TEST_F(EdgeModCommandTest, RemoveUndoesToTheSamePlaceInTheEdge) {
    const EdgeModificationPtr x = mod(1, "x"), y = mod(2, "y"), z = mod(3, "z");
    for (const EdgeModificationPtr& m : {x, y, z}) a->addRightEdgeModification(m);
    const EdgeModificationPtr left = mod(4);
    a->addLeftEdgeModification(left);
    expectExactUndo(RemoveRightEdgeModCmd::create(a, y));
    EXPECT_EQ(a->rightEdgeModifications(), (Mods{x, z}));
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(a->rightEdgeModifications(), (Mods{x, y, z}));
    expectExactUndo(RemoveLeftEdgeModCmd::create(a, left));
    EXPECT_TRUE(a->leftEdgeModifications().empty());
    expectRefused<AddRemoveException>(RemoveLeftEdgeModCmd::create(a, x));  // on the other edge
    expectRefused<AddRemoveException>(RemoveRightEdgeModCmd::create(b, x)); // on another clip
}

// Undo is not an addition: it gives back a fade that the clip, trimmed since,
// has become shorter than.
TEST_F(EdgeModCommandTest, UndoGivesBackAModificationLongerThanTheTrimmedClip) {
    const EdgeModificationPtr fade = mod(80);
    ASSERT_TRUE(project->execute(AddLeftEdgeModCmd::create(a, fade)));
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, a, 70)));
    expectExactUndo(RemoveLeftEdgeModCmd::create(a, fade));
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(a->leftEdgeModifications(), Mods{fade});
    expectExactUndo(MoveLeftEdgeModCmd::create(a, fade, -60)); // back within the clip
    EXPECT_EQ(fade->duration(), 20);
}

// A left modification's inner end is clip start + duration, a right one's
// clip end - duration: moving either to the right lengthens the left one and
// shortens the right one, within [0, the clip's duration].
TEST_F(EdgeModCommandTest, MoveShiftsTheInnerEndWithinTheClip) {
    const EdgeModificationPtr in = mod(10), out = mod(10);
    b->addLeftEdgeModification(in);
    b->addRightEdgeModification(out);
    expectExactUndo(MoveLeftEdgeModCmd::create(b, in, 5));
    EXPECT_EQ(in->duration(), 15);
    expectExactUndo(MoveRightEdgeModCmd::create(b, out, 5));
    EXPECT_EQ(out->duration(), 5);
    expectExactUndo(MoveRightEdgeModCmd::create(b, out, -35)); // the whole clip
    expectRefused<ValueException<VelaTime>>(MoveRightEdgeModCmd::create(b, out, -1));
    expectRefused<ValueException<VelaTime>>(MoveLeftEdgeModCmd::create(b, in, -16));
    expectRefused<ValueException<VelaTime>>(MoveLeftEdgeModCmd::create(b, in, INT64_MIN));
    expectRefused<ValueException<VelaTime>>(MoveLeftEdgeModCmd::create(b, in, INT64_MAX));
    expectRefused<void>(MoveLeftEdgeModCmd::create(b, in, 0));
    expectRefused<AddRemoveException>(MoveLeftEdgeModCmd::create(b, out, 1));
    expectExactUndo(MoveLeftEdgeModCmd::create(b, in, -15)); // down to nothing
    EXPECT_EQ(in->duration(), 0);
}

TEST_F(EdgeModCommandTest, TwoMovesOfOneModificationCombineIntoOneStep) {
    const EdgeModificationPtr in = mod(10), other = mod(10);
    a->addLeftEdgeModification(in);
    a->addRightEdgeModification(other);
    const std::string before = document();
    ASSERT_TRUE(project->execute(MoveLeftEdgeModCmd::create(a, in, 5)));
    ASSERT_TRUE(project->execute(MoveLeftEdgeModCmd::create(a, in, 7)));
    project->combineLastCommands();
    EXPECT_EQ(steps(), 3u);
    const std::string after = document();
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), before);
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(document(), after);
    EXPECT_EQ(in->duration(), 22);

    ASSERT_TRUE(project->execute(MoveLeftEdgeModCmd::create(a, in, 3)));
    ASSERT_TRUE(project->execute(MoveLeftEdgeModCmd::create(a, in, -3))); // cancels out, still replays
    project->combineLastCommands();
    ASSERT_TRUE(project->undo());
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(document(), after);

    ASSERT_TRUE(project->execute(MoveRightEdgeModCmd::create(a, other, 2))); // another one: grouped
    ASSERT_TRUE(project->execute(MoveLeftEdgeModCmd::create(a, in, 1)));
    project->combineLastCommands();
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), after);
}

// The copies are objects of their own: a move of one leaves the other alone.
TEST_F(EdgeModCommandTest, CloneGivesTheOtherClipIndependentCopies) {
    const EdgeModificationPtr in = mod(10), out = mod(20), tint = mod(5, "tint", 0.5);
    a->addLeftEdgeModification(in);
    a->addRightEdgeModification(out);
    a->addRightEdgeModification(tint);
    const EdgeModificationPtr bIn = mod(3), bKeep = mod(4, "keep");
    b->addLeftEdgeModification(bIn);
    b->addLeftEdgeModification(bKeep);
    expectExactUndo(EdgeModCloneCmd::create(a, b));
    const Mods left = b->leftEdgeModifications(), right = b->rightEdgeModifications();
    ASSERT_EQ(left.size(), 2u); // the own fade gave way, the other group stays
    EXPECT_EQ(left[0], bKeep);
    ASSERT_EQ(right.size(), 2u);
    EXPECT_NE(left[1], in);
    EXPECT_EQ(left[1]->duration(), 10);
    EXPECT_EQ(right[1]->group(), "tint");
    EXPECT_EQ(right[1]->value(), 0.5);

    ASSERT_TRUE(project->execute(MoveLeftEdgeModCmd::create(a, in, 20)));
    EXPECT_EQ(left[1]->duration(), 10);
    ASSERT_TRUE(project->execute(MoveRightEdgeModCmd::create(b, right[0], 10)));
    EXPECT_EQ(out->duration(), 20);
    EXPECT_EQ(in->duration(), 30);

    // Redo puts back the same copies, so a later step naming one replays.
    project->undo();
    project->undo();
    project->undo();
    project->redo();
    EXPECT_EQ(b->rightEdgeModifications(), right);
    EXPECT_TRUE(project->redo());
    EXPECT_TRUE(project->redo());
    EXPECT_EQ(right[0]->duration(), 10);
}

TEST_F(EdgeModCommandTest, CloneRefusesAsAWhole) {
    a->addRightEdgeModification(mod(10));
    a->addRightEdgeModification(mod(50, "long"));
    b->addRightEdgeModification(mod(20)); // gives way first, then comes back
    expectRefused<ValueException<VelaTime>>(EdgeModCloneCmd::create(a, b));
    expectRefused<void>(EdgeModCloneCmd::create(b, a, "long")); // nothing of that group
    expectExactUndo(EdgeModCloneCmd::create(a, b, "audioFade"));
    EXPECT_THROW(EdgeModCloneCmd::create(a, a), AddRemoveException);
    EXPECT_THROW(EdgeModCloneCmd::create(a, MediaPtr()), VelaMediaLibException);
}

// A fade changes no clip's place: the magnetic track closes nothing and the
// edit stays one step.
TEST_F(EdgeModCommandTest, OnAMagneticTrackTheEditIsOneStep) {
    track->magneticAttribute()->setValue(true);
    const EdgeModificationPtr fade = mod(10);
    expectExactUndo(AddRightEdgeModCmd::create(b, fade));
    expectExactUndo(MoveRightEdgeModCmd::create(b, fade, -5));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 100}));
}

// The seam: a handler given to a command sees its changes, and its refusal is
// the command's.
TEST_F(EdgeModCommandTest, CommandsActThroughTheirHandler) {
    struct Recorder : EdgeModCommandHandler {
        std::vector<std::string> calls;
        bool refuse = false;
        bool insertEdgeModification(const MediaPtr& m, Edge e, size_t i,
                                    const EdgeModificationPtr& x) override {
            calls.push_back("insert " + std::string(edgeName(e)) + " " + std::to_string(i));
            return !refuse && EdgeModCommandHandler::insertEdgeModification(m, e, i, x);
        }
        bool removeEdgeModification(const MediaPtr& m, Edge e, const EdgeModificationPtr& x) override {
            calls.push_back("remove " + std::string(edgeName(e)));
            return !refuse && EdgeModCommandHandler::removeEdgeModification(m, e, x);
        }
    };
    EXPECT_EQ(&project->edgeModCommandHandler(), &EdgeModCommandHandler::defaultHandler());
    const auto recorder = boost::make_shared<Recorder>();
    const EdgeModificationPtr fade = mod(10);
    a->addLeftEdgeModification(mod(1));
    expectExactUndo(AddLeftEdgeModCmd::create(a, fade, recorder));
    expectExactUndo(RemoveLeftEdgeModCmd::create(a, fade, recorder));
    EXPECT_EQ(recorder->calls, (std::vector<std::string>{"insert left 1", "remove left", "insert left 1",
                                                         "remove left", "insert left 1", "remove left"}));
    recorder->refuse = true;
    expectRefused<void>(AddEdgeModCmd::create(b, mod(1), mod(2), recorder));
}

} // namespace
} // namespace testing
} // namespace VelaMediaLib

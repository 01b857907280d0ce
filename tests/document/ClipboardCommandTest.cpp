#include <gtest/gtest.h>

#include "DocumentTestSupport.h"

#include <VelaMediaLib/document/CopyRangeClippingCmd.h>
#include <VelaMediaLib/document/PasteClippingCmd.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

typedef std::vector<TrackPtr> Tracks;

struct Side {
    ProjectPtr project;
    Tracks tracks;
    std::string document() const { return projectToJSONString(*project, true); }
    size_t steps() const { return project->commandHistory()->undoStack().size(); }
};

} // namespace

// Project "a" plays a video and a still: on track 0 two video slices joined
// by a transition, [0, 90) from media 10 and [90, 150); on track 1 a still at
// [30, 70). Project "b" plays only a screen recording, at [200, 230) of its
// track 0.
class ClipboardCommand : public DocumentFixture {
protected:
    Side a, b;

    void SetUp() override {
        DocumentFixture::SetUp();
        a = side(30, 2);
        const SourcePtr video = a.project->loadSource("/m/video.mp4");
        const auto first = VMFile::create(video, 0, 0, SafeRational(10), SafeRational(90));
        const auto second = VMFile::create(video, 0, 90, SafeRational(200), SafeRational(60));
        place(a, 0, first);
        place(a, 0, second);
        const TransitionPtr fade(new Transition("Fade", 10));
        first->setRightTransition(fade);
        second->setLeftTransition(fade);
        place(a, 1, IMFile::create(a.project->loadSource("/m/still.png"), 0, 30, 40));
        b = side(30, 2);
        place(b, 0,
              ScreenVMFile::create(b.project->loadSource("/m/screen.trec"), 0, 200, SafeRational(0),
                                   SafeRational(30)));
    }

    Side side(unsigned long rate, int trackCount) {
        Side made{Project::create(rate, 1), {}};
        made.project->sourceBin()->setFileSystem(files);
        const auto mixer = made.project->newMixer("main");
        for (int i = 0; i < trackCount; ++i) {
            made.tracks.push_back(made.project->timeline()->newTrack());
            made.project->timeline()->addTrack(mixer, made.tracks.back());
        }
        return made;
    }
    static void place(const Side& side, int track, const MediaPtr& media) {
        boost::dynamic_pointer_cast<GenericTrack>(side.tracks[track])->addMedia(media, media->startTime());
    }
    std::string copy(const Side& from, const Range<VelaTime>& range) {
        const auto command = CopyRangeClippingCmd::create(from.tracks, range);
        const std::string before = from.document();
        EXPECT_FALSE(from.project->execute(command)); // no undo step
        EXPECT_EQ(from.document(), before);
        EXPECT_EQ(from.steps(), 0u);
        return command->clippingText();
    }
    // Executes, then asks that undo gives the document back byte for byte and redo the executed one.
    static void expectExactUndo(const Side& side, const CommandPtr& command) {
        const std::string before = side.document();
        ASSERT_TRUE(side.project->execute(command)) << command->name();
        const std::string after = side.document();
        EXPECT_NE(after, before);
        ASSERT_TRUE(side.project->undo());
        EXPECT_EQ(side.document(), before) << command->name();
        ASSERT_TRUE(side.project->redo());
        EXPECT_EQ(side.document(), after) << command->name();
    }
    // The command throws E or reports false, leaving the document and the history as they were.
    template <typename E = void>
    static void expectRefused(const Side& side, const CommandPtr& command) {
        const std::string before = side.document();
        const size_t steps = side.steps();
        if constexpr (std::is_void<E>::value)
            EXPECT_FALSE(side.project->execute(command));
        else
            EXPECT_THROW(side.project->execute(command), E);
        EXPECT_EQ(side.document(), before);
        EXPECT_EQ(side.steps(), steps);
    }
};

TEST_F(ClipboardCommand, ACopyPastesIntoAnotherProjectWithItsSources) {
    const std::string text = copy(a, Range<VelaTime>(60, 60));
    const auto paste = PasteClippingCmd::create(text, b.tracks, 300);
    expectExactUndo(b, paste);
    EXPECT_EQ(b.project->sourceBin()->numSources(), 3u);
    ASSERT_EQ(b.tracks[0]->numMedias(), 3u);
    const auto clips = b.tracks[0]->medias();
    EXPECT_EQ(clips[1]->trackRange(), Range<VelaTime>(300, 30));
    EXPECT_EQ(clips[1]->state().mediaStart, SafeRational(70)); // plays on from the cut
    EXPECT_EQ(clips[2]->trackRange(), Range<VelaTime>(330, 30));
    ASSERT_TRUE(clips[1]->rightTransition());
    EXPECT_EQ(clips[1]->rightTransition(), clips[2]->leftTransition());
    EXPECT_EQ(clips[1]->rightTransition()->name(), "Fade");
    EXPECT_EQ(b.tracks[1]->medias().front()->trackRange(), Range<VelaTime>(300, 10));
    // What was pasted is what was copied.
    EXPECT_EQ(CopyRangeClippingCmd::clippingDocument(*b.project, b.tracks, Range<VelaTime>(300, 60)), text);
    EXPECT_EQ(paste->pastedMedias().size(), 3u);
}

TEST_F(ClipboardCommand, TwoEntriesOfOneFileAddOneSource) {
    std::string text = copy(a, Range<VelaTime>(60, 60));
    const size_t first = text.find("{\"id\":1,");
    const std::string entry = "{\"id\":7," + text.substr(first + 8, text.find(",{\"id\":2,") - first - 8);
    text.insert(first, entry + ","); // the video's entry again, under another id
    const std::string second = "\"id\":4,\"_type\":\"VMFile\",\"src\":1";
    text.replace(text.find(second), second.size(), "\"id\":4,\"_type\":\"VMFile\",\"src\":7");
    expectExactUndo(b, PasteClippingCmd::create(text, b.tracks, 300));
    EXPECT_EQ(b.project->sourceBin()->numSources(), 3u);
}

TEST_F(ClipboardCommand, APasteIntoTheSameProjectAddsNoSourceAndPastesTwice) {
    const std::string text = copy(a, Range<VelaTime>(0, 150));
    expectExactUndo(a, PasteClippingCmd::create(text, a.tracks, 200));
    EXPECT_EQ(a.project->sourceBin()->numSources(), 2u);
    expectExactUndo(a, PasteClippingCmd::create(text, a.tracks, 400));
    EXPECT_EQ(a.tracks[0]->numMedias(), 6u);
    EXPECT_EQ(a.project->sourceBin()->numSources(), 2u);
}

TEST_F(ClipboardCommand, TransitionsComeAlongOnlyWholeAndWhereTheyFit) {
    // The right clip is cut down to 5 ticks, shorter than the transition: it stays behind.
    const std::string text = copy(a, Range<VelaTime>(85, 30));
    ASSERT_TRUE(b.project->execute(PasteClippingCmd::create(text, b.tracks, 300)));
    for (const MediaPtr& clip : b.tracks[0]->medias()) {
        EXPECT_FALSE(clip->leftTransition());
        EXPECT_FALSE(clip->rightTransition());
    }
    // The left clip alone: its transition's other clip is not copied.
    b.project->undo();
    ASSERT_TRUE(b.project->execute(PasteClippingCmd::create(copy(a, Range<VelaTime>(0, 90)), b.tracks, 300)));
    EXPECT_FALSE(b.tracks[0]->medias()[1]->rightTransition());
}

TEST_F(ClipboardCommand, APasteOfAnotherRateIsRefusedWithTheParsersText) {
    const Side other = side(25, 1);
    const std::string text = copy(a, Range<VelaTime>(0, 60));
    try {
        other.project->execute(PasteClippingCmd::create(text, other.tracks, 0));
        FAIL() << "pasted a clipping of another rate";
    } catch (const ParserException& e) {
        EXPECT_NE(std::string(e.what()).find("clipping of another edit rate"), std::string::npos) << e.what();
    }
    EXPECT_EQ(other.project->sourceBin()->numSources(), 0u);
    expectRefused<ParserException>(other, PasteClippingCmd::create(text, other.tracks, 0));
}

TEST_F(ClipboardCommand, ACollidingPasteIsRefusedAndAddsNoSource) {
    const std::string text = copy(a, Range<VelaTime>(60, 60));
    // Track 1's clip would land beside the screen clip, track 0's on it: the sources added first go again.
    expectRefused(b, PasteClippingCmd::create(text, b.tracks, 180));
    EXPECT_EQ(b.project->sourceBin()->numSources(), 1u);
    expectRefused(a, CopyRangeAndPasteCmd::create(a.tracks, Range<VelaTime>(0, 60), 30));
}

TEST_F(ClipboardCommand, BadTextsAndArgumentsAreRefusedChangingNothing) {
    const std::string text = copy(a, Range<VelaTime>(60, 60));
    expectRefused<ParserException>(b, PasteClippingCmd::create("not a clipping", b.tracks, 300));
    std::string dangling = text;
    dangling.replace(dangling.find("\"src\":1,\"track"), 7, "\"src\":9");
    expectRefused<ParserException>(b, PasteClippingCmd::create(dangling, b.tracks, 300));
    // Two tracks of clips onto one track, and tracks of another project.
    expectRefused<VelaMediaLibException>(b, PasteClippingCmd::create(text, {b.tracks[0]}, 300));
    expectRefused<VelaMediaLibException>(b, PasteClippingCmd::create(text, a.tracks, 300));
    EXPECT_THROW(PasteClippingCmd::create(text, {}, 0), VelaMediaLibException);
    EXPECT_THROW(PasteClippingCmd::create(text, b.tracks, -1), VelaMediaLibException);
    EXPECT_THROW(CopyRangeClippingCmd::create(a.tracks, Range<VelaTime>(10, 0)), VelaMediaLibException);
    EXPECT_THROW(CutRangeClippingCmd::create({TrackPtr()}, Range<VelaTime>(0, 10)), VelaMediaLibException);
}

TEST_F(ClipboardCommand, ACutTakesTheRangeOutExactlyAndPastesBack) {
    const std::string copied = copy(a, Range<VelaTime>(60, 60));
    const auto cut = CutRangeClippingCmd::create(a.tracks, Range<VelaTime>(60, 60));
    expectExactUndo(a, cut);
    EXPECT_EQ(cut->clippingText(), copied);
    EXPECT_EQ(a.project->commandHistory()->undoStack().size(), 1u);
    ASSERT_EQ(a.tracks[0]->numMedias(), 2u);
    EXPECT_EQ(a.tracks[0]->medias()[0]->trackRange(), Range<VelaTime>(0, 60));
    EXPECT_EQ(a.tracks[0]->medias()[1]->trackRange(), Range<VelaTime>(120, 30));
    EXPECT_EQ(a.tracks[1]->medias()[0]->trackRange(), Range<VelaTime>(30, 30));
    // Pasting the cut back where it was gives the clips the range held.
    expectExactUndo(a, PasteClippingCmd::create(cut->clippingText(), a.tracks, 60));
    EXPECT_EQ(CopyRangeClippingCmd::clippingDocument(*a.project, a.tracks, Range<VelaTime>(60, 60)), copied);
    // A range holding nothing is no step.
    const auto empty = CutRangeClippingCmd::create(a.tracks, Range<VelaTime>(1000, 10));
    expectRefused(a, empty);
    EXPECT_FALSE(empty->clippingText().empty());
}

TEST_F(ClipboardCommand, CopyAndPasteIsOneStep) {
    const auto both = CopyRangeAndPasteCmd::create(a.tracks, Range<VelaTime>(0, 150), 150);
    expectExactUndo(a, both);
    EXPECT_EQ(a.steps(), 1u);
    EXPECT_EQ(both->pastedMedias().size(), 3u);
    EXPECT_EQ(a.tracks[0]->medias()[2]->trackRange(), Range<VelaTime>(150, 90));
    // Onto other tracks: b's of another project are refused.
    expectRefused<VelaMediaLibException>(
        a, CopyRangeAndPasteCmd::create(a.tracks, Range<VelaTime>(0, 10), 0, b.tracks));
}

TEST_F(ClipboardCommand, ACutOnAMagneticTrackClosesTheGapAsAStepOfItsOwn) {
    a.tracks[0]->magneticAttribute()->setValue(true);
    const std::string before = a.document();
    ASSERT_TRUE(a.project->execute(CutRangeClippingCmd::create({a.tracks[0]}, Range<VelaTime>(30, 30))));
    EXPECT_EQ(a.steps(), 2u); // the cut, then the closing
    const auto clips = a.tracks[0]->medias();
    ASSERT_EQ(clips.size(), 3u);
    EXPECT_EQ(clips[1]->trackRange(), Range<VelaTime>(30, 30));
    EXPECT_EQ(clips[2]->trackRange(), Range<VelaTime>(60, 60));
    a.project->undo();
    a.project->undo();
    EXPECT_EQ(a.document(), before);
}

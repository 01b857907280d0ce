#include "../JsonTestSupport.h"
#include "AnimationTestSupport.h"

#include <VelaMediaLib/commands/edits/AddAnimationCmd.h>
#include <VelaMediaLib/commands/edits/MergeAnimationsCmd.h>
#include <VelaMediaLib/commands/edits/MoveAnimationCmd.h>
#include <VelaMediaLib/commands/edits/RemoveAnimationCmd.h>
#include <VelaMediaLib/commands/edits/SetAnimationInterpolaterCmd.h>
#include <VelaMediaLib/commands/edits/SplitAnimationCmd.h>
#include <VelaMediaLib/commands/edits/TrimAnimationCmd.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

// Each animation as "start+length end/lead-in interp".
std::vector<std::string> spans(const MediaPtr& media, const std::string& name) {
    std::vector<std::string> result;
    AnimationTracksEditCmd::AnimationLists lists = AnimationTracksEditCmd::animationsOf(media);
    for (const auto& a : lists[name])
        result.push_back(std::to_string(a.range.start()) + "+" + std::to_string(a.range.duration()) + " " +
                         std::to_string(a.endTime) + "/" + std::to_string(a.duration) + " " + a.interp);
    return result;
}

class AnimationCommand : public DocumentEditTest {
protected:
    MediaPtr media = place(0, 100);

    void animate(VelaTime start, VelaTime length, const std::string& name = "opacity") {
        ASSERT_TRUE(project->execute(AddAnimationCmd::create(media, name, Range<VelaTime>(start, length))));
    }
};

typedef std::vector<std::string> Spans;

} // namespace

TEST_F(AnimationCommand, AddsAndRemovesUndoToTheExactDocument) {
    expectExactDocumentUndo(AddAnimationCmd::create(media, "opacity", Range<VelaTime>(20, 30), "esIn"));
    EXPECT_EQ(spans(media, "opacity"), Spans{"20+30 50/30 esIn"});
    AnimationTrack::Animation preset;
    preset.range = Range<long long>(60, 10);
    preset.endTime = 70;
    preset.duration = 4;
    preset.keyframes.push_back({"scale", JSONTree(), "linr"});
    expectExactDocumentUndo(AddAnimationWithDescriptionCmd::create(media, "opacity", preset));
    EXPECT_EQ(spans(media, "opacity"), (Spans{"20+30 50/30 esIn", "60+10 70/4 "}));
    animate(0, 10, "scale");
    expectExactDocumentUndo(RemoveAnimationCmd::create(media, "opacity", 60));
    expectExactDocumentUndo(RemoveAllAnimationsCmd::create(media, "opacity"));
    EXPECT_TRUE(spans(media, "opacity").empty());
    EXPECT_EQ(spans(media, "scale").size(), 1u);
    expectExactDocumentUndo(RemoveAllAnimationsCmd::create(media));
    EXPECT_TRUE(AnimationTracksEditCmd::animationsOf(media).empty());
}

TEST_F(AnimationCommand, BadArgumentsThrowAndRefusalsChangeNothing) {
    animate(20, 30);
    animate(60, 10);
    EXPECT_EQ(thrown<VelaMediaLibException>(
                  [&] { AddAnimationCmd::create(media, "loudness", Range<VelaTime>(0, 5)); }),
              "the clip has no parameter \"loudness\"");
    EXPECT_THROW(AddAnimationCmd::create(media, "opacity", Range<VelaTime>(0, -5)),
                 ValueException<long long>);
    EXPECT_THROW(AddAnimationCmd::create(media, "opacity", Range<VelaTime>(-1, 5)),
                 ValueException<long long>);
    EXPECT_THROW(AddAnimationCmd::create(media, "opacity", Range<VelaTime>(0, 5), "nope"),
                 VelaMediaLibException);
    EXPECT_THROW(SetAnimationInterpolaterCmd::create(media, "opacity", 20, "nope"), VelaMediaLibException);
    EXPECT_THROW(MergeAnimationsCmd::create(media, "opacity", 60, 20), ValueException<long long>);
    EXPECT_THROW(AddAnimationCmd::create(MediaPtr(), "opacity", Range<VelaTime>(0, 5)),
                 VelaMediaLibException);
    AnimationTrack::Animation badEnd;
    badEnd.range = Range<long long>(0, 10);
    badEnd.endTime = 9;
    EXPECT_THROW(AddAnimationWithDescriptionCmd::create(media, "opacity", badEnd), ValueException<long long>);

    const std::string before = document();
    expectRefusedDocument(AddAnimationCmd::create(media, "opacity", Range<VelaTime>(45, 10))); // overlaps
    expectRefusedDocument(RemoveAnimationCmd::create(media, "opacity", 21));                   // none there
    expectRefusedDocument(RemoveAllAnimationsCmd::create(media, "scale"));
    expectRefusedDocument(MoveAnimationCmd::create(media, "opacity", 20, 15));  // onto the next
    expectRefusedDocument(MoveAnimationCmd::create(media, "opacity", 20, -21)); // before the clip
    expectRefusedDocument(MoveAnimationCmd::create(media, "opacity", 20, 0));
    expectRefusedDocument(MoveAnimationsCmd::create(media, "opacity", {20, 61}, 5));          // one missing
    expectRefusedDocument(TrimAnimationStartCmd::create(media, "opacity", 20, 30));           // no tick left
    expectRefusedDocument(TrimAnimationEndCmd::create(media, "opacity", 20, -11));            // onto the next
    expectRefusedDocument(SplitAnimationCmd::create(media, "opacity", 20, 50));               // at its end
    expectRefusedDocument(SetAnimationInterpolaterCmd::create(media, "opacity", 20, "linr")); // already
    animate(52, 6);
    const std::string withMiddle = document();
    expectRefusedDocument(MergeAnimationsCmd::create(media, "opacity", 20, 60)); // one lies between
    EXPECT_EQ(document(), withMiddle);
    EXPECT_NE(before, withMiddle);
}

TEST_F(AnimationCommand, MovesTrimsSplitsAndMergesKeepTheirSpans) {
    animate(20, 30);
    animate(60, 10);
    expectExactDocumentUndo(MoveAnimationCmd::create(media, "opacity", 20, -20));
    EXPECT_EQ(spans(media, "opacity"), (Spans{"0+30 30/30 linr", "60+10 70/10 linr"}));
    // Together the two may pass where each other stood.
    expectExactDocumentUndo(MoveAnimationsCmd::create(media, "opacity", {0, 60}, 35));
    EXPECT_EQ(spans(media, "opacity"), (Spans{"35+30 65/30 linr", "95+10 105/10 linr"}));
    expectExactDocumentUndo(TrimAnimationStartCmd::create(media, "opacity", 35, 10));
    EXPECT_EQ(spans(media, "opacity")[0], "45+20 65/20 linr");
    expectExactDocumentUndo(TrimAnimationEndCmd::create(media, "opacity", 45, 5));
    EXPECT_EQ(spans(media, "opacity")[0], "45+15 60/15 linr");
    expectExactDocumentUndo(TrimAnimationEndCmd::create(media, "opacity", 45, -35)); // up to the next
    EXPECT_EQ(spans(media, "opacity")[0], "45+50 95/50 linr");
    // The lead-in is cut where it lies: 45..95 split at 80 leaves 35 before, 15 after.
    expectExactDocumentUndo(SplitAnimationCmd::create(media, "opacity", 45, 80));
    EXPECT_EQ(spans(media, "opacity"), (Spans{"45+35 80/35 linr", "80+15 95/15 linr", "95+10 105/10 linr"}));
    expectExactDocumentUndo(MergeAnimationsCmd::create(media, "opacity", 80, 95));
    EXPECT_EQ(spans(media, "opacity"), (Spans{"45+35 80/35 linr", "80+25 105/25 linr"}));
}

TEST_F(AnimationCommand, InterpolatersAndAutomaticCurves) {
    animate(0, 10);
    animate(10, 10);
    expectExactDocumentUndo(SetAnimationInterpolaterCmd::create(media, "opacity", 10, "bnce"));
    expectExactDocumentUndo(SetAnimationAutoInterpolationCmd::create(media, "opacity", true));
    EXPECT_EQ(spans(media, "opacity"), (Spans{"0+10 10/10 ", "10+10 20/10 "}));
    expectRefusedDocument(SetAnimationAutoInterpolationCmd::create(media, "opacity", true));
    expectExactDocumentUndo(SetAnimationAutoInterpolationCmd::create(media, "opacity", false, "esOt"));
    EXPECT_EQ(spans(media, "opacity"), (Spans{"0+10 10/10 esOt", "10+10 20/10 esOt"}));
    EXPECT_THROW(SetAnimationAutoInterpolationCmd::create(media, "opacity", false, ""),
                 VelaMediaLibException);
}

// An animation edit changes no timing, so a magnetic track has no gap to close.
TEST_F(AnimationCommand, OnAMagneticTrackAnEditIsOneStep) {
    track->magneticAttribute()->setValue(true);
    const MediaPtr second = place(100, 50);
    const size_t stepsBefore = steps();
    expectExactDocumentUndo(AddAnimationCmd::create(second, "scale", Range<VelaTime>(5, 10)));
    EXPECT_EQ(steps(), stepsBefore + 1);
    expectExactDocumentUndo(SplitAnimationCmd::create(second, "scale", 5, 8));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 100}));
}

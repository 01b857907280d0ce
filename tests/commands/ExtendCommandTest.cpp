// Extending and reducing clips, tracks, keyframes, animations and effects,
// trimming to a frame and holding a frame: each undoes and redoes to the
// byte, each Reduce gives back what its Extend changed, and refusals leave
// the written project as it was.
#include "../JsonTestSupport.h"
#include "../model/SourceTestSupport.h"
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/ExtendEffectsCmd.h>
#include <VelaMediaLib/commands/edits/ExtendFrameCmd.h>
#include <VelaMediaLib/commands/edits/ExtendMediaAnimationsCmd.h>
#include <VelaMediaLib/commands/edits/ExtendMediaCmd.h>
#include <VelaMediaLib/commands/edits/ExtendParametersCmd.h>
#include <VelaMediaLib/commands/edits/ExtendTracksCmd.h>
#include <VelaMediaLib/commands/edits/StitchingExtendFrameCmd.h>
#include <VelaMediaLib/commands/edits/TrimMediasToFrameCmd.h>
#include <VelaMediaLib/effects/StoredEffect.h>
#include <VelaMediaLib/model/media/ColorMedia.h>
#include <VelaMediaLib/model/media/IMFile.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/project/SourceBin.h>
#include <VelaMediaLib/model/source/Source.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

std::vector<Range<VelaTime>> effectRanges(const MediaPtr& media) {
    std::vector<Range<VelaTime>> ranges;
    for (const auto& each : media->allEffects()) ranges.push_back(each->timeRange());
    return ranges;
}

std::vector<RationalTime> keyTimes(const MediaPtr& media) { return *opacityOf(media)->keyframeTimes(); }

class ExtendCommand : public EditTest {
protected:
    ExtendCommand() {
        loader->set("a.mov", {stream(TrackType::Video, 0, 3000, 30), stream(TrackType::Image, 0, 1, 30)});
        loader->set("b.mov", {stream(TrackType::Video, 0, 3000, 30)});
        project->sourceBin()->setFileSystem(files);
        source = project->sourceBin()->loadFile("a.mov");
    }
    // A clip of the video playing from mediaStart, placed at start.
    MediaPtr shot(VelaTime start, VelaTime mediaStart, VelaTime duration, const TrackPtr& on = TrackPtr()) {
        clips.push_back(VMFile::create(source, 0, start, SafeRational(mediaStart), SafeRational(duration)));
        EXPECT_TRUE(project->execute(AddMediaCmd::create(on ? on : track, clips.back(), start)));
        return clips.back();
    }
    MediaPtr color(VelaTime start, VelaTime duration, const TrackPtr& on = TrackPtr()) {
        clips.push_back(ColorMedia::create(project->token(), project->editRateToken(), 0, duration));
        EXPECT_TRUE(project->execute(AddMediaCmd::create(on ? on : track, clips.back(), start)));
        return clips.back();
    }
    void keyframes(const MediaPtr& media, std::vector<VelaTime> times) {
        double value = 0;
        for (VelaTime time : times)
            opacityOf(media)->addKeyFrame(RationalTime(time), value += 0.25, RationalTime(0));
    }
    // Executing the command throws E and leaves the written project and history as they were.
    template <typename E>
    void expectThrowsUnchanged(const CommandPtr& command) {
        const std::string before = document();
        const size_t stepsBefore = steps();
        EXPECT_THROW(project->execute(command), E) << command->name();
        EXPECT_EQ(document(), before) << command->name();
        EXPECT_EQ(steps(), stepsBefore);
    }
    void expectRefusedUnchanged(const CommandPtr& command) {
        const std::string before = document();
        EXPECT_FALSE(project->execute(command)) << command->name();
        EXPECT_EQ(document(), before) << command->name();
    }
    // Extend, then Reduce with the same arguments, gives back the written project.
    void expectRoundTrip(const CommandPtr& extend, const CommandPtr& reduce) {
        const std::string before = document();
        expectExactDocumentUndo(extend);
        expectExactDocumentUndo(reduce);
        EXPECT_EQ(document(), before) << reduce->name();
    }

    RegisteredTableLoader loader;
    boost::shared_ptr<FakeFileSystem> files = boost::make_shared<FakeFileSystem>();
    SourcePtr source;
};

TEST_F(ExtendCommand, KeyframesFromTheTimeMoveAndComeBack) {
    const MediaPtr media = place(0, 40);
    keyframes(media, {0, 10, 20});
    const std::string original = document();
    expectExactDocumentUndo(ExtendParametersCmd::create(media, 10, 5));
    EXPECT_EQ(keyTimes(media), (std::vector<RationalTime>{0, 15, 25}));
    expectExactDocumentUndo(ReduceParametersCmd::create(media, 10, 5));
    EXPECT_EQ(document(), original);

    // A keyframe inside the removed time has nowhere to go; nothing from the time on is nothing to do.
    expectThrowsUnchanged<KeyFrameException>(ReduceParametersCmd::create(media, 5, 10));
    expectRefusedUnchanged(ExtendParametersCmd::create(media, 30, 5));
    EXPECT_THROW(ExtendParametersCmd::create(media, 0, -1), VelaMediaLibException);
}

TEST_F(ExtendCommand, AnimationsGoWithTheirEndKeyframe) {
    const MediaPtr media = place(0, 40);
    AnimationTrack::Animation first, second;
    first.range = Range<long long>(5, 5);
    first.endTime = 10;
    second.range = Range<long long>(15, 5);
    second.endTime = 20;
    first.duration = second.duration = 5;
    first.interp = second.interp = "linr";
    dynamic_cast<MediaImpl&>(*media).setAnimationTrack(AnimationTrack("opacity", {first, second}));
    expectRoundTrip(ExtendMediaAnimationsCmd::create(media, 12, 4),
                    ReduceMediaAnimationsCmd::create(media, 12, 4));

    ASSERT_TRUE(project->execute(ExtendMediaAnimationsCmd::create(media, 12, 4)));
    const auto moved = dynamic_cast<MediaImpl&>(*media).animationTracks().at("opacity").animations();
    EXPECT_EQ(moved[0].range, Range<long long>(5, 5));
    EXPECT_EQ(moved[1].range, Range<long long>(19, 5));
    EXPECT_EQ(moved[1].endTime, 24);
    expectThrowsUnchanged<VelaMediaLibException>(ReduceMediaAnimationsCmd::create(media, 8, 4));
}

TEST_F(ExtendCommand, EffectsMoveGrowOrStayByWhereTheyMeetTheTime) {
    const MediaPtr media = place(0, 40);
    for (const auto& each : {storedEffect("Blur", 0, 10), storedEffect("Glow", 5, 15),
                             storedEffect("Tint", 10, 5), storedEffect("DeviceFrameEffect", 0, 10)})
        media->addEffect(each);
    expectRoundTrip(ExtendEffectsCmd::create(media, 10, 5), ReduceEffectsCmd::create(media, 10, 5));

    ASSERT_TRUE(project->execute(ExtendEffectsCmd::create(media, 10, 5)));
    EXPECT_EQ(effectRanges(media), (std::vector<Range<VelaTime>>{{0, 10}, {5, 20}, {15, 5}, {0, 15}}));
    // Reducing over the moved effect's time drops it; undo brings it back.
    const std::string extended = document();
    ASSERT_TRUE(project->execute(ReduceEffectsCmd::create(media, 14, 8)));
    EXPECT_EQ(effectRanges(media), (std::vector<Range<VelaTime>>{{0, 10}, {5, 12}, {0, 14}}));
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), extended);
}

TEST_F(ExtendCommand, AClipGrowsAtBothEndsWithItsContentInPlace) {
    const MediaPtr media = shot(50, 100, 20);
    keyframes(media, {0, 10});
    media->addEffect(storedEffect("Blur", 2, 6));
    media->addEffect(storedEffect("DeviceFrameEffect", 0, 20));
    expectRoundTrip(ExtendMediaCmd::create(media, 10, 5), ReduceMediaCmd::create(media, 10, 5));

    ASSERT_TRUE(project->execute(ExtendMediaCmd::create(media, 10, 5)));
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(40, 35));
    EXPECT_EQ(media->state().mediaStart, SafeRational(90));
    EXPECT_EQ(keyTimes(media), (std::vector<RationalTime>{10, 20}));
    EXPECT_EQ(effectRanges(media), (std::vector<Range<VelaTime>>{{12, 6}, {0, 35}}));
}

TEST_F(ExtendCommand, AClipExtensionIsRefusedWithoutRoomOrMedia) {
    const MediaPtr media = shot(50, 100, 20);
    place(30, 15);
    expectRefusedUnchanged(ExtendMediaCmd::create(media, 10, 0));   // runs into the clip before
    expectRefusedUnchanged(ExtendMediaCmd::create(media, 0, 3000)); // past the file's end
    expectRefusedUnchanged(ReduceMediaCmd::create(media, 10, 10));  // nothing left
    expectRefusedUnchanged(ExtendMediaCmd::create(media, 0, 0));
    EXPECT_THROW(ExtendMediaCmd::create(media, -1, 0), VelaMediaLibException);
    MultiTrackEditOptions options;
    options.tracks.push_back(newTrack());
    EXPECT_THROW(ExtendMediaCmd::create(media, 1, 0, options, false), VelaMediaLibException);
    expectThrowsUnchanged<VelaMediaLibException>(ExtendMediaCmd::create(clip(10), 1, 1));
}

TEST_F(ExtendCommand, ARipplingExtensionKeepsTheStartAndMovesWhatFollows) {
    const MediaPtr media = shot(50, 100, 20);
    const MediaPtr after = place(80, 10);
    const auto other = newTrack();
    const MediaPtr across = color(60, 30, other); // across the clip's end, 70
    MultiTrackEditOptions options;
    options.tracks.push_back(other);
    expectRoundTrip(ExtendMediaCmd::create(media, 10, 5, options, true),
                    ReduceMediaCmd::create(media, 10, 5, options, true));

    ASSERT_TRUE(project->execute(ExtendMediaCmd::create(media, 10, 5, options, true)));
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(50, 35));
    EXPECT_EQ(after->startTime(), 95);
    // The other track opened 10 at 50 (moving the still) and 5 at 80 (extending it there).
    EXPECT_EQ(across->trackRange(), Range<VelaTime>(70, 35));
}

TEST_F(ExtendCommand, TracksExtendAStillAndSplitAClipAcrossTheTime) {
    const MediaPtr still = color(0, 30);
    keyframes(still, {0, 25});
    const MediaPtr later = place(40, 10);
    const auto other = newTrack();
    const MediaPtr video = shot(0, 100, 30, other);

    const auto extend = ExtendTracksCmd::create(20, 10);
    extend->addTrack(track);
    extend->addTrack(other);
    expectExactDocumentUndo(extend);
    EXPECT_EQ(still->trackRange(), Range<VelaTime>(0, 40));
    EXPECT_EQ(keyTimes(still), (std::vector<RationalTime>{0, 35}));
    EXPECT_EQ(later->startTime(), 50);
    ASSERT_EQ(other->medias().size(), 2u);
    EXPECT_EQ(video->trackRange(), Range<VelaTime>(0, 20));
    EXPECT_EQ(other->medias()[1]->startTime(), 30);

    // Reduce removes only free time or time of a clip across it.
    const auto blocked = ReduceTracksCmd::create(45, 10);
    blocked->addTrack(track);
    expectThrowsUnchanged<VelaMediaLibException>(blocked);
    EXPECT_THROW(project->execute(ReduceTracksCmd::create(20, 10)), VelaMediaLibException); // no track
}

TEST_F(ExtendCommand, ReducingTracksGivesBackWhatExtendingOpened) {
    const MediaPtr still = color(0, 30);
    keyframes(still, {0, 25});
    still->addEffect(storedEffect("Glow", 10, 15));
    place(40, 10);
    const auto extend = ExtendTracksCmd::create(20, 10);
    const auto reduce = ReduceTracksCmd::create(20, 10);
    extend->addTrack(track);
    reduce->addTrack(track);
    expectRoundTrip(extend, reduce);
}

TEST_F(ExtendCommand, TrimmingToAFrameEndsClipsThere) {
    const MediaPtr media = place(0, 30);
    const auto other = newTrack();
    const MediaPtr across = shot(10, 100, 30, other);
    const MediaPtr after = place(40, 10);
    expectThrowsUnchanged<VelaMediaLibException>(TrimMediasToFrameCmd::create(media, 35));
    expectRefusedUnchanged(TrimMediasToFrameCmd::create(media, 30));
    expectExactDocumentUndo(TrimMediasToFrameCmd::create(media, 20));
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(0, 20));

    expectExactDocumentUndo(TrimMediasToFrameCmd::create(mixer, 15));
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(0, 15));
    EXPECT_EQ(across->trackRange(), Range<VelaTime>(10, 5));
    EXPECT_EQ(after->trackRange(), Range<VelaTime>(40, 10));
    expectRefusedUnchanged(TrimMediasToFrameCmd::create(mixer, 100));
}

TEST_F(ExtendCommand, AHeldFrameIsAStillOfTheSourceInsertedAtTheTime) {
    const MediaPtr media = shot(50, 100, 30);
    const MediaPtr after = place(90, 10);
    const auto hold = ExtendFrameCmd::create(media, 60, 15);
    expectExactDocumentUndo(hold);
    const MediaPtr still = hold->createdImageMedia();
    ASSERT_TRUE(boost::dynamic_pointer_cast<IMFile>(still));
    EXPECT_EQ(still->trackRange(), Range<VelaTime>(60, 15));
    EXPECT_EQ(still->state().mediaStart, SafeRational(110));
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(50, 10));
    EXPECT_EQ(hold->followingMedia()->trackRange(), Range<VelaTime>(75, 20));
    EXPECT_EQ(after->startTime(), 105);
}

TEST_F(ExtendCommand, AnOverwritingHeldFrameMovesNothingAfterIt) {
    const MediaPtr media = shot(50, 100, 30);
    const MediaPtr after = place(80, 10);
    const auto hold = ExtendFrameCmd::create(media, 60, 5, false);
    expectExactDocumentUndo(hold);
    EXPECT_EQ(hold->followingMedia()->trackRange(), Range<VelaTime>(65, 15));
    EXPECT_EQ(hold->followingMedia()->state().mediaStart, SafeRational(115));
    EXPECT_EQ(after->startTime(), 80);
    expectRefusedUnchanged(ExtendFrameCmd::create(media, 55, 30, false)); // longer than what follows
}

TEST_F(ExtendCommand, AFrameWithoutAStillIsRefused) {
    const MediaPtr media = shot(50, 100, 30);
    expectThrowsUnchanged<VelaMediaLibException>(ExtendFrameCmd::create(media, 80, 5)); // at its end
    expectThrowsUnchanged<VelaMediaLibException>(ExtendFrameCmd::create(place(0, 20), 5, 5));
    clips.push_back(
        VMFile::create(project->sourceBin()->loadFile("b.mov"), 0, 100, SafeRational(0), SafeRational(10)));
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, clips.back(), 100)));
    EXPECT_EQ(thrown<VelaMediaLibException>(
                  [&] { project->execute(ExtendFrameCmd::create(clips.back(), 105, 5)); }),
              "the clip's source has no still image");
    EXPECT_THROW(ExtendFrameCmd::create(media, 60, 0), VelaMediaLibException);
}

TEST_F(ExtendCommand, AStitchedHeldFrameIsOneClip) {
    const MediaPtr media = shot(50, 100, 30);
    const auto hold = StitchingExtendFrameCmd::create(media, "Hold Frame", 60, 15, 5);
    EXPECT_EQ(hold->name(), "Hold Frame");
    expectExactDocumentUndo(hold);
    ASSERT_TRUE(hold->stitchedMedia());
    EXPECT_EQ(track->medias().size(), 1u);
    EXPECT_EQ(hold->stitchedMedia()->trackRange(), Range<VelaTime>(50, 40));
    EXPECT_EQ(hold->stitchedMedia()->numStitches(), 2u);
}

TEST_F(ExtendCommand, AReductionOnAMagneticTrackLetsTheMagnetCloseTheGap) {
    track->magneticAttribute()->setValue(true);
    const MediaPtr media = place(0, 30);
    place(30, 10);
    const std::string original = document();
    ASSERT_TRUE(project->execute(ReduceMediaCmd::create(media, 0, 10)));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 20}));
    while (steps() > 2) ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), original);
}

} // namespace

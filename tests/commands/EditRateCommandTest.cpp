#include "EditTestSupport.h"
// (gtest first: the document fixtures build on it)
#include "../document/DocumentTestSupport.h"

#include <VelaMediaLib/commands/edits/ChangeProjectEditRateCmd.h>
#include <VelaMediaLib/commands/edits/ScaleMediaEditRateCmd.h>
#include <VelaMediaLib/commands/edits/ScaleMixerEditRateCmd.h>
#include <VelaMediaLib/commands/edits/SetMediaStateCmd.h>

#include <random>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

const boost::rational<unsigned long> kThirty(30, 1), kNtsc60(60000, 1001);

std::string documentOf(const Project& project) { return projectToJSONString(project, true); }

class EditRate : public EditTest {
protected:
    std::string document() const { return documentOf(*project); }
    void execute(const CommandPtr& command) { ASSERT_TRUE(project->execute(command)) << command->name(); }

    // A run of clips at odd ticks: touching pairs with transitions, gaps of
    // at least two ticks, odd media slices and scalars, keyframes, edge
    // modifications, effects, a hotspot and animations.
    void fillWithOddClips(const boost::shared_ptr<GenericTrack>& on, unsigned seed, int count) {
        std::mt19937 random(seed);
        const auto pick = [&](int lo, int hi) { return std::uniform_int_distribution<int>(lo, hi)(random); };
        const SafeRational scalars[] = {SafeRational(1), SafeRational(3, 2), SafeRational(2, 3),
                                        SafeRational(7, 5)};
        VelaTime at = pick(-40, 40);
        MediaPtr previous;
        for (int i = 0; i < count; ++i) {
            const SafeRational mediaDuration(pick(7, 400), pick(1, 3));
            const MediaPtr media =
                slice(SafeRational(pick(0, 90), pick(1, 7)), mediaDuration, scalars[pick(0, 3)]);
            const bool touching = previous && pick(0, 1);
            if (!touching && previous) at += pick(2, 9);
            on->addMedia(media, at);
            if (touching && pick(0, 1)) {
                const TransitionPtr fade(new Transition("Fade", pick(1, 9)));
                previous->setRightTransition(fade);
                media->setLeftTransition(fade);
            }
            opacityOf(media)->addKeyFrame(RationalTime(SafeRational(pick(4, 150), pick(1, 3))), 0.5,
                                          RationalTime(SafeRational(pick(0, 2), 2)));
            media->addLeftEdgeModification(boost::make_shared<EdgeModification>(pick(1, 11), "fade", 0.0));
            StoredEffect::Fields fields;
            fields.effectName = "Glow";
            fields.start = pick(0, 13);
            fields.duration = pick(1, 17);
            media->addEffect(StoredEffect::create(fields));
            at = media->endTime();
            previous = media;
        }
    }
    MediaPtr calloutWithHotspot(const boost::shared_ptr<GenericTrack>& on, VelaTime start) {
        const auto callout = Callout::create(project->token(), project->editRateToken(), start, 61);
        HotspotInfo hotspot;
        hotspot.action = "jump";
        hotspot.gotoTime = 97;
        hotspot.markerTime = 13;
        callout->setHotspot(hotspot);
        AnimationTrack::Animation bounce;
        bounce.range = Range<long long>(7, 23);
        bounce.endTime = 30;
        bounce.duration = 23;
        callout->setAnimationTrack(AnimationTrack("opacity", {bounce}));
        on->addMedia(callout, start);
        return callout;
    }
    GroupPtr groupOfOddClips(const boost::shared_ptr<GenericTrack>& on, VelaTime start) {
        const auto inner = GenericMixer::create(project->token());
        const auto innerTrack = project->timeline()->newTrack();
        inner->addTrack(innerTrack);
        fillWithOddClips(innerTrack, 99, 5);
        const GroupPtr group = Group::create(project->token(), project->editRateToken(), inner, start);
        on->addMedia(group, start);
        return group;
    }
};

// The round trip, over a rich project brought to 30 first (stitched,
// unified, file, screen and caption clips, groups three deep) and many odd clips.
TEST_F(EditRate, ThirtyToNtscSixtyAndBackGivesBackTheSameDocument) {
    const auto files = boost::make_shared<FakeFileSystem>();
    files->present = {"/m/video.mp4", "/m/still.png", "/m/screen.trec", "/m/frame.trec"};
    RegisteredTableLoader table;
    table->set("/m/video.mp4",
               {stream(TrackType::Video, 0, 3000, 30), stream(TrackType::Audio, 0, 3000, 30, 2)});
    table->set("/m/still.png", {stream(TrackType::Image, 0, 1, 30)});
    table->set("/m/screen.trec", {stream(TrackType::ScreenVideo, 0, 3000, 30)});
    table->set("/m/frame.trec", {stream(TrackType::ScreenImage, 0, 1, 30)});
    project = richProject(files);
    const std::string rich = document();
    execute(ChangeProjectEditRateCmd::create(kThirty));
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), rich);
    ASSERT_TRUE(project->redo());

    const TimelinePtr timeline = project->timeline();
    mixer = boost::dynamic_pointer_cast<GenericMixer>(timeline->mixer("main"));
    tracks.clear();
    for (int seed = 1; seed <= 6; ++seed) fillWithOddClips(newTrack(), seed, 25);
    calloutWithHotspot(newTrack(), 1001);
    groupOfOddClips(tracks.back(), 1301);
    timeline->markerParam()->addKeyFrame(RationalTime(SafeRational(37)), std::string("m"), RationalTime(0));
    const std::string atThirty = document();

    for (int round = 0; round < 2; ++round) {
        execute(ChangeProjectEditRateCmd::create(kNtsc60));
        const std::string atNtsc = document();
        EXPECT_NE(atNtsc, atThirty);
        EXPECT_EQ(project->editRate(), kNtsc60);
        execute(ChangeProjectEditRateCmd::create(kThirty));
        EXPECT_EQ(document(), atThirty) << "round " << round;
        ASSERT_TRUE(project->undo());
        EXPECT_EQ(document(), atNtsc);
        ASSERT_TRUE(project->undo());
        EXPECT_EQ(document(), atThirty);
        ASSERT_TRUE(project->redo());
        EXPECT_EQ(document(), atNtsc);
        ASSERT_TRUE(project->redo());
    }
}

// What a change to a finer rate does to each kind of time.
TEST_F(EditRate, TicksGoToTheNearestTickAndExactTimesScaleExactly) {
    const MediaPtr a = slice(SafeRational(1, 3), SafeRational(30), SafeRational(3, 2));
    const MediaPtr b = clip(15);
    track->addMedia(a, 31);
    track->addMedia(b, a->endTime());
    const TransitionPtr fade(new Transition("Fade", 7));
    a->setRightTransition(fade);
    b->setLeftTransition(fade);
    opacityOf(a)->addKeyFrame(RationalTime(SafeRational(10)), 0.5, RationalTime(SafeRational(3)));
    const auto edge = boost::make_shared<EdgeModification>(15, "fade", 0.0);
    a->addRightEdgeModification(edge);
    StoredEffect::Fields fields;
    fields.start = 3;
    fields.duration = 30;
    a->addEffect(StoredEffect::create(fields));
    const MediaPtr callout = calloutWithHotspot(newTrack(), 50);
    execute(ChangeProjectEditRateCmd::create(kNtsc60));

    const SafeRational f(2000, 1001);
    const MediaState state = a->state();
    EXPECT_EQ(state.start, 62);                           // 31 x f = 61.938...
    EXPECT_EQ(state.mediaStart, SafeRational(1, 3) * f);  // exact
    EXPECT_EQ(state.mediaDuration, SafeRational(30) * f); // exact
    EXPECT_EQ(state.scalar, SafeRational(3, 2));          // the speed stays
    EXPECT_EQ(state.duration, 90);                        // round(45 x f) = round(89.91)
    EXPECT_EQ(b->startTime(), a->endTime());              // still touching,
    EXPECT_EQ(a->rightTransition(), b->leftTransition()); // still joined
    EXPECT_EQ(fade->duration(), 14);
    EXPECT_EQ(b->duration(), 30);
    EXPECT_TRUE(opacityOf(a)->hasKeyFrameAtTime(RationalTime(SafeRational(10) * f)));
    EXPECT_EQ(opacityOf(a)->keyFrameInterfaceAtTime(RationalTime(SafeRational(10) * f))->duration(),
              RationalTime(SafeRational(3) * f));
    EXPECT_EQ(edge->duration(), 30);
    const auto effect = boost::dynamic_pointer_cast<StoredEffect>(a->effectAtIndex(0));
    ASSERT_TRUE(effect);
    EXPECT_EQ(effect->fields().start, 6);
    EXPECT_EQ(effect->fields().duration, 60);
    const auto hotspot = boost::dynamic_pointer_cast<VisualMediaImpl>(callout)->hotspot();
    ASSERT_TRUE(hotspot);
    EXPECT_EQ(hotspot->gotoTime, 194);
    EXPECT_EQ(hotspot->markerTime, 26);
    const auto animation = boost::dynamic_pointer_cast<MediaImpl>(callout)->animationTracks().at("opacity");
    EXPECT_EQ(animation.animations()[0].range, Range<long long>(14, 46));
}

TEST_F(EditRate, RefusalsLeaveTheDocumentAsItWas) {
    place(0, 10);
    const std::string before = document();
    EXPECT_THROW(ChangeProjectEditRateCmd::create(0), VelaMediaLibException);
    EXPECT_THROW(SetEditRateCmd::create(boost::rational<unsigned long>(0, 1)), VelaMediaLibException);
    EXPECT_THROW(ScaleMixerEditRateCmd::create(mixer, SafeRational(0)), ValueException<double>);
    EXPECT_THROW(ScaleMediaEditRateCmd::create(track, clips[0], SafeRational(-1)), ValueException<double>);
    const size_t stepsBefore = steps();
    EXPECT_FALSE(project->execute(ChangeProjectEditRateCmd::create(kThirty))); // the rate it has
    EXPECT_FALSE(project->execute(ScaleHotspotEditRateCmd::create(clips[0], SafeRational(2)))); // none
    EXPECT_EQ(steps(), stepsBefore);
    EXPECT_EQ(document(), before);

    // A clip the change would leave without a tick refuses the whole change.
    const MediaPtr tiny = slice(SafeRational(0), SafeRational(1, 2));
    newTrack()->addMedia(tiny, 20);
    const std::string withTiny = document();
    EXPECT_THROW(project->execute(ChangeProjectEditRateCmd::create(10)), VelaMediaLibException);
    EXPECT_EQ(document(), withTiny);
    EXPECT_EQ(project->editRate(), kThirty);
}

TEST_F(EditRate, SetMediaStateUndoesExactlyAndRefusesCollisions) {
    const MediaPtr a = place(0, 10), b = place(10, 10);
    MediaState state = a->state();
    state.start = 3;
    state.mediaStart = SafeRational(1, 3);
    state.mediaDuration = SafeRational(20, 3);
    state.duration = 7;
    expectExactUndo(SetMediaStateCmd::create(a, state));
    state.start = 5; // would overlap b
    expectRefused(SetMediaStateCmd::create(track, a, state));
    const MediaPtr loose = clip(5);
    expectRefused(SetMediaStateCmd::create(loose, loose->state())); // on no track
    (void)b;
}

TEST_F(EditRate, ScaleCommandsUndoExactly) {
    fillWithOddClips(track, 7, 8);
    expectExactUndo(ScaleMediaEditRateCmd::create(track, track->medias().back(), SafeRational(2)));
    expectExactUndo(ScaleMixerEditRateCmd::create(mixer, kThirty, kNtsc60));
    const std::string before = document();
    execute(SetEditRateCmd::create(kNtsc60));
    EXPECT_EQ(project->editRate(), kNtsc60);
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), before);
}

// A magnetic track stays closed through the change and its undo: no gap opens, no follow-up runs.
TEST_F(EditRate, MagneticTrackStaysWithoutGaps) {
    track->magneticAttribute()->setValue(true);
    fillWithOddClips(track, 3, 1);
    const MediaPtr first = track->medias().front();
    execute(MoveCmd::create(track, first, -first->startTime()));
    for (int i = 0; i < 5; ++i)
        execute(AddMediaCmd::create(track, slice(SafeRational(i, 7), SafeRational(31, 3)), track->endTime()));
    const std::string before = document();
    const size_t stepsBefore = steps();
    execute(ChangeProjectEditRateCmd::create(kNtsc60));
    EXPECT_EQ(steps(), stepsBefore + 1);
    VelaTime end = 0;
    for (const MediaPtr& media : track->medias()) {
        EXPECT_EQ(media->startTime(), end);
        end = media->endTime();
    }
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(document(), before);
}

} // namespace

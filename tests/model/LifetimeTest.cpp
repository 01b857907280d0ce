// Clips, tracks and mixers that the host keeps after their containers or
// their project have gone still answer, and only through live objects (run
// under AddressSanitizer to see that nothing freed is read).
#include "MediaTestSupport.h"

#include <VelaMediaLib/commands/edits/LockData.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

#include <memory>

using namespace VelaMediaLib;

namespace {

// A project as the host builds one: timeline, mixer "main", one track with
// a clip at 100 whose opacity runs from 0 at 0 to 1 at 20.
struct Built {
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
    TimelinePtr timeline = Timeline::create(project);
    MixerPtr mixer = timeline->newMixer("main");
    boost::shared_ptr<GenericTrack> track = timeline->newTrack();
    boost::shared_ptr<PlaceholderMedia> clip = PlaceholderMedia::create(project, rate, 0, 50);

    Built() {
        timeline->addTrack(mixer, track);
        track->addMedia(clip, 100);
        clip->opacity()->setDefaultValue(0.0);
        clip->opacity()->addKeyFrame(RationalTime(20), 1.0, RationalTime(0));
    }
};

using Times = std::vector<RationalTime>;

// What a clip off any live container answers: its own time, its own values.
void expectAnswersAlone(const boost::shared_ptr<PlaceholderMedia>& clip) {
    EXPECT_FALSE(clip->parent() || clip->timeConverterParent() || !clip->parentTimeline().expired());
    EXPECT_EQ(Times({clip->fromGlobalToParametricTime(RationalTime(115)),
                     clip->fromParametricToGlobalTime(RationalTime(15)),
                     clip->clippingFromGlobalToParametricTime(RationalTime(500))}),
              Times({RationalTime(15), RationalTime(115), RationalTime(50)}));
    EXPECT_DOUBLE_EQ(clip->opacity()->valueAtTime(RationalTime(15)), 0.75); // between keyframes
    EXPECT_EQ(clip->mediaToModelTransformAtGlobalTime(RationalTime(115)), TransformMatrix());
    EXPECT_EQ(clip->trackRange(), Range<VelaTime>(100, 50));
    EXPECT_FALSE(LockData::IsMediaLocked(*clip));
}

} // namespace

TEST(Lifetime, AClipKeptPastItsProjectOrItsTrackAnswersAlone) {
    auto built = std::make_unique<Built>();
    const auto kept = built->clip;
    EXPECT_EQ(kept->timeConverterParent(), TimeConverterPtr(built->track));
    built.reset();
    expectAnswersAlone(kept);

    Built again;
    again.timeline->removeTrack(again.mixer, again.track);
    again.track.reset(); // the track goes; the clip stays with the host
    expectAnswersAlone(again.clip);
    const auto other = again.timeline->newTrack();
    again.timeline->addTrack(again.mixer, other);
    other->addMedia(again.clip, 40); // placed again
    EXPECT_EQ(again.clip->parentTimeline().lock(), again.timeline);
    EXPECT_EQ(again.clip->fromGlobalToParametricTime(RationalTime(55)), RationalTime(15));
}

TEST(Lifetime, ATrackKeptPastItsMixerAndProject) {
    auto built = std::make_unique<Built>();
    const TrackPtr kept = built->track;
    const auto clip = built->clip;
    built.reset();
    EXPECT_FALSE(kept->parentMixer() || kept->parentTimeline() || kept->parentTimeConverter() ||
                 kept->isParentMixerInSoloMode());
    EXPECT_TRUE(kept->isRenderable());
    EXPECT_EQ(kept->mediaAtTime(120).first, clip);
    EXPECT_TRUE(clip->parentTimeline().expired());
    EXPECT_EQ(clip->fromGlobalToParametricTime(RationalTime(115)), RationalTime(15));
    kept->move(clip, 10);
    EXPECT_EQ(clip->startTime(), 110);
    kept->removeMedia(clip);
    EXPECT_EQ(kept->numMedias(), 0u);
}

TEST(Lifetime, AMixerKeptPastItsTimeline) {
    auto built = std::make_unique<Built>();
    const MixerPtr kept = built->mixer;
    const auto clip = built->clip;
    built.reset();
    EXPECT_FALSE(kept->parentTimeline() || kept->parentTimeConverter());
    EXPECT_EQ(kept->numTracks(), 1u);
    EXPECT_EQ(kept->allMedias(), std::vector<MediaPtr>{clip});
    EXPECT_TRUE(clip->parentTimeline().expired());
    EXPECT_EQ(clip->fromGlobalToParametricTime(RationalTime(115)), RationalTime(15));
    EXPECT_EQ(kept->endTime(), 150);
    kept->trackAtIndex(0)->trimEnd(clip, 10); // the track still tells its mixer, which is alive
    EXPECT_EQ(kept->endTime(), 140);
}

TEST(Lifetime, ACopyOutlivesTheClipsItWasCopiedFrom) {
    std::map<MediaPtr, MediaPtr> copied;
    const TrackPtr portion = Built().track->copyPortion(Range<VelaTime>(100, 50), &copied);
    copied.clear(); // the originals go
    const auto copy = boost::dynamic_pointer_cast<VisualMedia>(portion->medias().at(0));
    EXPECT_DOUBLE_EQ(copy->opacity()->valueAtTime(RationalTime(15)), 0.75);
    EXPECT_EQ(copy->fromGlobalToParametricTime(RationalTime(15)), RationalTime(15));
}

TEST(Lifetime, TransitionsAndNeighboursKeptPastTheirClips) {
    const TransitionPtr shared(new Transition("dissolve", 4));
    MediaPtr later;
    {
        Built built;
        built.clip->setRightTransition(shared);
        later = PlaceholderMedia::create(built.project, built.rate, 0, 10);
        built.track->addMedia(later, 150); // joins the transition
        EXPECT_EQ(shared->rightMedia(), later);
        EXPECT_EQ(Track::getTouchingMediaToLeftOfMedia(later), built.clip);
    }
    EXPECT_EQ(std::make_pair(shared->leftMedia(), shared->rightMedia()), std::make_pair(MediaPtr(), later));
    EXPECT_EQ(later->leftTransition(), shared); // the earlier clip has gone, the transition stays
    EXPECT_EQ(later->transitionAtTime(151), shared);
    EXPECT_FALSE(Track::getLeftOfMedia(later) || Track::getTouchingMediaToLeftOfMedia(later));
    EXPECT_FALSE(LockData::IsTransitionLocked(*shared));
}

TEST(ParentTimeline, FollowsTheClipsContainersWhicheverWayTheyGotThere) {
    Built built;
    const auto mixer = GenericMixer::create(built.project);
    const auto track = GenericTrack::create(built.project);
    const MediaPtr early = PlaceholderMedia::create(built.project, built.rate, 0, 10);
    track->addMedia(early, 0); // on the track before the track is anywhere
    mixer->addTrack(track);
    EXPECT_TRUE(early->parentTimeline().expired());
    built.timeline->addMixer("second", mixer); // the mixer joins with its tracks and clips
    EXPECT_EQ(early->parentTimeline().lock(), built.timeline);
    const RemoveTrackInfo removed = built.timeline->removeTrack(mixer, track);
    EXPECT_TRUE(early->parentTimeline().expired());
    mixer->putBack(removed);
    EXPECT_EQ(early->parentTimeline().lock(), built.timeline);
    built.timeline->removeMixer(mixer);
    EXPECT_TRUE(early->parentTimeline().expired());
    EXPECT_FALSE(track->parentTimeline());
    built.timeline->addMixer("again", mixer);
    EXPECT_EQ(early->parentTimeline().lock(), built.timeline);
    track->removeMedia(early);
    EXPECT_TRUE(early->parentTimeline().expired());
}

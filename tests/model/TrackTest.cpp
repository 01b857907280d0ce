// Clips on tracks, tracks in mixers, mixers on a timeline: where clips are
// found, what collides, membership, and the path of a placed clip's edits.
#include "MediaTestSupport.h"

#include <VelaMediaLib/commands/edits/LockData.h>
#include <VelaMediaLib/model/media/ColorMedia.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

#include <functional>
#include <utility>
#include <limits>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

using Ticks = Range<VelaTime>;
using Clips = std::vector<MediaPtr>;

class TrackTest : public ModelTest {
protected:
    TimelinePtr timeline = Timeline::create(project);
    MixerPtr mixer = timeline->newMixer("main");
    boost::shared_ptr<GenericTrack> track = newTrack(), other = newTrack();

    boost::shared_ptr<GenericTrack> newTrack() {
        const auto made = timeline->newTrack();
        timeline->addTrack(mixer, made);
        return made;
    }
    MediaPtr clip(VelaTime duration) { return PlaceholderMedia::create(project, rate, 0, duration); }
    MediaPtr placed(VelaTime start, VelaTime duration) {
        const MediaPtr media = clip(duration);
        track->addMedia(media, start);
        return media;
    }
    // Placed with fifty ticks of media to spare either side.
    MediaPtr roomy(VelaTime start, VelaTime duration) {
        const MediaPtr media = PlaceholderMedia::createFromMediaRange(project, rate, 0, 0, 100);
        media->trimStart(50);
        media->trimEnd(50 - duration);
        track->addMedia(media, start);
        return media;
    }
    // Every clip of the track is found where the map keys it, and none overlap.
    void expectKeyedByStart() {
        ScopedReadLock lock(project);
        VelaTime end = std::numeric_limits<VelaTime>::min();
        for (auto entry = track->mediaBegin(); entry != track->mediaEnd(); ++entry) {
            EXPECT_EQ(entry->first, entry->second->lockedTrackRange().start());
            EXPECT_LE(end, entry->first) << "clips overlap";
            end = entry->second->lockedTrackRange().end();
        }
    }
};

const char* const kCollision = "Collision exception.";

// Audible, Visible, Renderable, Disabled.
std::string flags(const Track& track) {
    return std::string(track.isAudible() ? "A" : "-") + (track.isVisible() ? "V" : "-") +
           (track.isRenderable() ? "R" : "-") + (track.isDisabled() ? "D" : "-");
}

// Runs a function, once, from inside the next notification of a subject.
struct OneShot : Observer {
    std::function<void()> action;
    void update(Observable*) override {
        if (const auto once = std::exchange(action, nullptr)) once();
    }
};

} // namespace

TEST_F(TrackTest, TouchingClipsFitOverlappingOnesCollide) {
    const MediaPtr first = placed(0, 10), second = clip(10);
    const auto e = thrown<CollisionException>([&] { track->addMedia(second, 9); });
    EXPECT_TRUE(e && e->range() == Ticks(9, 10) && e->clip() == second && e->start() == 9);
    EXPECT_EQ(track->numMedias(), 1u);
    track->addMedia(second, 10);
    EXPECT_EQ(track->medias(), (Clips{first, second}));
    EXPECT_THROW(track->addMedia(clip(30), -5), CollisionException); // covers both
    EXPECT_TRUE(track->intersectionAtRange(Ticks(19, 1)));
    EXPECT_FALSE(track->intersectionAtRange(Ticks(20, 5)));
    EXPECT_EQ(track->endTime(), 20);
}

TEST_F(TrackTest, MediaAtTimeGivesTheClipOrBothTouchingClips) {
    const MediaPtr first = placed(0, 10), second = placed(10, 10), third = placed(30, 5), none;
    // The end of a clip is not in it.
    for (const auto& at :
         {std::make_pair(10, Track::Pair(first, second)), std::make_pair(5, Track::Pair(first, none)),
          std::make_pair(25, Track::Pair()), std::make_pair(20, Track::Pair()),
          std::make_pair(30, Track::Pair(third, none)), std::make_pair(-1, Track::Pair())})
        EXPECT_EQ(track->mediaAtTime(at.first), at.second) << at.first;
    EXPECT_EQ(Clips({Track::getLeftOfMedia(third), Track::getTouchingMediaToLeftOfMedia(third),
                     Track::getTouchingMediaToRightOfMedia(first), Track::getRightOfMedia(third)}),
              Clips({second, none, second, none}));
    EXPECT_EQ(track->mediasIntersectingRange(Ticks(5, 30), second), (Clips{first, third}));
    EXPECT_EQ(track->mediasIntersectingRange(Ticks(0, 40), Clips{first, third}), Clips{second});
    EXPECT_EQ(track->mediasIntersectingRange(Ticks(0, 40), std::set<MediaPtr>{second}).size(), 2u);
    EXPECT_EQ(track->mediasIntersectingRange(Ticks(20, 10)), Clips()); // touching only
    EXPECT_EQ(track->mediasIntersectingRange(Ticks(19, 11)), Clips{second});
    const auto parts = track->subSection(Ticks(5, 27));
    ASSERT_EQ(parts.size(), 3u);
    EXPECT_EQ(parts[0].range, Ticks(5, 5));
    EXPECT_EQ(parts[2].range, Ticks(30, 2));
    ScopedReadLock lock(project); // the map itself, walked under the caller's lock
    EXPECT_EQ(std::distance(track->mediaBegin(), track->mediaEnd()), 3);
    EXPECT_EQ(Clips({track->mediaRBegin()->second, std::prev(track->mediaREnd())->second,
                     track->lower_bound(10)->second, track->upper_bound(10)->second}),
              Clips({third, first, second, third}));
    EXPECT_EQ(track->lower_bound(31), track->mediaEnd());
}

// Every edit that would overlap a neighbour is refused as a collision, even
// one the media's limits would refuse too, and changes nothing.
TEST_F(TrackTest, EditsThatWouldCollideChangeNothing) {
    const MediaPtr left = placed(0, 10),
                   middle = PlaceholderMedia::createFromMediaRange(project, rate, 0, 0, 40);
    track->addMedia(middle, 10);
    middle->trimStart(5);
    middle->trimEnd(5); // [15, 45) of media [5, 35) within [0, 40)
    track->trimStart(middle, -5);
    track->trimEnd(middle, -5);
    const MediaPtr right = placed(50, 10);
    expectRefused<CollisionException>(*middle, kCollision, [&] { track->move(middle, -1); });
    expectRefused<CollisionException>(*middle, kCollision, [&] { track->trimStart(middle, -1); });
    expectRefused<CollisionException>(*middle, kCollision, [&] { track->trimEnd(middle, -1); });
    expectRefused<CollisionException>(*middle, kCollision, [&] { track->stretch(middle, SafeRational(2)); });
    MediaState elsewhere = middle->state();
    elsewhere.start = 45;
    expectRefused<CollisionException>(*middle, kCollision,
                                      [&] { track->restoreMediaState(middle, elsewhere, 0); });
    EXPECT_EQ(track->mediaAtTime(10), Track::Pair(left, middle));
    track->trimEnd(middle, 10);
    track->move(middle, 5);                     // now [15, 45)
    EXPECT_EQ(track->mediaMap().count(15), 1u); // keyed by the new start
    EXPECT_EQ(track->mediaAtTime(16).first, middle);
    track->removeMedia(right);
    EXPECT_DOUBLE_EQ(track->stretch(middle, 2.0), 2.0);
    EXPECT_EQ(middle->trackRange(), Ticks(15, 60));
    EXPECT_THROW(track->move(clip(5), 1), AddRemoveException);
}

TEST_F(TrackTest, AClipEditedByItselfGoesThroughItsTrack) {
    const MediaPtr left = roomy(0, 10), clip = roomy(20, 10), right = roomy(40, 10);
    clip->move(5); // now [25, 35), keyed there
    EXPECT_EQ(track->mediaAtTime(26).first, clip);
    EXPECT_EQ(Track::getLeftOfMedia(clip), left);
    expectKeyedByStart();
    // Each would overlap a neighbour.
    expectRefused<CollisionException>(*clip, kCollision, [&] { clip->move(10); });
    expectRefused<CollisionException>(*clip, kCollision, [&] { clip->trimEnd(-6); });
    expectRefused<CollisionException>(*clip, kCollision, [&] { clip->trimStart(-16); });
    expectRefused<CollisionException>(*clip, kCollision, [&] { clip->setTrackStart(5); });
    expectRefused<CollisionException>(*clip, kCollision, [&] { clip->rationalStretch(SafeRational(2)); });
    MediaState over = clip->state();
    over.start = 1;
    expectRefused<CollisionException>(*clip, kCollision, [&] { clip->restoreState(over, 0); });
    clip->trimStart(-5);
    clip->setTrackStart(10);
    EXPECT_EQ(clip->trackRange(), Ticks(10, 15));
    EXPECT_TRUE(track->hasMedia(clip));
    track->removeMedia(clip); // found under its new start
    expectKeyedByStart();
    EXPECT_EQ(track->medias(), (Clips{left, right}));
}

TEST_F(TrackTest, AnObserverThatEditsTheTrackMidEditFindsItConsistent) {
    const MediaPtr clip = roomy(0, 10), next = roomy(30, 10);
    OneShot removeItself, moveNeighbour;
    removeItself.action = [&] { track->removeMedia(clip); };
    clip->attachWithoutNotifyDelay(&removeItself);
    track->move(clip, 5);
    clip->detach(&removeItself);
    EXPECT_FALSE(track->hasMedia(clip));
    EXPECT_EQ(track->medias(), Clips{next});
    expectKeyedByStart();
    track->addMedia(clip, 0);
    moveNeighbour.action = [&] { track->move(next, 20); };
    clip->attachWithoutNotifyDelay(&moveNeighbour);
    clip->trimEnd(-5);
    clip->detach(&moveNeighbour);
    EXPECT_EQ(track->medias(), (Clips{clip, next}));
    EXPECT_EQ(next->startTime(), 50);
    expectKeyedByStart();
}

// A clip lies on one track at most, a track in one mixer, a mixer on one timeline or in one group.
TEST_F(TrackTest, MembershipIsSingle) {
    const MediaPtr media = placed(0, 10);
    expectThrows<AddRemoveException>("the clip is already on another track or in a group",
                                     [&] { other->addMedia(media, 50); });
    EXPECT_THROW(track->addMedia(media, 50), AddRemoveException);
    EXPECT_EQ(track->medias(), Clips{media});
    EXPECT_EQ(other->numMedias(), 0u);
    EXPECT_EQ(media->startTime(), 0);
    EXPECT_EQ(media->parent(), track);
    track->removeMedia(media); // still removable from its own track
    other->addMedia(media, 50);
    EXPECT_EQ(other->mediaAtTime(55).first, media);

    const auto second = GenericMixer::create(project);
    expectThrows<AddRemoveException>("the track is already in another mixer or a stitched clip",
                                     [&] { second->addTrack(track); });
    EXPECT_EQ(mixer->tracks(), (std::vector<TrackPtr>{track, other}));
    EXPECT_EQ(second->numTracks(), 0u);
    EXPECT_EQ(track->parentMixer(), mixer);
    EXPECT_THROW(timeline->addMixer("alias", mixer), AddRemoveException);
    const TimelinePtr elsewhere = Timeline::create(project);
    EXPECT_THROW(elsewhere->addMixer("main", mixer), AddRemoveException);
    EXPECT_TRUE(elsewhere->mixerNames().empty());
    EXPECT_EQ(mixer->parentTimeline(), timeline);

    const MediaPtr group = clip(10);
    expectThrows<VelaMediaLibException>("Cannot set parent group on a mixer that has a parent timeline",
                                        [&] { mixer->setParentGroup(group); });
    second->setParentGroup(group);
    expectThrows<VelaMediaLibException>("Cannot set parent timeline on a mixer that has a parent group",
                                        [&] { timeline->addMixer("other", second); });
    EXPECT_EQ(timeline->mixerNames(), std::vector<std::string>{"main"});
}

TEST_F(TrackTest, SoloDecidesOverMuteAndHide) {
    const TrackPtr third = newTrack();
    track->audioMutedAttribute()->setValue(true);
    other->videoHiddenAttribute()->setValue(true);
    EXPECT_EQ(flags(*track) + flags(*other) + flags(*third), "-VR-A-R-AVR-");
    other->audioMutedAttribute()->setValue(true);
    EXPECT_EQ(flags(*other), "---D");
    other->audioMutedAttribute()->setValue(false);
    track->soloAttribute()->setValue(true);
    EXPECT_TRUE(mixer->isInSoloMode());
    EXPECT_EQ(flags(*track) + flags(*other) + flags(*third), "AVR----D---D"); // solo overrides mute
    EXPECT_TRUE(LockData::IsTrackInvisible(*other));
}

TEST_F(TrackTest, MixerIndexRulesAndPuttingATrackBack) {
    const auto loose = GenericMixer::create(project);
    const TrackPtr a = GenericTrack::create(project), b = GenericTrack::create(project),
                   c = GenericTrack::create(project);
    loose->addTrack(a, -1);
    loose->addTrack(b, 1); // the number of tracks appends
    for (const int bad : {-2, 3}) {
        const auto e = thrown<ValueException<int>>([&] { loose->addTrack(c, bad); });
        EXPECT_TRUE(e && e->value() == bad && e->message() == "invalid index") << bad;
    }
    loose->addTrack(c, 0);
    EXPECT_EQ(loose->tracks(), (std::vector<TrackPtr>{c, a, b}));
    EXPECT_TRUE(Mixer::sortTracksByIndex(c, b));
    EXPECT_FALSE(Mixer::sortTracksByIndex(b, c) || Mixer::sortTracksByIndex(b, b)); // a strict order
    const RemoveTrackInfo info = loose->removeTrackImpl(a);
    EXPECT_EQ(info.index, 1);
    EXPECT_FALSE(a->parentMixer());
    EXPECT_EQ(loose->tracks(), (std::vector<TrackPtr>{c, b}));
    loose->putBack(info);
    EXPECT_EQ(loose->tracks(), (std::vector<TrackPtr>{c, a, b}));
    EXPECT_EQ(a->parentMixer(), loose);
    EXPECT_THROW(loose->trackAtIndex(3), IndexException);
    EXPECT_FALSE(loose->removeTrack(GenericTrack::create(project)));
}

// A mixer spans from the earliest clip of any track to the latest end; an
// empty track (which starts at 0) does not pull the start back.
TEST_F(TrackTest, AMixerSpansItsTracksClips) {
    placed(20, 10);
    newTrack();
    other->addMedia(clip(30), 50);
    EXPECT_EQ(mixer->startTime(), 20);
    EXPECT_EQ(mixer->endTime(), 80);
}

TEST_F(TrackTest, ATimelineKeepsNamedMixersAndRelaysClipEvents) {
    const TimelinePtr named = Timeline::create(project);
    EXPECT_FALSE(named->mixer());
    const auto second = named->newMixer("b"), first = named->newMixer("a");
    EXPECT_EQ(named->mixer(), first);
    EXPECT_EQ(named->mixerNames(), (std::vector<std::string>{"a", "b"}));
    struct Recorder : TimelineAddObserver {
        std::string events;
        void onTimelineAddTrack(Timeline&, Mixer&, const TrackPtr&) override { events += "T+"; }
        void onTimelineRemoveTrack(Timeline&, Mixer&, const TrackPtr&) override { events += "T-"; }
        void onTimelineAddMedia(Timeline&, Track&, const MediaPtr&) override { events += "C+"; }
        void onTimelineRemoveMedia(Timeline&, Track&, const MediaPtr&) override { events += "C-"; }
    } recorder;
    named->attachAddObserver(&recorder);
    const auto upper = named->newTrack(), lower = named->newTrack();
    named->addTrack(first, upper);
    named->addTrack(second, lower);
    const MediaPtr a = clip(10), b = clip(10);
    upper->addMedia(a, 0);
    lower->addMedia(b, 5);
    EXPECT_EQ(named->allMediasAtTime(7), (Clips{a, b}));
    EXPECT_EQ(
        std::make_tuple(named->endTime(), named->numTracks(), named->instancesOf<PlaceholderMedia>().size()),
        std::make_tuple(VelaTime(15), size_t(2), size_t(2)));
    EXPECT_FALSE(named->hasInstanceOf<ColorMedia>());
    upper->removeMedia(a);
    expectThrows<VelaMediaLibException>("track doesn't belong to project",
                                        [&] { named->removeTrack(first, lower); });
    EXPECT_EQ(named->removeTrack(second, lower).track, lower);
    EXPECT_EQ(recorder.events, "T+T+C+C+C-T-");
    expectThrows<VelaMediaLibException>("unable to find mixer",
                                        [&] { named->removeMixer(GenericMixer::create(project)); });
    named->removeMixer(second);
    EXPECT_EQ(named->mixerNames(), std::vector<std::string>{"a"});
    named->detachAddObserver(&recorder);
}

TEST_F(TrackTest, CopiesAndLocks) {
    const MediaPtr first = placed(2, 10), second = placed(12, 10);
    track->setIsLocked(true);
    track->magneticAttribute()->setValue(true);
    std::map<MediaPtr, MediaPtr> copied;
    const TrackPtr portion = track->copyPortion(Ticks(5, 10), &copied); // ticks [5, 15)
    ASSERT_EQ(portion->numMedias(), 2u);
    EXPECT_EQ(copied[first]->trackRange(), Ticks(0, 7));
    EXPECT_EQ(copied[first]->rationalMediaRange().start(), SafeRational(3));
    EXPECT_EQ(copied[second]->trackRange(), Ticks(7, 3));
    EXPECT_EQ(copied[second]->rationalMediaRange().start(), SafeRational(0));
    EXPECT_TRUE(portion->isLocked() && portion->attributeValue("magnetic", false));
    copied.clear();
    const TrackPtr spaced = track->copyPortion(Clips{second, first}, &copied);
    ASSERT_EQ(spaced->numMedias(), 2u);
    EXPECT_EQ(copied[first]->trackRange(), Ticks(0, 10)); // spacing kept from the earliest
    EXPECT_EQ(copied[second]->trackRange(), Ticks(10, 10));
    EXPECT_EQ(first->duration(), 10);
    EXPECT_TRUE(LockData::IsMediaLocked(*first));
    EXPECT_TRUE(track->mediasIntersectingRange(Ticks(5, 0)).empty()); // an empty range holds no tick
    EXPECT_EQ(Track::getTouchingMediaToRightOfMedia(first), second);
    EXPECT_FALSE(Track::getTouchingMediaToRightOfMedia(second));
    EXPECT_FALSE(LockData::IsMediaEditable(*second) || LockData::IsMediaLocked(*clip(3)));
    EXPECT_TRUE(
        track->recursivelyVisitAllMediaWithEarlyExitFlag([](const MediaPtr&, bool& stop) { stop = true; }));
}

TEST_F(TrackTest, TransitionsAreJoinedAgainWhenTouchingClipsMeet) {
    const MediaPtr first = placed(0, 10);
    const TransitionPtr shared(new Transition("dissolve", 4));
    first->setRightTransition(shared);
    const MediaPtr second = placed(10, 10);
    EXPECT_EQ(second->leftTransition(), shared);
    EXPECT_EQ(Clips({shared->leftMedia(), shared->rightMedia()}), Clips({first, second}));
    EXPECT_EQ(track->transitions().size(), 1u);
    EXPECT_FALSE(LockData::IsTransitionHidden(*shared) || LockData::IsTransitionLocked(*shared));
    track->videoHiddenAttribute()->setValue(true);
    EXPECT_TRUE(LockData::IsTransitionHidden(*shared));
    track->videoHiddenAttribute()->setValue(false);
    EXPECT_EQ(track->move(first, -5), Track::TransitionAndNeighbour(shared, second));
}

TEST(TimelineCamera, RightAndLeftHandedTransforms) {
    const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    const auto timeline = Timeline::create(project, 1920, 1080);
    const RationalTime zero(0);
    EXPECT_EQ(timeline->eyeLookAtPositionParam()->valueAtTime(zero), Point3d(0, 0, 0));
    EXPECT_EQ(timeline->eyeUpVectorParam()->valueAtTime(zero), Point3d(0, 1, 0));
    EXPECT_EQ(timeline->fovParam()->valueAtTime(zero), 45.0);
    EXPECT_EQ(timeline->farClipDistanceParam()->valueAtTime(zero), 100000.0);
    EXPECT_EQ(timeline->newTrack()->volume()->valueAtTime(zero), 1.0);
    const auto track = timeline->newTrack();
    timeline->addTrack(timeline->newMixer("main"), track);
    track->addMedia(PlaceholderMedia::create(project, boost::weak_ptr<ProjectEditRate>(), 0, 10), 0);
    EXPECT_EQ(timeline->swapSourceForTimelineMedias(nullptr, nullptr), 0u); // no clip has a source
    timeline->eyePositionParam()->setDefaultValue(Point3d(0, 0, 10));
    const TransformMatrix right = timeline->cameraTransformAtTime(zero),
                          left = timeline->cameraTransformAtTimeLH(zero);
    EXPECT_NEAR(right.apply(Point3d(0, 0, 0)).z, -10.0, 1e-12);
    EXPECT_NEAR(left.apply(Point3d(0, 0, 0)).z, 10.0, 1e-12);
    EXPECT_NEAR(right.apply(Point3d(1, 0, 0)).x, 1.0, 1e-12);
    EXPECT_NEAR(left.apply(Point3d(1, 0, 0)).x, -1.0, 1e-12);
    // The default camera shows the canvas exactly: its corners land on the screen's corners.
    timeline->eyePositionParam()->setDefaultValue(Point3d(0, 0, 540.0 / std::tan(M_PI / 8)));
    const TransformMatrix m = timeline->calcScreenTransformAtTime(zero);
    auto onScreen = [&](const Point3d& p) {
        const double w = m.at(3, 0) * p.x + m.at(3, 1) * p.y + m.at(3, 2) * p.z + m.at(3, 3);
        return Point3d(m.apply(p).x / w, m.apply(p).y / w, 0);
    };
    EXPECT_NEAR(onScreen(Point3d(-960, 540, 0)).x, 0.0, 1e-6);
    EXPECT_NEAR(onScreen(Point3d(-960, 540, 0)).y, 0.0, 1e-6);
    EXPECT_NEAR(onScreen(Point3d(960, -540, 0)).x, 1920.0, 1e-6);
    EXPECT_NEAR(onScreen(Point3d(960, -540, 0)).y, 1080.0, 1e-6);
    // The left-handed projection takes the near plane to depth 0 and the far plane to depth 1.
    const TransformMatrix lh = timeline->projectionTransformAtTimeLH(zero);
    const auto depth = [&](double z) { return lh.at(2, 2) + lh.at(2, 3) / z; }; // (A z + B) / z
    EXPECT_NEAR(depth(1.0), 0.0, 1e-9);
    EXPECT_NEAR(depth(100000.0), 1.0, 1e-9);
    const TransformerImpl& placement = *timeline; // the timeline places its content unchanged
    EXPECT_EQ(placement.transformAtTime(RationalTime(3)), TransformMatrix());
}

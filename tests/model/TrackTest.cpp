#include "MediaTestSupport.h"

#include <VelaMediaLib/model/media/ColorMedia.h>
#include <VelaMediaLib/commands/edits/LockData.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class TrackTest : public ModelTest {
protected:
    boost::shared_ptr<GenericTrack> track = GenericTrack::create(project);
    TimelinePtr timeline = Timeline::create(project);

    MediaPtr clip(VelaTime duration) { return PlaceholderMedia::create(project, rate, 0, duration); }
    MediaPtr placed(VelaTime start, VelaTime duration) {
        const MediaPtr media = clip(duration);
        track->addMedia(media, start);
        return media;
    }
};

template <typename Edit>
void expectCollision(const MediaPtr& media, Edit edit) {
    const MediaState before = media->state();
    EXPECT_THROW(edit(), CollisionException);
    EXPECT_TRUE(media->state() == before);
}

// Audible, Visible, Renderable, Disabled.
std::string flags(const Track& track) {
    return std::string(track.isAudible() ? "A" : "-") + (track.isVisible() ? "V" : "-") +
           (track.isRenderable() ? "R" : "-") + (track.isDisabled() ? "D" : "-");
}

} // namespace

TEST_F(TrackTest, TouchingClipsFitOverlappingOnesCollide) {
    const MediaPtr first = placed(0, 10), second = clip(10);
    try {
        track->addMedia(second, 9);
        FAIL();
    } catch (const CollisionException& e) {
        EXPECT_STREQ(e.what(), "Collision exception.");
        EXPECT_EQ(e.range(), Range<long long>(9, 10));
        EXPECT_EQ(e.clip(), second);
        EXPECT_EQ(e.start(), 9);
    }
    EXPECT_EQ(track->numMedias(), 1u);
    track->addMedia(second, 10);
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{first, second}));
    EXPECT_EQ(second->startTime(), 10);
    EXPECT_THROW(track->addMedia(second, 50), AddRemoveException);
    EXPECT_THROW(track->addMedia(clip(30), -5), CollisionException); // covers both
    EXPECT_TRUE(track->intersectionAtRange(Range<VelaTime>(19, 1)));
    EXPECT_FALSE(track->intersectionAtRange(Range<VelaTime>(20, 5)));
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
    EXPECT_EQ(Track::getLeftOfMedia(third), second);
    EXPECT_EQ(Track::getTouchingMediaToLeftOfMedia(third), none);
    EXPECT_EQ(Track::getTouchingMediaToRightOfMedia(first), second);
    EXPECT_EQ(Track::getRightOfMedia(third), none);
    using Clips = std::vector<MediaPtr>;
    EXPECT_EQ(track->mediasIntersectingRange(Range<VelaTime>(5, 30), second), (Clips{first, third}));
    EXPECT_EQ(track->mediasIntersectingRange(Range<VelaTime>(0, 40), Clips{first, third}), Clips{second});
    EXPECT_EQ(track->mediasIntersectingRange(Range<VelaTime>(0, 40), std::set<MediaPtr>{second}).size(), 2u);
    EXPECT_EQ(track->mediasIntersectingRange(Range<VelaTime>(20, 10)), Clips()); // touching only
    EXPECT_EQ(track->mediasIntersectingRange(Range<VelaTime>(19, 11)), Clips{second});
    const auto parts = track->subSection(Range<VelaTime>(5, 27));
    ASSERT_EQ(parts.size(), 3u);
    EXPECT_EQ(parts[0].range, Range<VelaTime>(5, 5));
    EXPECT_EQ(parts[2].range, Range<VelaTime>(30, 2));
}

TEST_F(TrackTest, EditsThatWouldCollideChangeNothing) {
    const MediaPtr left = placed(0, 10);
    const MediaPtr middle = PlaceholderMedia::createFromMediaRange(project, rate, 0, 0, 40);
    track->addMedia(middle, 10);
    middle->trimStart(5);
    middle->trimEnd(5); // [15, 45) of media [5, 35) within [0, 40)
    track->trimStart(middle, -5);
    track->trimEnd(middle, -5);
    const MediaPtr right = placed(50, 10);
    expectCollision(middle, [&] { track->move(middle, -1); });
    expectCollision(middle, [&] { track->trimStart(middle, -1); });
    expectCollision(middle, [&] { track->trimEnd(middle, -1); });
    expectCollision(middle, [&] { track->stretch(middle, SafeRational(2)); });
    MediaState elsewhere = middle->state();
    elsewhere.start = 45;
    expectCollision(middle, [&] { track->restoreMediaState(middle, elsewhere, 0); });
    EXPECT_EQ(track->mediaAtTime(10), Track::Pair(left, middle));

    track->trimEnd(middle, 10);
    track->move(middle, 5);                     // now [15, 45)
    EXPECT_EQ(track->mediaMap().count(15), 1u); // keyed by the new start
    EXPECT_EQ(track->mediaAtTime(16).first, middle);
    track->removeMedia(right);
    EXPECT_DOUBLE_EQ(track->stretch(middle, 2.0), 2.0);
    EXPECT_EQ(middle->trackRange(), Range<VelaTime>(15, 60));
    EXPECT_THROW(track->move(clip(5), 1), AddRemoveException);
}

TEST_F(TrackTest, SoloDecidesOverMuteAndHide) {
    const auto mixer = timeline->newMixer("main");
    std::vector<TrackPtr> tracks;
    for (int i = 0; i < 3; ++i) {
        tracks.push_back(timeline->newTrack());
        timeline->addTrack(mixer, tracks.back());
    }
    tracks[0]->audioMutedAttribute()->setValue(true);
    tracks[1]->videoHiddenAttribute()->setValue(true);
    EXPECT_EQ(flags(*tracks[0]) + flags(*tracks[1]) + flags(*tracks[2]), "-VR-A-R-AVR-");
    tracks[1]->audioMutedAttribute()->setValue(true);
    EXPECT_EQ(flags(*tracks[1]), "---D");
    tracks[1]->audioMutedAttribute()->setValue(false);
    tracks[0]->soloAttribute()->setValue(true);
    EXPECT_TRUE(mixer->isInSoloMode());
    EXPECT_EQ(flags(*tracks[0]) + flags(*tracks[1]) + flags(*tracks[2]),
              "AVR----D---D"); // solo overrides mute
    EXPECT_TRUE(LockData::IsTrackInvisible(*tracks[1]));
}

TEST_F(TrackTest, MixerIndexRulesAndPuttingATrackBack) {
    const auto mixer = GenericMixer::create(project);
    const TrackPtr a = GenericTrack::create(project), b = GenericTrack::create(project),
                   c = GenericTrack::create(project);
    mixer->addTrack(a, -1);
    mixer->addTrack(b, 1); // the number of tracks appends
    for (const int bad : {-2, 3}) {
        try {
            mixer->addTrack(c, bad);
            FAIL() << bad;
        } catch (const ValueException<int>& e) {
            EXPECT_STREQ(e.what(), "invalid index");
            EXPECT_EQ(e.value(), bad);
        }
    }
    mixer->addTrack(c, 0);
    EXPECT_EQ(mixer->tracks(), (std::vector<TrackPtr>{c, a, b}));
    EXPECT_TRUE(Mixer::sortTracksByIndex(c, b));
    EXPECT_FALSE(Mixer::sortTracksByIndex(b, c));
    EXPECT_FALSE(Mixer::sortTracksByIndex(b, b)); // a strict order
    const RemoveTrackInfo info = mixer->removeTrackImpl(a);
    EXPECT_EQ(info.index, 1);
    EXPECT_FALSE(a->parentMixer());
    EXPECT_EQ(mixer->tracks(), (std::vector<TrackPtr>{c, b}));
    mixer->putBack(info);
    EXPECT_EQ(mixer->tracks(), (std::vector<TrackPtr>{c, a, b}));
    EXPECT_EQ(a->parentMixer(), mixer);
    EXPECT_THROW(mixer->trackAtIndex(3), IndexException);
    EXPECT_FALSE(mixer->removeTrack(GenericTrack::create(project)));
}

TEST_F(TrackTest, ATimelineKeepsNamedMixersAndRelaysClipEvents) {
    EXPECT_FALSE(timeline->mixer());
    const auto second = timeline->newMixer("b"), first = timeline->newMixer("a");
    EXPECT_EQ(timeline->mixer(), first);
    EXPECT_EQ(timeline->mixerNames(), (std::vector<std::string>{"a", "b"}));
    struct Recorder : TimelineAddObserver {
        std::string events;
        void onTimelineAddTrack(Timeline&, Mixer&, const TrackPtr&) override { events += "T+"; }
        void onTimelineRemoveTrack(Timeline&, Mixer&, const TrackPtr&) override { events += "T-"; }
        void onTimelineAddMedia(Timeline&, Track&, const MediaPtr&) override { events += "C+"; }
        void onTimelineRemoveMedia(Timeline&, Track&, const MediaPtr&) override { events += "C-"; }
    } recorder;
    timeline->attachAddObserver(&recorder);
    const auto upper = timeline->newTrack(), lower = timeline->newTrack();
    timeline->addTrack(first, upper);
    timeline->addTrack(second, lower);
    const MediaPtr a = clip(10), b = clip(10);
    upper->addMedia(a, 0);
    lower->addMedia(b, 5);
    EXPECT_EQ(a->parentTimeline().lock(), timeline);
    EXPECT_EQ(timeline->allMediasAtTime(7), (std::vector<MediaPtr>{a, b}));
    EXPECT_EQ(timeline->endTime(), 15);
    EXPECT_EQ(timeline->numTracks(), 2u);
    EXPECT_EQ(timeline->instancesOf<PlaceholderMedia>().size(), 2u);
    EXPECT_FALSE(timeline->hasInstanceOf<ColorMedia>());
    upper->removeMedia(a);
    expectThrows<VelaMediaLibException>("track doesn't belong to project",
                                        [&] { timeline->removeTrack(first, lower); });
    EXPECT_EQ(timeline->removeTrack(second, lower).track, lower);
    EXPECT_EQ(recorder.events, "T+T+C+C+C-T-");
    expectThrows<VelaMediaLibException>("unable to find mixer",
                                        [&] { timeline->removeMixer(GenericMixer::create(project)); });
    timeline->removeMixer(second);
    EXPECT_EQ(timeline->mixerNames(), std::vector<std::string>{"a"});
    timeline->detachAddObserver(&recorder);
}

TEST_F(TrackTest, AMixerBelongsToATimelineOrAGroupNeverBoth) {
    const auto owned = timeline->newMixer("main"), grouped = GenericMixer::create(project);
    const MediaPtr group = clip(10);
    expectThrows<VelaMediaLibException>("Cannot set parent group on a mixer that has a parent timeline",
                                        [&] { owned->setParentGroup(group); });
    grouped->setParentGroup(group);
    expectThrows<VelaMediaLibException>("Cannot set parent timeline on a mixer that has a parent group",
                                        [&] { timeline->addMixer("other", grouped); });
    EXPECT_EQ(timeline->mixerNames(), std::vector<std::string>{"main"});
}

TEST_F(TrackTest, CopiesAndLocks) {
    const MediaPtr first = placed(2, 10), second = placed(12, 10);
    track->setIsLocked(true);
    track->magneticAttribute()->setValue(true);
    std::map<MediaPtr, MediaPtr> copied;
    const TrackPtr portion = track->copyPortion(Range<VelaTime>(5, 10), &copied); // ticks [5, 15)
    ASSERT_EQ(portion->numMedias(), 2u);
    EXPECT_EQ(copied[first]->trackRange(), Range<VelaTime>(0, 7));
    EXPECT_EQ(copied[first]->rationalMediaRange().start(), SafeRational(3));
    EXPECT_EQ(copied[second]->trackRange(), Range<VelaTime>(7, 3));
    EXPECT_EQ(copied[second]->rationalMediaRange().start(), SafeRational(0));
    copied.clear();
    const TrackPtr spaced = track->copyPortion(std::vector<MediaPtr>{second, first}, &copied);
    ASSERT_EQ(spaced->numMedias(), 2u);
    EXPECT_EQ(copied[first]->trackRange(), Range<VelaTime>(0, 10)); // spacing kept from the earliest
    EXPECT_EQ(copied[second]->trackRange(), Range<VelaTime>(10, 10));
    EXPECT_TRUE(portion->isLocked());
    EXPECT_TRUE(portion->attributeValue("magnetic", false));
    EXPECT_EQ(first->duration(), 10);
    EXPECT_TRUE(LockData::IsMediaLocked(*first));
    EXPECT_FALSE(LockData::IsMediaEditable(*second));
    EXPECT_FALSE(LockData::IsMediaLocked(*clip(3)));
    EXPECT_TRUE(
        track->recursivelyVisitAllMediaWithEarlyExitFlag([](const MediaPtr&, bool& stop) { stop = true; }));
}

TEST_F(TrackTest, TransitionsAreJoinedAgainWhenTouchingClipsMeet) {
    const MediaPtr first = placed(0, 10);
    const TransitionPtr shared(new Transition("dissolve", 4));
    first->setRightTransition(shared);
    const MediaPtr second = placed(10, 10);
    EXPECT_EQ(second->leftTransition(), shared);
    EXPECT_EQ(shared->leftMedia(), first);
    EXPECT_EQ(shared->rightMedia(), second);
    EXPECT_EQ(track->transitions().size(), 1u);
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
        const Point3d q = m.apply(p);
        return Point3d(q.x / w, q.y / w, 0);
    };
    for (const auto& corner : {std::make_pair(Point3d(-960, 540, 0), Point3d(0, 0, 0)),
                               std::make_pair(Point3d(960, -540, 0), Point3d(1920, 1080, 0))}) {
        EXPECT_NEAR(onScreen(corner.first).x, corner.second.x, 1e-6);
        EXPECT_NEAR(onScreen(corner.first).y, corner.second.y, 1e-6);
    }
    const TransformerImpl& placement = *timeline; // the timeline places its content unchanged
    EXPECT_EQ(placement.transformAtTime(RationalTime(3)), TransformMatrix());
}

#include "../ThreadTestSupport.h"

// Membership (a clip on one track, a track in one mixer, a mixer on one
// timeline) and the path of a placed clip's edits through its track.
#include "MediaTestSupport.h"

#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/sync/Observer.h>

#include <atomic>
#include <boost/function.hpp>
#include <chrono>
#include <gtest/gtest.h>
#include <limits>
#include <thread>

using namespace VelaMediaLib;

namespace {

class TrackEditPath : public ::testing::Test {
protected:
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
    TimelinePtr timeline = Timeline::create(project);
    MixerPtr mixer = timeline->newMixer("main");
    boost::shared_ptr<GenericTrack> track = newTrack(mixer);

    boost::shared_ptr<GenericTrack> newTrack(const MixerPtr& into) {
        const auto made = timeline->newTrack();
        timeline->addTrack(into, made);
        return made;
    }
    MediaPtr placed(const boost::shared_ptr<GenericTrack>& on, VelaTime start, VelaTime duration) {
        const MediaPtr media = PlaceholderMedia::createFromMediaRange(project, rate, 0, 0, 100);
        media->trimStart(50); // room to extend either way
        media->trimEnd(50 - duration);
        on->addMedia(media, start);
        return media;
    }
};

// Every clip of the track is found where the map keys it.
void expectKeyedByStart(const Track& track) {
    ScopedReadLock lock(track.projectMutex());
    VelaTime end = std::numeric_limits<VelaTime>::min();
    for (auto entry = track.mediaBegin(); entry != track.mediaEnd(); ++entry) {
        EXPECT_EQ(entry->first, entry->second->lockedTrackRange().start());
        EXPECT_LE(end, entry->first) << "clips overlap";
        end = entry->second->lockedTrackRange().end();
    }
}

// Runs a function, once, from inside the next notification of a subject.
struct OneShot : Observer {
    boost::function<void()> action;
    void update(Observable*) override {
        const boost::function<void()> once = action;
        action.clear();
        if (once) once();
    }
};

} // namespace

TEST_F(TrackEditPath, AClipLiesOnOneTrackAtMost) {
    const auto other = newTrack(mixer);
    const MediaPtr clip = placed(track, 0, 10);
    try {
        other->addMedia(clip, 50);
        FAIL();
    } catch (const AddRemoveException& e) {
        EXPECT_STREQ(e.what(), "the clip is already on another track or in a group");
    }
    EXPECT_EQ(track->medias(), std::vector<MediaPtr>{clip});
    EXPECT_EQ(other->numMedias(), 0u);
    EXPECT_EQ(clip->startTime(), 0);
    EXPECT_EQ(clip->parent(), track);
    track->removeMedia(clip); // still removable from its own track
    other->addMedia(clip, 50);
    EXPECT_EQ(other->mediaAtTime(55).first, clip);
}

TEST_F(TrackEditPath, ATrackLiesInOneMixerAndAMixerOnOneTimeline) {
    const auto second = timeline->newMixer("second");
    try {
        second->addTrack(track);
        FAIL();
    } catch (const AddRemoveException& e) {
        EXPECT_STREQ(e.what(), "the track is already in another mixer or a stitched clip");
    }
    EXPECT_EQ(mixer->tracks(), std::vector<TrackPtr>{track});
    EXPECT_EQ(second->numTracks(), 0u);
    EXPECT_EQ(timeline->numTracks(), 1u);
    EXPECT_EQ(track->parentMixer(), mixer);

    EXPECT_THROW(timeline->addMixer("alias", mixer), AddRemoveException);
    const TimelinePtr elsewhere = Timeline::create(project);
    EXPECT_THROW(elsewhere->addMixer("main", mixer), AddRemoveException);
    EXPECT_EQ(timeline->mixerNames(), (std::vector<std::string>{"main", "second"}));
    EXPECT_TRUE(elsewhere->mixerNames().empty());
    EXPECT_EQ(mixer->parentTimeline(), timeline);
}

TEST_F(TrackEditPath, AClipEditedByItselfGoesThroughItsTrack) {
    const MediaPtr left = placed(track, 0, 10), clip = placed(track, 20, 10), right = placed(track, 40, 10);
    clip->move(5); // now [25, 35), keyed there
    EXPECT_EQ(track->mediaAtTime(26).first, clip);
    EXPECT_EQ(Track::getLeftOfMedia(clip), left);
    expectKeyedByStart(*track);

    const MediaState before = clip->state();
    EXPECT_THROW(clip->move(10), CollisionException); // would overlap the right neighbour
    EXPECT_THROW(clip->trimEnd(-6), CollisionException);
    EXPECT_THROW(clip->trimStart(-16), CollisionException);
    EXPECT_THROW(clip->setTrackStart(5), CollisionException);
    EXPECT_THROW(clip->rationalStretch(SafeRational(2)), CollisionException);
    MediaState over = before;
    over.start = 1;
    EXPECT_THROW(clip->restoreState(over, 0), CollisionException);
    EXPECT_TRUE(clip->state() == before);

    clip->trimStart(-5);
    clip->setTrackStart(10);
    EXPECT_EQ(clip->trackRange(), Range<VelaTime>(10, 15));
    EXPECT_TRUE(track->hasMedia(clip));
    track->removeMedia(clip); // found under its new start
    expectKeyedByStart(*track);
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{left, right}));
}

TEST_F(TrackEditPath, AnObserverThatEditsTheTrackMidEditFindsItConsistent) {
    const MediaPtr clip = placed(track, 0, 10), other = placed(track, 30, 10);
    OneShot removeItself;
    removeItself.action = [&] { track->removeMedia(clip); };
    clip->attachWithoutNotifyDelay(&removeItself);
    track->move(clip, 5);
    clip->detach(&removeItself);
    EXPECT_FALSE(track->hasMedia(clip));
    EXPECT_EQ(track->medias(), std::vector<MediaPtr>{other});
    expectKeyedByStart(*track);

    track->addMedia(clip, 0);
    OneShot moveNeighbour;
    moveNeighbour.action = [&] { track->move(other, 20); };
    clip->attachWithoutNotifyDelay(&moveNeighbour);
    clip->trimEnd(-5);
    clip->detach(&moveNeighbour);
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{clip, other}));
    EXPECT_EQ(other->startTime(), 50);
    expectKeyedByStart(*track);
}

TEST_F(TrackEditPath, MapIteratorsWalkTheTrackUnderTheCallersLock) {
    const MediaPtr a = placed(track, 0, 10), b = placed(track, 10, 10), c = placed(track, 40, 5);
    ScopedReadLock lock(track->projectMutex());
    EXPECT_EQ(std::distance(track->mediaBegin(), track->mediaEnd()), 3);
    EXPECT_EQ(track->mediaRBegin()->second, c);
    EXPECT_EQ(std::prev(track->mediaREnd())->second, a);
    EXPECT_EQ(track->lower_bound(10)->second, b);
    EXPECT_EQ(track->upper_bound(10)->second, c);
    EXPECT_EQ(track->lower_bound(41), track->mediaEnd());
}

TEST(TrackConcurrency, EditsRacingForTheSameGapNeverOverlap) {
    VelaMediaLib::testing::Deadline watchdog;
    const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    const auto track = GenericTrack::create(project);
    const boost::weak_ptr<ProjectEditRate> noRate;
    const MediaPtr left = PlaceholderMedia::create(project, noRate, 0, 10);
    const MediaPtr right = PlaceholderMedia::create(project, noRate, 0, 10);
    track->addMedia(left, 0);
    track->addMedia(right, 12); // a two-tick gap both reach for
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(20);
    std::atomic<int> overlaps{0};
    auto jiggle = [&](const MediaPtr& clip, VelaTime towards) {
        for (int i = 0; i < 3000 && std::chrono::steady_clock::now() < deadline; ++i) {
            for (const VelaTime step : {towards, -towards}) {
                try {
                    i % 2 ? clip->move(step) : (void)track->move(clip, step);
                } catch (const CollisionException&) {}
            }
            ScopedReadLock lock(project); // both ranges at one moment
            if (left->lockedTrackRange().end() > right->lockedTrackRange().start()) ++overlaps;
        }
    };
    std::thread other([&] { jiggle(right, -2); });
    jiggle(left, 2);
    other.join();
    EXPECT_EQ(overlaps.load(), 0);
    expectKeyedByStart(*track);
}

// Membership (a clip on one track, a track in one mixer, a mixer on one
// timeline) and the path of a placed clip's edits through its track.
#include "MediaTestSupport.h"

#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

#include <boost/function.hpp>
#include <limits>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class TrackEditPath : public ModelTest {
protected:
    TimelinePtr timeline = Timeline::create(project);
    MixerPtr mixer = timeline->newMixer("main");
    boost::shared_ptr<GenericTrack> track = newTrack(), other = newTrack();

    boost::shared_ptr<GenericTrack> newTrack() {
        const auto made = timeline->newTrack();
        timeline->addTrack(mixer, made);
        return made;
    }
    MediaPtr placed(VelaTime start, VelaTime duration) {
        const MediaPtr media = PlaceholderMedia::createFromMediaRange(project, rate, 0, 0, 100);
        media->trimStart(50); // room to extend either way
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

TEST_F(TrackEditPath, AClipLiesOnOneTrackAtMostAndATrackInOneMixer) {
    const MediaPtr clip = placed(0, 10);
    expectThrows<AddRemoveException>("the clip is already on another track or in a group",
                                     [&] { other->addMedia(clip, 50); });
    EXPECT_EQ(track->medias(), std::vector<MediaPtr>{clip});
    EXPECT_EQ(other->numMedias(), 0u);
    EXPECT_EQ(clip->startTime(), 0);
    EXPECT_EQ(clip->parent(), track);
    track->removeMedia(clip); // still removable from its own track
    other->addMedia(clip, 50);
    EXPECT_EQ(other->mediaAtTime(55).first, clip);

    const auto second = timeline->newMixer("second");
    expectThrows<AddRemoveException>("the track is already in another mixer or a stitched clip",
                                     [&] { second->addTrack(track); });
    EXPECT_EQ(mixer->tracks(), (std::vector<TrackPtr>{track, other}));
    EXPECT_EQ(second->numTracks(), 0u);
    EXPECT_EQ(timeline->numTracks(), 2u);
    EXPECT_EQ(track->parentMixer(), mixer);
}

TEST_F(TrackEditPath, AMixerLiesOnOneTimeline) {
    EXPECT_THROW(timeline->addMixer("alias", mixer), AddRemoveException);
    const TimelinePtr elsewhere = Timeline::create(project);
    EXPECT_THROW(elsewhere->addMixer("main", mixer), AddRemoveException);
    EXPECT_EQ(timeline->mixerNames(), std::vector<std::string>{"main"});
    EXPECT_TRUE(elsewhere->mixerNames().empty());
    EXPECT_EQ(mixer->parentTimeline(), timeline);
}

TEST_F(TrackEditPath, AClipEditedByItselfGoesThroughItsTrack) {
    const MediaPtr left = placed(0, 10), clip = placed(20, 10), right = placed(40, 10);
    clip->move(5); // now [25, 35), keyed there
    EXPECT_EQ(track->mediaAtTime(26).first, clip);
    EXPECT_EQ(Track::getLeftOfMedia(clip), left);
    expectKeyedByStart();

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
    expectKeyedByStart();
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{left, right}));
}

TEST_F(TrackEditPath, AnObserverThatEditsTheTrackMidEditFindsItConsistent) {
    const MediaPtr clip = placed(0, 10), next = placed(30, 10);
    OneShot removeItself, moveNeighbour;
    removeItself.action = [&] { track->removeMedia(clip); };
    clip->attachWithoutNotifyDelay(&removeItself);
    track->move(clip, 5);
    clip->detach(&removeItself);
    EXPECT_FALSE(track->hasMedia(clip));
    EXPECT_EQ(track->medias(), std::vector<MediaPtr>{next});
    expectKeyedByStart();

    track->addMedia(clip, 0);
    moveNeighbour.action = [&] { track->move(next, 20); };
    clip->attachWithoutNotifyDelay(&moveNeighbour);
    clip->trimEnd(-5);
    clip->detach(&moveNeighbour);
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{clip, next}));
    EXPECT_EQ(next->startTime(), 50);
    expectKeyedByStart();
}

TEST_F(TrackEditPath, MapIteratorsWalkTheTrackUnderTheCallersLock) {
    const MediaPtr a = placed(0, 10), b = placed(10, 10), c = placed(40, 5);
    ScopedReadLock lock(track->projectMutex());
    EXPECT_EQ(std::distance(track->mediaBegin(), track->mediaEnd()), 3);
    EXPECT_EQ(track->mediaRBegin()->second, c);
    EXPECT_EQ(std::prev(track->mediaREnd())->second, a);
    EXPECT_EQ(track->lower_bound(10)->second, b);
    EXPECT_EQ(track->upper_bound(10)->second, c);
    EXPECT_EQ(track->lower_bound(41), track->mediaEnd());
}

// Observers hear the changed object itself, and only of real changes.
#include "MediaTestSupport.h"

#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/sync/MultiObjectObserver.h>

#include <gtest/gtest.h>

using namespace VelaMediaLib;

namespace {

class ModelNotification : public ::testing::Test {
protected:
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
    std::vector<Observable*> heard;
    MultiObjectObserver observer{[this](Observable* changed) { heard.push_back(changed); }};

    MediaPtr clip(VelaTime duration) {
        const MediaPtr made = PlaceholderMedia::createFromMediaRange(project, rate, 0, 0, 100);
        made->trimEnd(100 - duration);
        return made;
    }
};

struct Counter : Observer {
    int count = 0;
    Observable* last = nullptr;
    void update(Observable* changed) override {
        ++count;
        last = changed;
    }
};

} // namespace

TEST_F(ModelNotification, ObserversOfSeveralObjectsHearWhichOneChanged) {
    const TimelinePtr timeline = Timeline::create(project);
    const MixerPtr mixer = timeline->newMixer("main");
    const auto track = timeline->newTrack();
    timeline->addTrack(mixer, track);
    const MediaPtr a = clip(10), b = clip(10);
    track->addMedia(a, 0);
    track->addMedia(b, 20);
    for (const boost::shared_ptr<Observable>& subject : std::vector<boost::shared_ptr<Observable>>{
             a, b, mixer, track, boost::static_pointer_cast<ObjectSubject>(timeline)})
        observer.observe(subject);
    b->move(1);
    a->trimEnd(1);
    mixer->setIdentifier("renamed");
    track->setIdentifier("upper");
    timeline->setCaptionAttributes(CaptionAttributes());
    EXPECT_EQ(heard, (std::vector<Observable*>{b.get(), a.get(), mixer.get(), track.get(),
                                               static_cast<ObjectSubject*>(timeline.get())}));
    observer.stopObservingAll();
}

TEST_F(ModelNotification, TransitionObserversHearTheClip) {
    const MediaPtr a = clip(10), b = clip(10);
    Counter onA, onB;
    a->transitionAddRemoveObservable().attach(&onA);
    b->transitionAddRemoveObservable().attach(&onB);
    b->setLeftTransition(TransitionPtr(new Transition("fade", 3)));
    a->setRightTransition(TransitionPtr(new Transition("fade", 3)));
    EXPECT_EQ(onA.last, static_cast<Observable*>(a.get()));
    EXPECT_EQ(onB.last, static_cast<Observable*>(b.get()));
    a->transitionAddRemoveObservable().detach(&onA);
    b->transitionAddRemoveObservable().detach(&onB);
}

TEST_F(ModelNotification, EditsThatChangeNothingTellNobody) {
    const auto track = GenericTrack::create(project);
    const MediaPtr media = clip(10);
    track->addMedia(media, 0);
    const TransitionPtr fade(new Transition("fade", 3));
    media->setRightTransition(fade);
    media->setIdentifier("clip");
    media->addLeftEdgeModification(EdgeModificationPtr(new EdgeModification(4, "group", 0.0)));
    Counter counter;
    media->attach(&counter);
    media->trimStart(0);
    media->trimEnd(0);
    media->move(0);
    media->setTrackStart(0);
    media->rationalStretch(SafeRational(1));
    media->restoreState(media->state(), 0);
    track->move(media, 0);
    track->trimEnd(media, 0);
    media->setRightTransition(fade);
    media->setIdentifier("clip");
    media->setLeftEdgeModificationLength(4);
    EXPECT_EQ(counter.count, 0);
    media->move(1);
    EXPECT_EQ(counter.count, 1);
    EXPECT_EQ(counter.last, static_cast<Observable*>(media.get()));
    media->detach(&counter);
}

TEST_F(ModelNotification, ATransitionLetsGoOfTheClipThatDropsIt) {
    const MediaPtr media = clip(10);
    const TransitionPtr first(new Transition("fade", 3)), second(new Transition("wipe", 3));
    media->setRightTransition(first);
    media->setLeftTransition(second);
    EXPECT_EQ(first->leftMedia(), media);
    EXPECT_EQ(second->rightMedia(), media);
    media->setRightTransition(second); // replaced: the first lets go
    EXPECT_FALSE(first->leftMedia());
    EXPECT_EQ(second->leftMedia(), media);
    media->setLeftTransition(TransitionPtr()); // cleared: it lets go of that side
    EXPECT_FALSE(second->rightMedia());
    EXPECT_EQ(second->leftMedia(), media);
}

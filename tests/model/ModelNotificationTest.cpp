// Observers hear the changed object itself, only of real changes, and under
// the one project token that every part of an object shares.
#include "MediaTestSupport.h"

#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/sync/MultiObjectObserver.h>
#include <VelaMediaLib/time/sync/NotifyDelay.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class ModelNotification : public ModelTest {
protected:
    MediaPtr clip(VelaTime duration) {
        const MediaPtr made = PlaceholderMedia::createFromMediaRange(project, rate, 0, 0, 100);
        made->trimEnd(100 - duration);
        return made;
    }
};

/// An object with metadata, parameters and attributes, as a project part has.
class Part : public MetaDatable, public Parametric, public Attributable {
public:
    explicit Part(const boost::weak_ptr<const ThreadSafe>& token)
        : MetaDatable(token), Parametric(token), Attributable(token) {}

protected:
    boost::shared_ptr<ParameterInterface> createDefaultParameter(const std::string& name) const override {
        return InterpolatingParam<double>::create(projectMutex(), name, 1.0);
    }
    std::vector<std::string> defaultParameterNames() const override { return {"level"}; }
};

bool sameProject(const boost::weak_ptr<const ThreadSafe>& token,
                 const boost::shared_ptr<const ThreadSafe>& project) {
    return token.lock() == project;
}

} // namespace

TEST_F(ModelNotification, ObserversOfSeveralObjectsHearWhichOneChanged) {
    const TimelinePtr timeline = Timeline::create(project);
    const MixerPtr mixer = timeline->newMixer("main");
    const auto track = timeline->newTrack();
    timeline->addTrack(mixer, track);
    const MediaPtr a = clip(10), b = clip(10);
    track->addMedia(a, 0);
    track->addMedia(b, 20);
    std::vector<Observable*> heard;
    MultiObjectObserver observer([&](Observable* changed) { heard.push_back(changed); });
    const auto timelineSubject = boost::static_pointer_cast<ObjectSubject>(timeline);
    for (const boost::shared_ptr<Observable>& subject :
         std::vector<boost::shared_ptr<Observable>>{a, b, mixer, track, timelineSubject})
        observer.observe(subject);
    b->move(1);
    a->trimEnd(1);
    mixer->setIdentifier("renamed");
    track->setIdentifier("upper");
    timeline->setCaptionAttributes(CaptionAttributes());
    EXPECT_EQ(heard,
              (std::vector<Observable*>{b.get(), a.get(), mixer.get(), track.get(), timelineSubject.get()}));
    observer.stopObservingAll();
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
    // The quiet setter tells its caller whether to notify.
    EXPECT_FALSE(media->setLeftEdgeModificationsUnnotified(media->leftEdgeModifications()));
    EXPECT_TRUE(
        media->setRightEdgeModificationsUnnotified({EdgeModificationPtr(new EdgeModification(2, "g", 0))}));
    EXPECT_EQ(counter.count, 0);
    media->move(1);
    media->detach(&counter);
    EXPECT_EQ(std::make_pair(counter.count, counter.last),
              std::make_pair(1, static_cast<Observable*>(media.get())));
}

TEST_F(ModelNotification, ATransitionLetsGoOfTheClipThatDropsItAndItsObserversHearTheClip) {
    const MediaPtr media = clip(10), other = clip(10);
    Counter onMedia, onOther;
    media->transitionAddRemoveObservable().attach(&onMedia);
    other->transitionAddRemoveObservable().attach(&onOther);
    const TransitionPtr first(new Transition("fade", 3)), second(new Transition("wipe", 3));
    media->setRightTransition(first);
    media->setLeftTransition(second);
    other->setLeftTransition(TransitionPtr(new Transition("fade", 3)));
    EXPECT_EQ((std::vector<Observable*>{onMedia.last, onOther.last}),
              (std::vector<Observable*>{media.get(), other.get()}));
    media->transitionAddRemoveObservable().detach(&onMedia);
    other->transitionAddRemoveObservable().detach(&onOther);
    using Clips = std::vector<MediaPtr>;
    EXPECT_EQ(Clips({first->leftMedia(), second->rightMedia()}), Clips({media, media}));
    media->setRightTransition(second); // replaced: the first lets go
    EXPECT_EQ(Clips({first->leftMedia(), second->leftMedia()}), Clips({nullptr, media}));
    media->setLeftTransition(TransitionPtr()); // cleared: it lets go of that side
    EXPECT_EQ(Clips({second->rightMedia(), second->leftMedia()}), Clips({nullptr, media}));
}

// One token serves every part of an object: the metadata, the parameters and
// attributes made from it, the subject and the effect list all lock through it.
TEST(ProjectToken, EveryPartOfAClipAsksTheOneToken) {
    const ProjectPtr project = Project::create(30, 1);
    const auto clip = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10);
    EXPECT_EQ(&clip->projectMutex(), &clip->metaDataProjectMutex());
    EXPECT_TRUE(sameProject(clip->projectMutex(), project) &&
                sameProject(clip->attributeOrAdd<int>("count", 0)->projectMutex(), project) &&
                sameProject(clip->addMetaData("tag", "a")->projectMutex(), project));
    EXPECT_EQ(clip->mutex(), &project->mutex());
}

// Setting an object's token sets it for all its parts at once; a part
// constructed without a token keeps the one another part recorded.
TEST(ProjectToken, SettingTheTokenReachesEveryPart) {
    const auto first = boost::make_shared<ThreadSafe>(), second = boost::make_shared<ThreadSafe>();
    Part part(first);
    part.setMetaDataProjectMutex(second);
    EXPECT_TRUE(sameProject(part.projectMutex(), second) &&
                sameProject(part.parameter("level")->projectMutex(), second) &&
                sameProject(part.attributeOrAdd<bool>("flag", false)->projectMutex(), second) &&
                sameProject(part.addMetaData("tag", "b")->projectMutex(), second));
    struct Late : public Parametric, public Attributable {
        explicit Late(const boost::weak_ptr<const ThreadSafe>& token) : Parametric(token), Attributable() {}
    } late(first);
    EXPECT_TRUE(sameProject(late.projectMutex(), first));
}

// The clip's transition subject and the project's own subject notify under
// the project's token: its delay holds them back, and a clip let go of
// meanwhile leaves its subject unheard.
TEST(ProjectToken, SubjectsAreHeldBackByTheProjectsDelay) {
    const ProjectPtr project = Project::create(30, 1);
    auto clip = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10);
    Counter onClip, onProject;
    clip->transitionAddRemoveObservable().attach(&onClip);
    project->attach(&onProject);
    {
        NotifyDelay delay(project);
        clip->setLeftTransition(TransitionPtr(new Transition("fade", 3)));
        clip->setRightTransition(TransitionPtr(new Transition("wipe", 3)));
        project->notify();
        project->notify();
        EXPECT_EQ(onClip.count + onProject.count, 0);
    }
    EXPECT_EQ(std::make_pair(onClip.count, onProject.count), std::make_pair(1, 1));
    EXPECT_EQ(onProject.last, static_cast<Observable*>(project.get()));
    project->detach(&onProject);
    {
        NotifyDelay delay(project);
        clip->setLeftTransition(TransitionPtr());
        clip.reset();
    }
    EXPECT_EQ(onClip.count, 1);
}

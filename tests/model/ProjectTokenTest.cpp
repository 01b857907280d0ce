#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <boost/make_shared.hpp>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/sync/NotifyDelay.h>

#include <gtest/gtest.h>

using namespace VelaMediaLib;

namespace {

struct Counter : Observer {
    int count = 0;
    void update(Observable*) override { ++count; }
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

// One token serves every part of an object: the metadata, the parameters and
// attributes made from it, the subject and the effect list all lock through it.
TEST(ProjectToken, EveryPartOfAClipAsksTheOneToken) {
    const ProjectPtr project = Project::create(30, 1);
    const auto clip = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10);
    EXPECT_EQ(&clip->projectMutex(), &clip->metaDataProjectMutex());
    EXPECT_TRUE(sameProject(clip->projectMutex(), project));
    EXPECT_TRUE(sameProject(clip->attributeOrAdd<int>("count", 0)->projectMutex(), project));
    EXPECT_TRUE(sameProject(clip->addMetaData("tag", "a")->projectMutex(), project));
    EXPECT_EQ(clip->mutex(), &project->mutex());
}

// Setting an object's token sets it for all its parts at once: what its
// parameters and attributes are made with afterwards is the new project.
TEST(ProjectToken, SettingTheTokenReachesEveryPart) {
    const auto first = boost::make_shared<ThreadSafe>();
    const auto second = boost::make_shared<ThreadSafe>();
    Part part(first);
    part.setMetaDataProjectMutex(second);
    EXPECT_TRUE(sameProject(part.projectMutex(), second));
    EXPECT_TRUE(sameProject(part.parameter("level")->projectMutex(), second));
    EXPECT_TRUE(sameProject(part.attributeOrAdd<bool>("flag", false)->projectMutex(), second));
    EXPECT_TRUE(sameProject(part.addMetaData("tag", "b")->projectMutex(), second));
}

// A part constructed without a token leaves the token another part recorded,
// whatever the order of construction.
TEST(ProjectToken, APartWithoutATokenKeepsTheOneRecorded) {
    const auto project = boost::make_shared<ThreadSafe>();
    struct Late : public Parametric, public Attributable {
        explicit Late(const boost::weak_ptr<const ThreadSafe>& token) : Parametric(token), Attributable() {}
    } late(project);
    EXPECT_TRUE(sameProject(late.projectMutex(), project));
}

// A clip's transition subject notifies under the clip's token: a delay of
// the clip's project holds it back, and a clip let go of meanwhile leaves it.
TEST(ProjectToken, TheTransitionSubjectIsHeldBackByTheClipsProject) {
    const ProjectPtr project = Project::create(30, 1);
    auto clip = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10);
    Counter heard;
    clip->transitionAddRemoveObservable().attach(&heard);
    {
        NotifyDelay delay(project);
        clip->setLeftTransition(TransitionPtr(new Transition("fade", 3)));
        clip->setRightTransition(TransitionPtr(new Transition("wipe", 3)));
        EXPECT_EQ(heard.count, 0);
    }
    EXPECT_EQ(heard.count, 1);
    {
        NotifyDelay delay(project);
        clip->setLeftTransition(TransitionPtr());
        clip.reset();
    }
    EXPECT_EQ(heard.count, 1);
}

// The project's own subject notifies under the project's token: its delay
// holds it back, and observers hear the project.
TEST(ProjectToken, TheProjectsOwnSubjectIsHeldBackByItsDelay) {
    const ProjectPtr project = Project::create(30, 1);
    struct Last : Counter {
        Observable* changed = nullptr;
        void update(Observable* subject) override {
            Counter::update(subject);
            changed = subject;
        }
    } heard;
    project->attach(&heard);
    {
        NotifyDelay delay(project);
        project->notify();
        project->notify();
        EXPECT_EQ(heard.count, 0);
    }
    EXPECT_EQ(heard.count, 1);
    EXPECT_EQ(heard.changed, static_cast<Observable*>(project.get()));
    project->detach(&heard);
}

#include <VelaMediaLib/time/parameters/Attribute.h>
#include <VelaMediaLib/time/sync/LambdaObserverWithoutNotifyDelay.h>
#include <VelaMediaLib/time/parameters/MetaDatable.h>
#include <VelaMediaLib/time/sync/MultiObjectObserver.h>
#include <VelaMediaLib/time/sync/NotifyDelay.h>
#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <memory>

using namespace VelaMediaLib;

namespace {

struct CountingObserver : Observer {
    int count = 0;
    Observable* last = nullptr;
    void update(Observable* subject) override {
        ++count;
        last = subject;
    }
};

class Notification : public ::testing::Test {
protected:
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<Subject> subject = boost::make_shared<Subject>(project);
    CountingObserver observer;
};

} // namespace

TEST_F(Notification, DisablersNest) {
    subject->attach(&observer);
    {
        Subject::NotifyDisabler outer = subject->disableNotifies();
        {
            Subject::NotifyDisabler inner = subject->disableNotifies();
            subject->notify();
        }
        subject->notify();
        EXPECT_EQ(observer.count, 0);
    }
    subject->notify();
    EXPECT_EQ(observer.count, 1);
    EXPECT_EQ(observer.last, subject.get());
}

TEST_F(Notification, ADelayCoalescesChangesAndTheUndelayedHearAtOnce) {
    CountingObserver immediate;
    Subject other(project);
    CountingObserver otherObserver;
    subject->attach(&observer);
    subject->attachWithoutNotifyDelay(&immediate);
    other.attach(&otherObserver);
    {
        NotifyDelay delay(project);
        NotifyDelay nested(project); // delays count in and out
        subject->notify();
        subject->notify();
        other.notify();
        EXPECT_TRUE(NotifyDelay::isActive(project));
        EXPECT_EQ(immediate.count, 2);
        EXPECT_EQ(observer.count, 0);
    }
    EXPECT_FALSE(NotifyDelay::isActive(project));
    EXPECT_EQ(observer.count, 1);
    EXPECT_EQ(otherObserver.count, 1);
    EXPECT_EQ(immediate.count, 2); // not told again at the end of the delay
}

TEST_F(Notification, ADelayOpenedDuringDeliveryFails) {
    std::string message;
    bool notifyingSeen = false;
    auto opener = LambdaObserverWithoutNotifyDelay(boost::function<void(Observable*)>([&](Observable*) {
        notifyingSeen = NotifyDelay::isNotifying(project);
        try {
            NotifyDelay again(project);
        } catch (const VelaMediaLibException& e) {
            message = e.what();
        }
    }));
    subject->attach(&opener);
    {
        NotifyDelay delay(project);
        subject->notify();
    }
    EXPECT_TRUE(notifyingSeen);
    EXPECT_EQ(message, "nested delays not supported");
    NotifyDelay afterwards(project); // the registry is idle again
}

TEST_F(Notification, AnObserverInBothListsIsToldOnceAndDetachWorksFromEither) {
    subject->attach(&observer);
    subject->attachWithoutNotifyDelay(&observer);
    subject->attach(&observer);
    subject->notify();
    EXPECT_EQ(observer.count, 1);
    subject->detach(&observer);
    subject->notify();
    EXPECT_EQ(observer.count, 1);
}

TEST_F(Notification, ASubjectDestroyedWhileHeldBackIsForgotten) {
    auto doomed = std::make_unique<Subject>(project);
    doomed->attach(&observer);
    subject->attach(&observer);
    {
        NotifyDelay delay(project);
        doomed->notify();
        subject->notify();
        doomed.reset();
    }
    EXPECT_EQ(observer.count, 1);
    EXPECT_EQ(observer.last, subject.get());
}

// Checking for an open delay and parking are one step: a subject is never
// parked where no delay will deliver it.
TEST_F(Notification, ASubjectIsHeldBackOnlyWhileADelayIsOpen) {
    subject->attach(&observer);
    EXPECT_FALSE(NotifyDelay::addSubject(subject.get(), project));
    { NotifyDelay unrelated(project); }
    EXPECT_EQ(observer.count, 0);
    {
        NotifyDelay delay(project);
        EXPECT_TRUE(NotifyDelay::addSubject(subject.get(), project));
        EXPECT_TRUE(NotifyDelay::addSubject(subject.get(), project)); // held back once
    }
    EXPECT_EQ(observer.count, 1);
}

TEST_F(Notification, AnObserverThatThrowsSilencesNoneOfTheOthers) {
    struct Throwing : Observer {
        void update(Observable*) override { throw VelaMediaLibException("observer failed"); }
    } throwing;
    subject->attach(&throwing);
    subject->attach(&observer);
    {
        NotifyDelay delay(project);
        subject->notify();
    } // the failure is dropped: the edit has finished
    EXPECT_EQ(observer.count, 1);
    EXPECT_FALSE(NotifyDelay::isNotifying(project));
    EXPECT_NO_THROW(subject->notify()); // told at once too, the change has happened all the same
    EXPECT_EQ(observer.count, 2);
    subject->detach(&throwing);
}

TEST_F(Notification, ObserversMayChangeTheListsFromInsideTheirUpdate) {
    struct Rearranging : Observer {
        Subject* subject = nullptr;
        Observer* other = nullptr;
        int count = 0;
        void update(Observable*) override {
            ++count;
            subject->detach(this);
            subject->attach(other);
        }
    } rearranging;
    rearranging.subject = subject.get();
    rearranging.other = &observer;
    subject->attach(&rearranging);
    subject->notify();
    subject->notify();
    EXPECT_EQ(rearranging.count, 1);
    EXPECT_EQ(observer.count, 1); // attached during the first walk, told from the second on
}

TEST_F(Notification, AHeldBackNotificationMovesWithItsSubject) {
    const auto other = boost::make_shared<ThreadSafe>();
    subject->attach(&observer);
    NotifyDelay delay(project);
    subject->notify();
    {
        NotifyDelay otherDelay(other);
        subject->setProjectMutex(other);
        EXPECT_EQ(observer.count, 0);
    }
    EXPECT_EQ(observer.count, 1);
}

TEST_F(Notification, ASubjectOutlivingItsProjectStillNotifies) {
    subject->attach(&observer);
    project.reset();
    subject->notify();
    EXPECT_EQ(observer.count, 1);
}

TEST_F(Notification, ScopedObserversDetachThemselves) {
    int heard = 0;
    {
        auto lambda = LambdaObserverWithoutNotifyDelay::createWithScopedAttachDetach(
            subject, [&](Observable*) { ++heard; });
        NotifyDelay delay(project);
        subject->notify();
        EXPECT_EQ(heard, 1);
    }
    subject->notify();
    EXPECT_EQ(heard, 1);

    auto second = boost::make_shared<Subject>(project);
    std::vector<Observable*> changed;
    {
        MultiObjectObserver multi([&](Observable* s) { changed.push_back(s); });
        multi.observe(subject);
        multi.observe(second);
        subject->notify();
        second->notify();
        second.reset(); // an expired subject is skipped at detach
    }
    subject->notify();
    ASSERT_EQ(changed.size(), 2u);
    EXPECT_EQ(changed[0], subject.get());
}

TEST_F(Notification, AttributesAndMetadataTellOnlyRealChanges) {
    MetaDatable metadata(project);
    auto attribute = metadata.addMetaData("author", "ada");
    attribute->attach(&observer);
    EXPECT_EQ(metadata.addMetaData("author", "ada"), attribute);
    EXPECT_EQ(observer.count, 0);
    metadata.addMetaData("author", "grace");
    EXPECT_EQ(observer.count, 1);
    EXPECT_EQ(metadata.metaDataValue("author"), "grace");
    EXPECT_EQ(metadata.metaDataValue("missing"), "");
    EXPECT_FALSE(metadata.metaDataAttribute("missing"));
    EXPECT_TRUE(metadata.removeMetaData("author"));
    EXPECT_FALSE(metadata.removeMetaData("author"));
    EXPECT_TRUE(metadata.metaDataKeys().empty());

    Attribute<bool> flag("solo", false, project);
    flag.attach(&observer);
    EXPECT_FALSE(flag.setValue(false));
    EXPECT_TRUE(flag.setValue(true));
    EXPECT_EQ(observer.count, 2);
    EXPECT_EQ(flag.name(), "solo");
}

TEST(SimpleProjectEditRate, NotifiesAfterStoringTheRate) {
    SimpleProjectEditRate rate(boost::rational<unsigned long>(30));
    struct Reader : Observer {
        const ProjectEditRate* rate = nullptr;
        boost::rational<unsigned long> seen;
        void update(Observable*) override { seen = rate->editRate(); }
    } reader;
    reader.rate = &rate;
    rate.attachEditRateObserver(&reader);
    rate.setEditRate(boost::rational<unsigned long>(30000, 1001));
    EXPECT_EQ(reader.seen, boost::rational<unsigned long>(30000, 1001));
    EXPECT_EQ(rate.videoFrameRate(), 30);
    EXPECT_EQ(rate.audioSampleRate(), 44100);
    EXPECT_EQ(rate.durationPerFrame(), 1);
    EXPECT_EQ(rate.editingUnit(), 1u);
    rate.detachEditRateObserver(&reader);
}

// An observer that destroys a subject without a lifeline during delayed
// delivery ends that subject's delivery; the other held-back subjects are
// still told.
TEST_F(Notification, AnObserverThatDestroysItsSubjectEndsItsDelivery) {
    Subject* doomed = new Subject(project);
    struct Destroyer : Observer {
        Subject** doomed = nullptr;
        void update(Observable*) override {
            delete *doomed;
            *doomed = nullptr;
        }
    } destroyer;
    destroyer.doomed = &doomed;
    CountingObserver afterIt;
    doomed->attach(&destroyer);
    doomed->attach(&afterIt);
    subject->attach(&observer);
    {
        NotifyDelay delay(project);
        doomed->notify();
        subject->notify();
    }
    EXPECT_EQ(doomed, nullptr);
    EXPECT_EQ(afterIt.count, 0);
    EXPECT_EQ(observer.count, 1);
}

// A subject held by shared pointer is kept alive through its delivery: an
// observer letting go of the last reference leaves the others hearing it whole.
TEST_F(Notification, AnObserverThatLetsGoOfItsSubjectLeavesTheOthersHearingItWhole) {
    boost::shared_ptr<Attribute<std::string>> attribute(new Attribute<std::string>("name", "a", project));
    const boost::weak_ptr<Attribute<std::string>> watched = attribute;
    struct LettingGo : Observer {
        boost::shared_ptr<Attribute<std::string>>* held = nullptr;
        void update(Observable*) override { held->reset(); }
    } lettingGo;
    lettingGo.held = &attribute;
    struct Reading : Observer {
        std::string seen;
        void update(Observable* changed) override {
            seen = dynamic_cast<Attribute<std::string>&>(*changed).value();
        }
    } reading;
    attribute->attach(&lettingGo);
    attribute->attach(&reading);
    {
        NotifyDelay delay(project);
        attribute->setValue("b");
    }
    EXPECT_EQ(reading.seen, "b");
    EXPECT_TRUE(watched.expired());
}

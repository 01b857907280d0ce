#include "../ThreadTestSupport.h"

#include <VelaMediaLib/time/parameters/Attribute.h>
#include <VelaMediaLib/time/sync/LambdaObserverWithoutNotifyDelay.h>
#include <VelaMediaLib/time/parameters/MetaDatable.h>
#include <VelaMediaLib/time/sync/MultiObjectObserver.h>
#include <VelaMediaLib/time/sync/NotifyDelay.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <memory>

using namespace VelaMediaLib;

namespace {

typedef LambdaObserverWithoutNotifyDelay Lambda;
using VelaMediaLib::testing::CountingObserver;

class Notification : public ::testing::Test {
protected:
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<Subject> subject = boost::make_shared<Subject>(project);
    CountingObserver observer;
};

} // namespace

// Disablers nest, an observer in both lists is told once and detached from either, a subject outliving its
// project still notifies, and observers may change the lists from inside their update.
TEST_F(Notification, DisablersNestAndTheListsHoldEachObserverOnce) {
    subject->attach(&observer);
    subject->attachWithoutNotifyDelay(&observer);
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
    project.reset();
    subject->notify();
    EXPECT_EQ(observer.count, 2);
    subject->detach(&observer);
    subject->notify();
    EXPECT_EQ(observer.count, 2);
    int rearranged = 0;
    Lambda rearranging([&](Observable*) {
        ++rearranged;
        subject->detach(&rearranging);
        subject->attach(&observer);
    });
    subject->attach(&rearranging);
    subject->notify();
    subject->notify();
    EXPECT_EQ(rearranged, 1);
    EXPECT_EQ(observer.count, 3); // attached during the first walk, told from the second on
}

TEST_F(Notification, ADelayCoalescesChangesAndTheUndelayedHearAtOnce) {
    CountingObserver immediate, otherObserver;
    Subject other(project);
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
    EXPECT_FALSE(NotifyDelay::isActive(nullptr) || NotifyDelay::isNotifying(nullptr)); // no project, no delay
    EXPECT_EQ(observer.count, 1);
    EXPECT_EQ(otherObserver.count, 1);
    EXPECT_EQ(immediate.count, 2); // not told again at the end of the delay
}

TEST_F(Notification, ADelayOpenedDuringDeliveryFails) {
    std::string message;
    bool notifyingSeen = false;
    Lambda opener([&](Observable*) {
        notifyingSeen = NotifyDelay::isNotifying(project);
        try {
            NotifyDelay again(project);
        } catch (const VelaMediaLibException& e) {
            message = e.what();
        }
    });
    subject->attach(&opener);
    {
        NotifyDelay delay(project);
        subject->notify();
    }
    EXPECT_TRUE(notifyingSeen);
    EXPECT_EQ(message, "nested delays not supported");
    NotifyDelay afterwards(project); // the registry is idle again
}

// Checking for an open delay and parking are one step: a subject is never parked where no delay will deliver
// it. One destroyed while held back is forgotten; one moved to another project takes its notification along.
TEST_F(Notification, ASubjectIsHeldBackOnlyWhileADelayIsOpenAndWhileItLives) {
    subject->attach(&observer);
    EXPECT_FALSE(NotifyDelay::addSubject(subject.get(), project));
    { NotifyDelay unrelated(project); }
    EXPECT_EQ(observer.count, 0);
    auto doomed = std::make_unique<Subject>(project);
    doomed->attach(&observer);
    {
        NotifyDelay delay(project);
        EXPECT_TRUE(NotifyDelay::addSubject(subject.get(), project));
        EXPECT_TRUE(NotifyDelay::addSubject(subject.get(), project)); // held back once
        doomed->notify();
        doomed.reset();
    }
    EXPECT_EQ(observer.count, 1);
    EXPECT_EQ(observer.last, subject.get());
    const auto other = boost::make_shared<ThreadSafe>();
    NotifyDelay delay(project);
    subject->notify();
    {
        NotifyDelay otherDelay(other);
        subject->setProjectMutex(other);
        EXPECT_EQ(observer.count, 1);
    }
    EXPECT_EQ(observer.count, 2);
}

TEST_F(Notification, AnObserverThatThrowsSilencesNoneOfTheOthers) {
    Lambda throwing([](Observable*) { throw VelaMediaLibException("observer failed"); });
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

TEST_F(Notification, ScopedObserversDetachThemselves) {
    int heard = 0;
    {
        auto lambda = Lambda::createWithScopedAttachDetach(subject, [&](Observable*) { ++heard; });
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

// An observer that destroys a subject without a lifeline ends that subject's walk, told at once or held back:
// the observers after it are not told, nothing freed is touched (AddressSanitizer sees to that), and the
// other held-back subjects are still told.
TEST_F(Notification, AnObserverThatDestroysOrLetsGoOfItsSubject) {
    subject->attach(&observer);
    for (const bool delayed : {false, true}) {
        Subject* doomed = new Subject(project);
        Lambda destroyer([&](Observable*) {
            delete doomed;
            doomed = nullptr;
        });
        CountingObserver afterIt;
        delayed ? doomed->attach(&destroyer) : doomed->attachWithoutNotifyDelay(&destroyer);
        delayed ? doomed->attach(&afterIt) : doomed->attachWithoutNotifyDelay(&afterIt);
        {
            std::unique_ptr<NotifyDelay> delay(delayed ? new NotifyDelay(project) : nullptr);
            doomed->notify();
            subject->notify();
        }
        EXPECT_EQ(doomed, nullptr) << delayed;
        EXPECT_EQ(afterIt.count, 0) << delayed;
    }
    EXPECT_EQ(observer.count, 2);
    // A subject held by shared pointer is kept alive through its delivery: an observer letting go of the last
    // reference leaves the others hearing it whole.
    boost::shared_ptr<Attribute<std::string>> attribute(new Attribute<std::string>("name", "a", project));
    const boost::weak_ptr<Attribute<std::string>> watched = attribute;
    std::string seen;
    Lambda lettingGo([&](Observable*) { attribute.reset(); });
    Lambda reading(
        [&](Observable* changed) { seen = dynamic_cast<Attribute<std::string>&>(*changed).value(); });
    attribute->attach(&lettingGo);
    attribute->attach(&reading);
    {
        NotifyDelay delay(project);
        attribute->setValue("b");
    }
    EXPECT_EQ(seen, "b");
    EXPECT_TRUE(watched.expired());
}

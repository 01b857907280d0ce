#include "TimeTestSupport.h"

#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/time/parameters/Attribute.h>
#include <VelaMediaLib/time/sync/AddObserverList.h>
#include <VelaMediaLib/time/sync/NotifyDelay.h>
#include <VelaMediaLib/time/sync/SubjectWithMutex.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <atomic>
#include <chrono>
#include <functional>
#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <memory>
#include <stdexcept>
#include <thread>
#include <vector>

using namespace VelaMediaLib;
using VelaMediaLib::testing::BlockingObserver;
using VelaMediaLib::testing::Deadline;
using VelaMediaLib::testing::waitFor;

namespace {

struct AtomicCounter : Observer {
    std::atomic<int> count{0};
    void update(Observable*) override { ++count; }
};

} // namespace

// One thread notifies while another attaches and detaches observers of the
// same subject: the observer attached throughout hears every notification.
TEST(NotificationConcurrency, AttachAndDetachWhileAnotherThreadNotifies) {
    Deadline deadline(std::chrono::seconds(60));
    const auto project = boost::make_shared<ThreadSafe>();
    Subject subject(project);
    AtomicCounter steady;
    std::vector<AtomicCounter> coming(16);
    subject.attach(&steady);
    const int notifications = 20000;
    std::atomic<bool> done{false};
    std::thread churn([&] {
        for (size_t i = 0; !done.load(); ++i) {
            AtomicCounter& each = coming[i % coming.size()];
            if (i % 3 == 0)
                subject.attachWithoutNotifyDelay(&each);
            else
                subject.attach(&each);
            subject.detach(&coming[(i + 7) % coming.size()]);
        }
    });
    for (int i = 0; i < notifications; ++i) subject.notify();
    done = true;
    churn.join();
    EXPECT_EQ(steady.count.load(), notifications);
}

// A delay of the project ends on one thread while another thread's subject
// changes: whether it is held back or told at once, it is told exactly once.
TEST(NotificationConcurrency, ADelayEndingWhileASubjectChangesLosesNothing) {
    Deadline deadline(std::chrono::seconds(60));
    const auto project = boost::make_shared<ThreadSafe>();
    Subject subject(project);
    AtomicCounter observer;
    subject.attach(&observer);
    int lost = 0;
    for (int i = 0; i < 3000 && lost == 0; ++i) {
        std::atomic<bool> go{false};
        std::unique_ptr<NotifyDelay> delay(new NotifyDelay(project));
        std::thread changer([&] {
            while (!go.load()) {}
            subject.notify();
        });
        go = true;
        delay.reset();
        changer.join();
        if (observer.count.exchange(0) != 1) ++lost;
    }
    EXPECT_EQ(lost, 0);
}

// A held-back subject that another thread destroys while it is being
// delivered waits until its delivery has ended.
TEST(NotificationConcurrency, ASubjectDestroyedWhileAnotherThreadDeliversItWaitsForTheDelivery) {
    Deadline deadline(std::chrono::seconds(60));
    const auto project = boost::make_shared<ThreadSafe>();
    Subject* subject = new Subject(project);
    std::atomic<bool> delivering{false}, destroyed{false};
    bool destroyedDuringDelivery = false;
    struct Slow : Observer {
        std::function<void()> body;
        void update(Observable*) override { body(); }
    } slow;
    slow.body = [&] {
        delivering = true;
        const auto until = std::chrono::steady_clock::now() + std::chrono::milliseconds(200);
        while (!destroyed.load() && std::chrono::steady_clock::now() < until) std::this_thread::yield();
        destroyedDuringDelivery = destroyed.load();
    };
    subject->attach(&slow);
    std::thread destroyer([&] {
        while (!delivering.load()) std::this_thread::yield();
        delete subject;
        destroyed = true;
    });
    {
        NotifyDelay delay(project);
        subject->notify();
    }
    destroyer.join();
    EXPECT_FALSE(destroyedDuringDelivery);
}

// Another thread lets go of the last reference to an attribute while its
// held-back notification is delivered: the attribute lives, whole, until its
// observers have heard, and goes afterwards.
TEST(NotificationConcurrency, AnAttributeLetGoOfDuringItsDeliveryLivesUntilItsObserversHaveHeard) {
    Deadline deadline(std::chrono::seconds(60));
    const auto project = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<Attribute<std::string>> attribute(new Attribute<std::string>("name", "a", project));
    const boost::weak_ptr<Attribute<std::string>> watched = attribute;
    std::atomic<bool> delivering{false}, letGo{false};
    bool letGoDuringDelivery = false;
    std::string seen;
    BlockingObserver reader;
    reader.body = [&](Observable* changed) {
        delivering = true;
        letGoDuringDelivery = waitFor(letGo, std::chrono::seconds(5));
        if (letGoDuringDelivery) seen = dynamic_cast<Attribute<std::string>&>(*changed).value();
    };
    attribute->attach(&reader);
    std::thread host([&] {
        waitFor(delivering, std::chrono::seconds(30));
        attribute.reset();
        letGo = true;
    });
    {
        NotifyDelay delay(project);
        attribute->setValue("b");
    }
    host.join();
    EXPECT_TRUE(letGoDuringDelivery) << "letting go waited for the delivery";
    EXPECT_EQ(seen, "b");
    EXPECT_TRUE(watched.expired());
}

namespace {

// Detaches an observer while another thread is inside its update (told at
// once or in delayed delivery); says whether detach returned before the
// observer had finished.
template <typename Detach>
bool detachReturnsWhileTheObserverRuns(Subject& subject, const boost::shared_ptr<ThreadSafe>& project,
                                       bool delayed, Detach detach) {
    std::atomic<bool> entered{false}, detached{false};
    bool detachedWhileRunning = true;
    BlockingObserver slow;
    slow.body = [&](Observable*) {
        entered = true;
        detachedWhileRunning = waitFor(detached, std::chrono::milliseconds(200));
    };
    subject.attach(&slow);
    std::thread notifier([&] {
        if (!delayed) return subject.notify();
        NotifyDelay delay(project);
        subject.notify();
    });
    waitFor(entered, std::chrono::seconds(30));
    detach(&slow);
    detached = true;
    notifier.join();
    return detachedWhileRunning;
}

} // namespace

// A SubjectWithMutex holds its own mutex around its walks: once detach has
// returned on another thread, the observer has finished, whether it was told
// at once or at the end of a delay.
TEST(NotificationConcurrency, SubjectWithMutexDetachReturnsOnlyOnceTheObserverHasFinished) {
    Deadline deadline(std::chrono::seconds(60));
    const auto project = boost::make_shared<ThreadSafe>();
    for (const bool delayed : {false, true}) {
        SubjectWithMutex subject(delayed ? boost::weak_ptr<const ThreadSafe>(project)
                                         : boost::weak_ptr<const ThreadSafe>());
        EXPECT_FALSE(detachReturnsWhileTheObserverRuns(subject, project, delayed, [&](Observer* o) {
            subject.detach(o);
        })) << (delayed ? "delayed" : "at once");
    }
}

// Project subjects notify under the project's read lock, so detaching under
// its write lock waits for a notification running on another thread.
TEST(NotificationConcurrency, DetachUnderTheWriteLockWaitsForARunningNotification) {
    Deadline deadline(std::chrono::seconds(60));
    const auto project = boost::make_shared<ThreadSafe>();
    for (const bool delayed : {false, true}) {
        Subject subject(project);
        EXPECT_FALSE(detachReturnsWhileTheObserverRuns(subject, project, delayed, [&](Observer* o) {
            ScopedWriteLock lock(project);
            subject.detach(o);
        })) << (delayed ? "delayed" : "at once");
    }
}

// Every subject follows one policy: a plain subject, with a project or
// without, also returns from detach only once the observer has finished.
TEST(NotificationConcurrency, EverySubjectsDetachReturnsOnlyOnceTheObserverHasFinished) {
    Deadline deadline(std::chrono::seconds(60));
    const auto project = boost::make_shared<ThreadSafe>();
    for (const bool withProject : {false, true})
        for (const bool delayed : {false, true}) {
            if (delayed && !withProject) continue; // only a project holds notifications back
            Subject subject(withProject ? boost::weak_ptr<const ThreadSafe>(project)
                                        : boost::weak_ptr<const ThreadSafe>());
            EXPECT_FALSE(detachReturnsWhileTheObserverRuns(subject, project, delayed,
                                                           [&](Observer* o) { subject.detach(o); }))
                << withProject << delayed;
        }
}

// A thread holding the project's lock does not wait in detach: the observer
// it would wait for may itself be waiting for that lock (here it asks for the
// write lock, which waits for the detaching thread's read share).
TEST(NotificationConcurrency, DetachUnderTheProjectLockDoesNotWaitForAnObserverWaitingForIt) {
    Deadline deadline(std::chrono::seconds(60));
    const auto project = boost::make_shared<ThreadSafe>();
    SubjectWithMutex subject(project);
    std::atomic<bool> entered{false}, reading{false};
    BlockingObserver writer;
    writer.body = [&](Observable*) {
        entered = true;
        waitFor(reading, std::chrono::seconds(30));
        ScopedWriteLock lock(project); // waits for the detaching thread's read share
    };
    subject.attach(&writer);
    std::thread notifier([&] { subject.notify(); });
    waitFor(entered, std::chrono::seconds(30));
    {
        ScopedReadLock lock(project);
        reading = true;
        subject.detach(&writer);
    }
    notifier.join();
    std::atomic<int> told{0};
    BlockingObserver later;
    later.body = [&](Observable*) { ++told; };
    subject.attach(&later);
    subject.notify();
    EXPECT_EQ(told.load(), 1);
    subject.detach(&later);
}

// Observers are never called under a lock of the lists, so one may wait for
// another thread that attaches to (or detaches from) the same subject.
TEST(NotificationConcurrency, AnObserverMayWaitForAThreadAttachingToItsSubject) {
    Deadline deadline(std::chrono::seconds(60));
    const auto project = boost::make_shared<ThreadSafe>();
    SubjectWithMutex subject(project);
    AtomicCounter other;
    BlockingObserver waiting;
    waiting.body = [&](Observable*) {
        std::thread attacher([&] {
            subject.attach(&other);
            subject.detach(&other);
            subject.attachWithoutNotifyDelay(&other);
        });
        attacher.join();
    };
    subject.attach(&waiting);
    subject.notify();
    subject.detach(&waiting);
    subject.notify();
    EXPECT_EQ(other.count.load(), 1);
    subject.detach(&other);
}

namespace {

struct AddProbe {
    std::function<void()> body;
    void heard() { body(); }
};

} // namespace

// Add-observer lists share the subjects' policy: detach on another thread
// waits for a running call, and an observer that throws leaves the others
// hearing.
TEST(NotificationConcurrency, AddObserverListsFollowTheSamePolicy) {
    Deadline deadline(std::chrono::seconds(60));
    AddObserverList<AddProbe> list;
    std::atomic<bool> entered{false}, detached{false};
    bool detachedWhileRunning = true;
    AddProbe slow, thrower, counter;
    int counted = 0;
    slow.body = [&] {
        entered = true;
        detachedWhileRunning = waitFor(detached, std::chrono::milliseconds(200));
    };
    thrower.body = [] { throw std::runtime_error("observer failure"); };
    counter.body = [&] { ++counted; };
    list.attach(&slow);
    list.attach(&thrower);
    list.attach(&counter);
    list.attach(&counter); // attached once
    std::thread teller([&] { list.tell([](AddProbe& probe) { probe.heard(); }); });
    waitFor(entered, std::chrono::seconds(30));
    list.detach(&slow);
    detached = true;
    teller.join();
    EXPECT_FALSE(detachedWhileRunning);
    EXPECT_EQ(counted, 1);
}

namespace {

// Detaches another subject's observer from inside its own call, once that
// observer is running too.
struct CrossDetacher : Observer {
    std::atomic<bool> running{false};
    CrossDetacher* other = nullptr;
    Subject* otherSubject = nullptr;
    void update(Observable*) override {
        running = true;
        waitFor(other->running, std::chrono::seconds(5));
        otherSubject->detach(other);
    }
};

} // namespace

// Two observers running on two threads detach each other: neither waits for
// the other, since each is inside an observer's call.
TEST(NotificationConcurrency, ObserversDetachingEachOtherDoNotWaitForEachOther) {
    Deadline deadline(std::chrono::seconds(60));
    Subject first, second; // no project: nothing else keeps them apart
    CrossDetacher a, b;
    a.other = &b;
    a.otherSubject = &second;
    b.other = &a;
    b.otherSubject = &first;
    first.attach(&a);
    second.attach(&b);
    std::thread other([&] { second.notify(); });
    first.notify();
    other.join();
    EXPECT_TRUE(a.running && b.running);
}

// The edit rate tells its observers under the project's read lock like every
// subject of the project, so a thread holding the write lock may detach one
// while another thread sets the rate.
TEST(NotificationConcurrency, EditRateObserversDetachUnderTheWriteLock) {
    Deadline deadline(std::chrono::seconds(60));
    const ProjectPtr project = Project::create(30, 1);
    struct Reader : Observer {
        ProjectPtr project;
        std::atomic<bool> entered{false};
        void update(Observable*) override {
            entered = true;
            ScopedReadLock lock(project->token()); // looks at the model
        }
    } reader;
    reader.project = project;
    project->attachEditRateObserver(&reader);
    std::thread setter;
    {
        ScopedWriteLock lock(project->token());
        setter = std::thread([&] { project->setEditRate(boost::rational<unsigned long>(25)); });
        waitFor(reader.entered, std::chrono::milliseconds(100)); // gives the setter its chance
        project->detachEditRateObserver(&reader);
    }
    setter.join();
    EXPECT_FALSE(reader.entered) << "told outside the project's lock";
    EXPECT_EQ(project->editRate(), boost::rational<unsigned long>(25));
}

// An observer that destroys its subject ends the walk: the observers after it
// are not told, and nothing freed is touched (AddressSanitizer sees to that).
TEST(NotificationConcurrency, AnObserverDestroyingItsSubjectEndsTheNotification) {
    struct Destroyer : Observer {
        Subject* subject = nullptr;
        void update(Observable*) override {
            delete subject;
            subject = nullptr;
        }
    } destroyer;
    AtomicCounter after;
    destroyer.subject = new Subject();
    destroyer.subject->attachWithoutNotifyDelay(&destroyer);
    destroyer.subject->attachWithoutNotifyDelay(&after);
    destroyer.subject->notify();
    EXPECT_EQ(destroyer.subject, nullptr);
    EXPECT_EQ(after.count.load(), 0);
}

// Inside an observer's call, detaching an observer of another subject still
// waits for that observer's call on another thread: only a cycle of waits
// lets a detach return early.
TEST(NotificationConcurrency, DetachInsideAnObserverStillWaitsOutsideACycle) {
    Deadline deadline(std::chrono::seconds(60));
    Subject first, second;
    std::atomic<bool> slowRunning{false}, release{false}, slowFinished{false};
    BlockingObserver slow;
    slow.body = [&](Observable*) {
        slowRunning = true;
        waitFor(release, std::chrono::seconds(30));
        slowFinished = true;
    };
    second.attach(&slow);
    std::thread teller([&] { second.notify(); });
    ASSERT_TRUE(waitFor(slowRunning, std::chrono::seconds(30)));
    std::thread releaser([&] {
        std::this_thread::sleep_for(std::chrono::milliseconds(50));
        release = true;
    });
    bool finishedWhenDetached = false;
    BlockingObserver detacher;
    detacher.body = [&](Observable*) {
        second.detach(&slow);
        finishedWhenDetached = slowFinished;
    };
    first.attach(&detacher);
    first.notify();
    teller.join();
    releaser.join();
    EXPECT_TRUE(finishedWhenDetached);
}

// A detach that waited for a call counts that wait no longer once the call
// has ended: the thread that ended it, detaching in turn an observer the
// first thread is still running, waits for it like any other.
TEST(NotificationConcurrency, AFinishedWaitClosesNoCycle) {
    Deadline deadline(std::chrono::seconds(60));
    Subject first, second;
    std::atomic<bool> xRunning{false}, yFinished{false};
    BlockingObserver x, y;
    x.body = [&](Observable*) {
        xRunning = true;
        std::this_thread::sleep_for(std::chrono::milliseconds(50)); // the other thread starts waiting
    };
    y.body = [&](Observable*) {
        waitFor(xRunning, std::chrono::seconds(30));
        second.detach(&x); // waits for x's call on the other thread
        std::this_thread::sleep_for(std::chrono::milliseconds(50));
        yFinished = true;
    };
    first.attach(&y);
    second.attach(&x);
    bool finishedWhenDetached = false;
    std::thread other([&] {
        second.notify();
        first.detach(&y);
        finishedWhenDetached = yFinished;
    });
    first.notify();
    other.join();
    EXPECT_TRUE(finishedWhenDetached);
}

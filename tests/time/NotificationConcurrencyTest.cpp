#include "TimeTestSupport.h"

#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/time/sync/AddObserverList.h>
#include <VelaMediaLib/time/sync/NotifyDelay.h>
#include <VelaMediaLib/time/sync/SubjectWithMutex.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <memory>
#include <stdexcept>
#include <vector>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;
using std::chrono::seconds;

namespace {

struct AtomicCounter : Observer {
    std::atomic<int> count{0};
    void update(Observable*) override { ++count; }
};

} // namespace

// One thread notifies while another attaches and detaches observers of the same subject: the observer
// attached throughout hears every notification.
TEST(NotificationConcurrency, AttachAndDetachWhileAnotherThreadNotifies) {
    Deadline deadline;
    Subject subject(boost::make_shared<ThreadSafe>());
    AtomicCounter steady;
    std::vector<AtomicCounter> coming(16);
    subject.attach(&steady);
    std::atomic<bool> done{false};
    std::thread churn([&] {
        for (size_t i = 0; !done.load(); ++i) {
            AtomicCounter& each = coming[i % coming.size()];
            i % 3 == 0 ? subject.attachWithoutNotifyDelay(&each) : subject.attach(&each);
            subject.detach(&coming[(i + 7) % coming.size()]);
        }
    });
    for (int i = 0; i < 20000; ++i) subject.notify();
    done = true;
    churn.join();
    EXPECT_EQ(steady.count.load(), 20000);
}

// A delay of the project ends on one thread while another thread's subject changes: whether it is held back
// or told at once, it is told exactly once.
TEST(NotificationConcurrency, ADelayEndingWhileASubjectChangesLosesNothing) {
    Deadline deadline;
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

// Once detach (or the destructor of a subject without a lifeline) has returned on another thread, the
// observer's call has ended: told at once or at the end of a delay, with a project or without. Project
// subjects notify under the project's read lock, so a detach under its write lock waits too.
TEST(NotificationConcurrency, DetachReturnsOnlyOnceTheObserverHasFinished) {
    Deadline deadline;
    const auto project = boost::make_shared<ThreadSafe>();
    struct Case {
        bool withProject, delayed, underWriteLock, destroy;
    };
    const Case cases[] = {{false, false, false, false}, {true, false, false, false},
                          {true, true, false, false},   {true, false, true, false},
                          {true, true, true, false},    {true, true, false, true}};
    for (const Case& c : cases) {
        std::unique_ptr<Subject> subject(
            new Subject(c.withProject ? project : boost::shared_ptr<const ThreadSafe>()));
        BlockingObserver slow;
        subject->attach(&slow);
        const auto notify = [&] {
            std::unique_ptr<NotifyDelay> delay(c.delayed ? new NotifyDelay(project) : nullptr);
            subject->notify();
        };
        EXPECT_FALSE(detachReturnsWhileTheObserverRuns(
            slow, notify,
            [&] {
                std::unique_ptr<ScopedWriteLock> lock(c.underWriteLock ? new ScopedWriteLock(project)
                                                                       : nullptr);
                c.destroy ? subject.reset() : subject->detach(&slow);
            }))
            << c.withProject << c.delayed << c.underWriteLock << c.destroy;
    }
    // Inside another observer's call, detach still waits: only a cycle of waits lets it return early.
    Subject first, second;
    BlockingObserver slow, detacher;
    detacher.body = [&](Observable*) { second.detach(&slow); };
    second.attach(&slow);
    first.attach(&detacher);
    EXPECT_FALSE(detachReturnsWhileTheObserverRuns(
        slow, [&] { second.notify(); }, [&] { first.notify(); }));
}

// A thread holding the project's lock does not wait in detach: the observer it would wait for may itself be
// waiting for that lock (here it asks for the write lock, which waits for the detaching thread's read share).
TEST(NotificationConcurrency, DetachUnderTheProjectLockDoesNotWaitForAnObserverWaitingForIt) {
    Deadline deadline;
    const auto project = boost::make_shared<ThreadSafe>();
    SubjectWithMutex subject(project);
    std::atomic<bool> entered{false}, reading{false};
    BlockingObserver writer;
    writer.body = [&](Observable*) {
        entered = true;
        waitFor(reading, seconds(30));
        ScopedWriteLock lock(project);
    };
    subject.attach(&writer);
    std::thread notifier([&] { subject.notify(); });
    waitFor(entered, seconds(30));
    {
        ScopedReadLock lock(project);
        reading = true;
        subject.detach(&writer);
    }
    notifier.join();
    AtomicCounter later; // the early return left the lists as they should be
    subject.attach(&later);
    subject.notify();
    EXPECT_EQ(later.count.load(), 1);
    subject.detach(&later);
}

// Observers are never called under a lock of the lists, so one may wait for another thread that attaches to
// (or detaches from) the same subject.
TEST(NotificationConcurrency, AnObserverMayWaitForAThreadAttachingToItsSubject) {
    Deadline deadline;
    SubjectWithMutex subject(boost::make_shared<ThreadSafe>());
    AtomicCounter other;
    BlockingObserver waiting;
    waiting.body = [&](Observable*) {
        std::thread([&] {
            subject.attach(&other);
            subject.detach(&other);
            subject.attachWithoutNotifyDelay(&other);
        }).join();
    };
    subject.attach(&waiting);
    subject.notify();
    subject.detach(&waiting);
    subject.notify();
    EXPECT_EQ(other.count.load(), 1);
    subject.detach(&other);
}

// Add-observer lists share the subjects' policy: detach on another thread waits for a running call, and an
// observer that throws leaves the others hearing.
TEST(NotificationConcurrency, AddObserverListsFollowTheSamePolicy) {
    Deadline deadline;
    AddObserverList<BlockingObserver> list;
    BlockingObserver slow, thrower, counter;
    int counted = 0;
    thrower.body = [](Observable*) { throw std::runtime_error("observer failure"); };
    counter.body = [&](Observable*) { ++counted; };
    for (BlockingObserver* each : {&slow, &thrower, &counter, &counter}) list.attach(each); // counter once
    EXPECT_FALSE(detachReturnsWhileTheObserverRuns(
        slow, [&] { list.tell([](BlockingObserver& each) { each.update(nullptr); }); },
        [&] { list.detach(&slow); }));
    EXPECT_EQ(counted, 1);
}

// Two observers running on two threads detach each other: neither waits for the other, since each is inside
// an observer's call.
TEST(NotificationConcurrency, ObserversDetachingEachOtherDoNotWaitForEachOther) {
    Deadline deadline;
    Subject first, second; // no project: nothing else keeps them apart
    std::atomic<bool> aRunning{false}, bRunning{false};
    BlockingObserver a, b;
    a.body = [&](Observable*) {
        aRunning = true;
        waitFor(bRunning, seconds(30));
        second.detach(&b);
    };
    b.body = [&](Observable*) {
        bRunning = true;
        waitFor(aRunning, seconds(30));
        first.detach(&a);
    };
    first.attach(&a);
    second.attach(&b);
    std::thread other([&] { second.notify(); });
    first.notify();
    other.join();
    EXPECT_TRUE(aRunning && bRunning);
}

// The edit rate tells its observers under the project's read lock like every subject of the project, so a
// thread holding the write lock may detach one while another thread sets the rate.
TEST(NotificationConcurrency, EditRateObserversDetachUnderTheWriteLock) {
    Deadline deadline;
    const ProjectPtr project = Project::create(30, 1);
    std::atomic<bool> entered{false};
    BlockingObserver reader;
    reader.body = [&](Observable*) {
        entered = true;
        ScopedReadLock lock(project->token()); // looks at the model
    };
    project->attachEditRateObserver(&reader);
    std::thread setter;
    {
        ScopedWriteLock lock(project->token());
        setter = std::thread([&] { project->setEditRate(Rate(25)); });
        waitFor(entered, std::chrono::milliseconds(100)); // gives the setter its chance
        project->detachEditRateObserver(&reader);
    }
    setter.join();
    EXPECT_FALSE(entered) << "told outside the project's lock";
    EXPECT_EQ(project->editRate(), Rate(25));
}

// A detach that waited for a call counts that wait no longer once the call has ended: the thread that ended
// it, detaching in turn an observer the first thread is still running, waits for it like any other.
TEST(NotificationConcurrency, AFinishedWaitClosesNoCycle) {
    Deadline deadline;
    Subject first, second;
    std::atomic<bool> xRunning{false}, yFinished{false};
    BlockingObserver x, y;
    x.body = [&](Observable*) {
        xRunning = true;
        std::this_thread::sleep_for(std::chrono::milliseconds(50)); // the other thread starts waiting
    };
    y.body = [&](Observable*) {
        waitFor(xRunning, seconds(30));
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

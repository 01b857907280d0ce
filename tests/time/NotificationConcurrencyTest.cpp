#include "TimeTestSupport.h"

#include <VelaMediaLib/time/NotifyDelay.h>
#include <VelaMediaLib/time/ThreadSafe.h>

#include <atomic>
#include <functional>
#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <memory>
#include <thread>
#include <vector>

using namespace VelaMediaLib;
using VelaMediaLib::testing::Deadline;

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

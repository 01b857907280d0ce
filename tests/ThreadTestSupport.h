#pragma once
// What the tests share, threaded ones above all: a deadline for tests whose failure mode is a hang (a
// broken lock), past which the test program says so and ends instead of spinning until the runner's own
// timeout; a bounded wait for a flag; observers that count their calls or run a given body; and a driver
// of a detach racing that observer's call.

#include <VelaMediaLib/time/sync/Observer.h>

#include <atomic>
#include <functional>
#include <chrono>
#include <condition_variable>
#include <cstdio>
#include <cstdlib>
#include <mutex>
#include <thread>

namespace VelaMediaLib {
namespace testing {

class Deadline {
public:
    explicit Deadline(std::chrono::seconds limit = std::chrono::seconds(60))
        : watcher_([this, limit] {
              std::unique_lock<std::mutex> lock(mutex_);
              if (!finished_.wait_for(lock, limit, [this] { return done_; })) {
                  std::fprintf(stderr, "the test passed its deadline of %lld s\n", (long long)limit.count());
                  std::abort();
              }
          }) {}
    ~Deadline() {
        {
            std::lock_guard<std::mutex> lock(mutex_);
            done_ = true;
        }
        finished_.notify_all();
        watcher_.join();
    }
    Deadline(const Deadline&) = delete;
    Deadline& operator=(const Deadline&) = delete;

private:
    std::mutex mutex_;
    std::condition_variable finished_;
    bool done_ = false;
    std::thread watcher_;
};

/// Waits until the flag is set or the time is up; says whether it was set.
inline bool waitFor(const std::atomic<bool>& flag, std::chrono::milliseconds limit) {
    const auto until = std::chrono::steady_clock::now() + limit;
    while (!flag.load() && std::chrono::steady_clock::now() < until) std::this_thread::yield();
    return flag.load();
}

/// Counts its calls and keeps the subject of the last.
struct CountingObserver : Observer {
    int count = 0;
    Observable* last = nullptr;
    void update(Observable* changed) override {
        ++count;
        last = changed;
    }
};

struct BlockingObserver : Observer {
    std::function<void(Observable*)> body;
    void update(Observable* changed) override { body(changed); }
};

/// Runs `notify` on another thread and, once the attached `slow` is inside its call, `detach` on this one;
/// says whether detach returned before that call had ended.
template <typename Notify, typename Detach>
bool detachReturnsWhileTheObserverRuns(BlockingObserver& slow, Notify notify, Detach detach) {
    std::atomic<bool> entered{false}, detached{false};
    bool detachedWhileRunning = true;
    slow.body = [&](Observable*) {
        entered = true;
        detachedWhileRunning = waitFor(detached, std::chrono::milliseconds(200));
    };
    std::thread notifier(notify);
    waitFor(entered, std::chrono::seconds(30));
    detach();
    detached = true;
    notifier.join();
    return detachedWhileRunning;
}

} // namespace testing
} // namespace VelaMediaLib

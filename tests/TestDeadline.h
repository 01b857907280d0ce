#pragma once
// A deadline for tests whose failure mode is a hang (a broken lock): past it
// the test program says so and ends, instead of spinning until the runner's
// own timeout.

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

} // namespace testing
} // namespace VelaMediaLib

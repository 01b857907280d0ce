#pragma once
// A deadline for tests whose failure mode is a hang (a broken lock): past it
// the test program reports which test overran and exits, instead of spinning
// until the runner's own timeout.

#include <chrono>
#include <condition_variable>
#include <cstdio>
#include <cstdlib>
#include <mutex>
#include <string>
#include <thread>

namespace VelaMediaLib {
namespace testing {

class TestDeadline {
public:
    explicit TestDeadline(std::string what, std::chrono::seconds limit = std::chrono::seconds(60))
        : what_(std::move(what)), watcher_([this, limit] { watch(limit); }) {}
    ~TestDeadline() {
        {
            std::lock_guard<std::mutex> lock(mutex_);
            finished_ = true;
        }
        done_.notify_one();
        watcher_.join();
    }
    TestDeadline(const TestDeadline&) = delete;
    TestDeadline& operator=(const TestDeadline&) = delete;

private:
    void watch(std::chrono::seconds limit) {
        std::unique_lock<std::mutex> lock(mutex_);
        if (done_.wait_for(lock, limit, [this] { return finished_; })) return;
        std::fprintf(stderr, "%s: did not finish within %lld s (a lock that never frees?)\n", what_.c_str(),
                     (long long)limit.count());
        std::_Exit(3);
    }

    std::string what_;
    std::mutex mutex_;
    std::condition_variable done_;
    bool finished_ = false;
    std::thread watcher_;
};

} // namespace testing
} // namespace VelaMediaLib

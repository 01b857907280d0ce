#pragma once
// Helpers for the time and document tests: a small parametric kind and a
// deadline for tests that run threads.

#include <VelaMediaLib/model/Attributable.h>
#include <VelaMediaLib/model/Parametric.h>
#include <VelaMediaLib/time/InterpolatingParam.h>

#include <chrono>
#include <condition_variable>
#include <cstdio>
#include <cstdlib>
#include <mutex>
#include <thread>

namespace VelaMediaLib {
namespace testing {

/// A kind with two declared parameters ("level" 1.0 and "pan" 0.0), made on
/// first use, and attributes.
class Knob : public Parametric, public Attributable {
public:
    explicit Knob(const boost::weak_ptr<const ThreadSafe>& token) : Parametric(token), Attributable(token) {}

protected:
    boost::shared_ptr<ParameterInterface> createDefaultParameter(const std::string& name) const override {
        if (name == "level") return InterpolatingParam<double>::create(parametersToken(), name, 1.0);
        if (name == "pan") return InterpolatingParam<double>::create(parametersToken(), name, 0.0);
        return Parametric::createDefaultParameter(name);
    }
    std::vector<std::string> defaultParameterNames() const override { return {"level", "pan"}; }
};

/// Ends the test program when a test that runs threads has not finished in
/// time, so that a deadlock fails the run instead of hanging it.
class Deadline {
public:
    explicit Deadline(std::chrono::seconds limit)
        : watcher_([this, limit] {
              std::unique_lock<std::mutex> lock(mutex_);
              if (!finished_.wait_for(lock, limit, [this] { return done_; })) {
                  std::fprintf(stderr, "the test passed its deadline\n");
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

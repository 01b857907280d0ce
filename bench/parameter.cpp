// A parameter's valueAtTime against a plain std::map curve, and what
// parameters and keyframes cost in memory.
#include "AllocationCounter.h"
#include "Interleaved.h"

#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <benchmark/benchmark.h>
#include <boost/make_shared.hpp>
#include <map>
#include <random>

using namespace VelaMediaLib;

namespace {

const int kKeyFrames = 1000;
const int kQueries = 4096;

std::vector<double> queryTimes() {
    std::mt19937 random(3);
    std::uniform_real_distribution<double> spread(0.0, double(kKeyFrames - 1) * 10.0);
    std::vector<double> times;
    for (int i = 0; i < kQueries; ++i) times.push_back(spread(random));
    return times;
}

// A linear curve of kKeyFrames keyframes, as a parameter and as a bare map,
// asked at the same random times.
struct Curve {
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<InterpolatingParam<double>> parameter =
        InterpolatingParam<double>::create(project, "x", 0.0);
    std::map<double, double> bare;
    std::vector<double> seconds = queryTimes();
    std::vector<RationalTime> times;

    Curve() {
        bare[0.0] = 0.0;
        for (int i = 1; i < kKeyFrames; ++i) {
            parameter->addKeyFrame(RationalTime(i * 10), double(i % 7), RationalTime(0));
            bare[i * 10.0] = double(i % 7);
        }
        for (double& t : seconds) {
            times.push_back(RationalTime((long long)(t * 1000), 1000));
            t = times.back().asDouble(); // both sides ask the very same times
        }
    }
    static Curve& once() {
        static Curve curve;
        return curve;
    }

    void baseline(size_t first, size_t count) const {
        for (size_t i = first; i < first + count; ++i) {
            const double t = seconds[i % kQueries];
            const auto next = bare.upper_bound(t);
            const auto previous = std::prev(next);
            const double w = (t - previous->first) / (next->first - previous->first);
            benchmark::DoNotOptimize(w * next->second + (1.0 - w) * previous->second);
        }
    }
    void library(size_t first, size_t count) const {
        for (size_t i = first; i < first + count; ++i)
            benchmark::DoNotOptimize(parameter->valueAtTime(times[i % kQueries]));
    }
};

void BM_ValueAtTime_VsStdMap(benchmark::State& state) {
    const Curve& curve = Curve::once();
    Interleaved::compare(
        state, 256, [&](size_t first, size_t count) { curve.baseline(first, count); },
        [&](size_t first, size_t count) { curve.library(first, count); });
}

void BM_ValueAtTime_TwoReaders(benchmark::State& state) {
    const Curve& curve = Curve::once();
    Interleaved::scaling(
        state, 200000, [&](size_t first, size_t count) { curve.baseline(first, count); },
        [&](size_t first, size_t count) { curve.library(first, count); });
}

void BM_Memory_DoubleParameter(benchmark::State& state) {
    const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    const int further = 1000;
    long long perParameter = 0, perKeyFrame = 0;
    for (auto _ : state) {
        const long long before = AllocationCounter::bytes();
        auto parameter = InterpolatingParam<double>::create(project, "opacity", 1.0);
        const long long withOne = AllocationCounter::bytes();
        for (int i = 1; i <= further; ++i) parameter->addKeyFrame(RationalTime(i), 1.0, RationalTime(0));
        perParameter = withOne - before;
        perKeyFrame = (AllocationCounter::bytes() - withOne) / further;
    }
    state.counters["bytes_per_parameter_with_one_keyframe"] = double(perParameter);
    state.counters["bytes_per_further_keyframe"] = double(perKeyFrame);
}

} // namespace

BENCHMARK(BM_ValueAtTime_VsStdMap);
BENCHMARK(BM_ValueAtTime_TwoReaders)->Unit(benchmark::kMillisecond)->Iterations(10);
BENCHMARK(BM_Memory_DoubleParameter)->Iterations(3);

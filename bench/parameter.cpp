// A parameter's valueAtTime against a plain std::map curve, and what
// parameters and keyframes cost in memory.
#include "AllocationCounter.h"

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

void BM_ValueAtTime_StdMapBaseline(benchmark::State& state) {
    std::map<double, double> curve;
    for (int i = 0; i < kKeyFrames; ++i) curve[i * 10.0] = double(i % 7);
    const std::vector<double> times = queryTimes();
    size_t i = 0;
    for (auto _ : state) {
        const double t = times[i++ % kQueries];
        const auto next = curve.upper_bound(t);
        const auto previous = std::prev(next);
        const double w = (t - previous->first) / (next->first - previous->first);
        benchmark::DoNotOptimize(w * next->second + (1.0 - w) * previous->second);
    }
}

void BM_ValueAtTime_Parameter(benchmark::State& state) {
    const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    auto parameter = InterpolatingParam<double>::create(project, "x", 0.0);
    for (int i = 1; i < kKeyFrames; ++i)
        parameter->addKeyFrame(RationalTime(i * 10), double(i % 7), RationalTime(0));
    std::vector<RationalTime> times;
    for (double t : queryTimes()) times.push_back(RationalTime((long long)(t * 1000), 1000));
    size_t i = 0;
    for (auto _ : state) benchmark::DoNotOptimize(parameter->valueAtTime(times[i++ % kQueries]));
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

BENCHMARK(BM_ValueAtTime_StdMapBaseline);
BENCHMARK(BM_ValueAtTime_Parameter);
BENCHMARK(BM_Memory_DoubleParameter)->Iterations(3);

// What clips cost to make and hold, and how long their timing edits take.
#include "AllocationCounter.h"

#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>

#include <benchmark/benchmark.h>
#include <boost/make_shared.hpp>
#include <vector>

using namespace VelaMediaLib;

namespace {

const int kClips = 100000;

struct Project {
    boost::shared_ptr<ThreadSafe> token = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
};

// Makes the clips; with `allParameters` also asks each for its eight parameters.
void makeClips(benchmark::State& state, bool allParameters) {
    Project project;
    double bytesPerClip = 0;
    for (auto _ : state) {
        std::vector<boost::shared_ptr<PlaceholderMedia>> clips;
        clips.reserve(kClips);
        const long long before = AllocationCounter::bytes();
        for (int i = 0; i < kClips; ++i) {
            clips.push_back(PlaceholderMedia::create(project.token, project.rate, i * 100LL, 100));
            if (allParameters)
                for (const char* name : VisualMediaImpl::kParameterNames) clips.back()->parameter(name);
        }
        bytesPerClip =
            double(AllocationCounter::bytes() - before - (long long)(kClips * sizeof(void*) * 2)) / kClips;
        state.PauseTiming();
        clips.clear();
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * kClips);
    state.counters["bytes_per_clip"] = bytesPerClip;
}

void BM_CreatePlaceholders_ParametersMadeOnUse(benchmark::State& state) { makeClips(state, false); }
void BM_CreatePlaceholders_AllParametersMade(benchmark::State& state) { makeClips(state, true); }

// An edit by 10 ticks and back, on one clip of a thousand ticks.
template <typename Edit>
void editAndBack(benchmark::State& state, Edit edit) {
    Project project;
    const auto clip = PlaceholderMedia::create(project.token, project.rate, 0, 1000);
    for (auto _ : state) {
        edit(*clip, 10);
        edit(*clip, -10);
    }
    state.SetItemsProcessed(state.iterations() * 2);
}

void BM_TrimStartAndBack(benchmark::State& state) {
    editAndBack(state, [](Media& clip, VelaTime offset) { clip.trimStart(offset); });
}

void BM_TrimEndAndBack(benchmark::State& state) {
    editAndBack(state, [](Media& clip, VelaTime offset) { clip.trimEnd(offset); });
}

void BM_PreviewTrimStart(benchmark::State& state) {
    Project project;
    const auto clip = PlaceholderMedia::create(project.token, project.rate, 0, 1000);
    for (auto _ : state) benchmark::DoNotOptimize(clip->trackRangeWithTrimStart(10));
}

void BM_ValidTrimStart(benchmark::State& state) {
    Project project;
    const auto clip = PlaceholderMedia::create(project.token, project.rate, 0, 1000);
    for (auto _ : state) benchmark::DoNotOptimize(clip->validTrimStart(10));
}

} // namespace

BENCHMARK(BM_CreatePlaceholders_ParametersMadeOnUse)->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK(BM_CreatePlaceholders_AllParametersMade)->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK(BM_TrimStartAndBack);
BENCHMARK(BM_TrimEndAndBack);
BENCHMARK(BM_PreviewTrimStart);
BENCHMARK(BM_ValidTrimStart);

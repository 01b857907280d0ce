// Track queries and placement against plain maps, and the timeline-wide query.
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>

#include <benchmark/benchmark.h>
#include <boost/make_shared.hpp>
#include <map>
#include <random>

using namespace VelaMediaLib;

namespace {

const int kClips = 10000;
const VelaTime kClipLength = 90, kStep = 100; // clips with 10-tick gaps between them

struct Project {
    boost::shared_ptr<ThreadSafe> token = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
};

std::vector<VelaTime> randomTicks(VelaTime end) {
    std::mt19937_64 random(11);
    std::uniform_int_distribution<VelaTime> spread(0, end);
    std::vector<VelaTime> ticks(4096);
    for (VelaTime& tick : ticks) tick = spread(random);
    return ticks;
}

void BM_MediaAtTime_StdMapBaseline(benchmark::State& state) {
    std::map<long long, boost::shared_ptr<int>> starts;
    for (int i = 0; i < kClips; ++i) starts[i * kStep] = boost::make_shared<int>(i);
    const std::vector<VelaTime> ticks = randomTicks(kClips * kStep);
    size_t i = 0;
    for (auto _ : state) {
        const auto at = starts.upper_bound(ticks[i++ % ticks.size()]);
        const boost::shared_ptr<int> found =
            at == starts.begin() ? boost::shared_ptr<int>() : std::prev(at)->second;
        benchmark::DoNotOptimize(found); // the clip is handed out as a shared pointer, as the track does
    }
}

void BM_MediaAtTime_Track(benchmark::State& state) {
    Project project;
    const auto track = GenericTrack::create(project.token);
    for (int i = 0; i < kClips; ++i)
        track->addMedia(PlaceholderMedia::create(project.token, project.rate, 0, kClipLength), i * kStep);
    const std::vector<VelaTime> ticks = randomTicks(kClips * kStep);
    size_t i = 0;
    for (auto _ : state) benchmark::DoNotOptimize(track->mediaAtTime(ticks[i++ % ticks.size()]));
}

void BM_PlaceClipsEndToEnd(benchmark::State& state) {
    Project project;
    const int clips = 100000;
    for (auto _ : state) {
        state.PauseTiming();
        std::vector<MediaPtr> made;
        for (int i = 0; i < clips; ++i)
            made.push_back(PlaceholderMedia::create(project.token, project.rate, 0, 30));
        const auto track = GenericTrack::create(project.token);
        state.ResumeTiming();
        for (int i = 0; i < clips; ++i) track->addMedia(made[size_t(i)], i * 30LL);
        state.PauseTiming();
        made.clear();
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * clips);
}

void BM_AllMediasAtTime_20TracksOf5000(benchmark::State& state) {
    Project project;
    const auto timeline = Timeline::create(project.token);
    const auto mixer = timeline->newMixer("main");
    for (int t = 0; t < 20; ++t) {
        const auto track = timeline->newTrack();
        timeline->addTrack(mixer, track);
        for (int i = 0; i < 5000; ++i)
            track->addMedia(PlaceholderMedia::create(project.token, project.rate, 0, kClipLength),
                            i * kStep + t);
    }
    const std::vector<VelaTime> ticks = randomTicks(5000 * kStep);
    size_t i = 0;
    for (auto _ : state) benchmark::DoNotOptimize(timeline->allMediasAtTime(ticks[i++ % ticks.size()]));
}

} // namespace

BENCHMARK(BM_MediaAtTime_StdMapBaseline);
BENCHMARK(BM_MediaAtTime_Track);
BENCHMARK(BM_PlaceClipsEndToEnd)->Unit(benchmark::kMillisecond)->Iterations(2);
BENCHMARK(BM_AllMediasAtTime_20TracksOf5000)->Unit(benchmark::kMicrosecond);

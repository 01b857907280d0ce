// Track queries and placement against plain maps, and the timeline-wide query.
#include "Interleaved.h"

#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>

#include <benchmark/benchmark.h>
#include <boost/make_shared.hpp>
#include <algorithm>
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

// A track of kClips clips and two bare stand-ins holding the very same clip
// pointers, built once all clips exist: sorted flat arrays of starts, ends and
// clips (the track's own index shape, answering the same question the same
// way without a lock), and a map by start (no end check: the floor any
// container could reach).
struct Filled {
    Project project;
    boost::shared_ptr<GenericTrack> track = GenericTrack::create(project.token);
    std::vector<VelaTime> starts, ends;
    std::vector<MediaPtr> clips;
    std::map<long long, MediaPtr> byStart;
    std::vector<VelaTime> ticks = randomTicks(kClips * kStep);

    Filled() {
        for (int i = 0; i < kClips; ++i) {
            clips.push_back(PlaceholderMedia::create(project.token, project.rate, 0, kClipLength));
            track->addMedia(clips.back(), i * kStep);
        }
        for (int i = 0; i < kClips; ++i) {
            starts.push_back(i * kStep);
            ends.push_back(i * kStep + kClipLength);
            byStart[i * kStep] = clips[size_t(i)];
        }
    }
    static Filled& once() {
        static Filled filled;
        return filled;
    }
    VelaTime tick(size_t i) const { return ticks[i % ticks.size()]; }

    // The track's search over the same arrays, building the answer straight
    // from them as the track does; `hand` gives a clip out shared or raw.
    template <typename Result, typename Hand>
    Result flat(VelaTime t, Hand hand) const {
        const size_t count = size_t(std::upper_bound(starts.begin(), starts.end(), t) - starts.begin());
        if (count == 0) return Result();
        const size_t at = count - 1;
        if (starts[at] == t && at > 0 && ends[at - 1] == t)
            return Result(hand(clips[at - 1]), hand(clips[at]));
        return t < ends[at] ? Result(hand(clips[at]), typename Result::second_type()) : Result();
    }
    void flatArrays(size_t first, size_t count) const {
        const auto shared = [](const MediaPtr& clip) -> const MediaPtr& { return clip; };
        for (size_t i = first; i < first + count; ++i)
            benchmark::DoNotOptimize(flat<Track::Pair>(tick(i), shared));
    }
    void flatArraysRaw(size_t first, size_t count) const {
        const auto raw = [](const MediaPtr& clip) { return clip.get(); };
        for (size_t i = first; i < first + count; ++i)
            benchmark::DoNotOptimize(flat<Track::RawPair>(tick(i), raw));
    }
    void map(size_t first, size_t count) const {
        for (size_t i = first; i < first + count; ++i) {
            const auto at = byStart.upper_bound(tick(i));
            const MediaPtr found = at == byStart.begin() ? MediaPtr() : std::prev(at)->second;
            benchmark::DoNotOptimize(found); // handed out as a shared pointer, as the track does
        }
    }
    void library(size_t first, size_t count) const {
        for (size_t i = first; i < first + count; ++i) benchmark::DoNotOptimize(track->mediaAtTime(tick(i)));
    }
    // As a host would around one frame's queries: the lock once, then raw answers.
    void libraryUnderLock(size_t first, size_t count) const {
        ScopedReadLock lock(track->projectLock());
        for (size_t i = first; i < first + count; ++i)
            benchmark::DoNotOptimize(track->mediaAtTimeUnderLock(tick(i)));
    }
};

void BM_MediaAtTime_VsFlatArrays(benchmark::State& state) {
    const Filled& filled = Filled::once();
    Interleaved::compare(
        state, 256, [&](size_t first, size_t count) { filled.flatArrays(first, count); },
        [&](size_t first, size_t count) { filled.library(first, count); });
}

void BM_MediaAtTimeUnderLock_VsFlatArrays(benchmark::State& state) {
    const Filled& filled = Filled::once();
    Interleaved::compare(
        state, 256, [&](size_t first, size_t count) { filled.flatArraysRaw(first, count); },
        [&](size_t first, size_t count) { filled.libraryUnderLock(first, count); });
}

void BM_MediaAtTime_VsStdMap(benchmark::State& state) {
    const Filled& filled = Filled::once();
    Interleaved::compare(
        state, 256, [&](size_t first, size_t count) { filled.map(first, count); },
        [&](size_t first, size_t count) { filled.library(first, count); });
}

void BM_MediaAtTime_TwoReaders(benchmark::State& state) {
    const Filled& filled = Filled::once();
    Interleaved::scaling(
        state, 200000, [&](size_t first, size_t count) { filled.flatArrays(first, count); },
        [&](size_t first, size_t count) { filled.library(first, count); });
}

// Places `clips` clips end to end on a new track, last first or first first:
// last first shifts the whole index on every placement, the worst order.
void placeClips(benchmark::State& state, int clips, bool lastFirst) {
    Project project;
    for (auto _ : state) {
        state.PauseTiming();
        std::vector<MediaPtr> made;
        for (int i = 0; i < clips; ++i)
            made.push_back(PlaceholderMedia::create(project.token, project.rate, 0, 30));
        const auto track = GenericTrack::create(project.token);
        state.ResumeTiming();
        for (int n = 0; n < clips; ++n) {
            const int i = lastFirst ? clips - 1 - n : n;
            track->addMedia(made[size_t(i)], i * 30LL);
        }
        state.PauseTiming();
        made.clear();
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * clips);
}

void BM_PlaceClipsEndToEnd(benchmark::State& state) { placeClips(state, 100000, false); }
void BM_PlaceClipsFrontFirst(benchmark::State& state) { placeClips(state, 10000, true); }

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

BENCHMARK(BM_MediaAtTime_VsFlatArrays);
BENCHMARK(BM_MediaAtTime_VsStdMap);
BENCHMARK(BM_MediaAtTimeUnderLock_VsFlatArrays);
BENCHMARK(BM_MediaAtTime_TwoReaders)->Unit(benchmark::kMillisecond)->Iterations(10);
BENCHMARK(BM_PlaceClipsEndToEnd)->Unit(benchmark::kMillisecond)->Iterations(2);
BENCHMARK(BM_PlaceClipsFrontFirst)->Unit(benchmark::kMillisecond)->Iterations(2);
BENCHMARK(BM_AllMediasAtTime_20TracksOf5000)->Unit(benchmark::kMicrosecond);

// Importing sources and finding a source by its file.
//
// BM_ImportSources: 10,000 files through a stats loader that answers from
// memory, into a project's source bin: time per source against the bare
// equivalent (copying each record into a list and a map by path), the heap
// the project holds afterwards per source, and all it allocated on the way.
//
// BM_SourceForFile_VsBareMap: SourceBin::sourceForFile on a 10,000-source
// bin against a bare unordered_map lookup of the same paths.
#include "AllocationCounter.h"
#include "Interleaved.h"

#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/model/source/StatsLoader.h>

#include <boost/make_shared.hpp>
#ifdef __GLIBC__
#include <malloc.h>
#endif
#include <string>
#include <unordered_map>
#include <vector>

using namespace VelaMediaLib;

namespace {

const size_t kSources = 10000;

std::string pathOf(size_t index) { return "/recordings/session-" + std::to_string(index) + ".trec"; }

/// A screen recording with its sound, for every path.
MediaFileStats::Contents recording(const std::string& path) {
    MediaFileStats::Contents contents;
    contents.filename = path;
    TrackStats video;
    video.type = TrackType::ScreenVideo;
    video.range = Range<long long>(0, 600 * 60);
    video.rangeEditRate = 600;
    video.rect = Rect<int>(0, 0, 1920, 1080);
    TrackStats audio;
    audio.type = TrackType::Audio;
    audio.range = Range<long long>(0, 48000 * 60);
    audio.rangeEditRate = 48000;
    audio.numChannels = 2;
    contents.tracks = {video, audio};
    contents.rect = video.rect;
    return contents;
}

/// Bytes the allocator has handed out and not had back (glibc; 0 elsewhere).
double heapInUse() {
#if defined(__GLIBC__) && (__GLIBC__ > 2 || __GLIBC_MINOR__ >= 33)
    return double(mallinfo2().uordblks);
#else
    return 0;
#endif
}

class MemoryLoader : public StatsLoader {
public:
    bool loadStats(const std::string& path, MediaFileStats& stats) override {
        stats.setContents(recording(path));
        return true;
    }
};

struct RegisteredLoader {
    RegisteredLoader() { MediaFileStats::addStatsLoader(loader, 1); }
    ~RegisteredLoader() { MediaFileStats::removeStatsLoader(loader); }
    boost::shared_ptr<MemoryLoader> loader = boost::make_shared<MemoryLoader>();
};

void BM_ImportSources(benchmark::State& state) {
    RegisteredLoader registered;
    std::vector<std::string> paths;
    for (size_t i = 0; i < kSources; ++i) paths.push_back(pathOf(i));
    double libraryNs = 0, baselineNs = 0, allocated = 0, held = 0;
    std::vector<double> ratios;
    for (auto _ : state) {
        // Both are timed building, neither tearing down.
        double baseline = 0;
        {
            const auto start = Interleaved::Clock::now();
            std::vector<boost::shared_ptr<MediaFileStats::Contents>> list;
            std::unordered_map<std::string, boost::shared_ptr<MediaFileStats::Contents>> byPath;
            for (const std::string& path : paths) {
                list.push_back(boost::make_shared<MediaFileStats::Contents>(recording(path)));
                byPath.emplace(path, list.back());
            }
            benchmark::DoNotOptimize(byPath.size());
            baseline = Interleaved::nanoseconds(Interleaved::Clock::now() - start);
        }
        const ProjectPtr project = Project::create(30, 1);
        const long long allocatedBefore = AllocationCounter::bytes().load();
        const double heldBefore = heapInUse();
        const auto start = Interleaved::Clock::now();
        for (const std::string& path : paths) project->loadSource(path);
        const double library = Interleaved::nanoseconds(Interleaved::Clock::now() - start);
        allocated += double(AllocationCounter::bytes().load() - allocatedBefore);
        held += heapInUse() - heldBefore;
        baselineNs += baseline;
        libraryNs += library;
        ratios.push_back(library / baseline);
    }
    const double sources = double(state.iterations()) * double(kSources);
    state.counters["library_ns_per_source"] = libraryNs / sources;
    state.counters["baseline_ns_per_source"] = baselineNs / sources;
    state.counters["held_bytes_per_source"] = held / sources;           // kept by the project
    state.counters["allocated_bytes_per_source"] = allocated / sources; // temporaries included
    state.counters["ratio_to_baseline"] = Interleaved::median(ratios);
}
BENCHMARK(BM_ImportSources)->Iterations(6)->Unit(benchmark::kMillisecond);

void BM_SourceForFile_VsBareMap(benchmark::State& state) {
    RegisteredLoader registered;
    const ProjectPtr project = Project::create(30, 1);
    const boost::shared_ptr<SourceBin> bin = project->sourceBin();
    std::unordered_map<std::string, boost::shared_ptr<Source>> bare;
    std::vector<std::string> queries;
    for (size_t i = 0; i < kSources; ++i) {
        bare.emplace(pathOf(i), project->loadSource(pathOf(i)));
        queries.push_back(pathOf((i * 7919) % kSources)); // not in load order
    }
    size_t found = 0;
    Interleaved::compare(
        state, 256,
        [&](size_t first, size_t count) {
            for (size_t i = 0; i < count; ++i) {
                const auto hit = bare.find(queries[(first + i) % kSources]);
                const boost::shared_ptr<Source> source = hit == bare.end() ? nullptr : hit->second;
                found += bool(source);
            }
        },
        [&](size_t first, size_t count) {
            for (size_t i = 0; i < count; ++i)
                found += bool(bin->sourceForFile(queries[(first + i) % kSources]));
        });
    benchmark::DoNotOptimize(found);
}
BENCHMARK(BM_SourceForFile_VsBareMap);

} // namespace

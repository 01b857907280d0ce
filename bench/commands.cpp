// Edits through the history on a large magnetic track, and queries read
// while another thread edits.
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>

#include <atomic>
#include <benchmark/benchmark.h>
#include <chrono>
#include <random>
#include <thread>

using namespace VelaMediaLib;

namespace {

struct MagneticProject {
    ProjectPtr project = Project::create(30, 1);
    boost::shared_ptr<GenericTrack> track;
    std::vector<MediaPtr> clips;

    explicit MagneticProject(int count, bool magnetic) {
        const auto mixer = project->newMixer("main");
        track = project->timeline()->newTrack();
        project->timeline()->addTrack(mixer, track);
        for (int i = 0; i < count; ++i) {
            clips.push_back(PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 30));
            track->addMedia(clips.back(), i * 30LL);
        }
        track->magneticAttribute()->setValue(magnetic);
    }
};

double millisecondsOf(const std::function<void()>& step) {
    const auto start = std::chrono::steady_clock::now();
    step();
    return std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now() - start).count();
}

// Removing the first of 10,000 clips: the removal plus the automatic close-gaps command.
void BM_RemoveFirstOfTenThousandOnMagneticTrack(benchmark::State& state) {
    MagneticProject setup(10000, true);
    double remove = 0, undo = 0, redo = 0;
    for (auto _ : state) {
        remove = millisecondsOf(
            [&] { setup.project->execute(RemoveMediaCmd::create(setup.track, setup.clips.front())); });
        undo = millisecondsOf([&] {
            setup.project->undo(); // the closing
            setup.project->undo(); // the removal
        });
        redo = millisecondsOf([&] {
            setup.project->redo();
            setup.project->redo();
        });
        setup.project->undo();
        setup.project->undo();
    }
    state.counters["remove_ms"] = remove;
    state.counters["undo_ms"] = undo;
    state.counters["redo_ms"] = redo;
}

// mediaAtTime from two reader threads, with or without a writer moving clips meanwhile.
void readersWithWriter(benchmark::State& state, bool writer) {
    MagneticProject setup(1000, false);
    for (auto _ : state) {
        std::atomic<bool> stop{false};
        std::atomic<long long> queries{0};
        std::thread editor;
        if (writer)
            editor = std::thread([&] {
                const MediaPtr last = setup.clips.back();
                while (!stop.load()) {
                    setup.project->execute(MoveCmd::create(setup.track, last, 7));
                    setup.project->undo();
                }
            });
        std::vector<std::thread> readers;
        for (int r = 0; r < 2; ++r)
            readers.emplace_back([&, r] {
                std::mt19937_64 random(r);
                std::uniform_int_distribution<VelaTime> spread(0, 30000);
                long long mine = 0;
                while (!stop.load()) {
                    benchmark::DoNotOptimize(setup.track->mediaAtTime(spread(random)));
                    ++mine;
                }
                queries += mine;
            });
        std::this_thread::sleep_for(std::chrono::milliseconds(500));
        stop = true;
        for (std::thread& reader : readers) reader.join();
        if (editor.joinable()) editor.join();
        state.counters["queries_per_second"] = double(queries.load()) / 0.5;
    }
}

void BM_MediaAtTimeTwoReaders_NoWriter(benchmark::State& state) { readersWithWriter(state, false); }
void BM_MediaAtTimeTwoReaders_WriterMovingAndUndoing(benchmark::State& state) {
    readersWithWriter(state, true);
}

} // namespace

BENCHMARK(BM_RemoveFirstOfTenThousandOnMagneticTrack)->Iterations(3)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_MediaAtTimeTwoReaders_NoWriter)->Iterations(1)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_MediaAtTimeTwoReaders_WriterMovingAndUndoing)->Iterations(1)->Unit(benchmark::kMillisecond);

// Edits through the history on a track of 10,000 clips, each measured
// against one mediaAtTime query on the same track; edits on a large magnetic
// track; and queries read while another thread edits.
#include "Interleaved.h"

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/InsertTimeCmd.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/commands/edits/RippleMoveCmd.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>
#include <VelaMediaLib/commands/framework/CommandHistory.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/media/Transition.h>

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

    // With `transitions`, every two touching clips share a 4-tick one.
    explicit MagneticProject(int count, bool magnetic, bool transitions = false) {
        const auto mixer = project->newMixer("main");
        track = project->timeline()->newTrack();
        project->timeline()->addTrack(mixer, track);
        for (int i = 0; i < count; ++i) {
            clips.push_back(PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 30));
            if (transitions && i + 1 < count)
                clips.back()->setRightTransition(TransitionPtr(new Transition("t", 4)));
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

// An edit, its undo and its redo, each timed alone, alternating with a batch of
// mediaAtTime queries on the same track (taking turns at going first), so
// that "edit / mediaAtTime" tells the edit's cost in queries on a noisy
// machine: the median over the iterations of edit time over one query's.
void editAgainstQueries(benchmark::State& state, const std::function<CommandPtr(MagneticProject&)>& make,
                        bool transitions = false) {
    MagneticProject setup(10000, false, transitions);
    const std::vector<VelaTime> ticks = [] {
        std::mt19937_64 random(11);
        std::uniform_int_distribution<VelaTime> spread(0, 10000 * 30);
        std::vector<VelaTime> all(4096);
        for (VelaTime& tick : all) tick = spread(random);
        return all;
    }();
    const size_t batch = 2000;
    size_t next = 0;
    std::vector<double> editRatios, undoRatios, redoRatios, edits, undos, redos, queries;
    bool queriesFirst = true;
    for (auto _ : state) {
        const CommandPtr command = make(setup);
        double query = 0, edit = 0, undo = 0, redo = 0;
        const auto ask = [&] {
            query = millisecondsOf([&] {
                        for (size_t i = 0; i < batch; ++i)
                            benchmark::DoNotOptimize(setup.track->mediaAtTime(ticks[next++ % ticks.size()]));
                    }) /
                    double(batch);
        };
        if (queriesFirst) ask();
        edit = millisecondsOf([&] {
            if (!setup.project->execute(command)) state.SkipWithError("the edit was refused");
        });
        undo = millisecondsOf([&] { setup.project->undo(); });
        redo = millisecondsOf([&] {
            if (!setup.project->redo()) state.SkipWithError("the redo was refused");
        });
        setup.project->undo();
        if (!queriesFirst) ask();
        queriesFirst = !queriesFirst;
        // Dropped outside the timing: the next edit would release it.
        const auto history = setup.project->commandHistory();
        history->restoreState(CommandHistoryState{history->undoStack(), {}});
        editRatios.push_back(edit / query);
        undoRatios.push_back(undo / query);
        redoRatios.push_back(redo / query);
        edits.push_back(edit);
        undos.push_back(undo);
        redos.push_back(redo);
        queries.push_back(query);
    }
    state.counters["edit_us"] = Interleaved::median(edits) * 1e3;
    state.counters["undo_us"] = Interleaved::median(undos) * 1e3;
    state.counters["redo_us"] = Interleaved::median(redos) * 1e3;
    state.counters["mediaAtTime_ns"] = Interleaved::median(queries) * 1e6;
    state.counters["edit / mediaAtTime"] = Interleaved::median(editRatios);
    state.counters["undo / mediaAtTime"] = Interleaved::median(undoRatios);
    state.counters["redo / mediaAtTime"] = Interleaved::median(redoRatios);
}

// Target: 50 us each, history included.
void BM_SplitInTheMiddleOfTenThousand(benchmark::State& state) {
    editAgainstQueries(state, [](MagneticProject& setup) {
        return SplitCmd::create(setup.track, 5000 * 30 + 15); // inside the 5,001st clip
    });
}

// The same on a track where every edge has a transition: the edits record
// the slots of the clips around them, so this must cost what the above does.
void BM_SplitInTheMiddleOfTenThousandWithTransitions(benchmark::State& state) {
    editAgainstQueries(
        state, [](MagneticProject& setup) { return SplitCmd::create(setup.track, 5000 * 30 + 15); }, true);
}

// Each moves 10,000 clips. Target: 20 ms each.
void BM_RippleMoveFirstOfTenThousand(benchmark::State& state) {
    editAgainstQueries(state, [](MagneticProject& setup) {
        return RippleMoveCmd::create(setup.track, setup.clips.front(), 30);
    });
}

void BM_InsertTimeAtStartOfTenThousand(benchmark::State& state) {
    editAgainstQueries(state, [](MagneticProject& setup) {
        const auto insert = InsertTimeCmd::create(Range<VelaTime>(0, 30));
        insert->addTrack(setup.track);
        return insert;
    });
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

BENCHMARK(BM_SplitInTheMiddleOfTenThousand)->Iterations(200)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_SplitInTheMiddleOfTenThousandWithTransitions)->Iterations(200)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_RippleMoveFirstOfTenThousand)->Iterations(15)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_InsertTimeAtStartOfTenThousand)->Iterations(15)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_RemoveFirstOfTenThousandOnMagneticTrack)->Iterations(3)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_MediaAtTimeTwoReaders_NoWriter)->Iterations(1)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_MediaAtTimeTwoReaders_WriterMovingAndUndoing)->Iterations(1)->Unit(benchmark::kMillisecond);

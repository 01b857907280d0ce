#pragma once
// Measures the library against its bare baseline on a shared, noisy machine:
// both run in short alternating batches over the same inputs inside one
// benchmark, so that a slow spell falls on both alike, and the figure to
// quote is their ratio. Also the same for reader threads: the items per
// second of two threads at once against one thread alone.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <functional>
#include <thread>
#include <vector>

namespace Interleaved {

typedef std::chrono::steady_clock Clock;

inline double nanoseconds(Clock::duration d) {
    return double(std::chrono::duration_cast<std::chrono::nanoseconds>(d).count());
}

/// A query run over `count` inputs starting at input `first` (wrapping).
typedef std::function<void(size_t first, size_t count)> Batch;

inline double median(std::vector<double> values) {
    std::nth_element(values.begin(), values.begin() + std::ptrdiff_t(values.size() / 2), values.end());
    return values[values.size() / 2];
}

/// Alternates baseline and library batches, taking turns at going first;
/// reports ns per query of each and "ratio_to_baseline", the median over the
/// iterations of library time / baseline time, so that a batch cut short by
/// the scheduler does not sway it.
inline void compare(benchmark::State& state, size_t batch, const Batch& baseline, const Batch& library) {
    Clock::duration spentBaseline{}, spentLibrary{};
    std::vector<double> ratios;
    size_t first = 0;
    bool baselineFirst = true;
    for (auto _ : state) {
        Clock::duration spent[2] = {};
        for (int turn = 0; turn < 2; ++turn) {
            const bool runBaseline = (turn == 0) == baselineFirst;
            const Clock::time_point start = Clock::now();
            (runBaseline ? baseline : library)(first, batch);
            spent[runBaseline ? 0 : 1] += Clock::now() - start;
        }
        spentBaseline += spent[0];
        spentLibrary += spent[1];
        ratios.push_back(nanoseconds(spent[1]) / nanoseconds(spent[0]));
        baselineFirst = !baselineFirst;
        first += batch;
    }
    const double queries = double(state.iterations()) * double(batch);
    state.counters["baseline_ns"] = nanoseconds(spentBaseline) / queries;
    state.counters["library_ns"] = nanoseconds(spentLibrary) / queries;
    state.counters["ratio_to_baseline"] = median(ratios);
}

/// Wall time of `threads` threads running `count` queries each at once, each
/// from its own place in the inputs; they start together.
inline Clock::duration runThreads(int threads, size_t count, const Batch& query) {
    std::atomic<int> ready{0};
    std::atomic<bool> go{false};
    std::vector<std::thread> workers;
    for (int t = 1; t < threads; ++t)
        workers.emplace_back([&, t] {
            ++ready;
            while (!go.load()) std::this_thread::yield();
            query(size_t(t) * 7919, count);
        });
    while (ready.load() < threads - 1) std::this_thread::yield();
    const Clock::time_point start = Clock::now();
    go = true;
    query(0, count);
    for (std::thread& worker : workers) worker.join();
    return Clock::now() - start;
}

/// Alternates rounds of one thread and of two threads over the same query;
/// reports "scaling" (two threads' queries per second over one thread's) for
/// the library and, as the machine's own limit, for the baseline: each the
/// median over the iterations, as in compare.
inline void scaling(benchmark::State& state, size_t count, const Batch& baseline, const Batch& library) {
    std::vector<double> scalings, baselineScalings;
    bool oneFirst = true;
    for (auto _ : state) {
        Clock::duration one{}, two{}, baseOne{}, baseTwo{};
        for (int turn = 0; turn < 2; ++turn) {
            const int threads = (turn == 0) == oneFirst ? 1 : 2;
            (threads == 1 ? one : two) += runThreads(threads, count, library);
            (threads == 1 ? baseOne : baseTwo) += runThreads(threads, count, baseline);
        }
        scalings.push_back(2.0 * nanoseconds(one) / nanoseconds(two));
        baselineScalings.push_back(2.0 * nanoseconds(baseOne) / nanoseconds(baseTwo));
        oneFirst = !oneFirst;
    }
    state.counters["scaling"] = median(scalings);
    state.counters["baseline_scaling"] = median(baselineScalings);
}

} // namespace Interleaved

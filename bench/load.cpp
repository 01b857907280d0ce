// What loading the shared library costs a host: dlopen with every symbol
// bound at once (RTLD_NOW), dlclose, and looking up a few exported symbols.
//
// Each load happens in a child process of its own: the library holds unique
// (STB_GNU_UNIQUE) symbols, so dlclose never unloads it and a second dlopen in
// the same process would only count a reference. The child times itself and
// reports back; fork and exit are not counted.
//
// VELA_LOAD_LIBRARY=/path/to/libVelaMediaLib.so measures another build of the
// library with the same program.
#include <benchmark/benchmark.h>

#include <chrono>
#include <cstdlib>
#include <dlfcn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

// Exported by every build of the library: a factory, a command, the history
// and an operator.
const char* const kSymbols[] = {
    "_ZN12VelaMediaLib7Project6createEmm",
    "_ZN12VelaMediaLib11AddMediaCmd6createERKN5boost10shared_ptrINS_5TrackEEERKNS2_INS_5MediaEEEx",
    "_ZN12VelaMediaLib14CommandHistory7executeERKN5boost10shared_ptrINS_7CommandEEE",
    "_ZN12VelaMediaLibplERKNS_12SafeRationalES2_",
};
const int kSymbolCount = sizeof kSymbols / sizeof kSymbols[0];

struct Timings {
    double open = 0, lookup = 0, close = 0; // seconds
    bool failed = false;
};

const char* libraryPath() {
    const char* path = std::getenv("VELA_LOAD_LIBRARY");
    return path && *path ? path : VELA_LIBRARY_PATH;
}

double since(std::chrono::steady_clock::time_point start) {
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

Timings loadOnce(const char* path) {
    Timings timings;
    auto start = std::chrono::steady_clock::now();
    void* handle = dlopen(path, RTLD_NOW | RTLD_LOCAL);
    timings.open = since(start);
    if (!handle) {
        timings.failed = true;
        return timings;
    }
    start = std::chrono::steady_clock::now();
    for (const char* symbol : kSymbols) timings.failed |= dlsym(handle, symbol) == nullptr;
    timings.lookup = since(start);
    start = std::chrono::steady_clock::now();
    dlclose(handle);
    timings.close = since(start);
    return timings;
}

bool loadInChild(const char* path, Timings& timings) {
    int pipeEnds[2];
    if (pipe(pipeEnds) != 0) return false;
    const pid_t child = fork();
    if (child == 0) {
        close(pipeEnds[0]);
        const Timings measured = loadOnce(path);
        const bool written = write(pipeEnds[1], &measured, sizeof measured) == sizeof measured;
        _exit(written ? 0 : 1);
    }
    close(pipeEnds[1]);
    const bool read_ = child > 0 && read(pipeEnds[0], &timings, sizeof timings) == sizeof timings;
    close(pipeEnds[0]);
    int status = 0;
    if (child > 0) waitpid(child, &status, 0);
    return read_ && !timings.failed;
}

void LoadLibrary(benchmark::State& state) {
    const char* path = libraryPath();
    double opens = 0, lookups = 0, closes = 0;
    for (auto _ : state) {
        Timings timings;
        if (!loadInChild(path, timings)) {
            state.SkipWithError(dlerror() ? dlerror() : "the library or one of its symbols did not load");
            break;
        }
        opens += timings.open;
        lookups += timings.lookup;
        closes += timings.close;
        state.SetIterationTime(timings.open + timings.close);
    }
    const double n = static_cast<double>(state.iterations());
    if (n == 0) return;
    state.counters["open_us"] = opens / n * 1e6;
    state.counters["close_us"] = closes / n * 1e6;
    state.counters["lookup_ns_per_symbol"] = lookups / n / kSymbolCount * 1e9;
}
BENCHMARK(LoadLibrary)->UseManualTime()->Unit(benchmark::kMicrosecond)->MinTime(0.3);

} // namespace

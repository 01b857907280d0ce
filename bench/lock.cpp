// The project lock against std::shared_mutex, alone and with two readers at once.
#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

#include <benchmark/benchmark.h>
#include <shared_mutex>

using VelaMediaLib::ReadWriteMutex;

namespace {

ReadWriteMutex projectLock;
std::shared_mutex standardLock;

void BM_ReadLock_SharedMutex(benchmark::State& state) {
    for (auto _ : state) {
        standardLock.lock_shared();
        standardLock.unlock_shared();
    }
    state.SetItemsProcessed(state.iterations());
}

void BM_ReadLock_ReadWriteMutex(benchmark::State& state) {
    for (auto _ : state) {
        projectLock.lockRead();
        projectLock.unlockRead();
    }
    state.SetItemsProcessed(state.iterations());
}

void BM_ScopedReadLock_ReadWriteMutex(benchmark::State& state) {
    for (auto _ : state) {
        ReadWriteMutex::ScopedReadLock lock(projectLock);
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations());
}

} // namespace

// items_per_second summed over threads is the readers' joint throughput.
BENCHMARK(BM_ReadLock_SharedMutex)->Threads(1)->Threads(2)->UseRealTime();
BENCHMARK(BM_ReadLock_ReadWriteMutex)->Threads(1)->Threads(2)->UseRealTime();
BENCHMARK(BM_ScopedReadLock_ReadWriteMutex)->Threads(1)->Threads(2)->UseRealTime();

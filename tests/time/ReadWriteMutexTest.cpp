#include "../ThreadTestSupport.h"

#include <VelaMediaLib/time/sync/ThreadSafe.h>
#include <VelaMediaLib/base/detail/Portable.h>
#include <VelaMediaLib/time/sync/detail/AsymmetricFence.h>

#if defined(__linux__) && defined(__has_include)
#if __has_include(<linux/membarrier.h>)
#include <linux/membarrier.h>
#include <sys/syscall.h>
#include <unistd.h>
#define VELA_HAVE_MEMBARRIER_TEST 1
#endif
#endif

#include <atomic>
#include <boost/make_shared.hpp>
#include <chrono>
#include <gtest/gtest.h>
#include <thread>
#include <vector>

using namespace VelaMediaLib;
using VelaMediaLib::testing::Deadline;

namespace {

// Threads that mix reads, nested reads, upgrades and writes, counting any moment at which a writer shares the
// lock with anyone.
void runMixedLoad(int threadCount, int iterations) {
    ReadWriteMutex mutex;
    std::atomic<int> readers{0}, writers{0}, violations{0}, writes{0};
    long long sharedValue = 0; // written only under the write lock
    auto write = [&] {
        ++writes;
        ScopedWriteLock lock(mutex);
        if (++writers != 1 || readers.load() != 0) ++violations;
        ++sharedValue;
        --writers;
    };
    std::atomic<int> started{0};
    auto work = [&](int seed) {
        {
            ScopedReadLock lock(
                mutex); // every thread reads at once (readers that serialised would hang here)
            ++started;
            while (started.load() < threadCount) std::this_thread::yield();
            if (!mutex.heldByThisThread()) ++violations; // owned slot or shared, it knows
        }
        if (mutex.heldByThisThread()) ++violations;
        for (int i = 0; i < iterations; ++i) {
            if ((i + seed) % 4 == 0) {
                write();
            } else if ((i + seed) % 8 == 1) {
                ScopedReadLock outer(mutex);
                ScopedReadLock nested(mutex);
                write(); // upgrade: the read share is given up meanwhile
            } else {
                ScopedReadLock lock(mutex);
                ++readers;
                if (writers.load() != 0) ++violations;
                ScopedReadLock nested(mutex);
                volatile long long seen = sharedValue;
                (void)seen;
                --readers;
            }
        }
    };
    std::vector<std::thread> threads;
    for (int t = 0; t < threadCount; ++t) threads.emplace_back(work, t);
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(violations.load(), 0);
    EXPECT_EQ(sharedValue, writes.load());
}

} // namespace

// With more threads than reader slots too: the extra threads share the counted slot.
TEST(ReadWriteMutexConcurrency, AWriterNeverOverlapsAnyoneElse) {
    Deadline deadline;
    runMixedLoad(4, 3000);
    runMixedLoad(72, 200);
}

// A reader and a writer that start at the same instant, over and over: the
// tightest race between a reader's announcement and the writer's flag.
// Returns how often both were inside at once.
namespace {
// Spins, to start close together on two cores, but yields after a while: on
// a loaded machine the other thread may share this one's core, and a pure
// spin would hold it for whole time slices.
template <typename Ready>
void spinUntil(const Ready& ready) {
    for (int spins = 0; !ready(); ++spins)
        if (spins > 2000) std::this_thread::yield();
}

int overlapsOfReaderAndWriterStartingTogether(ReadWriteMutex& mutex, int rounds) {
    std::atomic<int> round{-1}, arrived{0}, overlaps{0};
    std::atomic<bool> readerIn{false}, writerIn{false};
    auto inside = [&](std::atomic<bool>& mine, const std::atomic<bool>& other) {
        mine.exchange(true);
        if (other.load()) ++overlaps;
        mine.store(false);
    };
    std::thread reader([&] {
        for (int r = 0; r < rounds; ++r) {
            ++arrived;
            spinUntil([&] { return round.load(std::memory_order_acquire) == r; });
            ScopedReadLock lock(mutex);
            inside(readerIn, writerIn);
        }
    });
    for (int r = 0; r < rounds; ++r) {
        spinUntil([&] { return arrived.load() == r + 1; });
        round.store(r, std::memory_order_release);
        for (volatile int spin = 0; spin < r % 97; ++spin) { // sweeps the writer across the reader's entry
        }
        ScopedWriteLock lock(mutex);
        inside(writerIn, readerIn);
    }
    reader.join();
    return overlaps.load();
}
} // namespace

// Both ways of ordering a reader's entry against a writer: writes this close
// together make the reader fence itself; with no busy gap the writer always
// fences for it. A smoke test: the window it aims at is a few instructions
// wide, and a missing fence shows only rarely.
TEST(ReadWriteMutexConcurrency, AReaderAndAWriterStartingTogetherNeverOverlap) {
    Deadline deadline;
    ReadWriteMutex readersFence;
    EXPECT_EQ(overlapsOfReaderAndWriterStartingTogether(readersFence, 5000), 0);
    EXPECT_TRUE(readersFence.readersFenceThemselves());
    ReadWriteMutex writerFences(std::chrono::nanoseconds(0));
    EXPECT_EQ(overlapsOfReaderAndWriterStartingTogether(writerFences, 5000), 0);
    EXPECT_EQ(writerFences.readersFenceThemselves(), !detail::asymmetricFenceAvailable());
}

// Where the kernel offers the expedited barrier the lock uses it: a build
// that silently lost it would pass every other test, only slower.
TEST(ReadWriteMutex, UsesTheKernelsBarrierWhereItIsOffered) {
#if defined(VELA_HAVE_MEMBARRIER_TEST) && !VELA_THREAD_SANITIZER && !defined(VELA_NO_ASYMMETRIC_FENCE)
    const long offered = syscall(__NR_membarrier, MEMBARRIER_CMD_QUERY, 0, 0);
    if (offered < 0 || !(offered & MEMBARRIER_CMD_PRIVATE_EXPEDITED)) GTEST_SKIP() << "not offered here";
    EXPECT_TRUE(detail::asymmetricFenceAvailable());
#else
    GTEST_SKIP() << "not built with the kernel's barrier";
#endif
}

// Close writes turn readers' own fencing on, but only with another thread
// about to read; once writes are quiet, reading turns it off again.
TEST(ReadWriteMutexConcurrency, ReadersFenceThemselvesOnlyWhileWritesAreBusy) {
    Deadline deadline;
    ReadWriteMutex mutex;
    const bool always = !detail::asymmetricFenceAvailable();
    const auto busyWrites = [&] { // nine gaps: one under a millisecond is enough
        for (int i = 0; i < 10; ++i) ScopedWriteLock lock(mutex);
    };
    busyWrites();
    EXPECT_EQ(mutex.readersFenceThemselves(), always); // alone: nobody to fence for
    std::atomic<bool> done{false}, holding{false};
    std::thread other([&] {
        { ScopedReadLock lock(mutex); } // takes a reader slot and keeps it while it lives
        holding = true;
        while (!done.load()) std::this_thread::yield();
    });
    while (!holding.load()) std::this_thread::yield();
    const auto lastWrite = std::chrono::steady_clock::now();
    busyWrites();
    EXPECT_TRUE(mutex.readersFenceThemselves());
    for (int i = 0; i < 5000; ++i) ScopedReadLock lock(mutex);
    if (std::chrono::steady_clock::now() - lastWrite < std::chrono::milliseconds(40)) {
        EXPECT_TRUE(mutex.readersFenceThemselves()); // not quiet yet (unless this thread was held up)
    }
    std::this_thread::sleep_for(std::chrono::milliseconds(60));
    for (int i = 0; i < 5000; ++i) ScopedReadLock lock(mutex);
    EXPECT_EQ(mutex.readersFenceThemselves(), always);
    done = true;
    other.join();
}

// A writer alone skips fencing for readers; a thread born meanwhile must
// still see its flag on its first read, or it would read a half-made write.
TEST(ReadWriteMutexConcurrency, ThreadsBornDuringWritesReadWholeWrites) {
    Deadline deadline;
    ReadWriteMutex mutex;
    long long first = 0, second = 0; // equal outside the write lock
    std::atomic<bool> done{false};
    std::atomic<int> torn{0};
    std::thread births([&] {
        for (int i = 0; i < 300; ++i)
            std::thread([&] {
                ScopedReadLock lock(mutex);
                if (first != second) ++torn;
            }).join();
        done = true;
    });
    while (!done.load()) {
        ScopedWriteLock lock(mutex);
        ++first;
        for (volatile int spin = 0; spin < 200; ++spin) {}
        ++second;
    }
    births.join();
    EXPECT_EQ(torn.load(), 0);
}

// One thread may nest reads and writes, upgrade and downgrade; a downgraded writer still excludes writers.
TEST(ReadWriteMutexConcurrency, ReentrantReadWriteUpgradeAndDowngradeOnOneThread) {
    Deadline deadline;
    ReadWriteMutex mutex;
    {
        ScopedWriteLock write(mutex);
        ScopedReadLock read(mutex); // a writer may read what it writes
        ScopedWriteLock again(mutex);
    }
    {
        ScopedReadLock read(mutex);
        ScopedReadLock nested(mutex);
        ScopedWriteLock upgraded(mutex);
    }
    mutex.lockWrite(); // everything above was released, or the writer below never gets in
    mutex.lockRead();
    mutex.unlockWrite(); // still reading
    std::atomic<bool> written{false};
    std::thread writer([&] {
        ScopedWriteLock lock(mutex);
        written = true;
    });
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    EXPECT_FALSE(written.load());
    mutex.unlockRead();
    writer.join();
    EXPECT_TRUE(written.load());
}

TEST(ReadWriteMutexConcurrency, TokenLocksTakeNothingOnceTheProjectIsGone) {
    Deadline deadline;
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    const boost::weak_ptr<const ThreadSafe> token = project;
    {
        ScopedWriteLock lock(token); // keeps the project alive while held
        project.reset();
        EXPECT_FALSE(token.expired());
    }
    EXPECT_TRUE(token.expired());
    ScopedReadLock read(token);
    ScopedWriteLock write(token);
}

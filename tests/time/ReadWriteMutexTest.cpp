#include "../ThreadTestSupport.h"

#include <VelaMediaLib/time/sync/ThreadSafe.h>

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

#include "../ThreadTestSupport.h"

#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <atomic>
#include <boost/make_shared.hpp>
#include <chrono>
#include <future>
#include <gtest/gtest.h>
#include <thread>
#include <vector>

using namespace VelaMediaLib;

TEST(ReadWriteMutexConcurrency, ReadersHoldTheLockTogether) {
    VelaMediaLib::testing::Deadline watchdog;
    ReadWriteMutex mutex;
    std::atomic<int> inside{0};
    // Each reader waits, holding the lock, until the other is inside too: readers that serialised would never
    // both get there.
    auto reader = [&] {
        ScopedReadLock lock(mutex);
        ++inside;
        const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(10);
        while (inside.load() < 2 && std::chrono::steady_clock::now() < deadline) std::this_thread::yield();
        return inside.load() >= 2;
    };
    auto first = std::async(std::launch::async, reader);
    auto second = std::async(std::launch::async, reader);
    EXPECT_TRUE(first.get());
    EXPECT_TRUE(second.get());
}

namespace {

// Threads that mix reads, nested reads, upgrades and writes, counting any moment at which a writer shares the
// lock with anyone.
void runMixedLoad(int threadCount, int iterations) {
    ReadWriteMutex mutex;
    std::atomic<int> readers{0}, writers{0}, violations{0};
    long long sharedValue = 0; // written only under the write lock
    auto write = [&] {
        ScopedWriteLock lock(mutex);
        if (++writers != 1 || readers.load() != 0) ++violations;
        ++sharedValue;
        --writers;
    };
    std::atomic<int> started{0};
    auto work = [&](int seed) {
        {
            ScopedReadLock lock(mutex); // every thread reads at once before the mix begins
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
    long long expected = 0;
    for (int t = 0; t < threadCount; ++t)
        for (int i = 0; i < iterations; ++i) expected += ((i + t) % 4 == 0 || (i + t) % 8 == 1) ? 1 : 0;
    EXPECT_EQ(sharedValue, expected);
}

} // namespace

TEST(ReadWriteMutexConcurrency, AWriterNeverOverlapsAnyoneElse) { runMixedLoad(4, 3000); }

// More threads than reader slots: the extra threads share the counted slot.
TEST(ReadWriteMutexConcurrency, AWriterNeverOverlapsAnyoneElseBeyondTheOwnedSlots) { runMixedLoad(72, 200); }

TEST(ReadWriteMutexConcurrency, ReentrantReadWriteAndUpgradeOnOneThread) {
    VelaMediaLib::testing::Deadline watchdog;
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
    // Everything was released: another thread can write at once.
    auto writer = std::async(std::launch::async, [&] {
        ScopedWriteLock lock(mutex);
        return true;
    });
    ASSERT_EQ(writer.wait_for(std::chrono::seconds(10)), std::future_status::ready);
}

TEST(ReadWriteMutexConcurrency, ADowngradedWriterStillExcludesWriters) {
    VelaMediaLib::testing::Deadline watchdog;
    ReadWriteMutex mutex;
    mutex.lockWrite();
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
    VelaMediaLib::testing::Deadline watchdog;
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

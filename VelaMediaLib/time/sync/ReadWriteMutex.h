#pragma once
// The project's reader-writer lock. Each thread owns a reader slot two cache
// lines wide (up to 64 threads at once; further threads share one counted
// slot), so readers on different cores never write the same line, nor a line
// the processor prefetches with it. A read lock is a plain store and load:
// on systems with a process-wide barrier (Linux, Windows) the writer, which
// raises one flag and waits for every slot to drain, makes the running
// readers fence for it, so that a read never stalls on a fence; a writer
// with no other thread about skips that too. While write locks follow each
// other closely (within a millisecond) readers fence themselves instead, with
// one exchange, until a reader finds writes quiet for 50 ms (it looks every
// 1,024 fenced entries); elsewhere they always do. Waiting spins with a
// back-off that doubles from 1 to 64 pauses and then stays there, yielding
// the processor at the ceiling so that a waiting thread does not starve the
// holder on a small machine.
//
// The lock is reentrant per thread: a thread that holds it (for reading or
// writing) may take it again for reading or writing. A reader that asks for
// the write lock gives up its read share while it waits and takes it back
// when the write lock ends, so two upgrading readers cannot deadlock; what it
// read before may have changed by then.

#include <VelaMediaLib/base/Export.h>

#include <boost/weak_ptr.hpp>
#include <atomic>
#include <chrono>
#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

class ThreadSafe;

class VELAMEDIALIB_API ReadWriteMutex {
public:
    /// Write locks taken less than `busyGap` apart make readers fence
    /// themselves for a while (see above); zero never does.
    explicit ReadWriteMutex(std::chrono::nanoseconds busyGap = std::chrono::milliseconds(1));
    ReadWriteMutex(const ReadWriteMutex&) = delete;
    ReadWriteMutex& operator=(const ReadWriteMutex&) = delete;

    void lockRead();
    void unlockRead();
    void lockWrite();
    void unlockWrite();
    /// Whether a writer holds the lock or waits for it (for diagnostics and tests).
    bool hasWriter() const { return writer_.load(std::memory_order_acquire); }
    /// Whether readers fence themselves now, rather than writers for them
    /// (for diagnostics and tests).
    bool readersFenceThemselves() const { return !asymmetric_ || fencedReaders_.load(); }
    /// Whether the calling thread holds the lock, for reading or writing.
    bool heldByThisThread() const;

    /// Guards that take the lock for their lifetime. The token forms lock the
    /// project's mutex while the project lives, and nothing once it has gone.
    class ScopedReadLock {
    public:
        explicit ScopedReadLock(ReadWriteMutex& mutex);
        explicit ScopedReadLock(const boost::weak_ptr<const ThreadSafe>& token);
        /// Locks the mutex unless it is null (an object of no project).
        explicit ScopedReadLock(ReadWriteMutex* mutex) : mutex_(mutex) {
            if (mutex_) mutex_->lockRead();
        }
        ~ScopedReadLock() {
            if (mutex_) mutex_->unlockRead();
        }
        ScopedReadLock(const ScopedReadLock&) = delete;
        ScopedReadLock& operator=(const ScopedReadLock&) = delete;

    private:
        boost::shared_ptr<const ThreadSafe> keepAlive_;
        ReadWriteMutex* mutex_;
    };

    class ScopedWriteLock {
    public:
        explicit ScopedWriteLock(ReadWriteMutex& mutex);
        explicit ScopedWriteLock(const boost::weak_ptr<const ThreadSafe>& token);
        ~ScopedWriteLock();
        ScopedWriteLock(const ScopedWriteLock&) = delete;
        ScopedWriteLock& operator=(const ScopedWriteLock&) = delete;

    private:
        boost::shared_ptr<const ThreadSafe> keepAlive_;
        ReadWriteMutex* mutex_;
    };

private:
    static const int kOwnedSlots = 64;
    struct alignas(128) Slot {
        std::atomic<int> readers{0};
        unsigned fencedEntries = 0; // the owning thread's, between looks at the clock
    };

    Slot& slot(int index) { return slots_[index]; }
    void lockReadShared();
    void unlockReadShared();
    int dropReadShareForWrite(int index);
    void restoreReadShareAfterWrite(int index);
    void acquireExclusive();
    void announceReader(Slot& own);
    void fenceForReaders();

    Slot slots_[kOwnedSlots + 1]; // the last slot is shared by the threads beyond 64
    alignas(128) std::atomic<bool> writer_{false};
    const bool asymmetric_; // writers can fence for readers
    const long long busyGapNs_;
    std::atomic<bool> fencedReaders_{false}; // readers fence themselves while writes are busy
    std::atomic<long long> lastWrite_{0};    // when the last write lock was taken, in ns
    std::atomic<const void*> writerOwner_{nullptr};
    int writeDepth_ = 0; // touched only by the writer
    int savedReads_ = 0; // the writer's own read share, given up while it writes
};

typedef ReadWriteMutex::ScopedReadLock ScopedReadLock;
typedef ReadWriteMutex::ScopedWriteLock ScopedWriteLock;

} // namespace VelaMediaLib

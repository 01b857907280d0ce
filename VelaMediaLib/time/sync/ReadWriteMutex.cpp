#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

#include <VelaMediaLib/time/sync/ThreadSafe.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/base/detail/Portable.h>
#include <VelaMediaLib/time/sync/detail/AsymmetricFence.h>

#include <chrono>
#include <thread>

namespace VelaMediaLib {
namespace {

const int kOwnedSlots = 64;
const int kSharedSlot = kOwnedSlots;

// Write locks taken closer together than the mutex's busy gap make readers
// fence themselves, so that a busy writer does not stop every running thread
// each time; once no write has come for the quiet time, a reader turns that
// off again, looking at the clock once every so many fenced entries.
const long long kQuietNs = 50000000;
const int kFencedEntriesPerLook = 1024;

long long nowNs() {
    return std::chrono::duration_cast<std::chrono::nanoseconds>(
               std::chrono::steady_clock::now().time_since_epoch())
        .count();
}

// Which reader slot this thread owns; indices go back to the pool when the
// thread ends. Threads beyond the pool use the shared slot.
std::atomic<unsigned long long> slotPool{0};
thread_local int slotOfThread VELA_TLS = -1;
thread_local char threadMarker VELA_TLS;

struct SlotReleaser {
    ~SlotReleaser() {
        if (slotOfThread >= 0 && slotOfThread < kOwnedSlots)
            slotPool.fetch_and(~(1ULL << slotOfThread), std::memory_order_release);
        slotOfThread = kSharedSlot; // a lock taken during thread teardown still works
    }
};

int claimSlot() {
    static thread_local SlotReleaser releaser;
    (void)releaser;
    unsigned long long used = slotPool.load(std::memory_order_relaxed);
    while (~used != 0) {
        const int index = detail::lowestSetBit(~used);
        if (slotPool.compare_exchange_weak(used, used | (1ULL << index), std::memory_order_seq_cst)) {
            // A writer that saw no other slot taken skipped its heavy fence;
            // this full fence makes sure such a writer's flag is seen here.
#if !VELA_THREAD_SANITIZER
            std::atomic_thread_fence(std::memory_order_seq_cst);
#endif
            return slotOfThread = index;
        }
    }
    return slotOfThread = kSharedSlot;
}

// Whether a thread other than this one may hold a read share: only threads
// with a slot (or beyond the pool) can.
bool otherThreadsMayRead(int ownSlot) {
    const unsigned long long own = ownSlot < kOwnedSlots ? 1ULL << ownSlot : 0;
    return (slotPool.load(std::memory_order_seq_cst) & ~own) != 0 || ownSlot == kSharedSlot;
}

inline int threadSlot() { return VELA_LIKELY(slotOfThread >= 0) ? slotOfThread : claimSlot(); }
inline const void* self() { return &threadMarker; }

// Read depths of the threads on the shared slot, which cannot keep them in it.
struct Held {
    const ReadWriteMutex* mutex;
    int reads;
    bool counted; // whether this thread's share is counted in the shared slot
};
const int kMaxHeld = 8;
thread_local Held heldEntries[kMaxHeld] VELA_TLS;
thread_local int heldCount VELA_TLS = 0;

Held* findHeld(const ReadWriteMutex* mutex) {
    for (int i = 0; i < heldCount; ++i)
        if (heldEntries[i].mutex == mutex) return &heldEntries[i];
    return nullptr;
}

Held* addHeld(const ReadWriteMutex* mutex) {
    if (heldCount == kMaxHeld) throw VelaMediaLibFatalException("too many project locks held by one thread");
    heldEntries[heldCount] = Held{mutex, 0, false};
    return &heldEntries[heldCount++];
}

void dropIfFree(Held* entry) {
    if (entry->reads == 0) *entry = heldEntries[--heldCount];
}

class Backoff {
public:
    void pause() {
        for (int i = 0; i < spins_; ++i) detail::cpuRelax();
        if (spins_ < 64)
            spins_ *= 2;
        else
            std::this_thread::yield();
    }

private:
    int spins_ = 1;
};

// A reader announces itself, then looks for a writer; if one is there it
// withdraws and waits for the flag to drop before trying again.
template <typename Enter, typename Withdraw>
void enterWhenNoWriter(const std::atomic<bool>& writer, Enter enter, Withdraw withdraw) {
    Backoff backoff;
    for (;;) {
        enter();
        if (!writer.load(std::memory_order_seq_cst)) return;
        withdraw();
        while (writer.load(std::memory_order_acquire)) backoff.pause();
    }
}

} // namespace

ReadWriteMutex::ReadWriteMutex(std::chrono::nanoseconds busyGap)
    : asymmetric_(detail::asymmetricFenceAvailable()), busyGapNs_(busyGap.count()) {}

// The mode is read after the store: a writer that turned fencing on fenced
// every running thread, so a reader that still saw it off had its store
// seen by then.
void ReadWriteMutex::announceReader(Slot& own) {
    std::atomic<int>& readers = own.readers;
    if (!asymmetric_) {
        readers.exchange(1, std::memory_order_seq_cst);
        return;
    }
    readers.store(1, std::memory_order_relaxed);
    detail::lightFence();
    if (!fencedReaders_.load(std::memory_order_seq_cst)) return;
    readers.exchange(1, std::memory_order_seq_cst);
    if (++own.fencedEntries % kFencedEntriesPerLook == 0 &&
        nowNs() - lastWrite_.load(std::memory_order_relaxed) > kQuietNs)
        fencedReaders_.store(false, std::memory_order_seq_cst);
}

void ReadWriteMutex::lockRead() {
    const int index = threadSlot();
    if (index == kSharedSlot) return lockReadShared();
    std::atomic<int>& readers = slot(index).readers;
    const int depth = readers.load(std::memory_order_relaxed);
    if (depth != 0 || writerOwner_.load(std::memory_order_relaxed) == self()) {
        readers.store(depth + 1, std::memory_order_relaxed); // nested, or reading what we write
        return;
    }
    enterWhenNoWriter(
        writer_, [&] { announceReader(slot(index)); }, [&] { readers.store(0, std::memory_order_release); });
}

// Readers that announce themselves without a fence must each pass one before
// the writer looks at their slots; when writes come thick and fast the
// writer has readers fence themselves instead. A writer with no other
// thread about has no reader to fence for, and leaves the mode alone.
void ReadWriteMutex::fenceForReaders() {
    if (!otherThreadsMayRead(threadSlot())) return;
    const long long now = nowNs();
    const bool busy = now - lastWrite_.load(std::memory_order_relaxed) < busyGapNs_;
    lastWrite_.store(now, std::memory_order_relaxed);
    if (fencedReaders_.load(std::memory_order_seq_cst)) return;
    if (busy) fencedReaders_.store(true, std::memory_order_seq_cst);
    detail::heavyFence();
}

void ReadWriteMutex::unlockRead() {
    const int index = threadSlot();
    if (index == kSharedSlot) return unlockReadShared();
    std::atomic<int>& readers = slot(index).readers;
    readers.store(readers.load(std::memory_order_relaxed) - 1, std::memory_order_release);
}

bool ReadWriteMutex::heldByThisThread() const {
    if (writerOwner_.load(std::memory_order_relaxed) == self()) return true;
    const int index = slotOfThread;
    if (index < 0) return false; // this thread has never locked anything
    if (index == kSharedSlot) return findHeld(this) != nullptr;
    return slots_[index].readers.load(std::memory_order_relaxed) != 0;
}

void ReadWriteMutex::lockReadShared() {
    if (Held* entry = findHeld(this)) {
        ++entry->reads;
        return;
    }
    Held* entry = addHeld(this); // may throw: take nothing before it
    entry->reads = 1;
    if (writerOwner_.load(std::memory_order_relaxed) == self()) return;
    std::atomic<int>& readers = slot(kSharedSlot).readers;
    enterWhenNoWriter(
        writer_, [&] { readers.fetch_add(1, std::memory_order_seq_cst); },
        [&] { readers.fetch_sub(1, std::memory_order_release); });
    entry->counted = true;
}

void ReadWriteMutex::unlockReadShared() {
    Held* entry = findHeld(this);
    if (!entry) return;
    if (--entry->reads == 0 && entry->counted)
        slot(kSharedSlot).readers.fetch_sub(1, std::memory_order_release);
    dropIfFree(entry);
}

void ReadWriteMutex::acquireExclusive() {
    Backoff backoff;
    bool expected = false;
    while (!writer_.compare_exchange_weak(expected, true, std::memory_order_seq_cst)) {
        expected = false;
        backoff.pause();
    }
    if (asymmetric_) fenceForReaders();
    for (Slot& each : slots_)
        while (each.readers.load(std::memory_order_seq_cst) != 0) backoff.pause();
}

// A reader asking for the write lock gives its share up while it waits, so
// that two upgrading readers cannot wait for each other.
// Returns the reads to take back afterwards (the shared-slot threads keep
// theirs in their own table).
int ReadWriteMutex::dropReadShareForWrite(int index) {
    if (index != kSharedSlot) return slot(index).readers.exchange(0, std::memory_order_release);
    Held* entry = findHeld(this);
    if (entry && entry->counted) {
        slot(kSharedSlot).readers.fetch_sub(1, std::memory_order_release);
        entry->counted = false;
    }
    return 0;
}

// Takes the reads this thread still holds back before the writer flag drops,
// so that a writer that also reads keeps reading without a gap.
void ReadWriteMutex::restoreReadShareAfterWrite(int index) {
    if (index != kSharedSlot) {
        std::atomic<int>& readers = slot(index).readers;
        readers.store(readers.load(std::memory_order_relaxed) + savedReads_, std::memory_order_relaxed);
        savedReads_ = 0;
        return;
    }
    Held* entry = findHeld(this);
    if (entry && entry->reads > 0 && !entry->counted) {
        slot(kSharedSlot).readers.fetch_add(1, std::memory_order_relaxed);
        entry->counted = true;
    }
}

void ReadWriteMutex::lockWrite() {
    if (writerOwner_.load(std::memory_order_relaxed) == self()) {
        ++writeDepth_;
        return;
    }
    const int saved = dropReadShareForWrite(threadSlot());
    acquireExclusive();
    savedReads_ = saved;
    writerOwner_.store(self(), std::memory_order_relaxed);
    writeDepth_ = 1;
}

void ReadWriteMutex::unlockWrite() {
    if (writerOwner_.load(std::memory_order_relaxed) != self()) return;
    if (--writeDepth_ > 0) return;
    restoreReadShareAfterWrite(threadSlot());
    writerOwner_.store(nullptr, std::memory_order_relaxed);
    writer_.store(false, std::memory_order_release);
}

ReadWriteMutex::ScopedReadLock::ScopedReadLock(ReadWriteMutex& mutex) : mutex_(&mutex) { mutex_->lockRead(); }

ReadWriteMutex::ScopedReadLock::ScopedReadLock(const boost::weak_ptr<const ThreadSafe>& token)
    : keepAlive_(token.lock()), mutex_(keepAlive_ ? &keepAlive_->mutex() : nullptr) {
    if (mutex_) mutex_->lockRead();
}

ReadWriteMutex::ScopedWriteLock::ScopedWriteLock(ReadWriteMutex& mutex) : mutex_(&mutex) {
    mutex_->lockWrite();
}

ReadWriteMutex::ScopedWriteLock::ScopedWriteLock(const boost::weak_ptr<const ThreadSafe>& token)
    : keepAlive_(token.lock()), mutex_(keepAlive_ ? &keepAlive_->mutex() : nullptr) {
    if (mutex_) mutex_->lockWrite();
}

ReadWriteMutex::ScopedWriteLock::~ScopedWriteLock() {
    if (mutex_) mutex_->unlockWrite();
}

} // namespace VelaMediaLib

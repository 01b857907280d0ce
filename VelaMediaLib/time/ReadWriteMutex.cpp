#include <VelaMediaLib/time/ReadWriteMutex.h>

#include <VelaMediaLib/time/ThreadSafe.h>
#include <VelaMediaLib/time/VelaMediaLibException.h>

#include <thread>

namespace VelaMediaLib {
namespace {

// What this thread holds of which mutex. A thread rarely holds more than one
// project's lock at a time; the table is small and searched linearly.
struct Held {
    const ReadWriteMutex* mutex;
    int reads;
    int writes;
    bool shared; // whether a reader slot is counted for this thread
};
const int kMaxHeld = 8;
struct HeldTable {
    Held entries[kMaxHeld];
    int count;
};
thread_local HeldTable held __attribute__((tls_model("initial-exec")));
thread_local int slotOfThread __attribute__((tls_model("initial-exec"))) = -1;
std::atomic<int> nextSlot{0};

Held* findHeld(const ReadWriteMutex* mutex) {
    for (int i = 0; i < held.count; ++i)
        if (held.entries[i].mutex == mutex) return &held.entries[i];
    return nullptr;
}

Held* addHeld(const ReadWriteMutex* mutex) {
    if (held.count == kMaxHeld)
        throw VelaMediaLibFatalException("too many project locks held by one thread");
    held.entries[held.count] = Held{mutex, 0, 0, false};
    return &held.entries[held.count++];
}

void dropIfFree(Held* entry) {
    if (entry->reads != 0 || entry->writes != 0) return;
    *entry = held.entries[--held.count];
}

class Backoff {
public:
    void pause() {
        for (int i = 0; i < spins_; ++i) __builtin_ia32_pause();
        if (spins_ < 64) spins_ *= 2;
        else std::this_thread::yield();
    }

private:
    int spins_ = 1;
};

} // namespace

ReadWriteMutex::ReadWriteMutex() = default;

ReadWriteMutex::Slot& ReadWriteMutex::mySlot() {
    if (slotOfThread < 0) slotOfThread = nextSlot.fetch_add(1, std::memory_order_relaxed) % kSlots;
    return slots_[slotOfThread];
}

void ReadWriteMutex::acquireShared() {
    Slot& slot = mySlot();
    Backoff backoff;
    for (;;) {
        slot.readers.fetch_add(1, std::memory_order_seq_cst);
        if (!writer_.load(std::memory_order_seq_cst)) return;
        slot.readers.fetch_sub(1, std::memory_order_release);
        while (writer_.load(std::memory_order_acquire)) backoff.pause();
    }
}

void ReadWriteMutex::releaseShared() { mySlot().readers.fetch_sub(1, std::memory_order_release); }

void ReadWriteMutex::acquireExclusive() {
    Backoff backoff;
    bool expected = false;
    while (!writer_.compare_exchange_weak(expected, true, std::memory_order_seq_cst)) {
        expected = false;
        backoff.pause();
    }
    for (Slot& slot : slots_)
        while (slot.readers.load(std::memory_order_seq_cst) != 0) backoff.pause();
}

void ReadWriteMutex::releaseExclusive() { writer_.store(false, std::memory_order_release); }

void ReadWriteMutex::lockRead() {
    if (Held* entry = findHeld(this)) {
        ++entry->reads;
        return;
    }
    Held* entry = addHeld(this); // may throw: take nothing before it
    acquireShared();
    entry->reads = 1;
    entry->shared = true;
}

void ReadWriteMutex::unlockRead() {
    Held* entry = findHeld(this);
    if (!entry || entry->reads == 0) return;
    if (--entry->reads == 0 && entry->writes == 0 && entry->shared) releaseShared();
    dropIfFree(entry);
}

void ReadWriteMutex::lockWrite() {
    Held* entry = findHeld(this);
    if (entry && entry->writes > 0) {
        ++entry->writes;
        return;
    }
    if (!entry) entry = addHeld(this);
    if (entry->shared) {
        releaseShared(); // upgrade: give the read share up while waiting
        entry->shared = false;
    }
    acquireExclusive();
    entry->writes = 1;
}

void ReadWriteMutex::unlockWrite() {
    Held* entry = findHeld(this);
    if (!entry || entry->writes == 0) return;
    if (--entry->writes > 0) return;
    if (entry->reads > 0) {
        mySlot().readers.fetch_add(1, std::memory_order_seq_cst); // downgrade without a gap
        entry->shared = true;
    }
    releaseExclusive();
    dropIfFree(entry);
}

ReadWriteMutex::ScopedReadLock::ScopedReadLock(ReadWriteMutex& mutex) : mutex_(&mutex) {
    mutex_->lockRead();
}

ReadWriteMutex::ScopedReadLock::ScopedReadLock(const boost::weak_ptr<const ThreadSafe>& token)
    : keepAlive_(token.lock()), mutex_(keepAlive_ ? &keepAlive_->mutex() : nullptr) {
    if (mutex_) mutex_->lockRead();
}

ReadWriteMutex::ScopedReadLock::~ScopedReadLock() {
    if (mutex_) mutex_->unlockRead();
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

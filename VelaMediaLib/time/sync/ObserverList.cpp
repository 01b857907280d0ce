#include <VelaMediaLib/time/sync/ObserverList.h>

#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

#include <algorithm>
#include <condition_variable>
#include <cstdint>
#include <mutex>

namespace VelaMediaLib {
namespace {

// The lists' mutexes: a process-wide table, so that the many subjects
// (keyframes, attributes, parameters) carry none of their own. Each has a
// condition on which detaching threads wait for running calls to end.
struct alignas(64) ListMutex {
    std::mutex mutex;
    std::condition_variable callEnded;
};
const std::uintptr_t kListMutexes = 64;
ListMutex listMutexes[kListMutexes];

ListMutex& listMutex(const void* lists) {
    const std::uintptr_t address = reinterpret_cast<std::uintptr_t>(lists);
    return listMutexes[((address >> 4) * 0x9E3779B97F4A7C15ull >> 58) % kListMutexes];
}

void removeFrom(std::vector<void*>& list, void* observer) {
    list.erase(std::remove(list.begin(), list.end(), observer), list.end());
}

// How many observer calls this thread is inside (nested notifications count).
thread_local int callsOnThisThread = 0;

} // namespace

// Shared by the subject and the walks over it: freed by whichever lets go
// last, so a walk whose subject an observer destroyed touches nothing freed.
// Counted under the subject's list mutex.
struct ObserverList::Lists {
    std::vector<void*> of[2];
    std::vector<std::pair<void*, std::thread::id>> calling; // calls running now
    ListMutex* guard; // the subject's mutex, kept for walks that outlive it
    int holders = 1;
    bool gone = false; // the subject was destroyed
};

ObserverList::~ObserverList() {
    Lists* lists = lists_.load(std::memory_order_acquire);
    if (!lists) return;
    bool last = false;
    {
        std::lock_guard<std::mutex> lock(lists->guard->mutex);
        lists->gone = true;
        lists->of[Ordinary].clear();
        lists->of[WithoutDelay].clear();
        last = --lists->holders == 0;
    }
    if (last) delete lists;
}

ObserverList::Walk::Walk(const ObserverList& list) {
    std::lock_guard<std::mutex> lock(listMutex(&list).mutex);
    lists_ = list.lists_.load(std::memory_order_relaxed);
    if (lists_) ++lists_->holders;
}

ObserverList::Walk::~Walk() {
    if (!lists_) return;
    bool last = false;
    {
        std::lock_guard<std::mutex> lock(lists_->guard->mutex);
        last = --lists_->holders == 0;
    }
    if (last) delete lists_;
}

bool ObserverList::contains(const std::vector<void*>& list, void* observer) {
    return std::find(list.begin(), list.end(), observer) != list.end();
}

void ObserverList::add(Kind kind, void* observer) {
    std::lock_guard<std::mutex> lock(listMutex(this).mutex);
    Lists* lists = lists_.load(std::memory_order_relaxed);
    if (!lists) {
        lists = new Lists;
        lists->guard = &listMutex(this);
        lists_.store(lists, std::memory_order_release);
    }
    removeFrom(lists->of[kind == Ordinary ? WithoutDelay : Ordinary], observer);
    if (!contains(lists->of[kind], observer)) lists->of[kind].push_back(observer);
}

void ObserverList::remove(void* observer, const ReadWriteMutex* projectLock) {
    ListMutex& guard = listMutex(this);
    std::unique_lock<std::mutex> lock(guard.mutex);
    Lists* lists = lists_.load(std::memory_order_relaxed);
    if (!lists) return;
    removeFrom(lists->of[Ordinary], observer);
    removeFrom(lists->of[WithoutDelay], observer);
    if (callsOnThisThread > 0 || (projectLock && projectLock->heldByThisThread())) return;
    const std::thread::id me = std::this_thread::get_id();
    guard.callEnded.wait(lock, [&] {
        return std::none_of(lists->calling.begin(), lists->calling.end(),
                            [&](const std::pair<void*, std::thread::id>& call) {
                                return call.first == observer && call.second != me;
                            });
    });
}

std::vector<void*> ObserverList::snapshot(Kind kind) const {
    std::lock_guard<std::mutex> lock(listMutex(this).mutex);
    Lists* lists = lists_.load(std::memory_order_relaxed);
    return lists ? lists->of[kind] : std::vector<void*>();
}

bool ObserverList::Walk::beginCall(Kind kind, void* observer) const {
    if (!lists_) return false;
    std::lock_guard<std::mutex> lock(lists_->guard->mutex);
    if (!contains(lists_->of[kind], observer)) return false;
    lists_->calling.emplace_back(observer, std::this_thread::get_id());
    ++callsOnThisThread;
    return true;
}

bool ObserverList::Walk::endCall(void* observer) const {
    --callsOnThisThread;
    bool gone = false;
    {
        std::lock_guard<std::mutex> lock(lists_->guard->mutex);
        std::vector<std::pair<void*, std::thread::id>>& calling = lists_->calling;
        const auto call =
            std::find(calling.begin(), calling.end(), std::make_pair(observer, std::this_thread::get_id()));
        if (call != calling.end()) calling.erase(call);
        gone = lists_->gone;
    }
    lists_->guard->callEnded.notify_all();
    return !gone;
}

} // namespace VelaMediaLib

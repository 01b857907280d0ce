#include <VelaMediaLib/time/sync/ObserverList.h>

#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

#include <algorithm>
#include <condition_variable>
#include <cstdint>
#include <map>
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

// Which calls each detaching thread waits for: a detach whose wait would
// close a cycle of threads waiting for each other (observers detaching each
// other) does not wait for that call. An entry leaves when its call ends, so
// no finished call counts. Taken after a list mutex, never before one.
struct AwaitedCall {
    std::thread::id thread;
    const void* lists; // the subject's lists the call walks
    const void* observer;
};
std::mutex waitsMutex;
std::map<std::thread::id, std::vector<AwaitedCall>> waitsFor;
std::atomic<int> waitingThreads{0};

// Whether `from` waits, directly or through other waiting threads, for
// `target`. The table holds no cycle (none is ever registered), so the walk
// ends; each thread is visited once.
bool waitsOn(std::thread::id from, std::thread::id target) {
    std::vector<std::thread::id> pending{from}, seen;
    while (!pending.empty()) {
        const std::thread::id next = pending.back();
        pending.pop_back();
        if (next == target) return true;
        if (std::find(seen.begin(), seen.end(), next) != seen.end()) continue;
        seen.push_back(next);
        const auto found = waitsFor.find(next);
        if (found != waitsFor.end())
            for (const AwaitedCall& call : found->second) pending.push_back(call.thread);
    }
    return false;
}

// Of the calls, the threads this thread may wait for (those not waiting,
// directly or not, for it), registered as awaited.
std::vector<std::thread::id> registerWait(const std::vector<AwaitedCall>& calls) {
    const std::thread::id me = std::this_thread::get_id();
    std::vector<AwaitedCall> kept;
    std::vector<std::thread::id> threads;
    std::lock_guard<std::mutex> lock(waitsMutex);
    for (const AwaitedCall& call : calls)
        if (!waitsOn(call.thread, me)) {
            kept.push_back(call);
            threads.push_back(call.thread);
        }
    if (!kept.empty()) {
        waitsFor[me] = kept;
        ++waitingThreads;
    }
    return threads;
}

void endWait() {
    std::lock_guard<std::mutex> lock(waitsMutex);
    if (waitsFor.erase(std::this_thread::get_id())) --waitingThreads;
}

// The call has ended: no one waits for it any longer.
void forgetAwaitedCall(const void* lists, const void* observer) {
    if (waitingThreads.load() == 0) return;
    const std::thread::id me = std::this_thread::get_id();
    std::lock_guard<std::mutex> lock(waitsMutex);
    for (auto& waiter : waitsFor) {
        std::vector<AwaitedCall>& calls = waiter.second;
        const auto call = std::find_if(calls.begin(), calls.end(), [&](const AwaitedCall& each) {
            return each.thread == me && each.lists == lists && each.observer == observer;
        });
        if (call != calls.end()) calls.erase(call);
    }
}

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
    const std::thread::id me = std::this_thread::get_id();
    std::vector<AwaitedCall> calls; // collected first: nothing below the removal allocates
    if (!(projectLock && projectLock->heldByThisThread()))
        for (const auto& call : lists->calling)
            if (call.first == observer && call.second != me)
                calls.push_back(AwaitedCall{call.second, lists, observer});
    const std::vector<std::thread::id> awaited =
        calls.empty() ? std::vector<std::thread::id>() : registerWait(calls);
    removeFrom(lists->of[Ordinary], observer);
    removeFrom(lists->of[WithoutDelay], observer);
    if (awaited.empty()) return; // nothing runs it elsewhere, or every caller waits for this thread
    ++lists->holders;            // the subject may be destroyed meanwhile
    guard.callEnded.wait(lock, [&] {
        return std::none_of(lists->calling.begin(), lists->calling.end(),
                            [&](const std::pair<void*, std::thread::id>& call) {
                                return call.first == observer && std::find(awaited.begin(), awaited.end(),
                                                                           call.second) != awaited.end();
                            });
    });
    const bool last = --lists->holders == 0;
    lock.unlock();
    endWait();
    if (last) delete lists;
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
    return true;
}

void ObserverList::Walk::endCall(void* observer) const {
    {
        std::lock_guard<std::mutex> lock(lists_->guard->mutex);
        std::vector<std::pair<void*, std::thread::id>>& calling = lists_->calling;
        const auto call =
            std::find(calling.begin(), calling.end(), std::make_pair(observer, std::this_thread::get_id()));
        if (call != calling.end()) calling.erase(call);
        gone_ = lists_->gone;
    }
    lists_->guard->callEnded.notify_all();
    forgetAwaitedCall(lists_, observer);
}

} // namespace VelaMediaLib

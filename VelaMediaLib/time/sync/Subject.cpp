#include <VelaMediaLib/time/sync/Subject.h>

#include <VelaMediaLib/time/sync/NotifyDelay.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <algorithm>
#include <cstdint>
#include <mutex>

namespace VelaMediaLib {
namespace {

// The observer lists' mutexes: a process-wide table, so that the many
// subjects (keyframes, attributes, parameters) carry none of their own. The
// mutexes are constant-initialised and never torn down early.
struct alignas(64) ListMutex {
    std::mutex mutex;
};
const std::uintptr_t kListMutexes = 64;
ListMutex listMutexes[kListMutexes];

std::mutex& listMutex(const Subject* subject) {
    const std::uintptr_t address = reinterpret_cast<std::uintptr_t>(subject);
    return listMutexes[((address >> 4) * 0x9E3779B97F4A7C15ull >> 58) % kListMutexes].mutex;
}

void removeFrom(std::vector<Observer*>& list, Observer* observer) {
    list.erase(std::remove(list.begin(), list.end(), observer), list.end());
}

void addTo(std::vector<Observer*>& list, Observer* observer) {
    if (std::find(list.begin(), list.end(), observer) == list.end()) list.push_back(observer);
}

bool contains(const std::vector<Observer*>& list, Observer* observer) {
    return std::find(list.begin(), list.end(), observer) != list.end();
}

} // namespace

Subject::Subject(const boost::weak_ptr<const ThreadSafe>& token) : token_(token) {}

// A subject whose project has gone has nothing to leave: the held-back
// subjects went with the project.
Subject::~Subject() {
    if (parked_.load())
        if (const boost::shared_ptr<const ThreadSafe> project = token_.lock())
            NotifyDelay::removeSubject(this, project);
    delete lists_.load(std::memory_order_acquire);
}

// A notification held back by the old project moves with the subject: it is
// held back by the new one's delay, or told now.
void Subject::setProjectMutex(const boost::weak_ptr<const ThreadSafe>& token) {
    const bool wasParked = parked_.load();
    if (wasParked)
        if (const boost::shared_ptr<const ThreadSafe> old = token_.lock())
            NotifyDelay::removeSubject(this, old);
    parked_.store(false);
    token_ = token;
    if (wasParked) notify();
}

void Subject::add(ListKind kind, Observer* observer) {
    std::lock_guard<std::mutex> lock(listMutex(this));
    Lists* lists = lists_.load(std::memory_order_relaxed);
    if (!lists) {
        lists = new Lists;
        lists_.store(lists, std::memory_order_release);
    }
    removeFrom(lists->of(kind == Ordinary ? WithoutDelay : Ordinary), observer);
    addTo(lists->of(kind), observer);
}

void Subject::attach(Observer* observer) { add(Ordinary, observer); }

void Subject::attachWithoutNotifyDelay(Observer* observer) { add(WithoutDelay, observer); }

void Subject::detach(Observer* observer) {
    std::lock_guard<std::mutex> lock(listMutex(this));
    Lists* lists = lists_.load(std::memory_order_relaxed);
    if (!lists) return;
    removeFrom(lists->ordinary, observer);
    removeFrom(lists->withoutDelay, observer);
}

std::vector<Observer*> Subject::snapshot(ListKind kind) const {
    std::lock_guard<std::mutex> lock(listMutex(this));
    Lists* lists = lists_.load(std::memory_order_relaxed);
    return lists ? lists->of(kind) : std::vector<Observer*>();
}

bool Subject::stillIn(ListKind kind, Observer* observer) const {
    std::lock_guard<std::mutex> lock(listMutex(this));
    Lists* lists = lists_.load(std::memory_order_relaxed);
    return lists && contains(lists->of(kind), observer);
}

// Skips observers detached meanwhile and observers already told in this
// notification. Once an observer has destroyed the subject, nothing of it is
// touched any more.
bool Subject::tell(ListKind kind, const std::vector<Observer*>& observers, std::vector<Observer*>& told,
                   const StillHere* stillHere) {
    for (Observer* observer : observers) {
        if (contains(told, observer) || !stillIn(kind, observer)) continue;
        told.push_back(observer);
        try {
            observer->update(owner());
        } catch (...) {
            // The change has happened: an observer's failure is its own, and
            // must neither undo the edit's success nor silence the others.
        }
        if (stillHere && !(*stillHere)()) return false;
    }
    return true;
}

void Subject::notify() {
    ScopedReadLock lock(token_);
    if (!notifiesEnabled() || !lists_.load(std::memory_order_acquire)) return;
    std::vector<Observer*> told;
    tell(WithoutDelay, snapshot(WithoutDelay), told, nullptr);
    const std::vector<Observer*> ordinary = snapshot(Ordinary);
    if (ordinary.empty()) return;
    const boost::shared_ptr<const ThreadSafe> token = token_.lock();
    if (token && NotifyDelay::addSubject(this, token)) return;
    tell(Ordinary, ordinary, told, nullptr);
}

bool Subject::tellHeldBackObservers(const StillHere& stillHere) {
    ScopedReadLock lock(token_);
    if (!notifiesEnabled() || !lists_.load(std::memory_order_acquire)) return true;
    std::vector<Observer*> told;
    return tell(Ordinary, snapshot(Ordinary), told, &stillHere);
}

boost::weak_ptr<const void> Subject::lifeline() const {
    return owner_ && owner_ != this ? owner_->lifeline() : Observable::lifeline();
}

Subject::NotifyDisabler::NotifyDisabler(Subject& subject) : subject_(subject) { ++subject_.disableCount_; }

Subject::NotifyDisabler::~NotifyDisabler() { --subject_.disableCount_; }

} // namespace VelaMediaLib

#include <VelaMediaLib/time/Subject.h>

#include <VelaMediaLib/time/NotifyDelay.h>
#include <VelaMediaLib/time/ThreadSafe.h>

#include <algorithm>

namespace VelaMediaLib {
namespace {

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

Subject::~Subject() { NotifyDelay::removeSubject(this); }

Subject::Lists& Subject::lists() {
    if (!lists_) lists_.reset(new Lists);
    return *lists_;
}

void Subject::attach(Observer* observer) {
    auto guard = lockLists();
    removeFrom(lists().withoutDelay, observer);
    addTo(lists().ordinary, observer);
}

void Subject::attachWithoutNotifyDelay(Observer* observer) {
    auto guard = lockLists();
    removeFrom(lists().ordinary, observer);
    addTo(lists().withoutDelay, observer);
}

void Subject::detach(Observer* observer) {
    auto guard = lockLists();
    if (!lists_) return;
    removeFrom(lists_->ordinary, observer);
    removeFrom(lists_->withoutDelay, observer);
}

// Walks a snapshot, skipping observers detached meanwhile and observers
// already told in this notification.
void Subject::tell(const std::vector<Observer*>& list, std::vector<Observer*>& told) {
    const std::vector<Observer*> snapshot = list;
    for (Observer* observer : snapshot) {
        if (!contains(list, observer) || contains(told, observer)) continue;
        told.push_back(observer);
        observer->update(owner());
    }
}

void Subject::notify() {
    ScopedReadLock lock(token_);
    if (!notifiesEnabled()) return;
    auto guard = lockLists();
    if (!lists_) return;
    std::vector<Observer*> told;
    if (!lists_->withoutDelay.empty()) tell(lists_->withoutDelay, told);
    if (lists_->ordinary.empty()) return;
    const boost::shared_ptr<const ThreadSafe> token = token_.lock();
    if (token && NotifyDelay::isActive(token)) {
        NotifyDelay::addSubject(this, token);
        return;
    }
    tell(lists_->ordinary, told);
}

void Subject::tellOrdinaryObservers() {
    ScopedReadLock lock(token_);
    if (!notifiesEnabled()) return;
    auto guard = lockLists();
    if (!lists_) return;
    std::vector<Observer*> told;
    tell(lists_->ordinary, told);
}

Subject::NotifyDisabler::NotifyDisabler(Subject& subject) : subject_(subject) { ++subject_.disableCount_; }

Subject::NotifyDisabler::~NotifyDisabler() { --subject_.disableCount_; }

} // namespace VelaMediaLib

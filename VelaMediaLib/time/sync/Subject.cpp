#include <VelaMediaLib/time/sync/Subject.h>

#include <VelaMediaLib/time/sync/NotifyDelay.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

namespace VelaMediaLib {

// A subject whose project has gone has nothing to leave: the held-back
// subjects went with the project.
bool SubjectBase::leaveDelay(const boost::weak_ptr<const ThreadSafe>& token) {
    const bool wasParked = parked_.load();
    if (wasParked)
        if (const boost::shared_ptr<const ThreadSafe> project = token.lock())
            NotifyDelay::removeSubject(this, project);
    parked_.store(false);
    return wasParked;
}

void SubjectBase::attach(Observer* observer) { observers_.add(ObserverList::Ordinary, observer); }

void SubjectBase::attachWithoutNotifyDelay(Observer* observer) {
    observers_.add(ObserverList::WithoutDelay, observer);
}

void SubjectBase::detach(Observer* observer) {
    const boost::shared_ptr<const ThreadSafe> project = subjectToken().lock();
    observers_.remove(observer, project ? &project->mutex() : nullptr);
}

bool SubjectBase::tell(ObserverList::Kind kind, std::vector<void*>& told, const StillHere* stillHere) {
    Observable* const changed = owner();
    return observers_.tell(
        kind, observers_.snapshot(kind), told,
        [changed](void* observer) { static_cast<Observer*>(observer)->update(changed); }, stillHere);
}

void SubjectBase::notify() {
    const boost::weak_ptr<const ThreadSafe>& token = subjectToken();
    ScopedReadLock lock(token);
    if (!notifiesEnabled() || observers_.empty()) return;
    std::vector<void*> told;
    if (!tell(ObserverList::WithoutDelay, told, nullptr)) return; // an observer destroyed the subject
    if (observers_.snapshot(ObserverList::Ordinary).empty()) return;
    const boost::shared_ptr<const ThreadSafe> project = token.lock();
    if (project && NotifyDelay::addSubject(this, project)) return;
    tell(ObserverList::Ordinary, told, nullptr);
}

bool SubjectBase::tellHeldBackObservers(const StillHere& stillHere) {
    ScopedReadLock lock(subjectToken());
    if (!notifiesEnabled() || observers_.empty()) return true;
    std::vector<void*> told;
    return tell(ObserverList::Ordinary, told, &stillHere);
}

boost::weak_ptr<const void> SubjectBase::lifeline() const {
    return owner_ && owner_ != this ? owner_->lifeline() : Observable::lifeline();
}

SubjectBase::NotifyDisabler::NotifyDisabler(SubjectBase& subject) : subject_(subject) {
    ++subject_.disableCount_;
}

SubjectBase::NotifyDisabler::~NotifyDisabler() { --subject_.disableCount_; }

Subject::Subject(const boost::weak_ptr<const ThreadSafe>& token)
    : token_(token), lock_(ProjectToken::lockOf(token)) {}

Subject::~Subject() { leaveDelay(token_); }

// A notification held back by the old project moves with the subject: it is
// held back by the new one's delay, or told now.
void Subject::setProjectMutex(const boost::weak_ptr<const ThreadSafe>& token) {
    const bool wasParked = leaveDelay(token_);
    token_ = token;
    lock_ = ProjectToken::lockOf(token);
    if (wasParked) notify();
}

ObjectSubject::~ObjectSubject() { leaveDelay(projectMutex()); }

PartSubject::~PartSubject() { leaveDelay(object_.projectMutex()); }

} // namespace VelaMediaLib

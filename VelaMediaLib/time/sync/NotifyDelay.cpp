#include <VelaMediaLib/time/sync/NotifyDelay.h>

#include <VelaMediaLib/time/sync/Subject.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <algorithm>

namespace VelaMediaLib {

NotifyDelayState& NotifyDelay::stateOf(const ThreadSafe& project) { return project.notifyDelayState_; }

NotifyDelay::NotifyDelay(const boost::shared_ptr<const ThreadSafe>& token) : token_(token) {
    if (!token_) return;
    NotifyDelayState& s = stateOf(*token_);
    std::lock_guard<std::mutex> lock(s.mutex_);
    if (s.count_ < 0) throw VelaMediaLibException("nested delays not supported");
    ++s.count_;
}

NotifyDelay::~NotifyDelay() {
    if (!token_) return;
    {
        NotifyDelayState& s = stateOf(*token_);
        std::lock_guard<std::mutex> lock(s.mutex_);
        if (--s.count_ > 0) return;
        s.count_ = -1;
        s.deliverer_ = std::this_thread::get_id();
    }
    while (deliverNext()) {}
}

// Takes the waiting subjects one at a time, so that a subject destroyed by an
// observer during delivery is simply no longer there. The project's read lock
// is held from taking a subject to the end of its delivery, so a subject
// released under the write lock is never caught in between. The lifeline is
// locked under the state's mutex, where a destructor removing its subject
// would wait; it is let go after the read lock, since the owner may end then.
bool NotifyDelay::deliverNext() {
    NotifyDelayState& s = stateOf(*token_);
    boost::shared_ptr<const void> keep;
    ScopedReadLock read(token_->mutex());
    SubjectBase* next = nullptr;
    {
        std::lock_guard<std::mutex> lock(s.mutex_);
        if (s.waiting_.empty()) {
            s.count_ = 0;
            return false;
        }
        const NotifyDelayState::Waiting waiting = s.waiting_.front();
        s.waiting_.pop_front();
        if (waiting.kept && !(keep = waiting.lifeline.lock())) return true; // its owner is being destroyed
        next = waiting.subject;
        s.delivering_ = next;
    }
    bool stillHere = true;
    try {
        stillHere = next->tellHeldBackObservers([&] {
            std::lock_guard<std::mutex> lock(s.mutex_);
            return s.delivering_ == next;
        });
    } catch (...) {
        // Nothing to report to: the edit has finished (observers' own failures are dropped inside).
    }
    {
        std::lock_guard<std::mutex> lock(s.mutex_);
        if (stillHere && s.delivering_ == next) next->parked_ = false; // else an observer destroyed it
        s.delivering_ = nullptr;
    }
    s.delivered_.notify_all();
    return true;
}

bool NotifyDelay::isActive(const boost::shared_ptr<const ThreadSafe>& token) {
    if (!token) return false;
    NotifyDelayState& s = stateOf(*token);
    std::lock_guard<std::mutex> lock(s.mutex_);
    return s.count_ > 0;
}

bool NotifyDelay::isNotifying(const boost::shared_ptr<const ThreadSafe>& token) {
    if (!token) return false;
    NotifyDelayState& s = stateOf(*token);
    std::lock_guard<std::mutex> lock(s.mutex_);
    return s.count_ < 0;
}

bool NotifyDelay::addSubject(SubjectBase* subject, const boost::shared_ptr<const ThreadSafe>& token) {
    if (!subject || !token) return false;
    NotifyDelayState& s = stateOf(*token);
    std::lock_guard<std::mutex> lock(s.mutex_);
    if (s.count_ <= 0) return false;
    if (!subject->parked_.load(std::memory_order_relaxed)) {
        boost::weak_ptr<const void> lifeline = subject->lifeline();
        const bool kept = !lifeline.expired();
        s.waiting_.push_back({subject, std::move(lifeline), kept});
        subject->parked_.store(true, std::memory_order_relaxed);
    }
    return true;
}

void NotifyDelay::removeSubject(SubjectBase* subject, const boost::shared_ptr<const ThreadSafe>& token) {
    if (!subject || !token) return;
    NotifyDelayState& s = stateOf(*token);
    std::unique_lock<std::mutex> lock(s.mutex_);
    if (s.delivering_ == subject) {
        if (s.deliverer_ == std::this_thread::get_id())
            s.delivering_ = nullptr; // one of its own observers is destroying it
        else
            s.delivered_.wait(lock, [&] { return s.delivering_ != subject; });
    }
    s.waiting_.erase(std::remove_if(s.waiting_.begin(), s.waiting_.end(),
                                    [&](const NotifyDelayState::Waiting& w) { return w.subject == subject; }),
                     s.waiting_.end());
    subject->parked_.store(false, std::memory_order_relaxed);
}

// Every subject still waiting is alive here: a subject destroyed while its
// project lives removes itself under the same mutex first.
void NotifyDelay::removeMappingForThreadSafe(const ThreadSafe* token) {
    if (!token) return;
    NotifyDelayState& s = stateOf(*token);
    std::lock_guard<std::mutex> lock(s.mutex_);
    for (const NotifyDelayState::Waiting& waiting : s.waiting_)
        waiting.subject->parked_.store(false, std::memory_order_relaxed);
    s.waiting_.clear();
}

} // namespace VelaMediaLib

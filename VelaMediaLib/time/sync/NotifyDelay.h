#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/shared_ptr.hpp>
#include <boost/weak_ptr.hpp>
#include <condition_variable>
#include <deque>
#include <mutex>
#include <thread>

namespace VelaMediaLib {

class SubjectBase;
class ThreadSafe;

/// The delay state of one project, held by the project itself (its
/// ThreadSafe): the number of live delays (or -1 while the held-back
/// notifications are being delivered), the subjects waiting, in the order in
/// which they first changed (each with its lifeline), and the subject being
/// delivered. Its small mutex is taken only for the state's own reads and
/// writes, never while observers run.
class NotifyDelayState {
public:
    NotifyDelayState() = default;
    NotifyDelayState(const NotifyDelayState&) = delete;
    NotifyDelayState& operator=(const NotifyDelayState&) = delete;

private:
    friend class NotifyDelay;

    struct Waiting {
        SubjectBase* subject;
        boost::weak_ptr<const void> lifeline;
        bool kept; // whether the lifeline held the subject when it was parked
    };

    std::mutex mutex_;
    std::condition_variable delivered_;
    int count_ = 0; // > 0: live delays; 0: idle; -1: delivering
    std::deque<Waiting> waiting_;
    SubjectBase* delivering_ = nullptr;
    std::thread::id deliverer_;
};

/// Holds back the ordinary notifications of one project while it lives; when
/// the last delay of that project ends, each held-back subject is told once,
/// in the order in which it first changed. An observer that throws during
/// that delivery is skipped and its exception dropped: the edit it heard of
/// has already finished, and the other observers must still hear of it.
///
/// A subject is delivered holding its lifeline (Observable::lifeline), so the
/// object it belongs to lives until its observers have heard; a subject whose
/// lifeline has expired by then is being destroyed and is skipped. The last
/// reference may then be let go by the delivering thread, after the read lock.
class VELAMEDIALIB_API NotifyDelay {
public:
    /// Throws VelaMediaLibException "nested delays not supported" when opened
    /// by an observer while the project's held-back notifications are delivered.
    explicit NotifyDelay(const boost::shared_ptr<const ThreadSafe>& token);
    ~NotifyDelay();
    NotifyDelay(const NotifyDelay&) = delete;
    NotifyDelay& operator=(const NotifyDelay&) = delete;

    static bool isActive(const boost::shared_ptr<const ThreadSafe>& token);
    static bool isNotifying(const boost::shared_ptr<const ThreadSafe>& token);
    /// Holds the subject back if a delay of the project is active, checking
    /// and parking in one step; returns whether it did. A subject is held
    /// back once however often it changes.
    static bool addSubject(SubjectBase* subject, const boost::shared_ptr<const ThreadSafe>& token);
    /// Forgets a held-back subject (one that is destroyed). A subject without
    /// a lifeline that another thread is delivering at that moment waits
    /// until that delivery has ended (one with a lifeline cannot be destroyed
    /// then).
    static void removeSubject(SubjectBase* subject, const boost::shared_ptr<const ThreadSafe>& token);
    /// Forgets every subject the project holds back (they will not be told).
    static void removeMappingForThreadSafe(const ThreadSafe* token);

private:
    static NotifyDelayState& stateOf(const ThreadSafe& project);
    bool deliverNext();

    boost::shared_ptr<const ThreadSafe> token_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>

#include <atomic>
#include <functional>
#include <thread>
#include <utility>
#include <vector>

namespace VelaMediaLib {

class ReadWriteMutex;

/// The observer lists of one subject (a Subject's two, an add-observer list's
/// one) and the one policy every list of the library follows:
///
/// - List changes, and the copies walks take, hold a small mutex from a
///   process-wide table chosen by the lists' address, so a subject carries no
///   mutex of its own and attach and detach are safe on any thread.
/// - Observers are never called under that mutex. A walk tells a snapshot,
///   skips observers detached meanwhile and tells each observer once; what an
///   observer throws is dropped (the change has happened), the others still
///   hear.
/// - Detach returns only once the observer's calls on other threads have
///   ended, except on a thread that holds the project's lock (a running
///   observer may be waiting for that lock; under the write lock none runs,
///   as observers run under the read lock), and where waiting would close a
///   cycle of detaching threads waiting for each other (observers detaching
///   each other): the detach closing it returns at once. An observer detached
///   by itself, or on the thread that calls it, returns at once.
/// - A subject destroyed by one of its observers ends the walk: the lists
///   live until the last walk over them lets go.
///
/// The lists are allocated with the first observer: most subjects have none.
class VELAMEDIALIB_API ObserverList {
public:
    enum Kind { Ordinary = 0, WithoutDelay = 1 };
    typedef std::function<bool()> StillHere;

    ObserverList() = default;
    ~ObserverList();
    ObserverList(const ObserverList&) = delete;
    ObserverList& operator=(const ObserverList&) = delete;

    /// Adds the observer to the list of the kind, taking it out of the other one.
    void add(Kind kind, void* observer);
    /// Takes the observer out; waits for its calls on other threads unless
    /// `projectLock` (the lock observers run under) is held by this thread.
    void remove(void* observer, const ReadWriteMutex* projectLock);
    bool empty() const { return lists_.load(std::memory_order_acquire) == nullptr; }
    std::vector<void*> snapshot(Kind kind) const;

    /// Calls `call` for each observer of the snapshot still in the list and not
    /// in `told`, dropping its exceptions. With `stillHere`, asked after each
    /// call, a false answer (the owner was destroyed) ends the walk touching
    /// nothing more; returns whether the walk went to the end.
    template <typename Call>
    bool tell(Kind kind, const std::vector<void*>& observers, std::vector<void*>& told, Call call,
              const StillHere* stillHere = nullptr) const {
        const Walk walk(*this);
        told.reserve(told.size() + observers.size());
        for (void* observer : observers) {
            if (contains(told, observer) || !walk.beginCall(kind, observer)) continue;
            told.push_back(observer);
            bool ownerGone = false;
            {
                const CallEnd end{walk, observer};
                try {
                    call(observer);
                } catch (...) {
                    // The change has happened: an observer's failure is its own, and
                    // must neither undo the edit's success nor silence the others.
                }
                ownerGone = stillHere && !(*stillHere)();
            }
            if (ownerGone || walk.subjectGone()) return false; // the subject went
        }
        return true;
    }

private:
    struct Lists;
    /// Holds the lists alive for one walk, and counts this thread as inside an
    /// observer's call while it calls one.
    class VELAMEDIALIB_API Walk {
    public:
        explicit Walk(const ObserverList& list);
        ~Walk();
        Walk(const Walk&) = delete;
        Walk& operator=(const Walk&) = delete;
        /// Whether the observer is still in the list; if so, records its call.
        bool beginCall(Kind kind, void* observer) const;
        /// Ends the call, noting whether the subject was destroyed meanwhile.
        void endCall(void* observer) const;
        bool subjectGone() const { return gone_; }

    private:
        Lists* lists_;
        mutable bool gone_ = false;
    };
    /// Ends a call however the observer left it.
    struct CallEnd {
        const Walk& walk;
        void* observer;
        ~CallEnd() { walk.endCall(observer); }
    };
    static bool contains(const std::vector<void*>& list, void* observer);

    std::atomic<Lists*> lists_{nullptr};
};

} // namespace VelaMediaLib

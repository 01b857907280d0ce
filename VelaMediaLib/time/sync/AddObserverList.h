#pragma once

#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <algorithm>
#include <vector>

namespace VelaMediaLib {

/// The add observers of a track, mixer or timeline: attached once each, told
/// in the order they came, from a snapshot so that an observer may detach
/// itself (or another) while being told; one detached meanwhile is skipped.
///
/// Observers are told once the change has been made, so what one throws
/// cannot undo it: like an observer failing during delayed delivery, its
/// exception is dropped and the others are still told. The edit that told
/// them therefore never fails after it has changed the model.
template <typename ObserverType>
class AddObserverList {
public:
    explicit AddObserverList(const boost::weak_ptr<const ThreadSafe>& token) : token_(token) {}

    void attach(ObserverType* observer) {
        ScopedWriteLock lock(token_);
        if (std::find(observers_.begin(), observers_.end(), observer) == observers_.end())
            observers_.push_back(observer);
    }
    void detach(ObserverType* observer) {
        ScopedWriteLock lock(token_);
        observers_.erase(std::remove(observers_.begin(), observers_.end(), observer), observers_.end());
    }
    template <typename Tell>
    void tell(Tell tellOne) const {
        std::vector<ObserverType*> snapshot;
        {
            ScopedReadLock lock(token_);
            snapshot = observers_;
        }
        for (ObserverType* observer : snapshot) {
            if (!stillAttached(observer)) continue;
            try {
                tellOne(*observer);
            } catch (...) {
                // The change stands; the observer's failure is its own.
            }
        }
    }

private:
    bool stillAttached(ObserverType* observer) const {
        ScopedReadLock lock(token_);
        return std::find(observers_.begin(), observers_.end(), observer) != observers_.end();
    }

    boost::weak_ptr<const ThreadSafe> token_;
    std::vector<ObserverType*> observers_;
};

} // namespace VelaMediaLib

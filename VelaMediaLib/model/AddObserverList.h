#pragma once

#include <VelaMediaLib/time/ThreadSafe.h>

#include <algorithm>
#include <vector>

namespace VelaMediaLib {

/// The add observers of a track, mixer or timeline: attached once each, told
/// in the order they came, from a snapshot so that an observer may detach
/// itself while being told.
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
        for (ObserverType* observer : snapshot) tellOne(*observer);
    }

private:
    boost::weak_ptr<const ThreadSafe> token_;
    std::vector<ObserverType*> observers_;
};

} // namespace VelaMediaLib

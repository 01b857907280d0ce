#pragma once

#include <VelaMediaLib/time/sync/ObserverList.h>

#include <vector>

namespace VelaMediaLib {

/// The add observers of a track, mixer or timeline: attached once each, told
/// in the order they came, under the same policy as every subject's lists
/// (ObserverList): an observer may detach itself (or another) while being
/// told, one detached meanwhile is skipped, and detach returns once the
/// observer's calls on other threads have ended.
///
/// Observers are told once the change has been made, so what one throws
/// cannot undo it: its exception is dropped and the others are still told.
/// The edit that told them therefore never fails after it has changed the
/// model.
template <typename ObserverType>
class AddObserverList {
public:
    AddObserverList() = default;

    void attach(ObserverType* observer) { observers_.add(ObserverList::Ordinary, observer); }
    /// `projectLock` is the lock the owner tells its observers under, if any:
    /// a thread holding it does not wait for calls on other threads.
    void detach(ObserverType* observer, const ReadWriteMutex* projectLock = nullptr) {
        observers_.remove(observer, projectLock);
    }
    template <typename Tell>
    void tell(Tell tellOne) const {
        std::vector<void*> told;
        observers_.tell(ObserverList::Ordinary, observers_.snapshot(ObserverList::Ordinary), told,
                        [&tellOne](void* observer) { tellOne(*static_cast<ObserverType*>(observer)); });
    }

private:
    ObserverList observers_;
};

} // namespace VelaMediaLib

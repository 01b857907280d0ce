#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/sync/NotifyDelay.h>
#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

namespace VelaMediaLib {

/// The thread-safety token: the project derives from it, so the project itself
/// is the token every model object holds (weakly) to find the project's lock.
/// It also keeps the project's notify-delay state, so that state goes with it.
class VELAMEDIALIB_API ThreadSafe {
public:
    ThreadSafe();
    virtual ~ThreadSafe();
    ThreadSafe(const ThreadSafe&) = delete;
    ThreadSafe& operator=(const ThreadSafe&) = delete;

    ReadWriteMutex& mutex() const { return *mutex_; }
    /// The lock as the project's objects hold it, so that it outlives the
    /// project while they remain.
    const boost::shared_ptr<ReadWriteMutex>& sharedMutex() const { return mutex_; }

private:
    friend class NotifyDelay;

    const boost::shared_ptr<ReadWriteMutex> mutex_;
    mutable NotifyDelayState notifyDelayState_;
};

} // namespace VelaMediaLib

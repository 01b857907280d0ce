#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/sync/ReadWriteMutex.h>
#include <VelaMediaLib/time/sync/Subject.h>

#include <mutex>

namespace VelaMediaLib {

/// A subject attached to and detached from on several threads whose
/// observers must know when they are done (the command history, the edit
/// rate). It holds a recursive mutex of its own around every change of its
/// lists and around every walk of them, so once detach has returned the
/// observer is not running and will not be called, except on the detaching
/// thread itself (an observer detaching from inside its update).
///
/// The project's read lock, when the subject has a project, is taken before
/// that mutex, as an edit holding the write lock that detaches takes it after;
/// observers run holding the mutex, so they must not wait for another thread
/// that attaches to or detaches from the same subject, nor destroy it.
class VELAMEDIALIB_API SubjectWithMutex : public Subject {
public:
    using Subject::Subject;

    void attach(Observer* observer) override {
        std::lock_guard<std::recursive_mutex> lock(mutex_);
        Subject::attach(observer);
    }
    void attachWithoutNotifyDelay(Observer* observer) override {
        std::lock_guard<std::recursive_mutex> lock(mutex_);
        Subject::attachWithoutNotifyDelay(observer);
    }
    void detach(Observer* observer) override {
        std::lock_guard<std::recursive_mutex> lock(mutex_);
        Subject::detach(observer);
    }
    void notify() override {
        ScopedReadLock read(projectMutex());
        std::lock_guard<std::recursive_mutex> lock(mutex_);
        Subject::notify();
    }

protected:
    bool tellHeldBackObservers(const StillHere& stillHere) override {
        ScopedReadLock read(projectMutex());
        std::lock_guard<std::recursive_mutex> lock(mutex_);
        return Subject::tellHeldBackObservers(stillHere);
    }

private:
    std::recursive_mutex mutex_;
};

} // namespace VelaMediaLib

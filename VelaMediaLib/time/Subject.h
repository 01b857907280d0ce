#pragma once

#include <VelaMediaLib/time/Observable.h>

#include <atomic>
#include <memory>
#include <boost/weak_ptr.hpp>
#include <mutex>
#include <vector>

namespace VelaMediaLib {

class ThreadSafe;
class NotifyDelay;

/// A subject of one project: two observer lists (ordinary ones, which a
/// NotifyDelay holds back, and ones that are always told at once), a disable
/// counter and the project's token. An observer sits in one list at a time.
class Subject : public Observable {
public:
    explicit Subject(const boost::weak_ptr<const ThreadSafe>& token = boost::weak_ptr<const ThreadSafe>());
    ~Subject() override;
    Subject(const Subject&) = delete;
    Subject& operator=(const Subject&) = delete;

    void attach(Observer* observer) override;
    void attachWithoutNotifyDelay(Observer* observer) override;
    void detach(Observer* observer) override;
    /// Tells observers under the project's read lock, unless disabled; while a
    /// delay is active on the project, ordinary observers hear at its end.
    void notify() override;

    /// Raises the disable counter for its lifetime; disablers nest.
    class NotifyDisabler {
    public:
        explicit NotifyDisabler(Subject& subject);
        ~NotifyDisabler();
        NotifyDisabler(const NotifyDisabler&) = delete;
        NotifyDisabler& operator=(const NotifyDisabler&) = delete;

    private:
        Subject& subject_;
    };
    NotifyDisabler disableNotifies() { return NotifyDisabler(*this); }
    bool notifiesEnabled() const { return disableCount_.load() <= 0; }

    /// The object observers are told changed: a clip, track or project that
    /// notifies through a subject of its own names itself here, so that an
    /// observer of several objects can tell them apart.
    void setOwner(Observable* owner) { owner_ = owner; }
    Observable* owner() { return owner_ ? owner_ : this; }

    const boost::weak_ptr<const ThreadSafe>& projectMutex() const { return token_; }
    void setProjectMutex(const boost::weak_ptr<const ThreadSafe>& token) { token_ = token; }

protected:
    /// SubjectWithMutex guards the lists with a mutex of its own.
    virtual std::unique_lock<std::recursive_mutex> lockLists() const {
        return std::unique_lock<std::recursive_mutex>();
    }

private:
    friend class NotifyDelay;
    // Most subjects (keyframes, parameters) never have observers: the lists
    // are allocated with the first one.
    struct Lists {
        std::vector<Observer*> ordinary;
        std::vector<Observer*> withoutDelay;
    };
    Lists& lists();
    void tell(const std::vector<Observer*>& list, std::vector<Observer*>& told);
    void tellOrdinaryObservers();

    std::unique_ptr<Lists> lists_;
    std::atomic<int> disableCount_{0};
    Observable* owner_ = nullptr;
    bool pendingInDelay_ = false; // guarded by the NotifyDelay registry mutex
    boost::weak_ptr<const ThreadSafe> token_;
};

} // namespace VelaMediaLib

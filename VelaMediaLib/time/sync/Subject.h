#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/sync/Observable.h>

#include <atomic>
#include <boost/weak_ptr.hpp>
#include <functional>
#include <vector>

namespace VelaMediaLib {

class ThreadSafe;
class NotifyDelay;

/// A subject of one project: two observer lists (ordinary ones, which a
/// NotifyDelay holds back, and ones that are always told at once), a disable
/// counter and the project's token. An observer sits in one list at a time.
///
/// Every subject guards its lists the same way: list changes and the copies
/// that walks take hold a small mutex from a process-wide table (chosen by the
/// subject's address), so attach and detach are safe while another thread
/// notifies, and a subject costs no mutex of its own. Observers are never
/// called under that mutex: a walk tells a snapshot and skips observers
/// detached meanwhile. Notifications run under the project's read lock, so an
/// observer detached under the write lock is certain not to be called any more.
///
/// A notification held back by a NotifyDelay is delivered holding the
/// subject's lifeline (its owner's, when it has one), so neither the owner nor
/// the subject can be destroyed during that delivery. A subject without a
/// lifeline that another thread destroys meanwhile waits in its destructor for
/// the delivery to end (by then the parts of any object it belongs to are
/// gone: such objects give a lifeline); one destroyed by its own observer
/// ends its delivery.
class VELAMEDIALIB_API Subject : public Observable {
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
    /// The owner's lifeline, or none.
    boost::weak_ptr<const void> lifeline() const override;

    const boost::weak_ptr<const ThreadSafe>& projectMutex() const { return token_; }
    /// Set before the subject is shared with other threads. A notification
    /// the old project's delay holds back moves to the new project (held back
    /// by its delay, or told at once).
    void setProjectMutex(const boost::weak_ptr<const ThreadSafe>& token);

protected:
    /// Whether the subject still exists, asked after each observer of a
    /// delayed delivery (an observer may destroy the subject).
    typedef std::function<bool()> StillHere;
    /// The ordinary observers at the end of a delay; one that throws does not
    /// keep the others from hearing. Returns whether the subject is still here.
    virtual bool tellHeldBackObservers(const StillHere& stillHere);

private:
    friend class NotifyDelay;
    enum ListKind { Ordinary, WithoutDelay };
    // Most subjects (keyframes, parameters, attributes) never have observers:
    // the lists are allocated with the first one.
    struct Lists {
        std::vector<Observer*> ordinary;
        std::vector<Observer*> withoutDelay;
        std::vector<Observer*>& of(ListKind kind) { return kind == Ordinary ? ordinary : withoutDelay; }
    };
    void add(ListKind kind, Observer* observer);
    std::vector<Observer*> snapshot(ListKind kind) const;
    bool stillIn(ListKind kind, Observer* observer) const;
    /// Without `stillHere` failures go to the caller; with it (delayed
    /// delivery) they are dropped. Returns whether the subject is still here.
    bool tell(ListKind kind, const std::vector<Observer*>& observers, std::vector<Observer*>& told,
              const StillHere* stillHere);

    std::atomic<Lists*> lists_{nullptr};
    std::atomic<int> disableCount_{0};
    std::atomic<bool> parked_{false}; // held back by its project's delay; written under that delay's mutex
    Observable* owner_ = nullptr;
    boost::weak_ptr<const ThreadSafe> token_;
};

} // namespace VelaMediaLib

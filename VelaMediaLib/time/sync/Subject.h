#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/sync/Observable.h>
#include <VelaMediaLib/time/sync/ObserverList.h>
#include <VelaMediaLib/time/sync/ProjectToken.h>

#include <atomic>
#include <boost/weak_ptr.hpp>
#include <functional>
#include <vector>

namespace VelaMediaLib {

class ThreadSafe;
class NotifyDelay;

/// What every subject of a project does: two observer lists (ordinary ones,
/// which a NotifyDelay holds back, and ones that are always told at once) and
/// a disable counter. An observer sits in one list at a time. The project's
/// token comes from subjectToken: a Subject keeps its own, an ObjectSubject
/// shares its object's ProjectToken, a PartSubject asks the object it is a
/// part of.
///
/// The lists follow ObserverList's policy: safe to change on any thread,
/// observers told from a snapshot and never under a lock of the lists, their
/// exceptions dropped, and detach returning only once the observer's calls on
/// other threads have ended. Notifications run under the project's read lock,
/// so an observer detached under the write lock is not running either.
///
/// A notification held back by a NotifyDelay is delivered holding the
/// subject's lifeline (its owner's, when it has one), so neither the owner nor
/// the subject can be destroyed during that delivery. A subject without a
/// lifeline that another thread destroys meanwhile waits in its destructor for
/// the delivery to end (by then the parts of any object it belongs to are
/// gone: such objects give a lifeline); one destroyed by its own observer
/// ends its delivery.
class VELAMEDIALIB_API SubjectBase : public virtual Observable {
public:
    SubjectBase() = default;
    ~SubjectBase() override = default;
    SubjectBase(const SubjectBase&) = delete;
    SubjectBase& operator=(const SubjectBase&) = delete;

    void attach(Observer* observer) override;
    void attachWithoutNotifyDelay(Observer* observer) override;
    void detach(Observer* observer) override;
    /// Tells observers under the project's read lock, unless disabled; while a
    /// delay is active on the project, ordinary observers hear at its end.
    void notify() override;

    /// Raises the disable counter for its lifetime; disablers nest.
    class NotifyDisabler {
    public:
        explicit NotifyDisabler(SubjectBase& subject);
        ~NotifyDisabler();
        NotifyDisabler(const NotifyDisabler&) = delete;
        NotifyDisabler& operator=(const NotifyDisabler&) = delete;

    private:
        SubjectBase& subject_;
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

protected:
    /// The token of the project the subject notifies in.
    virtual const boost::weak_ptr<const ThreadSafe>& subjectToken() const = 0;
    /// Takes the subject out of the delay of the project of `token`, if it is
    /// held back there; returns whether it was. Called by destructors (which
    /// must not ask subjectToken) and when the token changes.
    bool leaveDelay(const boost::weak_ptr<const ThreadSafe>& token);

    /// Whether the subject still exists, asked after each observer of a
    /// delayed delivery (an observer may destroy the subject).
    typedef std::function<bool()> StillHere;
    /// The ordinary observers at the end of a delay; one that throws does not
    /// keep the others from hearing. Returns whether the subject is still here.
    virtual bool tellHeldBackObservers(const StillHere& stillHere);

private:
    friend class NotifyDelay;
    /// Tells the observers of the snapshot still in the list, each once per
    /// notification. Returns whether the subject is still here.
    bool tell(ObserverList::Kind kind, std::vector<void*>& told, const StillHere* stillHere);

    ObserverList observers_;
    std::atomic<int> disableCount_{0};
    std::atomic<bool> parked_{false}; // held back by its project's delay; written under that delay's mutex
    Observable* owner_ = nullptr;
};

/// A subject on its own (a parameter, an attribute, a keyframe's owner): it
/// keeps the project's token itself.
class VELAMEDIALIB_API Subject : public SubjectBase {
public:
    explicit Subject(const boost::weak_ptr<const ThreadSafe>& token = boost::weak_ptr<const ThreadSafe>());
    ~Subject() override;

    const boost::weak_ptr<const ThreadSafe>& projectMutex() const { return token_; }
    /// The project's lock, held as ProjectToken holds it.
    ReadWriteMutex* projectLock() const { return lock_.get(); }
    /// Set before the subject is shared with other threads. A notification
    /// the old project's delay holds back moves to the new project (held back
    /// by its delay, or told at once).
    void setProjectMutex(const boost::weak_ptr<const ThreadSafe>& token);

protected:
    const boost::weak_ptr<const ThreadSafe>& subjectToken() const override { return token_; }

private:
    boost::weak_ptr<const ThreadSafe> token_;
    boost::shared_ptr<ReadWriteMutex> lock_;
};

/// The subject part of an object whose parts share one ProjectToken (a clip,
/// a track, the timeline): it keeps no token of its own.
class VELAMEDIALIB_API ObjectSubject : public SubjectBase, public virtual ProjectToken {
public:
    explicit ObjectSubject(const boost::weak_ptr<const ThreadSafe>& token) { recordProjectToken(token); }
    ~ObjectSubject() override;

protected:
    const boost::weak_ptr<const ThreadSafe>& subjectToken() const override { return projectMutex(); }
};

/// A further subject of an object (a clip's transition subject) that
/// notifies under the token of the object it is a part of, keeping no copy.
/// The object outlives it: it is a member of that object.
class VELAMEDIALIB_API PartSubject : public SubjectBase {
public:
    explicit PartSubject(const ProjectToken& object) : object_(object) {}
    ~PartSubject() override;

protected:
    const boost::weak_ptr<const ThreadSafe>& subjectToken() const override { return object_.projectMutex(); }

private:
    const ProjectToken& object_;
};

} // namespace VelaMediaLib

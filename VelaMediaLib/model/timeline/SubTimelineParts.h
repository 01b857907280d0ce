#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/effects/EffectList.h>
#include <VelaMediaLib/model/timeline/SubTimeline.h>
#include <VelaMediaLib/time/sync/Subject.h>

namespace VelaMediaLib {

/// What every concrete SubTimeline (clip, track, mixer) implements the same
/// way: observation (the object is its own subject, sharing the object's one
/// project token), an ordered effect list, and a name. Observers are told the
/// object itself.
/// A change that changes nothing (the same name, an effect swapped with
/// itself) notifies nobody.
/// Interface is SubTimeline or an interface derived from it, held as a
/// virtual base so that clip families can share it.
template <typename Interface>
class VELAMEDIALIB_TEMPLATE_API SubTimelineParts : public virtual Interface, protected ObjectSubject {
public:
    typedef Effectable::EffectPtr EffectPtr;
    typedef Effectable::Effects Effects;

    explicit SubTimelineParts(const boost::weak_ptr<const ThreadSafe>& token)
        : Interface(token), ObjectSubject(token), effects_(*this) {}

    void attach(Observer* observer) override { ObjectSubject::attach(observer); }
    void attachWithoutNotifyDelay(Observer* observer) override {
        ObjectSubject::attachWithoutNotifyDelay(observer);
    }
    void detach(Observer* observer) override { ObjectSubject::detach(observer); }
    void notify() override { ObjectSubject::notify(); }

    std::string identifier() const override {
        ScopedReadLock lock(this->projectLock());
        return identifier_;
    }
    void setIdentifier(const std::string& identifier) override {
        {
            ScopedWriteLock lock(this->projectMutex());
            if (identifier_ == identifier) return;
            identifier_ = identifier;
        }
        notify();
    }

    void addEffect(const EffectPtr& effect) override {
        effects_.add(effect);
        notify();
    }
    void insertEffect(const EffectPtr& effect, size_t index) override {
        effects_.insert(effect, index);
        notify();
    }
    bool removeEffect(const EffectPtr& effect) override {
        if (!effects_.remove(effect)) return false;
        notify();
        return true;
    }
    void swapEffectOrder(size_t first, size_t second) override {
        if (effects_.swap(first, second)) notify();
    }
    void replaceAllEffects(const Effects& effects) override {
        effects_.replaceAll(effects);
        notify();
    }
    EffectPtr effectAtIndex(size_t index) const override { return effects_.at(index); }
    size_t numEffects() const override { return effects_.size(); }
    Effects allEffects() const override { return effects_.all(); }
    typename Effects::iterator effectBegin() override { return effects_.begin(); }
    typename Effects::iterator effectEnd() override { return effects_.end(); }
    typename Effects::const_iterator effectBegin() const override { return effects_.begin(); }
    typename Effects::const_iterator effectEnd() const override { return effects_.end(); }
    Effects effectsWithName(const std::string& name) override { return effects_.withName(name); }
    Effects effectsWithName(const std::string& name) const override { return effects_.withName(name); }

protected:
    EffectList& effectList() { return effects_; }
    const EffectList& effectList() const { return effects_; }

private:
    EffectList effects_;
    std::string identifier_;
};

} // namespace VelaMediaLib

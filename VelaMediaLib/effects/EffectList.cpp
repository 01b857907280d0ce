#include <VelaMediaLib/effects/EffectList.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <algorithm>

namespace VelaMediaLib {

void EffectList::checkIndex(size_t index, size_t limit) const {
    if (index >= limit)
        throw IndexException("effect index " + std::to_string(index) + " out of range (" +
                             std::to_string(effects_.size()) + " effects)");
}

void EffectList::add(const EffectPtr& effect) {
    if (!effect) throw AddRemoveException("no effect to add");
    ScopedWriteLock lock(owner_.projectMutex());
    effects_.push_back(effect);
}

void EffectList::insert(const EffectPtr& effect, size_t index) {
    if (!effect) throw AddRemoveException("no effect to insert");
    ScopedWriteLock lock(owner_.projectMutex());
    checkIndex(index, effects_.size() + 1);
    effects_.insert(effects_.begin() + long(index), effect);
}

bool EffectList::remove(const EffectPtr& effect) {
    ScopedWriteLock lock(owner_.projectMutex());
    const auto found = std::find(effects_.begin(), effects_.end(), effect);
    if (found == effects_.end()) return false;
    effects_.erase(found);
    return true;
}

bool EffectList::swap(size_t first, size_t second) {
    ScopedWriteLock lock(owner_.projectMutex());
    checkIndex(first, effects_.size());
    checkIndex(second, effects_.size());
    if (first == second) return false;
    std::swap(effects_[first], effects_[second]);
    return true;
}

EffectList::EffectPtr EffectList::at(size_t index) const {
    ScopedReadLock lock(owner_.projectLock());
    checkIndex(index, effects_.size());
    return effects_[index];
}

size_t EffectList::size() const {
    ScopedReadLock lock(owner_.projectLock());
    return effects_.size();
}

EffectList::Effects EffectList::all() const {
    ScopedReadLock lock(owner_.projectLock());
    return effects_;
}

EffectList::Effects EffectList::withName(const std::string& name) const {
    ScopedReadLock lock(owner_.projectLock());
    Effects named;
    for (const EffectPtr& effect : effects_)
        if (effect->effectName() == name) named.push_back(effect);
    return named;
}

EffectList::Effects EffectList::cloned() const {
    ScopedReadLock lock(owner_.projectLock());
    Effects copies;
    for (const EffectPtr& effect : effects_) copies.push_back(effect->cloneEffect());
    return copies;
}

void EffectList::replaceAll(const Effects& effects) {
    ScopedWriteLock lock(owner_.projectMutex());
    effects_ = effects;
}

} // namespace VelaMediaLib

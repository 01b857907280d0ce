#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/effects/Effectable.h>
#include <VelaMediaLib/time/sync/ProjectToken.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

namespace VelaMediaLib {

/// The ordered effects of one owner, guarded by the project lock it finds
/// through its owner's token. Each change returns whether it changed
/// anything, so the owner knows to notify.
class VELAMEDIALIB_API EffectList {
public:
    typedef Effectable::EffectPtr EffectPtr;
    typedef Effectable::Effects Effects;

    explicit EffectList(const ProjectToken& owner) : owner_(owner) {}

    void add(const EffectPtr& effect);
    void insert(const EffectPtr& effect, size_t index);
    bool remove(const EffectPtr& effect);
    /// Returns whether the order changed (not for an index with itself).
    bool swap(size_t first, size_t second);
    EffectPtr at(size_t index) const;
    size_t size() const;
    Effects all() const;
    Effects withName(const std::string& name) const;
    Effects::iterator begin() { return effects_.begin(); }
    Effects::iterator end() { return effects_.end(); }
    Effects::const_iterator begin() const { return effects_.begin(); }
    Effects::const_iterator end() const { return effects_.end(); }
    /// Clones of every effect, for a cloned owner.
    Effects cloned() const;
    void replaceAll(const Effects& effects);

private:
    void checkIndex(size_t index, size_t limit) const;

    const ProjectToken& owner_;
    Effects effects_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/effects/Effect.h>

#include <string>
#include <vector>

namespace VelaMediaLib {

/// What holds an ordered list of effects (clips, tracks). Indices out of
/// range throw IndexException.
class VELAMEDIALIB_API Effectable {
public:
    typedef boost::shared_ptr<Effect> EffectPtr;
    typedef std::vector<EffectPtr> Effects;

    virtual ~Effectable() = default;
    virtual void addEffect(const EffectPtr& effect) = 0;
    /// Inserts before the index; the size itself appends.
    virtual void insertEffect(const EffectPtr& effect, size_t index) = 0;
    /// Returns whether the effect was there.
    virtual bool removeEffect(const EffectPtr& effect) = 0;
    virtual void swapEffectOrder(size_t first, size_t second) = 0;
    /// The whole list at once (an edit that moves effects and its undo).
    virtual void replaceAllEffects(const Effects& effects) = 0;
    virtual EffectPtr effectAtIndex(size_t index) const = 0;
    virtual size_t numEffects() const = 0;
    /// A copy of the list, in order.
    virtual Effects allEffects() const = 0;
    /// Iterators over the list itself: valid until the next change; hold the
    /// project's read lock while walking them on a shared project (the write
    /// lock when changing the effects they lead to).
    virtual Effects::iterator effectBegin() = 0;
    virtual Effects::iterator effectEnd() = 0;
    virtual Effects::const_iterator effectBegin() const = 0;
    virtual Effects::const_iterator effectEnd() const = 0;
    virtual Effects effectsWithName(const std::string& name) = 0;
    virtual Effects effectsWithName(const std::string& name) const = 0;
    virtual bool supportsPerCharacterEffects() const { return false; }
};

} // namespace VelaMediaLib

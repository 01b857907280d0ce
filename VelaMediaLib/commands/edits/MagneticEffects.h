#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/Media.h>

#include <vector>

namespace VelaMediaLib {

/// An effect that follows its clip's edges, and where it stood on the
/// project's time line when it was found.
struct VELAMEDIALIB_API EdgeEffect {
    Effectable::EffectPtr effect;
    Range<VelaTime> range;
};
typedef std::vector<EdgeEffect> EdgeEffects;

/// Of the clip's effects, the magnetized ones, their ranges in project ticks.
VELAMEDIALIB_API EdgeEffects magneticEffectsForMedia(const MediaPtr& media);

/// The clip's effect list after one of its edges moved from `before` to
/// `after` (track ranges): each listed effect that reached the moved edge has
/// its own edge there moved with it, its other edge staying where it was on
/// the time line; every other effect stays where it was on the time line
/// (after a start trim its ticks, counted from the clip's start, shift). A
/// follower the move would leave without a tick stays put like the others.
/// Null when no effect changes, so the list need not change.
VELAMEDIALIB_API boost::shared_ptr<Effectable::Effects>
effectsFollowingEdge(const Effectable::Effects& effects, const EdgeEffects& followers,
                     const Range<VelaTime>& before, const Range<VelaTime>& after, bool startEdge);

} // namespace VelaMediaLib

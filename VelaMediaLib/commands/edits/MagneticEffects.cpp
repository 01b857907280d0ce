#include <VelaMediaLib/commands/edits/MagneticEffects.h>

#include <algorithm>

namespace VelaMediaLib {

EdgeEffects magneticEffectsForMedia(const MediaPtr& media) {
    EdgeEffects found;
    if (!media) return found;
    const VelaTime start = media->trackRange().start();
    for (const Effectable::EffectPtr& effect : media->allEffects()) {
        if (!effect->isMagnetized()) continue;
        const Range<VelaTime> local = effect->timeRange();
        found.push_back(EdgeEffect{effect, Range<VelaTime>(start + local.start(), local.duration())});
    }
    return found;
}

namespace {

bool listed(const EdgeEffects& followers, const Effectable::EffectPtr& effect) {
    return std::any_of(followers.begin(), followers.end(),
                       [&](const EdgeEffect& follower) { return follower.effect == effect; });
}

// The effect's range in the clip's ticks once the edge moved: a follower that
// reached the edge moves that edge with it; every other effect stays where it
// was on the time line (its ticks count from the clip's start, which a start
// trim moves). A follower the move would leave without a tick stays put too.
Range<VelaTime> movedRange(const Range<VelaTime>& local, bool follows, const Range<VelaTime>& before,
                           const Range<VelaTime>& after, bool startEdge) {
    const VelaTime shift = before.start() - after.start();
    const Range<VelaTime> kept(local.start() + shift, local.duration());
    const Range<VelaTime> placed(before.start() + local.start(), local.duration());
    VelaTime from = placed.start(), to = placed.end();
    if (follows && startEdge && from <= before.start())
        from = after.start();
    else if (follows && !startEdge && to >= before.end())
        to = after.end();
    else
        return kept;
    if (to <= from) return kept;
    return Range<VelaTime>(from - after.start(), to - from);
}

} // namespace

boost::shared_ptr<Effectable::Effects> effectsFollowingEdge(const Effectable::Effects& effects,
                                                            const EdgeEffects& followers,
                                                            const Range<VelaTime>& before,
                                                            const Range<VelaTime>& after, bool startEdge) {
    boost::shared_ptr<Effectable::Effects> moved;
    for (size_t i = 0; i < effects.size(); ++i) {
        const Effectable::EffectPtr& effect = effects[i];
        if (!effect->hasTimeRange()) continue;
        const Range<VelaTime> local = effect->timeRange();
        const Range<VelaTime> next = movedRange(local, listed(followers, effect), before, after, startEdge);
        if (next == local) continue;
        const Effectable::EffectPtr replacement = effect->withTimeRange(next);
        if (!replacement) continue; // a kind that says it has a place but cannot be moved stays
        if (!moved) moved.reset(new Effectable::Effects(effects));
        (*moved)[i] = replacement;
    }
    return moved;
}

} // namespace VelaMediaLib

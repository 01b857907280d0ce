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

// The effect's range in the clip's ticks once the edge moved, as it stood
// before in project ticks; the same range when it does not follow.
Range<VelaTime> followingRange(const Range<VelaTime>& local, const Range<VelaTime>& before,
                               const Range<VelaTime>& after, bool startEdge) {
    const Range<VelaTime> placed(before.start() + local.start(), local.duration());
    VelaTime from = placed.start(), to = placed.end();
    if (startEdge && from <= before.start())
        from = after.start();
    else if (!startEdge && to >= before.end())
        to = after.end();
    else
        return local;
    if (to <= from) return local;
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
        if (!listed(followers, effect)) continue;
        const Range<VelaTime> local = effect->timeRange();
        const Range<VelaTime> next = followingRange(local, before, after, startEdge);
        if (next == local) continue;
        const Effectable::EffectPtr replacement = effect->withTimeRange(next);
        if (!replacement) continue;
        if (!moved) moved.reset(new Effectable::Effects(effects));
        (*moved)[i] = replacement;
    }
    return moved;
}

} // namespace VelaMediaLib

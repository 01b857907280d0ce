#include <VelaMediaLib/commands/edits/ExtendEffectsCmd.h>

namespace VelaMediaLib {

EffectTimeCmd::EffectTimeCmd(const MediaPtr& media, VelaTime time, VelaTime amount, bool extend)
    : ClipTimeCmd(media, time, amount, extend, "fit effects of", "effect") {}

Range<VelaTime> EffectTimeCmd::extended(const Range<VelaTime>& range, bool magnetized, VelaTime time,
                                        VelaTime amount) {
    VelaTime from = range.start(), to = range.end();
    const bool touches = from == time || to == time;
    if (magnetized && touches) {
        to += amount;
    } else {
        if (from >= time) from += amount;
        if (to > time) to += amount;
    }
    return Range<VelaTime>(from, to - from);
}

Range<VelaTime> EffectTimeCmd::reduced(const Range<VelaTime>& range, VelaTime time, VelaTime amount) {
    const auto edge = [&](VelaTime at) { return at <= time ? at : at < time + amount ? time : at - amount; };
    const VelaTime from = edge(range.start()), to = edge(range.end());
    return Range<VelaTime>(from, to - from);
}

bool EffectTimeCmd::execute(CommandHandler*) {
    before_ = media_->allEffects();
    after_.clear();
    if (amount_ == 0) return false;
    bool changed = false;
    for (const Effectable::EffectPtr& effect : before_) {
        const Range<VelaTime> range = effect->timeRange();
        if (!effect->hasTimeRange() || range.duration() <= 0) { // covers nothing of its own
            after_.push_back(effect);
            continue;
        }
        const Range<VelaTime> next = extend_ ? extended(range, effect->isMagnetized(), time_, amount_)
                                             : reduced(range, time_, amount_);
        const Effectable::EffectPtr moved = next == range ? effect : effect->withTimeRange(next);
        changed = changed || moved != effect;
        if (next.duration() > 0) after_.push_back(moved);
    }
    if (!changed) return false;
    media_->replaceAllEffects(after_);
    return true;
}

bool EffectTimeCmd::unexecute(CommandHandler*) {
    media_->replaceAllEffects(before_);
    return true;
}

bool EffectTimeCmd::reexecute(CommandHandler*) {
    media_->replaceAllEffects(after_);
    return true;
}

boost::shared_ptr<ExtendEffectsCmd> ExtendEffectsCmd::create(const MediaPtr& media, VelaTime time,
                                                             VelaTime amount) {
    const boost::shared_ptr<ExtendEffectsCmd> command(new ExtendEffectsCmd(media, time, amount));
    command->setName("Extend Effects");
    return command;
}

boost::shared_ptr<ReduceEffectsCmd> ReduceEffectsCmd::create(const MediaPtr& media, VelaTime time,
                                                             VelaTime amount) {
    const boost::shared_ptr<ReduceEffectsCmd> command(new ReduceEffectsCmd(media, time, amount));
    command->setName("Reduce Effects");
    return command;
}

} // namespace VelaMediaLib

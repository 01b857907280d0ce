#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/ClipTimeCmd.h>
#include <VelaMediaLib/model/media/Media.h>

namespace VelaMediaLib {

/// What fitting a clip's effects to time opened or removed shares. Times are
/// the clip's own ticks; effects without a place of their own (they cover the
/// whole clip) are left alone. Effects are values: the command replaces the
/// clip's list, undo gives back the list it had (the same effects), redo the
/// list it made. Reports false when no effect changes.
class VELAMEDIALIB_API EffectTimeCmd : public ClipTimeCmd {
public:
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    bool reexecute(CommandHandler* handler) override;

    /// A range as ExtendEffectsCmd leaves it.
    static Range<VelaTime> extended(const Range<VelaTime>& range, bool magnetized, VelaTime time,
                                    VelaTime amount);
    /// A range as ReduceEffectsCmd leaves it (it may be left without a tick).
    static Range<VelaTime> reduced(const Range<VelaTime>& range, VelaTime time, VelaTime amount);

protected:
    /// Throws VelaMediaLibException for no clip or a negative amount.
    EffectTimeCmd(const MediaPtr& media, VelaTime time, VelaTime amount, bool extend);

private:
    Effectable::Effects before_;
    Effectable::Effects after_;
};

/// Fits a clip's effects to `amount` ticks opened at `time`: an effect that
/// starts after the time moves later by it; one across the time grows by it
/// (it covers what was opened inside it); an effect that ends at or before
/// the time stays. An effect that only touches the time follows its
/// magnetism: a magnetized one (a device frame, fitted to the clip) grows to
/// cover the opened time, another keeps to its content (starting at the time
/// it moves, ending there it stays).
class VELAMEDIALIB_API ExtendEffectsCmd : public EffectTimeCmd {
public:
    static boost::shared_ptr<ExtendEffectsCmd> create(const MediaPtr& media, VelaTime time, VelaTime amount);

private:
    ExtendEffectsCmd(const MediaPtr& media, VelaTime time, VelaTime amount)
        : EffectTimeCmd(media, time, amount, true) {}
};

/// Fits a clip's effects to the `amount` ticks from `time` on being removed,
/// the inverse of ExtendEffectsCmd with the same arguments: each edge of an
/// effect inside the removed time goes to its start, each edge after it moves
/// earlier by the amount. An effect that lay wholly inside the removed time is
/// dropped with it.
class VELAMEDIALIB_API ReduceEffectsCmd : public EffectTimeCmd {
public:
    static boost::shared_ptr<ReduceEffectsCmd> create(const MediaPtr& media, VelaTime time, VelaTime amount);

private:
    ReduceEffectsCmd(const MediaPtr& media, VelaTime time, VelaTime amount)
        : EffectTimeCmd(media, time, amount, false) {}
};

} // namespace VelaMediaLib

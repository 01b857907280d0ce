#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/ClipTimeCmd.h>
#include <VelaMediaLib/model/media/MediaImpl.h>

namespace VelaMediaLib {

/// What moving a clip's animations in time shares. Times are the clip's own
/// ticks. An animation goes with the keyframe that ends it (as its keyframes
/// go with ExtendParametersCmd), so an animation is chosen by its end time and
/// moves whole, its span and length kept. Undo gives back the animation tracks
/// as they were; redo those the command made. Reports false when no
/// animation moves (and for a clip kind without animation tracks).
class VELAMEDIALIB_API AnimationTimeCmd : public ClipTimeCmd {
public:
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    bool reexecute(CommandHandler* handler) override;

protected:
    /// Throws VelaMediaLibException for no clip or a negative amount.
    AnimationTimeCmd(const MediaPtr& media, VelaTime time, VelaTime amount, bool extend);

private:
    /// The tracks the command changes, as they become; throws for an
    /// animation ending in the time a reduction removes.
    MediaImpl::AnimationTracks moved(const MediaImpl::AnimationTracks& tracks) const;
    void apply(const MediaImpl::AnimationTracks& tracks) const;

    MediaImpl::AnimationTracks before_;
    MediaImpl::AnimationTracks after_;
};

/// Opens `amount` ticks in a clip's animations at `time`: every animation
/// ending at or after the time moves later by the amount.
class VELAMEDIALIB_API ExtendMediaAnimationsCmd : public AnimationTimeCmd {
public:
    static boost::shared_ptr<ExtendMediaAnimationsCmd> create(const MediaPtr& media, VelaTime time,
                                                              VelaTime amount);

private:
    ExtendMediaAnimationsCmd(const MediaPtr& media, VelaTime time, VelaTime amount)
        : AnimationTimeCmd(media, time, amount, true) {}
};

/// Removes `amount` ticks from `time` on from a clip's animations, the inverse
/// of ExtendMediaAnimationsCmd with the same arguments: every animation ending
/// at or after time + amount moves earlier by the amount. An animation ending
/// inside the removed time refuses the command (VelaMediaLibException).
class VELAMEDIALIB_API ReduceMediaAnimationsCmd : public AnimationTimeCmd {
public:
    static boost::shared_ptr<ReduceMediaAnimationsCmd> create(const MediaPtr& media, VelaTime time,
                                                              VelaTime amount);

private:
    ReduceMediaAnimationsCmd(const MediaPtr& media, VelaTime time, VelaTime amount)
        : AnimationTimeCmd(media, time, amount, false) {}
};

} // namespace VelaMediaLib

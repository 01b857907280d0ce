#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/ClipTimeCmd.h>
#include <VelaMediaLib/model/media/Media.h>

#include <vector>

namespace VelaMediaLib {

/// What moving a clip's keyframes in time shares. Times are the clip's own
/// ticks (0 is its start). A parameter of one keyframe holds its value at
/// every time and is left alone. Each parameter moves all or nothing; when
/// one refuses (its keyframes would meet, a lead-in would reach past a
/// keyframe) those already moved go back and the KeyFrameException goes on,
/// the clip as it was. Undo moves the same keyframes back by the same
/// amount, which is exact. Reports false when no keyframe moves.
class VELAMEDIALIB_API KeyframeTimeCmd : public ClipTimeCmd {
public:
    /// A time before every keyframe a clip can hold: from it, every keyframe
    /// moves (the content of a clip whose start is extended).
    static VelaTime earliestTime() { return -(VelaTime(1) << 62); }

    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    bool reexecute(CommandHandler* handler) override;

protected:
    /// Throws VelaMediaLibException for no clip or a negative amount.
    KeyframeTimeCmd(const MediaPtr& media, VelaTime time, VelaTime amount, bool extend);

private:
    /// Moves the chosen keyframes of every parameter listed, forwards (as the
    /// command does) or backwards (undo); all or nothing.
    void moveAll(const std::vector<boost::shared_ptr<ParameterInterface>>& parameters, bool forwards) const;
    /// The parameters with keyframes to move; throws for a keyframe in the
    /// time a reduction removes.
    std::vector<boost::shared_ptr<ParameterInterface>> parametersToMove() const;

    std::vector<boost::shared_ptr<ParameterInterface>> moved_;
};

/// Opens `amount` ticks in a clip's parameters at `time`: every keyframe at
/// or after the time moves later by the amount.
class VELAMEDIALIB_API ExtendParametersCmd : public KeyframeTimeCmd {
public:
    static boost::shared_ptr<ExtendParametersCmd> create(const MediaPtr& media, VelaTime time,
                                                         VelaTime amount);

private:
    ExtendParametersCmd(const MediaPtr& media, VelaTime time, VelaTime amount)
        : KeyframeTimeCmd(media, time, amount, true) {}
};

/// Removes the `amount` ticks from `time` on from a clip's parameters, the
/// inverse of ExtendParametersCmd with the same arguments: every keyframe at
/// or after time + amount moves earlier by the amount. A keyframe inside the
/// removed time refuses the command (KeyFrameException), since it would have
/// nowhere to go.
class VELAMEDIALIB_API ReduceParametersCmd : public KeyframeTimeCmd {
public:
    static boost::shared_ptr<ReduceParametersCmd> create(const MediaPtr& media, VelaTime time,
                                                         VelaTime amount);

private:
    ReduceParametersCmd(const MediaPtr& media, VelaTime time, VelaTime amount)
        : KeyframeTimeCmd(media, time, amount, false) {}
};

} // namespace VelaMediaLib

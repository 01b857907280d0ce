#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/ExtendFrameCmd.h>

#include <string>

namespace VelaMediaLib {

class StitchedMedia;

/// Holds a frame as ExtendFrameCmd does with ripple (the still inserted at
/// the tick for `duration` ticks, rippling the clip's track and, with
/// `rippleOtherTracks`, the other tracks of its mixer), then makes the parts
/// one clip: the part before the tick, the still and the part after it are
/// stitched into one StitchedMedia (StitchMediaCmd), so the held frame moves,
/// trims and stretches with the clip. `trim` ticks of the part after the still
/// are left out first (ReduceMediaCmd with ripple: the still stands in for
/// them, and what follows moves back by as much); a scalar other than 1 gives
/// the stitched media that scalar (StretchCmd), refused where it would collide.
/// The name names the command, the undo step a user sees. Refusals as for
/// ExtendFrameCmd and the sub-commands; the whole is rolled back.
class VELAMEDIALIB_API StitchingExtendFrameCmd : public ExtendFrameCmd {
public:
    /// Throws VelaMediaLibException as ExtendFrameCmd::create does, and for a
    /// negative trim or a scalar not above zero.
    static boost::shared_ptr<StitchingExtendFrameCmd> create(const MediaPtr& media, const std::string& name,
                                                             VelaTime time, VelaTime duration, VelaTime trim,
                                                             const SafeRational& scalar = SafeRational(1),
                                                             bool rippleOtherTracks = false);
    /// The stitched media made (null before execution or when refused).
    const boost::shared_ptr<StitchedMedia>& stitchedMedia() const { return stitched_; }
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    StitchingExtendFrameCmd(const MediaPtr& media, VelaTime time, VelaTime duration, VelaTime trim,
                            const SafeRational& scalar, bool rippleOtherTracks)
        : ExtendFrameCmd(media, time, duration, true, rippleOtherTracks), trim_(trim), scalar_(scalar) {}

    VelaTime trim_;
    SafeRational scalar_;
    boost::shared_ptr<StitchedMedia> stitched_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/EditRateScale.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Mixer.h>

namespace VelaMediaLib {

/// Carries every track of a mixer over to another edit rate (see
/// EditRateScale): each track's transitions once, then each clip with
/// ScaleMediaEditRateCmd, placed by EditRateScale::trackStates. Clips moving
/// later go first, latest first, then the others, earliest first, so no clip
/// meets one that has not moved yet. Undo gives back every saved state; a
/// refusal anywhere undoes the steps before it.
class VELAMEDIALIB_API ScaleMixerEditRateCmd : public MultiCommand {
public:
    /// Throws ValueException<double> for a factor not above zero, and
    /// AddRemoveException "no mixer to scale" for none.
    static boost::shared_ptr<ScaleMixerEditRateCmd> create(const MixerPtr& mixer, const SafeRational& factor);
    static boost::shared_ptr<ScaleMixerEditRateCmd> create(const MixerPtr& mixer,
                                                           const boost::rational<unsigned long>& from,
                                                           const boost::rational<unsigned long>& to);

    /// Leaves fitting the transitions to the change this is part of (a
    /// project's change, or the clip change a group's mixer is scaled in),
    /// which fits once every track is scaled (fitTransitionsStep).
    void withoutFits() { fits_ = false; }

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    ScaleMixerEditRateCmd(const MixerPtr& mixer, const EditRateScale& scale) : mixer_(mixer), scale_(scale) {}

    MixerPtr mixer_;
    EditRateScale scale_;
    bool fits_ = true;
};

/// Issues, through the composite, the steps that carry one track's
/// transitions and clips over (what ScaleMixerEditRateCmd does per track; a
/// stitched clip's parts go the same way), then, with `fit`, the track's
/// fitTransitionsStep. Stops at the first refusal.
VELAMEDIALIB_API void scaleTrackEditRate(MultiCommand& into, const TrackPtr& track,
                                         const EditRateScale& scale, bool fit = true);
/// Made before a change of edit rate and executed after it: a clip of the
/// tracks (or of groups and stitched clips on them, at any depth) that had room for its
/// transitions, and that rounding each length on its own left a tick short,
/// takes the missing ticks from its longer transition. Undone exactly.
VELAMEDIALIB_API CommandPtr fitTransitionsStep(const std::vector<TrackPtr>& tracks);

} // namespace VelaMediaLib

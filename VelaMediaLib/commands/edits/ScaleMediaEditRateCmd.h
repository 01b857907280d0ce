#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/detail/EditRateScale.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/media/HotspotInfo.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <boost/optional.hpp>

namespace VelaMediaLib {

/// Carries one clip over to another edit rate (see EditRateScale): its
/// timing (SetMediaStateCmd), edge modification lengths, effect ranges,
/// animation ranges, keyframe times, a caption's longest duration, its
/// hotspot (ScaleHotspotEditRateCmd), a group's inner tracks
/// (ScaleMixerEditRateCmd) and a stitched clip's parts. Transitions belong to
/// the track (ScaleMixerEditRateCmd scales each once). Undo gives back every
/// saved state exactly; a refusal anywhere undoes the steps before it.
class VELAMEDIALIB_API ScaleMediaEditRateCmd : public MultiCommand {
public:
    /// The clip goes to the nearest tick of its start. Throws
    /// ValueException<double> for a factor not above zero.
    static boost::shared_ptr<ScaleMediaEditRateCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                           const SafeRational& factor);
    /// The clip is placed at the given tick (a track keeps touching clips touching).
    static boost::shared_ptr<ScaleMediaEditRateCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                           const SafeRational& factor, VelaTime start);
    /// Marks the command as a step of a whole track's change, whose
    /// transitions are scaled before and fitted after (ScaleMixerEditRateCmd):
    /// the clip's new timing then does not ask for its transitions' room.
    /// Alone, the transitions stay as they are, and a clip the change would
    /// leave too short for them refuses it.
    void partOfTrackChange() { partOfTrack_ = true; }

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    ScaleMediaEditRateCmd(const TrackPtr& track, const MediaPtr& media, const EditRateScale& scale,
                          boost::optional<VelaTime> start)
        : track_(track), media_(media), scale_(scale), start_(start) {}

    TrackPtr track_;
    MediaPtr media_;
    EditRateScale scale_;
    boost::optional<VelaTime> start_;
    bool partOfTrack_ = false;
};

/// Carries a visual clip's hotspot over to another edit rate: its go-to,
/// marker and last marker times go to the nearest tick. A clip without a
/// hotspot reports false. Undo gives back the hotspot as it was.
class VELAMEDIALIB_API ScaleHotspotEditRateCmd : public Command {
public:
    /// Throws ValueException<double> for a factor not above zero.
    static boost::shared_ptr<ScaleHotspotEditRateCmd> create(const MediaPtr& media,
                                                             const SafeRational& factor);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;

private:
    ScaleHotspotEditRateCmd(const MediaPtr& media, const EditRateScale& scale)
        : media_(media), scale_(scale) {}

    MediaPtr media_;
    EditRateScale scale_;
    HotspotInfo saved_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/commands/MultiCommand.h>
#include <VelaMediaLib/model/Track.h>

namespace VelaMediaLib {

/// Closes every gap on a track, the one before the first clip included: each
/// clip that does not start where the previous one ends (0 for the first) is
/// moved back there with a MoveCmd.
class CloseGapsOnTrackCmd : public MultiCommand {
public:
    static boost::shared_ptr<CloseGapsOnTrackCmd> create(const TrackPtr& track);
    const TrackPtr& track() const { return track_; }
    /// Whether the track has a gap to close.
    static bool hasGap(const Track& track);

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit CloseGapsOnTrackCmd(const TrackPtr& track) : track_(track) {}
    TrackPtr track_;
};

} // namespace VelaMediaLib

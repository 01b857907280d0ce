#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

namespace VelaMediaLib {

class UnifiedMedia;

/// Leaves a unified clip's visual part alone in its place: the audio part
/// goes with the unified clip, which undo puts back exactly. A clip not on
/// the track refuses the command (false, nothing changed).
class VELAMEDIALIB_API RemoveAudioCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException for no track and TypeException when the
    /// clip is not a unified media.
    static boost::shared_ptr<RemoveAudioCmd> create(const TrackPtr& track, const MediaPtr& media);

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    RemoveAudioCmd(const TrackPtr& track, const boost::shared_ptr<UnifiedMedia>& unified)
        : track_(track), unified_(unified) {}

    TrackPtr track_;
    boost::shared_ptr<UnifiedMedia> unified_;
};

} // namespace VelaMediaLib

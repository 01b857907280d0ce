#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <vector>

namespace VelaMediaLib {

/// Places a clip at a time on a track of a mixer and pushes aside what
/// stands in its way, instead of refusing the collision. A clip across the
/// time is cut there (SplitCmd), its first part staying put; the clips the
/// placed clip would overlap move later just far enough to make room, and
/// each clip they would then overlap in turn moves as far as needed, so
/// gaps further on absorb the push and clips beyond them stay where they
/// are (MoveCmd each, latest first). On a mixer of unified clips a pushed
/// clip takes its video and audio parts with it: they are one clip on the
/// track. A clip standing on a track is taken off it first (RemoveMediaCmd),
/// so the command also drags a clip to its new place. All or nothing: a clip
/// inside another clip refuses (false, nothing changed).
class VELAMEDIALIB_API DisplaceMediaOnUnifiedMixerCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException for no track or clip.
    static boost::shared_ptr<DisplaceMediaOnUnifiedMixerCmd> create(const TrackPtr& track,
                                                                    const MediaPtr& media, VelaTime time);
    /// The clips the last execution pushed aside (after any cut), in time order.
    const std::vector<MediaPtr>& displacedMedias() const { return displaced_; }
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    DisplaceMediaOnUnifiedMixerCmd(const TrackPtr& track, const MediaPtr& media, VelaTime time)
        : track_(track), media_(media), time_(time) {}
    /// The clips from the time on that must move, each with its delta.
    std::vector<std::pair<MediaPtr, VelaTime>> pushes(VelaTime duration) const;

    TrackPtr track_;
    MediaPtr media_;
    VelaTime time_;
    std::vector<MediaPtr> displaced_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <vector>

namespace VelaMediaLib {

/// Places clones of clips at given times on given tracks, one AddMediaCmd
/// each, in the order given; the clips cloned stay as they are, wherever
/// they are. A clone carries the clip's content (parameters, effects,
/// animations, metadata) but no transition. All or nothing: a clone that
/// would collide (with a clip or another clone) refuses the whole command
/// (false, nothing changed). Redo places the same clone objects again.
class VELAMEDIALIB_API CloneAddMediasCmd : public MultiCommand {
public:
    struct Placement {
        MediaPtr media;
        TrackPtr track;
        VelaTime time;
    };
    /// Throws VelaMediaLibException for an empty list, or a placement
    /// without a clip or a track.
    static boost::shared_ptr<CloneAddMediasCmd> create(const std::vector<Placement>& placements);
    static boost::shared_ptr<CloneAddMediasCmd> create(const MediaPtr& media, const TrackPtr& track,
                                                       VelaTime time);
    /// The clones the last execution placed, in the order of the placements.
    const std::vector<MediaPtr>& createdMedias() const { return created_; }
    /// A copy of the clip ready to be placed: a clone without transitions.
    static MediaPtr placeableClone(const Media& media);
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit CloneAddMediasCmd(const std::vector<Placement>& placements) : placements_(placements) {}
    std::vector<Placement> placements_;
    std::vector<MediaPtr> created_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <vector>

namespace VelaMediaLib {

class StitchedMedia;

/// Makes touching clips of one source on one track one stitched media in
/// their place: the clips come off the track, become its parts in time
/// order, and the stitched media stands where they stood, playing what they
/// played; the first clip's left and the last clip's right transition become
/// its own. Undo puts every clip, state and transition back as it was; redo
/// stitches again into the same stitched media.
class VELAMEDIALIB_API StitchMediaCmd : public MultiCommand {
public:
    /// Throws, changing nothing, for no track, fewer than two clips, a clip
    /// given twice or not on the track (AddRemoveException), clips that do not
    /// touch ("only touching clips can be stitched") or that play different
    /// sources ("cannot stitch clips of different sources"; clips of no
    /// source stitch with each other). Executing checks the same again.
    static boost::shared_ptr<StitchMediaCmd> create(const TrackPtr& track,
                                                    const std::vector<MediaPtr>& clips);

    /// The stitched media the command makes (the same on every redo).
    const boost::shared_ptr<StitchedMedia>& stitchedMedia() const { return stitched_; }

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    StitchMediaCmd(const TrackPtr& track, const std::vector<MediaPtr>& clips);
    /// The clips in time order, checked as create says.
    std::vector<MediaPtr> checkedClips() const;

    TrackPtr track_;
    std::vector<MediaPtr> clips_;
    boost::shared_ptr<StitchedMedia> stitched_;
};

} // namespace VelaMediaLib

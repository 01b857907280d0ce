#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

namespace VelaMediaLib {

class StitchedMedia;

/// Puts a stitched media's parts on its track in its place, each where the
/// stitched media played it (see StitchedMedia::placementsWherePlayed), the
/// stitched media's edge transitions on the first and last of them. Undo
/// puts the stitched media back with its parts as they were; a stitched
/// media no longer on the track is refused (false).
class VELAMEDIALIB_API UnstitchMediaCmd : public MultiCommand {
public:
    /// Throws TypeException "only a stitched media can be unstitched" for a
    /// plain clip, AddRemoveException for no track.
    static boost::shared_ptr<UnstitchMediaCmd> create(const TrackPtr& track, const MediaPtr& media);

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    UnstitchMediaCmd(const TrackPtr& track, const boost::shared_ptr<StitchedMedia>& stitched)
        : track_(track), stitched_(stitched) {}

    TrackPtr track_;
    boost::shared_ptr<StitchedMedia> stitched_;
};

} // namespace VelaMediaLib

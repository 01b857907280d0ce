#include <VelaMediaLib/commands/edits/UnstitchAllCmd.h>

#include <VelaMediaLib/commands/edits/UnstitchMediaCmd.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>

namespace VelaMediaLib {
namespace {

std::vector<MediaPtr> stitchedOn(const Track& track) {
    std::vector<MediaPtr> found;
    for (const MediaPtr& media : track.medias())
        if (boost::dynamic_pointer_cast<StitchedMedia>(media)) found.push_back(media);
    return found;
}

} // namespace

boost::shared_ptr<UnstitchAllCmd> UnstitchAllCmd::create(const TrackPtr& track) {
    return create(std::vector<TrackPtr>{track});
}

boost::shared_ptr<UnstitchAllCmd> UnstitchAllCmd::create(const std::vector<TrackPtr>& tracks) {
    for (const TrackPtr& track : tracks)
        if (!track) throw AddRemoveException("no track to unstitch on");
    const boost::shared_ptr<UnstitchAllCmd> command(new UnstitchAllCmd(tracks));
    command->setName("Unstitch All");
    return command;
}

bool UnstitchAllCmd::execute(CommandHandler* handler) {
    for (const TrackPtr& track : tracks_)
        if (!stitchedOn(*track).empty()) return MultiCommand::execute(handler);
    return false;
}

void UnstitchAllCmd::executeCommands(const CommandHandler*) {
    for (const TrackPtr& track : tracks_)
        for (const MediaPtr& stitched : stitchedOn(*track))
            if (!executeRequired(UnstitchMediaCmd::create(track, stitched))) return;
}

} // namespace VelaMediaLib

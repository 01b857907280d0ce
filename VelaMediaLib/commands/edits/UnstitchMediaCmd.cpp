#include <VelaMediaLib/commands/edits/UnstitchMediaCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/detail/StitchSupport.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>

namespace VelaMediaLib {

boost::shared_ptr<UnstitchMediaCmd> UnstitchMediaCmd::create(const TrackPtr& track, const MediaPtr& media) {
    if (!track) throw AddRemoveException("no track to unstitch on");
    const auto stitched = boost::dynamic_pointer_cast<StitchedMedia>(media);
    if (!stitched) throw TypeException("only a stitched media can be unstitched");
    const boost::shared_ptr<UnstitchMediaCmd> command(new UnstitchMediaCmd(track, stitched));
    command->setName("Unstitch");
    return command;
}

void UnstitchMediaCmd::executeCommands(const CommandHandler*) {
    if (!executeRequired(RemoveMediaCmd::create(track_, stitched_))) return;
    const boost::shared_ptr<detail::UnstitchPartsCmd> parts(new detail::UnstitchPartsCmd(stitched_));
    if (!executeRequired(parts)) return;
    for (const StitchedMedia::Placement& placement : parts->placements())
        if (!executeRequired(AddMediaCmd::create(track_, placement.media, placement.state.start))) return;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/CloneAddMediasCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<CloneAddMediasCmd> CloneAddMediasCmd::create(const std::vector<Placement>& placements) {
    if (placements.empty()) throw VelaMediaLibException("no clips to clone");
    for (const Placement& placement : placements)
        if (!placement.media || !placement.track)
            throw VelaMediaLibException("a clone needs a clip and a track");
    const boost::shared_ptr<CloneAddMediasCmd> command(new CloneAddMediasCmd(placements));
    command->setName("Clone Add Medias");
    return command;
}

boost::shared_ptr<CloneAddMediasCmd> CloneAddMediasCmd::create(const MediaPtr& media, const TrackPtr& track,
                                                               VelaTime time) {
    return create(std::vector<Placement>{Placement{media, track, time}});
}

// A transition joins two clips of a track: the copy's neighbours are others.
MediaPtr CloneAddMediasCmd::placeableClone(const Media& media) {
    const MediaPtr copy = media.clone();
    if (copy->leftTransition()) copy->setLeftTransition(TransitionPtr());
    if (copy->rightTransition()) copy->setRightTransition(TransitionPtr());
    return copy;
}

bool CloneAddMediasCmd::execute(CommandHandler* handler) {
    created_.clear();
    if (MultiCommand::execute(handler)) return true;
    created_.clear();
    return false;
}

void CloneAddMediasCmd::executeCommands(const CommandHandler*) {
    for (const Placement& placement : placements_) {
        const MediaPtr copy = placeableClone(*placement.media);
        if (!executeRequired(AddMediaCmd::create(placement.track, copy, placement.time))) return;
        created_.push_back(copy);
    }
}

} // namespace VelaMediaLib

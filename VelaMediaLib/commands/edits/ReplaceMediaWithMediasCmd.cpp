#include <VelaMediaLib/commands/edits/ReplaceMediaWithMediasCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>

#include <set>

namespace VelaMediaLib {

void ReplaceMediaWithMediasCmd::check(const TrackPtr& track, const MediaPtr& media,
                                      const std::vector<MediaPtr>& medias) {
    if (!track || !media) throw VelaMediaLibException("replacing a clip needs a track and a clip");
    if (medias.empty()) throw VelaMediaLibException("no clips to replace a clip with");
    std::set<MediaPtr> seen{media};
    for (const MediaPtr& each : medias) {
        if (!each) throw VelaMediaLibException("no clip to replace a clip with");
        if (!seen.insert(each).second)
            throw VelaMediaLibException("a clip cannot replace itself or stand twice in its place");
    }
}

boost::shared_ptr<ReplaceMediaWithMediasCmd>
ReplaceMediaWithMediasCmd::create(const TrackPtr& track, const MediaPtr& media,
                                  const std::vector<MediaPtr>& medias) {
    check(track, media, medias);
    const boost::shared_ptr<ReplaceMediaWithMediasCmd> command(
        new ReplaceMediaWithMediasCmd(track, media, medias));
    command->setName("Replace Media");
    return command;
}

// A clip not on the track is refused by its removal, before anything changed.
void ReplaceMediaWithMediasCmd::executeCommands(const CommandHandler*) {
    const Range<VelaTime> replaced = media_->trackRange();
    VelaTime length = 0;
    for (const MediaPtr& media : medias_) length += media->duration();
    if (!executeRequired(RemoveMediaCmd::create(track_, media_))) return;
    if (!makeRoom(replaced.end(), length - replaced.duration())) return;
    VelaTime at = replaced.start();
    for (const MediaPtr& media : medias_) {
        if (!executeRequired(AddMediaCmd::create(track_, media, at))) return;
        at += media->duration();
    }
}

} // namespace VelaMediaLib

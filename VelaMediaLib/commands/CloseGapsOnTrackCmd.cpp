#include <VelaMediaLib/commands/CloseGapsOnTrackCmd.h>

#include <VelaMediaLib/commands/AtomicEditCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<CloseGapsOnTrackCmd> CloseGapsOnTrackCmd::create(const TrackPtr& track) {
    if (!track) throw VelaMediaLibException("no track to close gaps on");
    const boost::shared_ptr<CloseGapsOnTrackCmd> command(new CloseGapsOnTrackCmd(track));
    command->setName("Close Gaps");
    return command;
}

bool CloseGapsOnTrackCmd::hasGap(const Track& track) {
    VelaTime expected = 0;
    for (const MediaPtr& media : track.medias()) {
        if (media->startTime() != expected) return true;
        expected = media->endTime();
    }
    return false;
}

void CloseGapsOnTrackCmd::executeCommands(const CommandHandler*) {
    VelaTime position = 0;
    for (const MediaPtr& media : track_->medias()) {
        if (media->startTime() != position)
            execute(MoveCmd::create(track_, media, position - media->startTime()));
        position = media->endTime();
    }
}

} // namespace VelaMediaLib

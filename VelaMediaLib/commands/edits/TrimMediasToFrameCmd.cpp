#include <VelaMediaLib/commands/edits/TrimMediasToFrameCmd.h>

#include <VelaMediaLib/commands/edits/SplitCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<TrimMediasToFrameCmd> TrimMediasToFrameCmd::create(const MediaPtr& media, VelaTime time) {
    if (!media) throw VelaMediaLibException("no clip to trim");
    const boost::shared_ptr<TrimMediasToFrameCmd> command(new TrimMediasToFrameCmd(media, MixerPtr(), time));
    command->setName("Trim Medias To Frame");
    return command;
}

boost::shared_ptr<TrimMediasToFrameCmd> TrimMediasToFrameCmd::create(const MixerPtr& mixer, VelaTime time) {
    if (!mixer) throw VelaMediaLibException("no mixer to trim clips of");
    const boost::shared_ptr<TrimMediasToFrameCmd> command(new TrimMediasToFrameCmd(MediaPtr(), mixer, time));
    command->setName("Trim Medias To Frame");
    return command;
}

bool TrimMediasToFrameCmd::execute(CommandHandler* handler) {
    return MultiCommand::execute(handler) && numUndoCommands() > 0;
}

bool TrimMediasToFrameCmd::trimToTime(const TrackPtr& track, const MediaPtr& media) {
    const VelaTime end = media->trackRange().end();
    return end == time_ || executeRequired(TrimEndCmd::create(track, media, end - time_));
}

void TrimMediasToFrameCmd::executeCommands(const CommandHandler*) {
    if (mixer_) {
        for (const TrackPtr& track : mixer_->tracks()) {
            const MediaPtr across = SplitCmd::mediaToSplit(*track, time_);
            if (across && !trimToTime(track, across)) return;
        }
        return;
    }
    TrackPtr track;
    media_->parentVisitor([&](const boost::shared_ptr<SubTimeline>& parent) {
        track = boost::dynamic_pointer_cast<Track>(parent);
    });
    if (!track) throw VelaMediaLibException("the clip is on no track");
    const Range<VelaTime> range = media_->trackRange();
    if (time_ <= range.start() || time_ > range.end())
        throw VelaMediaLibException("the time is outside the clip");
    trimToTime(track, media_);
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/SetMediaStateCmd.h>

#include <VelaMediaLib/model/media/Transition.h>

namespace VelaMediaLib {

boost::shared_ptr<SetMediaStateCmd> SetMediaStateCmd::create(const MediaPtr& media, const MediaState& state) {
    return create(TrackPtr(), media, state);
}

boost::shared_ptr<SetMediaStateCmd> SetMediaStateCmd::create(const TrackPtr& track, const MediaPtr& media,
                                                             const MediaState& state) {
    const boost::shared_ptr<SetMediaStateCmd> command(new SetMediaStateCmd(track, media, state));
    command->setName("Set Media State");
    return command;
}

boost::shared_ptr<SetMediaStateCmd>
SetMediaStateCmd::createRounded(const TrackPtr& track, const MediaPtr& media, const MediaState& state) {
    const boost::shared_ptr<SetMediaStateCmd> command = create(track, media, state);
    command->keepRoom_ = false;
    return command;
}

bool SetMediaStateCmd::execute(CommandHandler* handler) {
    need(handler);
    if (!media_) return false;
    if (findTrack_) {
        track_.reset();
        media_->parentVisitor([&](const boost::shared_ptr<SubTimeline>& parent) {
            track_ = boost::dynamic_pointer_cast<Track>(parent);
        });
    }
    if (!track_ || (keepRoom_ && !Transition::keepsRoom(*media_, state_.duration))) return false;
    saveState();
    return keep(handler->restoreMediaState(track_, media_, state_));
}

} // namespace VelaMediaLib

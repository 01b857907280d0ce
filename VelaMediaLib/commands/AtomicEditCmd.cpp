#include <VelaMediaLib/commands/AtomicEditCmd.h>

namespace VelaMediaLib {

bool AtomicEditCmd::keep(const CommandHandler::TrackAndMedia& result) {
    if (!result.second) return false;
    resultTrack_ = result.first;
    resultMedia_ = result.second;
    return true;
}

void AtomicEditCmd::saveState() {
    if (media_) saved_ = media_->state();
}

bool AtomicEditCmd::restoreSavedState(CommandHandler* handler) {
    return bool(handler->restoreMediaState(resultTrack_, resultMedia_, saved_).second);
}

boost::shared_ptr<MoveCmd> MoveCmd::create(const TrackPtr& track, const MediaPtr& media, VelaTime delta) {
    const boost::shared_ptr<MoveCmd> command(new MoveCmd(track, media, delta));
    command->setName("Move");
    return command;
}

bool MoveCmd::execute(CommandHandler* handler) {
    saveState();
    return keep(handler->moveMedia(track_, media_, amount_));
}

bool MoveCmd::unexecute(CommandHandler* handler) { return restoreSavedState(handler); }

CommandPtr MoveCmd::combine(const CommandPtr& later) {
    const boost::shared_ptr<MoveCmd> move = boost::dynamic_pointer_cast<MoveCmd>(later);
    if (!move || move->media_ != resultMedia_ || move->track_ != resultTrack_) return Command::combine(later);
    const boost::shared_ptr<MoveCmd> both = create(track_, media_, amount_ + move->amount_);
    both->resultTrack_ = move->resultTrack_;
    both->resultMedia_ = move->resultMedia_;
    both->saved_ = saved_;
    return both;
}

boost::shared_ptr<AddMediaCmd> AddMediaCmd::create(const TrackPtr& track, const MediaPtr& media,
                                                   VelaTime start) {
    const boost::shared_ptr<AddMediaCmd> command(new AddMediaCmd(track, media, start));
    command->setName("Add Media");
    return command;
}

bool AddMediaCmd::execute(CommandHandler* handler) {
    saveState();
    return keep(handler->addMedia(track_, media_, amount_));
}

// Placing a clip changes only its start; off the track again, it takes back
// the one it had.
bool AddMediaCmd::unexecute(CommandHandler* handler) {
    if (!handler->removeMedia(resultTrack_, resultMedia_).second) return false;
    resultMedia_->setTrackStart(saved_.start);
    return true;
}

boost::shared_ptr<RemoveMediaCmd> RemoveMediaCmd::create(const TrackPtr& track, const MediaPtr& media) {
    const boost::shared_ptr<RemoveMediaCmd> command(new RemoveMediaCmd(track, media));
    command->setName("Remove Media");
    return command;
}

bool RemoveMediaCmd::execute(CommandHandler* handler) {
    if (!media_) return false;
    amount_ = media_->startTime(); // where it goes back on undo
    return keep(handler->removeMedia(track_, media_));
}

bool RemoveMediaCmd::unexecute(CommandHandler* handler) {
    return bool(handler->addMedia(resultTrack_, resultMedia_, amount_).second);
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/ChangeTrackFlagCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<ChangeTrackFlagCmd> ChangeTrackFlagCmd::create(const TrackPtr& track, Flag flag,
                                                                 bool value) {
    if (!track) throw VelaMediaLibException("no track to change");
    const boost::shared_ptr<ChangeTrackFlagCmd> command(new ChangeTrackFlagCmd(track, flag, value));
    command->setName(flag == Locked ? "Lock Track" : (flag == Hidden ? "Hide Track" : "Solo Track"));
    return command;
}

bool ChangeTrackFlagCmd::current() const {
    switch (flag_) {
    case Locked:
        return track_->isLocked();
    case Hidden:
        return track_->attributeValue("videoHidden", false);
    case Solo:
        return track_->attributeValue("solo", false);
    }
    return false;
}

void ChangeTrackFlagCmd::set(bool value) {
    switch (flag_) {
    case Locked:
        track_->setIsLocked(value);
        break;
    case Hidden:
        track_->videoHiddenAttribute()->setValue(value);
        break;
    case Solo:
        track_->soloAttribute()->setValue(value);
        break;
    }
}

bool ChangeTrackFlagCmd::execute(CommandHandler*) {
    previous_ = current();
    if (flag_ == Locked) {
        hadLockEntry_ = track_->hasMetaData(Track::isLockedMetaDataKey());
        previousLockText_ = track_->metaDataValue(Track::isLockedMetaDataKey());
    }
    set(value_);
    return true;
}

bool ChangeTrackFlagCmd::unexecute(CommandHandler*) {
    if (flag_ != Locked) {
        set(previous_);
    } else if (hadLockEntry_) {
        track_->addMetaData(Track::isLockedMetaDataKey(), previousLockText_);
    } else {
        set(false); // observers of the entry hear the track unlocked before it goes
        track_->removeMetaData(Track::isLockedMetaDataKey());
    }
    return true;
}

} // namespace VelaMediaLib

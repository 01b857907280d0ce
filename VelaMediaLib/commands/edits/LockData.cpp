#include <VelaMediaLib/commands/edits/LockData.h>

#include <VelaMediaLib/commands/edits/ChangeTrackFlagCmd.h>

namespace VelaMediaLib {

// A clip inside clips answers with the track of the outermost of them.
TrackPtr LockData::trackOf(const Media& media) {
    const Media* outermost = &media;
    MediaPtr held;
    while (const MediaPtr outer = Track::enclosingClipOf(*outermost)) {
        held = outer;
        outermost = held.get();
    }
    TrackPtr track;
    outermost->parentVisitor([&](const boost::shared_ptr<SubTimeline>& parent) {
        track = boost::dynamic_pointer_cast<Track>(parent);
    });
    return track;
}

bool LockData::IsMediaLocked(const Media& media) {
    const TrackPtr track = trackOf(media);
    return track && track->isLocked();
}

bool LockData::IsMediaHidden(const Media& media) {
    const TrackPtr track = trackOf(media);
    return track && IsTrackHidden(*track);
}

bool LockData::IsMediaInvisible(const Media& media) {
    const TrackPtr track = trackOf(media);
    return track && IsTrackInvisible(*track);
}

bool LockData::IsTransitionLocked(const Transition& transition) {
    for (const MediaPtr& media : {transition.leftMedia(), transition.rightMedia()})
        if (media && IsMediaLocked(*media)) return true;
    return false;
}

bool LockData::IsTransitionHidden(const Transition& transition) {
    for (const MediaPtr& media : {transition.leftMedia(), transition.rightMedia()})
        if (media && IsMediaHidden(*media)) return true;
    return false;
}

std::vector<TrackPtr> LockData::GetAllEditableTracks(const Timeline& timeline) {
    std::vector<TrackPtr> editable;
    for (const MixerPtr& mixer : timeline.mixers())
        for (const TrackPtr& track : mixer->tracks())
            if (IsTrackEditable(*track)) editable.push_back(track);
    return editable;
}

boost::shared_ptr<Command> LockData::GetChangeIsLockedCommand(const TrackPtr& track, bool locked) {
    return ChangeTrackFlagCmd::create(track, ChangeTrackFlagCmd::Locked, locked);
}

boost::shared_ptr<Command> LockData::GetChangeIsHiddenCommand(const TrackPtr& track, bool hidden) {
    return ChangeTrackFlagCmd::create(track, ChangeTrackFlagCmd::Hidden, hidden);
}

boost::shared_ptr<Command> LockData::GetChangeIsSoloCommand(const TrackPtr& track, bool solo) {
    return ChangeTrackFlagCmd::create(track, ChangeTrackFlagCmd::Solo, solo);
}

void LockData::Attach(Track& track, Observer* observer) {
    if (!track.metaDataAttribute(Track::isLockedMetaDataKey())) track.setIsLocked(false);
    track.metaDataAttribute(Track::isLockedMetaDataKey())->attach(observer);
}

void LockData::Detach(Track& track, Observer* observer) {
    if (const auto attribute = track.metaDataAttribute(Track::isLockedMetaDataKey()))
        attribute->detach(observer);
}

} // namespace VelaMediaLib

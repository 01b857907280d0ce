#include <VelaMediaLib/model/TrackMagnetizer.h>

#include <VelaMediaLib/commands/CloseGapsOnTrackCmd.h>

#include <algorithm>

namespace VelaMediaLib {

TrackMagnetizer::TrackMagnetizer(const TrackPtr& track, CommandExecutor& executor)
    : track_(track), executor_(executor), trigger_(track->projectMutex()) {
    track->attachAddObserver(this);
    track->magneticAttribute()->attach(this);
    trigger_.attach(this);
    for (const MediaPtr& media : track->medias()) observe(media);
}

TrackMagnetizer::~TrackMagnetizer() {
    for (const boost::weak_ptr<Media>& held : clips_)
        if (const MediaPtr media = held.lock()) media->detach(this);
    if (const TrackPtr track = track_.lock()) {
        track->detachAddObserver(this);
        track->magneticAttribute()->detach(this);
    }
}

void TrackMagnetizer::observe(const MediaPtr& media) {
    media->attach(this);
    clips_.push_back(media);
}

void TrackMagnetizer::onTrackAddMedia(Track&, const MediaPtr& media) {
    observe(media);
    trigger_.notify();
}

void TrackMagnetizer::onTrackRemoveMedia(Track&, const MediaPtr& media) {
    media->detach(this);
    clips_.erase(std::remove_if(clips_.begin(), clips_.end(),
                                [&](const boost::weak_ptr<Media>& held) {
                                    return held.expired() || held.lock() == media;
                                }),
                 clips_.end());
    trigger_.notify();
}

void TrackMagnetizer::update(Observable*) {
    if (running_ || executor_.isReplaying()) return;
    const TrackPtr track = track_.lock();
    if (!track || !track->attributeValue("magnetic", false) || !CloseGapsOnTrackCmd::hasGap(*track)) return;
    running_ = true;
    try {
        executor_.execute(CloseGapsOnTrackCmd::create(track));
    } catch (...) {
        running_ = false;
        throw;
    }
    running_ = false;
}

} // namespace VelaMediaLib

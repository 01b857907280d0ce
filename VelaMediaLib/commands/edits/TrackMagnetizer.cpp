#include <VelaMediaLib/commands/edits/TrackMagnetizer.h>

#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>

#include <algorithm>

namespace VelaMediaLib {

TrackMagnetizer::TrackMagnetizer(const TrackPtr& track, CommandExecutor& executor)
    : track_(track), executor_(executor), flag_(track->magneticAttribute()), magnetic_(flag_->value()) {
    track->attachAddObserver(this);
    flag_->attachWithoutNotifyDelay(this);
    for (const MediaPtr& media : track->medias()) observe(media);
}

TrackMagnetizer::~TrackMagnetizer() {
    {
        const std::lock_guard<std::mutex> lock(requestMutex_);
        if (const boost::shared_ptr<CloseGapsOnTrackCmd> waiting = waiting_.lock()) waiting->cancel();
    }
    for (const auto& held : clips_)
        if (const MediaPtr media = held.second.lock()) media->detach(this);
    flag_->detach(this);
    if (const TrackPtr track = track_.lock()) track->detachAddObserver(this);
}

// Heard at once, without waiting for the edit's delay: hearing only queues a
// request, and a clip that nobody else observes is then not held back at all.
void TrackMagnetizer::observe(const MediaPtr& media) {
    media->attachWithoutNotifyDelay(this);
    clips_[media.get()] = media;
}

void TrackMagnetizer::onTrackAddMedia(Track&, const MediaPtr& media) {
    observe(media);
    requestClosing();
}

void TrackMagnetizer::onTrackRemoveMedia(Track&, const MediaPtr& media) {
    media->detach(this);
    clips_.erase(media.get());
    requestClosing();
}

void TrackMagnetizer::update(Observable* subject) {
    if (subject == flag_.get()) magnetic_ = flag_->value();
    requestClosing();
}

// Cheap on purpose, as it runs inside every edit of the track's clips: the
// flag is kept at hand, and closing gaps moves every clip after the gap, each
// of them heard again; only the first change after a request has started
// asks for another (which finds no gap and records nothing). A request is
// marked started before it reads the track, so a change heard while it
// waits is one it will see.
void TrackMagnetizer::requestClosing() {
    if (!magnetic_.load() || executor_.isReplaying()) return;
    const std::lock_guard<std::mutex> lock(requestMutex_);
    const boost::shared_ptr<CloseGapsOnTrackCmd> waiting = waiting_.lock();
    if (waiting && !waiting->hasStarted()) return;
    const TrackPtr track = track_.lock();
    if (!track) return;
    const boost::shared_ptr<CloseGapsOnTrackCmd> request = CloseGapsOnTrackCmd::createRequest(track);
    executor_.queueFollowUp(request);
    waiting_ = request;
}

} // namespace VelaMediaLib

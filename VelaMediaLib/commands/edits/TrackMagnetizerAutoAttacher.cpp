#include <VelaMediaLib/commands/edits/TrackMagnetizerAutoAttacher.h>

namespace VelaMediaLib {

TrackMagnetizerAutoAttacher::TrackMagnetizerAutoAttacher(const TimelinePtr& timeline,
                                                         CommandExecutor& executor)
    : timeline_(timeline), executor_(executor) {
    timeline->attachAddObserver(this);
    for (const MixerPtr& mixer : timeline->mixers()) onTimelineAddMixer(*timeline, mixer);
}

TrackMagnetizerAutoAttacher::~TrackMagnetizerAutoAttacher() {
    magnetizers_.clear();
    if (const TimelinePtr timeline = timeline_.lock()) timeline->detachAddObserver(this);
}

void TrackMagnetizerAutoAttacher::add(const TrackPtr& track) {
    std::unique_ptr<TrackMagnetizer>& slot = magnetizers_[track.get()];
    if (!slot) slot.reset(new TrackMagnetizer(track, executor_));
}

void TrackMagnetizerAutoAttacher::onTimelineAddMixer(Timeline&, const MixerPtr& mixer) {
    for (const TrackPtr& track : mixer->tracks()) add(track);
}

void TrackMagnetizerAutoAttacher::onTimelineRemoveMixer(Timeline&, const MixerPtr& mixer) {
    for (const TrackPtr& track : mixer->tracks()) magnetizers_.erase(track.get());
}

} // namespace VelaMediaLib

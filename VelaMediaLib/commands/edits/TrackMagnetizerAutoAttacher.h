#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/commands/edits/TrackMagnetizer.h>

#include <map>
#include <memory>

namespace VelaMediaLib {

/// Gives every track of a timeline its TrackMagnetizer, as tracks and mixers
/// come, and drops it when they go.
class VELAMEDIALIB_API TrackMagnetizerAutoAttacher : public TimelineAddObserver {
public:
    TrackMagnetizerAutoAttacher(const TimelinePtr& timeline, CommandExecutor& executor);
    ~TrackMagnetizerAutoAttacher() override;

    bool hasMagnetizer(const TrackPtr& track) const { return magnetizers_.count(track.get()) > 0; }

    void onTimelineAddTrack(Timeline&, Mixer&, const TrackPtr& track) override { add(track); }
    void onTimelineRemoveTrack(Timeline&, Mixer&, const TrackPtr& track) override {
        magnetizers_.erase(track.get());
    }
    void onTimelineAddMixer(Timeline&, const MixerPtr& mixer) override;
    void onTimelineRemoveMixer(Timeline&, const MixerPtr& mixer) override;

private:
    void add(const TrackPtr& track);

    boost::weak_ptr<Timeline> timeline_;
    CommandExecutor& executor_;
    std::map<const Track*, std::unique_ptr<TrackMagnetizer>> magnetizers_;
};

} // namespace VelaMediaLib

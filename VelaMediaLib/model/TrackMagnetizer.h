#pragma once

#include <VelaMediaLib/commands/CommandExecutor.h>
#include <VelaMediaLib/model/Track.h>
#include <VelaMediaLib/time/Subject.h>

namespace VelaMediaLib {

/// Keeps a magnetic track free of gaps: it observes the track's clips, its
/// "magnetic" flag and the clips coming and going, and when the flag is set
/// and the track has a gap it runs CloseGapsOnTrackCmd through the executor,
/// so that closing the gaps is an undo step of its own. A change heard while
/// the executor undoes or redoes, or while its own command runs, is left alone.
///
/// A clip that comes or goes is answered through a subject of the magnetizer's
/// own, so that the answer waits for the notify delay of the edit that caused
/// it and is recorded after that edit.
class TrackMagnetizer : public Observer, public TrackAddObserver {
public:
    TrackMagnetizer(const TrackPtr& track, CommandExecutor& executor);
    ~TrackMagnetizer() override;
    TrackMagnetizer(const TrackMagnetizer&) = delete;
    TrackMagnetizer& operator=(const TrackMagnetizer&) = delete;

    void update(Observable* subject) override;
    void onTrackAddMedia(Track& track, const MediaPtr& media) override;
    void onTrackRemoveMedia(Track& track, const MediaPtr& media) override;

private:
    void observe(const MediaPtr& media);

    boost::weak_ptr<Track> track_;
    CommandExecutor& executor_;
    Subject trigger_;
    std::vector<boost::weak_ptr<Media>> clips_;
    bool running_ = false;
};

} // namespace VelaMediaLib

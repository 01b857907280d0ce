#pragma once

#include <VelaMediaLib/commands/CommandExecutor.h>
#include <VelaMediaLib/model/Track.h>
#include <VelaMediaLib/time/Subject.h>

namespace VelaMediaLib {

class CloseGapsOnTrackCmd;

/// Keeps a magnetic track free of gaps: it observes the track's clips, its
/// "magnetic" flag and the clips coming and going, and when the flag is set
/// it queues CloseGapsOnTrackCmd on the executor as a follow-up. It never
/// edits from inside a notification: the history runs the request after the
/// edit that caused it, as an undo step of its own (recorded only when the
/// track has a gap by then). It hears changes at once (without notify delay)
/// since all it does is queue; one request waits at a time, however many
/// changes it hears; while the executor replays, it asks for nothing.
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
    void requestClosing();

    boost::weak_ptr<Track> track_;
    CommandExecutor& executor_;
    boost::shared_ptr<Attribute<bool>> flag_; // the track's "magnetic" attribute
    bool magnetic_;
    std::vector<boost::weak_ptr<Media>> clips_;
    boost::weak_ptr<CloseGapsOnTrackCmd> waiting_;
};

} // namespace VelaMediaLib

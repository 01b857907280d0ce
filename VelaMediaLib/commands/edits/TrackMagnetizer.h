#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/CommandExecutor.h>
#include <VelaMediaLib/model/timeline/Track.h>
#include <VelaMediaLib/time/sync/Subject.h>

#include <atomic>
#include <mutex>
#include <unordered_map>

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
///
/// It hears a clip on whichever thread edits it (under the read lock only,
/// so on several threads at once): the flag it keeps is atomic and the
/// waiting request is guarded by a small mutex of its own. A request that
/// has not started when the magnetizer goes (its track left the timeline) is
/// cancelled, and refuses when it comes to run. The executor must outlive it.
class VELAMEDIALIB_API TrackMagnetizer : public Observer, public TrackAddObserver {
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
    std::atomic<bool> magnetic_;
    // The clips it observes, by address, so that a clip leaving a track of
    // thousands is let go at once. Changed under the write lock only.
    std::unordered_map<const Media*, boost::weak_ptr<Media>> clips_;
    std::mutex requestMutex_; // guards waiting_
    boost::weak_ptr<CloseGapsOnTrackCmd> waiting_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <atomic>

namespace VelaMediaLib {

/// Closes every gap on a track, the one before the first clip included: the
/// clips keep their order and end up one after another from 0, each moved
/// with a MoveCmd. Moves to the left go first, earliest clip first, then
/// moves to the right, latest clip first, so no move lands on a clip that
/// has not moved yet. A refused move refuses the whole command (rolled back,
/// false); so does a track without a gap, which leaves nothing to record.
class VELAMEDIALIB_API CloseGapsOnTrackCmd : public MultiCommand {
public:
    static boost::shared_ptr<CloseGapsOnTrackCmd> create(const TrackPtr& track);
    /// A magnetizer's request, queued to run later: it refuses (false,
    /// nothing recorded) when it was cancelled before it started, or when by
    /// then its track is on no timeline (it has left the project).
    static boost::shared_ptr<CloseGapsOnTrackCmd> createRequest(const TrackPtr& track);
    const TrackPtr& track() const { return track_; }
    /// Whether the track has a gap to close.
    static bool hasGap(const Track& track);
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;
    /// Whether execute has begun: a request still waiting to run has not.
    /// Safe from any thread, as is cancel.
    bool hasStarted() const { return state_.load() == Started; }
    /// Makes a command that has not started refuse when it runs.
    void cancel();

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    enum State { Waiting, Started, Cancelled };
    CloseGapsOnTrackCmd(const TrackPtr& track, bool request) : track_(track), request_(request) {}
    TrackPtr track_;
    bool request_;
    std::atomic<int> state_{Waiting};
};

} // namespace VelaMediaLib

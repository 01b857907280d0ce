#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Mixer.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <vector>

namespace VelaMediaLib {

/// Clears a stretch of time on tracks without closing it: on each track, in
/// the order added, a clip across either edge of the range is cut there
/// (SplitCmd), and every clip then inside the range is taken off
/// (RemoveMediaCmd). The clips after the range stay where they are; a
/// magnetic track closes the gap afterwards, as a step of its own. Without a
/// track it throws VelaMediaLibException "can't remove a range without
/// tracks"; a range holding no clip on any track records nothing (false); a
/// sub-edit's refusal refuses the whole.
class VELAMEDIALIB_API RemoveRangeMediaCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException for a range that is not longer than zero.
    static boost::shared_ptr<RemoveRangeMediaCmd> create(const Range<VelaTime>& range);
    void addTrack(const TrackPtr& track);
    /// Adds every track of the mixer, top to bottom.
    void addTracksOf(const MixerPtr& mixer);
    const std::vector<TrackPtr>& tracks() const { return tracks_; }
    /// The clips the last execution took off (the cut parts among them).
    const std::vector<MediaPtr>& removedMedias() const { return removed_; }
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit RemoveRangeMediaCmd(const Range<VelaTime>& range) : range_(range) {}
    bool clearTrack(const TrackPtr& track);

    Range<VelaTime> range_;
    std::vector<TrackPtr> tracks_;
    std::vector<MediaPtr> removed_;
};

} // namespace VelaMediaLib

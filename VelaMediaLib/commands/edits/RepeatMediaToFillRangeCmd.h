#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <vector>

namespace VelaMediaLib {

/// Fills a range of a track with copies of a clip standing one after
/// another from the range's start; the last copy is cut at its end to end
/// with the range (keeping its beginning). The clip itself is only the
/// pattern: it stays where it is. Copies are clones without transitions,
/// placed with one AddMediaCmd each; the last is shortened before it is
/// placed, so a clip right after the range does not stand in its way. All
/// or nothing: a copy that collides (with a clip inside the range, the
/// pattern included) refuses the whole command (false, nothing changed).
class VELAMEDIALIB_API RepeatMediaToFillRangeCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException for no track or clip, or a range not longer than zero.
    static boost::shared_ptr<RepeatMediaToFillRangeCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                               const Range<VelaTime>& range);
    /// The copies the last execution placed, in time order.
    const std::vector<MediaPtr>& createdMedias() const { return created_; }
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    RepeatMediaToFillRangeCmd(const TrackPtr& track, const MediaPtr& media, const Range<VelaTime>& range)
        : track_(track), media_(media), range_(range) {}
    TrackPtr track_;
    MediaPtr media_;
    Range<VelaTime> range_;
    std::vector<MediaPtr> created_;
};

} // namespace VelaMediaLib

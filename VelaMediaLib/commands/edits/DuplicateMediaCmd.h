#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <vector>

namespace VelaMediaLib {

/// Places a copy of each clip on the clip's own track: right after the clip
/// where there is room for it, else at the first place after the clip where
/// it fits (the start of the first gap long enough, or the end of the
/// track). Clips are duplicated earliest first (by start, then in list
/// order), each place found once the copies before it stand, so that
/// duplicating a run of touching clips puts the copies after the run in the
/// same order. A copy is a clone without transitions (one AddMediaCmd
/// each). A clip on no track refuses the whole command (false, nothing
/// changed).
class VELAMEDIALIB_API DuplicateMediaCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException for an empty list, a null clip or a clip given twice.
    static boost::shared_ptr<DuplicateMediaCmd> create(const std::vector<MediaPtr>& medias);
    /// The copies the last execution placed, index for index with the clips given.
    const std::vector<MediaPtr>& createdMedias() const { return created_; }
    /// The first start at or after `from` where a clip of the duration fits on the track.
    static VelaTime firstFreeStart(const Track& track, VelaTime from, VelaTime duration);
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit DuplicateMediaCmd(const std::vector<MediaPtr>& medias) : medias_(medias) {}
    std::vector<MediaPtr> medias_;
    std::vector<MediaPtr> created_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <vector>

namespace VelaMediaLib {

/// Unstitches every stitched media on the tracks (an UnstitchMediaCmd
/// each), as one undo step. Takes no effect (false) when they hold none.
class VELAMEDIALIB_API UnstitchAllCmd : public MultiCommand {
public:
    /// Throws AddRemoveException "no track to unstitch on" for a null track.
    static boost::shared_ptr<UnstitchAllCmd> create(const TrackPtr& track);
    static boost::shared_ptr<UnstitchAllCmd> create(const std::vector<TrackPtr>& tracks);

    using MultiCommand::execute;
    bool execute(CommandHandler* handler) override;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit UnstitchAllCmd(const std::vector<TrackPtr>& tracks) : tracks_(tracks) {}

    std::vector<TrackPtr> tracks_;
};

} // namespace VelaMediaLib

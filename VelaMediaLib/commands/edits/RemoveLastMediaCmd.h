#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

namespace VelaMediaLib {

/// Takes the last clip of a track (the one starting latest) off it, with a
/// RemoveMediaCmd; undo puts it back with its transitions. An empty track
/// leaves nothing to do (false, nothing recorded).
class VELAMEDIALIB_API RemoveLastMediaCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException for no track.
    static boost::shared_ptr<RemoveLastMediaCmd> create(const TrackPtr& track);
    /// The clip the last execution took off, or null.
    const MediaPtr& removedMedia() const { return removed_; }
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit RemoveLastMediaCmd(const TrackPtr& track) : track_(track) {}
    TrackPtr track_;
    MediaPtr removed_;
};

} // namespace VelaMediaLib

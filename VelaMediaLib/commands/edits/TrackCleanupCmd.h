#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

namespace VelaMediaLib {

/// Tidies what edits leave behind on one track (the track itself; groups on
/// it are looked at, not into):
/// - an empty group (no clip on any of its tracks) is taken off
///   (RemoveMediaCmd);
/// - a transition is kept only where it stands: on a free edge of its clip,
///   or between two touching clips of the track that both hold it. A clip
///   holding one that names another clip on its other side which is not the
///   clip touching it there holding it too (the other clip was removed,
///   moved away, or went to another track) gives it up; the other clip, on
///   or off the track, keeps its own slot, so placing it back beside this
///   clip joins them again.
/// Clips never overlap and never last zero ticks, so nothing else can be
/// left over. Refused (false, nothing recorded) when there is nothing to
/// tidy; a sub-edit's refusal refuses the whole.
class VELAMEDIALIB_API TrackCleanupCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException for no track.
    static boost::shared_ptr<TrackCleanupCmd> create(const TrackPtr& track);
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    explicit TrackCleanupCmd(const TrackPtr& track) : track_(track) {}
    bool removeEmptyGroups();
    bool releaseStrayTransitions();
    TrackPtr track_;
};

} // namespace VelaMediaLib

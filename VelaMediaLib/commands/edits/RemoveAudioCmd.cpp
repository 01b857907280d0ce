#include <VelaMediaLib/commands/edits/RemoveAudioCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/SeparateVideoAudioCmd.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>

namespace VelaMediaLib {

boost::shared_ptr<RemoveAudioCmd> RemoveAudioCmd::create(const TrackPtr& track, const MediaPtr& media) {
    const boost::shared_ptr<RemoveAudioCmd> command(
        new RemoveAudioCmd(track, SeparateVideoAudioCmd::unifiedOf(track, media)));
    command->setName("Remove Audio");
    return command;
}

void RemoveAudioCmd::executeCommands(const CommandHandler*) {
    const VelaTime start = unified_->startTime();
    if (!executeRequired(RemoveMediaCmd::create(track_, unified_))) return;
    if (!executeRequired(ReleaseInternalsCmd::create(unified_))) return;
    executeRequired(AddMediaCmd::create(track_, unified_->internalVisualMedia(), start));
}

} // namespace VelaMediaLib

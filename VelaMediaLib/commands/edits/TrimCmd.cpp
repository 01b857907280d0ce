#include <VelaMediaLib/commands/edits/TrimCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<TrimStartCmd> TrimStartCmd::create(const TrackPtr& track, const MediaPtr& media,
                                                     VelaTime delta) {
    const boost::shared_ptr<TrimStartCmd> command(new TrimStartCmd(track, media, delta));
    command->setName("Trim Start");
    return command;
}

bool TrimStartCmd::execute(CommandHandler* handler) {
    need(handler);
    saveState();
    return keep(handler->trimMediaStart(track_, media_, amount_));
}

boost::shared_ptr<TrimEndCmd> TrimEndCmd::create(const TrackPtr& track, const MediaPtr& media,
                                                 VelaTime delta) {
    const boost::shared_ptr<TrimEndCmd> command(new TrimEndCmd(track, media, delta));
    command->setName("Trim End");
    return command;
}

bool TrimEndCmd::execute(CommandHandler* handler) {
    need(handler);
    saveState();
    return keep(handler->trimMediaEnd(track_, media_, amount_));
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/DisplaceMediaOnUnifiedMixerCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<DisplaceMediaOnUnifiedMixerCmd>
DisplaceMediaOnUnifiedMixerCmd::create(const TrackPtr& track, const MediaPtr& media, VelaTime time) {
    if (!track || !media) throw VelaMediaLibException("displacing needs a track and a clip");
    const boost::shared_ptr<DisplaceMediaOnUnifiedMixerCmd> command(
        new DisplaceMediaOnUnifiedMixerCmd(track, media, time));
    command->setName("Displace Media");
    return command;
}

// A clip inside another (a unified clip's part, a group's or a stitched
// clip's child) is that clip's, not for dragging out.
bool DisplaceMediaOnUnifiedMixerCmd::execute(CommandHandler* handler) {
    displaced_.clear();
    if (Track::enclosingClipOf(*media_)) return false;
    if (MultiCommand::execute(handler)) return true;
    displaced_.clear();
    return false;
}

// Each clip moves as far as the one before it now reaches past its start.
std::vector<std::pair<MediaPtr, VelaTime>> DisplaceMediaOnUnifiedMixerCmd::pushes(VelaTime duration) const {
    std::vector<std::pair<MediaPtr, VelaTime>> result;
    ScopedReadLock lock(track_->projectLock());
    VelaTime reach = time_ + duration;
    for (auto at = track_->lower_bound(time_); at != track_->mediaEnd(); ++at) {
        const Range<VelaTime> range = at->second->lockedTrackRange();
        if (range.start() >= reach) break;
        const VelaTime delta = reach - range.start();
        result.emplace_back(at->second, delta);
        reach = range.end() + delta;
    }
    return result;
}

void DisplaceMediaOnUnifiedMixerCmd::executeCommands(const CommandHandler*) {
    const TrackPtr from = boost::dynamic_pointer_cast<Track>(media_->parent());
    if (from && !executeRequired(RemoveMediaCmd::create(from, media_))) return;
    if (SplitCmd::mediaToSplit(*track_, time_) && !executeRequired(SplitCmd::create(track_, time_))) return;
    const std::vector<std::pair<MediaPtr, VelaTime>> moving = pushes(media_->duration());
    for (auto push = moving.rbegin(); push != moving.rend(); ++push)
        if (!executeRequired(MoveCmd::create(track_, push->first, push->second))) return;
    if (!executeRequired(AddMediaCmd::create(track_, media_, time_))) return;
    for (const auto& push : moving) displaced_.push_back(push.first);
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/StretchTrimCmd.h>

#include <VelaMediaLib/model/media/Transition.h>

namespace VelaMediaLib {

// The slice stays; the new scalar is the new length over the slice's, so the
// rounded duration is the new length itself.
bool StretchTrimCmd::execute(CommandHandler* handler) {
    need(handler);
    track_ = parentTrackOf(media_);
    if (!track_) return false;
    saveState();
    const VelaTime kLongest = VelaTime(1) << 61; // far past any document's times, short of overflow
    if (amount_ >= saved_.duration || amount_ < -kLongest || saved_.mediaDuration <= SafeRational(0))
        return false;
    const VelaTime duration = saved_.duration - amount_;
    if (!Transition::keepsRoom(*media_, duration)) return false; // as a trim keeps it
    MediaState next = saved_;
    next.duration = duration;
    next.scalar = SafeRational(duration) / saved_.mediaDuration;
    if (startEdge_) next.start = saved_.start + amount_;
    if (!keep(handler->restoreMediaState(track_, media_, next))) return false;
    saveAfter();
    return true;
}

boost::shared_ptr<StretchTrimStartCmd> StretchTrimStartCmd::create(const MediaPtr& media, VelaTime delta) {
    const boost::shared_ptr<StretchTrimStartCmd> command(new StretchTrimStartCmd(media, delta));
    command->setName("Stretch Trim Start");
    return command;
}

boost::shared_ptr<StretchTrimEndCmd> StretchTrimEndCmd::create(const MediaPtr& media, VelaTime delta) {
    const boost::shared_ptr<StretchTrimEndCmd> command(new StretchTrimEndCmd(media, delta));
    command->setName("Stretch Trim End");
    return command;
}

} // namespace VelaMediaLib

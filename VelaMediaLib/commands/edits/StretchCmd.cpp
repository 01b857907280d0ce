#include <VelaMediaLib/commands/edits/StretchCmd.h>

#include <VelaMediaLib/time/rational/RationalUtil.h>

namespace VelaMediaLib {

boost::shared_ptr<StretchCmd> StretchCmd::create(const MediaPtr& media, const SafeRational& scalar) {
    if (scalar <= SafeRational(0))
        throw ValueException<double>("a clip's scalar must be above zero", scalar.asDouble());
    const boost::shared_ptr<StretchCmd> command(new StretchCmd(media, scalar));
    command->setName("Stretch");
    return command;
}

boost::shared_ptr<StretchCmd> StretchCmd::create(const MediaPtr& media, double scalar) {
    if (!(scalar > 0)) throw ValueException<double>("a clip's scalar must be above zero", scalar);
    return create(media, RationalUtil::fromDoubleApprox(scalar));
}

// The track is the clip's parent at the time; the handler multiplies the
// scalar, so the factor is the new scalar over the present one.
bool StretchCmd::execute(CommandHandler* handler) {
    need(handler);
    if (!media_) return false;
    track_ = parentTrackOf(media_);
    if (!track_) return false;
    saveState();
    if (!keep(handler->stretchMedia(track_, media_, scalar_ / saved_.scalar))) return false;
    saveAfter();
    return true;
}

CommandPtr StretchCmd::combine(const CommandPtr& later) {
    const boost::shared_ptr<StretchCmd> stretch = boost::dynamic_pointer_cast<StretchCmd>(later);
    if (!stretch || stretch->media_ != resultMedia_ || stretch->track_ != resultTrack_)
        return Command::combine(later);
    const boost::shared_ptr<StretchCmd> both(new StretchCmd(media_, stretch->scalar_));
    both->setName(name());
    both->track_ = track_;
    both->resultTrack_ = stretch->resultTrack_;
    both->resultMedia_ = stretch->resultMedia_;
    both->saved_ = saved_;
    both->after_ = stretch->after_;
    return both;
}

} // namespace VelaMediaLib

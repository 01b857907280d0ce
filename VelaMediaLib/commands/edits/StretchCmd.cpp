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
    track_.reset();
    media_->parentVisitor([&](const boost::shared_ptr<SubTimeline>& parent) {
        track_ = boost::dynamic_pointer_cast<Track>(parent);
    });
    if (!track_) return false;
    saveState();
    return keep(handler->stretchMedia(track_, media_, scalar_ / saved_.scalar));
}

} // namespace VelaMediaLib

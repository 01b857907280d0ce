#include <VelaMediaLib/commands/edits/TrimCmd.h>

#include <VelaMediaLib/commands/edits/detail/ContentShift.h>

namespace VelaMediaLib {

// A start trim moves the origin of the clip's own ticks: keyframes,
// animations and effects shift back by as much, so they stay with the
// content under the remaining part.
VelaTime EdgeTrimCmd::originShift() const { return saved_.start - after_.start; }

bool EdgeTrimCmd::execute(CommandHandler* handler) {
    need(handler);
    if (!media_) return false;
    saveState();
    savedEffects_ = media_->allEffects();
    const CommandHandler::TrackAndMedia result = startEdge_ ? handler->trimMediaStart(track_, media_, amount_)
                                                            : handler->trimMediaEnd(track_, media_, amount_);
    if (!keep(result)) return false;
    saveAfter();
    afterEffects_ = savedEffects_;
    const boost::shared_ptr<Effectable::Effects> moved = effectsFollowingEdge(
        savedEffects_, edgeEffects_, saved_.trackRange(), after_.trackRange(), startEdge_);
    if (moved) afterEffects_ = *moved;
    applyContent(afterEffects_, originShift());
    return true;
}

void EdgeTrimCmd::applyContent(const Effectable::Effects& effects, VelaTime shift) {
    detail::shiftKeyframesAndAnimations(*resultMedia_, shift);
    if (afterEffects_ != savedEffects_) resultMedia_->replaceAllEffects(effects);
}

bool EdgeTrimCmd::unexecute(CommandHandler* handler) {
    if (!restoreSavedState(handler)) return false;
    applyContent(savedEffects_, -originShift());
    return true;
}

bool EdgeTrimCmd::reexecute(CommandHandler* handler) {
    if (!restoreAfter(handler)) return false;
    applyContent(afterEffects_, originShift());
    return true;
}

CommandPtr EdgeTrimCmd::combine(const CommandPtr& later) {
    const boost::shared_ptr<EdgeTrimCmd> trim = boost::dynamic_pointer_cast<EdgeTrimCmd>(later);
    if (!trim || trim->startEdge_ != startEdge_ || trim->media_ != resultMedia_ ||
        trim->track_ != resultTrack_)
        return Command::combine(later);
    const boost::shared_ptr<EdgeTrimCmd> both = sameEdge(amount_ + trim->amount_);
    both->resultTrack_ = trim->resultTrack_;
    both->resultMedia_ = trim->resultMedia_;
    both->saved_ = saved_;
    both->savedEffects_ = savedEffects_;
    both->after_ = trim->after_;
    both->afterEffects_ = trim->afterEffects_;
    return both;
}

boost::shared_ptr<TrimStartCmd> TrimStartCmd::create(const TrackPtr& track, const MediaPtr& media,
                                                     VelaTime delta, const EdgeEffects& effects) {
    const boost::shared_ptr<TrimStartCmd> command(new TrimStartCmd(track, media, delta, effects));
    command->setName("Trim Start");
    return command;
}

boost::shared_ptr<TrimStartCmd> TrimStartCmd::create(const TrackPtr& track, const MediaPtr& media,
                                                     VelaTime delta) {
    return create(track, media, delta, magneticEffectsForMedia(media));
}

boost::shared_ptr<EdgeTrimCmd> TrimStartCmd::sameEdge(VelaTime delta) const {
    return create(track_, media_, delta, edgeEffects());
}

boost::shared_ptr<TrimEndCmd> TrimEndCmd::create(const TrackPtr& track, const MediaPtr& media, VelaTime delta,
                                                 const EdgeEffects& effects) {
    const boost::shared_ptr<TrimEndCmd> command(new TrimEndCmd(track, media, delta, effects));
    command->setName("Trim End");
    return command;
}

boost::shared_ptr<TrimEndCmd> TrimEndCmd::create(const TrackPtr& track, const MediaPtr& media,
                                                 VelaTime delta) {
    return create(track, media, delta, magneticEffectsForMedia(media));
}

boost::shared_ptr<EdgeTrimCmd> TrimEndCmd::sameEdge(VelaTime delta) const {
    return create(track_, media_, delta, edgeEffects());
}

} // namespace VelaMediaLib

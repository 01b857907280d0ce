#include <VelaMediaLib/commands/edits/SplitCmd.h>

#include <VelaMediaLib/commands/edits/RemoveEdgeModCmd.h>
#include <VelaMediaLib/commands/edits/RemoveTransitionCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/commands/edits/detail/ContentShift.h>
#include <VelaMediaLib/model/media/MediaImpl.h>

#include <algorithm>

namespace VelaMediaLib {

boost::shared_ptr<SplitCmd> SplitCmd::create(const TrackPtr& track, VelaTime time) {
    if (!track) throw VelaMediaLibException("no track to split on");
    const boost::shared_ptr<SplitCmd> command(new SplitCmd(track, time));
    command->setName("Split");
    return command;
}

MediaPtr SplitCmd::mediaToSplit(const Track& track, VelaTime time) {
    const Track::Pair found = track.mediaAtTime(time);
    const MediaPtr& media = found.second ? found.second : found.first;
    if (!media || media->startTime() >= time) return MediaPtr();
    return media;
}

namespace {

// Effects wholly before the cut go; one across it keeps what lies after.
void cutEffects(Media& copy, VelaTime offset) {
    Effectable::Effects kept;
    for (const Effectable::EffectPtr& effect : copy.allEffects()) {
        if (!effect->hasTimeRange()) { // covers the whole clip
            kept.push_back(effect);
            continue;
        }
        const Range<VelaTime> range = effect->timeRange();
        const VelaTime from = std::max<VelaTime>(range.start() - offset, 0);
        const VelaTime to = range.end() - offset;
        if (to > from) kept.push_back(effect->withTimeRange(Range<VelaTime>(from, to - from)));
    }
    copy.replaceAllEffects(kept);
}

} // namespace

MediaPtr SplitCmd::rightHandCopy(const Media& media, VelaTime offset) {
    const MediaPtr copy = media.clone();
    copy->trimStart(offset); // off a track: the copy's own edit
    detail::shiftKeyframesAndAnimations(*copy, -offset);
    cutEffects(*copy, offset);
    // A clone carries no transition; one that did would not belong at the cut.
    if (copy->leftTransition()) copy->setLeftTransition(TransitionPtr());
    // Nor do the fades in: they stay with the left part's start.
    copy->setLeftEdgeModificationsUnnotified(EdgeModifiable::EdgeModifications());
    return copy;
}

bool SplitCmd::execute(CommandHandler* handler) {
    created_.clear();
    if (!MultiCommand::execute(handler) || numUndoCommands() == 0) {
        created_.clear();
        return false;
    }
    return true;
}

void SplitCmd::executeCommands(const CommandHandler*) {
    const MediaPtr media = mediaToSplit(*track_, time_);
    if (!media) return;
    const Range<VelaTime> range = media->trackRange();
    const VelaTime cut = range.end() - time_;
    const VelaTime offset = time_ - range.start();
    const MediaPtr copy = rightHandCopy(*media, offset);
    const TransitionPtr right = media->rightTransition();
    // The transition goes first: a clip may not be shorter than its transitions.
    if (right && !executeRequired(RemoveTransitionCmd::create(track_, right))) return;
    if (!executeRequired(TrimEndCmd::create(track_, media, cut))) return;
    // The fades out go with the right part's end (its copies of them).
    for (const EdgeModificationPtr& fade : media->rightEdgeModifications())
        if (!executeRequired(RemoveRightEdgeModCmd::create(media, fade))) return;
    if (!executeRequired(AddMediaCmd::create(track_, copy, time_))) return;
    created_.push_back(copy);
    if (!right || right->duration() <= 0) return;
    const VelaTime fitted = std::min(right->duration(), copy->duration());
    if (fitted != right->duration() && !executeRequired(TrimTransitionCmd::create(track_, right, fitted)))
        return;
    executeRequired(AddTransitionCmd::create(track_, copy, right, TransitionEditCmd::Right));
}

} // namespace VelaMediaLib

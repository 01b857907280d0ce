#include <VelaMediaLib/commands/edits/AddTransitionCmd.h>

#include <algorithm>

namespace VelaMediaLib {

bool TransitionEditCmd::unexecute(CommandHandler*) {
    slots_.restore();
    return true;
}

bool TransitionEditCmd::reexecute(CommandHandler*) {
    after_.restore();
    return true;
}

void TransitionEditCmd::saveSlots(const std::vector<MediaPtr>& clips) {
    recorded_ = clips;
    slots_.take(clips);
}

bool TransitionEditCmd::done() {
    after_.take(recorded_);
    return true;
}

bool TransitionEditCmd::onTrack(const std::vector<MediaPtr>& clips) const {
    if (!track_) return false;
    ScopedReadLock lock(track_->projectLock());
    return std::all_of(clips.begin(), clips.end(),
                       [&](const MediaPtr& clip) { return clip && track_->hasMedia(clip); });
}

boost::shared_ptr<AddTransitionCmd> AddTransitionCmd::create(const TrackPtr& track, const MediaPtr& media,
                                                             const TransitionPtr& transition, Side side) {
    const boost::shared_ptr<AddTransitionCmd> command(new AddTransitionCmd(track, media, transition, side));
    command->setName("Add Transition");
    return command;
}

namespace {

MediaPtr touchingOn(const MediaPtr& media, TransitionEditCmd::Side side) {
    return side == TransitionEditCmd::Left ? Track::getTouchingMediaToLeftOfMedia(media)
                                           : Track::getTouchingMediaToRightOfMedia(media);
}

TransitionPtr slotOf(const Media& media, TransitionEditCmd::Side side) {
    return side == TransitionEditCmd::Left ? media.leftTransition() : media.rightTransition();
}

} // namespace

bool AddTransitionCmd::fits(const Track& track, const MediaPtr& media, const TransitionPtr& transition,
                            Side side) {
    ScopedReadLock lock(track.projectLock());
    if (!media || !transition || !track.hasMedia(media) || transition->leftMedia() ||
        transition->rightMedia())
        return false;
    if (slotOf(*media, side) || !Transition::roomFor(*media, transition, TransitionPtr())) return false;
    const MediaPtr neighbour = touchingOn(media, side);
    if (!neighbour) return true;
    const Side facing = side == Left ? Right : Left;
    return !slotOf(*neighbour, facing) && Transition::roomFor(*neighbour, transition, TransitionPtr());
}

bool AddTransitionCmd::execute(CommandHandler*) {
    if (!track_ || !fits(*track_, media_, transition_, side_)) return false;
    const MediaPtr neighbour = touchingOn(media_, side_);
    std::vector<MediaPtr> clips{media_};
    if (neighbour) clips.push_back(neighbour);
    saveSlots(clips);
    if (side_ == Left) {
        media_->setLeftTransition(transition_);
        if (neighbour) neighbour->setRightTransition(transition_);
    } else {
        media_->setRightTransition(transition_);
        if (neighbour) neighbour->setLeftTransition(transition_);
    }
    return done();
}

boost::shared_ptr<AddTransitionToMediasCmd>
AddTransitionToMediasCmd::create(const TrackPtr& track, const std::vector<MediaPtr>& medias,
                                 const TransitionPtr& transition) {
    if (!track || !transition) throw VelaMediaLibException("a transition and a track are needed");
    const boost::shared_ptr<AddTransitionToMediasCmd> command(
        new AddTransitionToMediasCmd(track, medias, transition));
    command->setName("Add Transitions");
    return command;
}

bool AddTransitionToMediasCmd::execute(CommandHandler* handler) {
    return MultiCommand::execute(handler) && numUndoCommands() > 0;
}

// Each edge is looked at after the ones before took theirs, so two touching
// clips of the list share one copy.
void AddTransitionToMediasCmd::executeCommands(const CommandHandler*) {
    for (const MediaPtr& media : medias_)
        for (const TransitionEditCmd::Side side : {TransitionEditCmd::Left, TransitionEditCmd::Right}) {
            const TransitionPtr copy = transition_->clone();
            if (!AddTransitionCmd::fits(*track_, media, copy, side)) continue;
            if (!executeRequired(AddTransitionCmd::create(track_, media, copy, side))) return;
        }
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/RemoveTransitionCmd.h>

#include <boost/make_shared.hpp>

namespace VelaMediaLib {
namespace {

// The clips holding the transition, earlier first; empty when it stands on none.
std::vector<MediaPtr> holders(const TransitionPtr& transition) {
    std::vector<MediaPtr> clips;
    if (!transition) return clips;
    for (const MediaPtr& clip : {transition->leftMedia(), transition->rightMedia()})
        if (clip) clips.push_back(clip);
    return clips;
}

// Whether each clip has room for `in` standing where `out` stands.
bool fitsOn(const std::vector<MediaPtr>& clips, const TransitionPtr& in, const TransitionPtr& out) {
    for (const MediaPtr& clip : clips)
        if (!Transition::roomFor(*clip, in, out)) return false;
    return true;
}

// Sets the slots that hold `from` to `to` (null clears them).
void replaceIn(const std::vector<MediaPtr>& clips, const TransitionPtr& from, const TransitionPtr& to) {
    for (const MediaPtr& clip : clips) {
        if (clip->rightTransition() == from) clip->setRightTransition(to);
        if (clip->leftTransition() == from) clip->setLeftTransition(to);
    }
}

} // namespace

boost::shared_ptr<RemoveTransitionCmd> RemoveTransitionCmd::create(const TrackPtr& track,
                                                                   const TransitionPtr& transition) {
    const boost::shared_ptr<RemoveTransitionCmd> command(new RemoveTransitionCmd(track, transition));
    command->setName("Remove Transition");
    return command;
}

bool RemoveTransitionCmd::execute(CommandHandler*) {
    const std::vector<MediaPtr> clips = holders(transition_);
    if (clips.empty() || !onTrack(clips)) return false;
    saveSlots(clips);
    replaceIn(clips, transition_, TransitionPtr());
    return done();
}

boost::shared_ptr<ReplaceTransitionCmd> ReplaceTransitionCmd::create(const TrackPtr& track,
                                                                     const TransitionPtr& transition,
                                                                     const TransitionPtr& replacement) {
    const boost::shared_ptr<ReplaceTransitionCmd> command(
        new ReplaceTransitionCmd(track, transition, replacement));
    command->setName("Replace Transition");
    return command;
}

bool ReplaceTransitionCmd::execute(CommandHandler*) {
    const std::vector<MediaPtr> clips = holders(transition_);
    if (clips.empty() || !replacement_ || !holders(replacement_).empty() || !onTrack(clips) ||
        !fitsOn(clips, replacement_, transition_))
        return false;
    saveSlots(clips);
    replaceIn(clips, transition_, replacement_);
    return done();
}

boost::shared_ptr<SplitTransitionCmd> SplitTransitionCmd::create(const TrackPtr& track,
                                                                 const TransitionPtr& transition) {
    const boost::shared_ptr<SplitTransitionCmd> command(new SplitTransitionCmd(track, transition));
    command->setName("Split Transition");
    return command;
}

bool SplitTransitionCmd::execute(CommandHandler*) {
    const std::vector<MediaPtr> clips = holders(transition_);
    if (clips.size() != 2 || !onTrack(clips)) return false;
    if (clips[0]->rightTransition() != transition_ || clips[1]->leftTransition() != transition_) return false;
    saveSlots(clips);
    if (!copy_) copy_ = transition_->clone();
    clips[1]->setLeftTransition(copy_);
    return done();
}

boost::shared_ptr<TrimTransitionCmd>
TrimTransitionCmd::create(const TrackPtr& track, const TransitionPtr& transition, VelaTime duration) {
    const boost::shared_ptr<TrimTransitionCmd> command(new TrimTransitionCmd(track, transition, duration));
    command->setName("Trim Transition");
    return command;
}

// A transition's length is read under the project's lock by the clips'
// queries, so it changes under the write lock; the clips tell of it.
bool TrimTransitionCmd::execute(CommandHandler* handler) {
    if (!transition_ || duration_ < 0 || duration_ == transition_->duration()) return false; // nothing to do
    const std::vector<MediaPtr> clips = holders(transition_);
    if (!onTrack(clips) || !fitsOn(clips, boost::make_shared<Transition>("", duration_), transition_))
        return false;
    saved_ = transition_->duration();
    return reexecute(handler);
}

bool TrimTransitionCmd::unexecute(CommandHandler*) {
    setLength(saved_);
    return true;
}

bool TrimTransitionCmd::reexecute(CommandHandler*) {
    setLength(duration_);
    return true;
}

void TrimTransitionCmd::setLength(VelaTime duration) {
    {
        ScopedWriteLock lock(track_->projectMutex());
        transition_->setDuration(duration);
    }
    for (const MediaPtr& clip : holders(transition_)) clip->notify();
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>

#include <VelaMediaLib/model/media/Transition.h>

#include <algorithm>

namespace VelaMediaLib {

// One read lock, so that the slots and links taken belong together.
void TransitionSlots::takeAround(const Track& track, const MediaPtr& media, const Range<VelaTime>& range,
                                 bool always) {
    *this = TransitionSlots();
    token_ = track.projectMutex();
    ScopedReadLock lock(token_);
    std::vector<MediaPtr> clips =
        track.mediasIntersectingRange(Range<VelaTime>(range.start() - 1, range.duration() + 2), media);
    clips.insert(clips.begin(), media);
    takeLocked(clips);
    if (links_.empty() && !always) clips_.clear(); // no transition around: nothing to join
}

void TransitionSlots::take(const std::vector<MediaPtr>& clips) {
    *this = TransitionSlots();
    if (clips.empty()) return;
    token_ = clips.front()->projectMutex();
    ScopedReadLock lock(token_);
    takeLocked(clips);
}

// A clip elsewhere holding one of these transitions lets go when a clip here
// takes it, so its slots are given back too (its other transition's links
// are not touched by that).
void TransitionSlots::takeLocked(const std::vector<MediaPtr>& clips) {
    for (const MediaPtr& clip : clips) addSlots(clip, true);
    const std::vector<Links> taken = links_;
    for (const Links& links : taken)
        for (const boost::weak_ptr<Media>& side : {links.left, links.right}) addSlots(side.lock(), false);
}

void TransitionSlots::addSlots(const MediaPtr& clip, bool withLinks) {
    if (!clip) return;
    for (const Slots& slots : clips_)
        if (slots.media.lock() == clip) return;
    clips_.push_back(Slots{clip, clip->leftTransition(), clip->rightTransition()});
    if (!withLinks) return;
    addLinks(clips_.back().left);
    addLinks(clips_.back().right);
}

void TransitionSlots::addLinks(const TransitionPtr& transition) {
    if (!transition) return;
    for (const Links& links : links_)
        if (links.transition == transition) return;
    links_.push_back(Links{transition, transition->leftMedia(), transition->rightMedia()});
}

// Setting a slot moves links as a side effect, so the links go back last.
void TransitionSlots::restore() const {
    if (clips_.empty()) return;
    for (const Slots& slots : clips_) {
        const MediaPtr media = slots.media.lock();
        if (!media) continue;
        if (media->leftTransition() != slots.left) media->setLeftTransition(slots.left);
        if (media->rightTransition() != slots.right) media->setRightTransition(slots.right);
    }
    ScopedWriteLock lock(token_);
    for (const Links& links : links_) {
        links.transition->setLeftMedia(links.left);
        links.transition->setRightMedia(links.right);
    }
}

bool TransitionSlots::standsAsTaken() const {
    ScopedReadLock lock(token_);
    for (const Slots& slots : clips_) {
        const MediaPtr media = slots.media.lock();
        if (!media || media->leftTransition() != slots.left || media->rightTransition() != slots.right)
            return false;
    }
    for (const Links& links : links_)
        if (links.transition->leftMedia() != links.left.lock() ||
            links.transition->rightMedia() != links.right.lock())
            return false;
    return true;
}

CommandHandler& AtomicEditCmd::need(CommandHandler* handler) {
    if (!handler) throw VelaMediaLibException("no command handler");
    return *handler;
}

TrackPtr AtomicEditCmd::parentTrackOf(const MediaPtr& media) {
    TrackPtr track;
    if (media)
        media->parentVisitor([&](const boost::shared_ptr<SubTimeline>& parent) {
            track = boost::dynamic_pointer_cast<Track>(parent);
        });
    return track;
}

bool AtomicEditCmd::keep(const CommandHandler::TrackAndMedia& result) {
    if (!result.second) return false;
    resultTrack_ = result.first;
    resultMedia_ = result.second;
    return true;
}

void AtomicEditCmd::saveState() {
    if (media_) saved_ = media_->state();
}

void AtomicEditCmd::saveState(const Range<VelaTime>& placed) {
    slots_ = TransitionSlots();
    if (!media_) return;
    saved_ = media_->state();
    if (track_) slots_.takeAround(*track_, media_, placed);
}

bool AtomicEditCmd::restoreSavedState(CommandHandler* handler) {
    if (!need(handler).restoreMediaState(resultTrack_, resultMedia_, saved_).second) return false;
    slots_.restore();
    return true;
}

boost::shared_ptr<MoveCmd> MoveCmd::create(const TrackPtr& track, const MediaPtr& media, VelaTime delta) {
    const boost::shared_ptr<MoveCmd> command(new MoveCmd(track, media, delta));
    command->setName("Move");
    return command;
}

bool MoveCmd::execute(CommandHandler* handler) {
    need(handler);
    saveState();
    return keep(handler->moveMedia(track_, media_, amount_));
}

bool MoveCmd::unexecute(CommandHandler* handler) { return restoreSavedState(handler); }

CommandPtr MoveCmd::combine(const CommandPtr& later) {
    const boost::shared_ptr<MoveCmd> move = boost::dynamic_pointer_cast<MoveCmd>(later);
    if (!move || move->media_ != resultMedia_ || move->track_ != resultTrack_) return Command::combine(later);
    const boost::shared_ptr<MoveCmd> both = create(track_, media_, amount_ + move->amount_);
    both->resultTrack_ = move->resultTrack_;
    both->resultMedia_ = move->resultMedia_;
    both->saved_ = saved_;
    return both;
}

boost::shared_ptr<AddMediaCmd> AddMediaCmd::create(const TrackPtr& track, const MediaPtr& media,
                                                   VelaTime start) {
    const boost::shared_ptr<AddMediaCmd> command(new AddMediaCmd(track, media, start));
    command->setName("Add Media");
    return command;
}

bool AddMediaCmd::execute(CommandHandler* handler) {
    need(handler);
    // A clip whose transitions were lengthened while it was off the track is
    // placed only with the room they need (an undo putting a clip back asks not).
    if (media_ && !Transition::keepsRoom(*media_, media_->duration())) return false;
    saveState(media_ ? Range<VelaTime>(amount_, media_->duration()) : Range<VelaTime>());
    return keep(handler->addMedia(track_, media_, amount_));
}

// Placing a clip changes its start and joins transitions; off the track
// again, it takes back its start, and it and its neighbours their transitions.
bool AddMediaCmd::unexecute(CommandHandler* handler) {
    if (!need(handler).removeMedia(resultTrack_, resultMedia_).second) return false;
    resultMedia_->setTrackStart(saved_.start);
    slots_.restore();
    return true;
}

boost::shared_ptr<RemoveMediaCmd> RemoveMediaCmd::create(const TrackPtr& track, const MediaPtr& media) {
    const boost::shared_ptr<RemoveMediaCmd> command(new RemoveMediaCmd(track, media));
    command->setName("Remove Media");
    return command;
}

bool RemoveMediaCmd::execute(CommandHandler* handler) {
    need(handler);
    if (!media_) return false;
    saveState(media_->trackRange());
    amount_ = saved_.start; // where it goes back on undo
    return keep(handler->removeMedia(track_, media_));
}

bool RemoveMediaCmd::unexecute(CommandHandler* handler) {
    if (!need(handler).addMedia(resultTrack_, resultMedia_, amount_).second) return false;
    slots_.restore();
    return true;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/model/timeline/CollisionException.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>
#include <VelaMediaLib/model/timeline/Mixer.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <algorithm>
#include <cassert>
#include <typeinfo>

namespace VelaMediaLib {
namespace {

const char* const kFlags[] = {"audioMuted", "videoHidden", "magnetic", "matte", "solo"};

// Both ranges are (start, duration); they collide when they share a tick.
bool shareATick(VelaTime start, VelaTime end, const Range<VelaTime>& range) {
    return start < range.end() && range.start() < end;
}

boost::shared_ptr<Track> trackOf(const MediaPtr& media) {
    return media ? boost::dynamic_pointer_cast<Track>(media->parent()) : boost::shared_ptr<Track>();
}

// The range the edit would give the clip, as the previews compute it (a
// trim's preview is plain arithmetic, so a collision is named before the
// clip's own refusal).
Range<VelaTime> previewOf(const Media& media, const Media::TimingEdit& edit) {
    switch (edit.kind) {
    case Media::TimingEdit::Move:
        return media.trackRangeWithMove(edit.amount);
    case Media::TimingEdit::SetStart:
        return Range<VelaTime>(edit.amount, media.lockedTrackRange().duration());
    case Media::TimingEdit::TrimStart:
        return media.trackRangeWithTrimStart(edit.amount);
    case Media::TimingEdit::TrimEnd:
        return media.trackRangeWithTrimEnd(edit.amount);
    case Media::TimingEdit::Stretch:
        return media.trackRangeWithRationalStretch(edit.factor);
    case Media::TimingEdit::Restore:
        return edit.saved->trackRange();
    }
    return media.lockedTrackRange();
}

} // namespace

Track::Track(const boost::weak_ptr<const ThreadSafe>& token)
    : SubTimeline(token), SubTimelineParts<SubTimeline>(token),
      nodePool_(new std::pmr::unsynchronized_pool_resource()), medias_(nodePool_.get()) {
    for (const char* key : kFlags) addAttribute<bool>(key, false);
}

Track::~Track() = default;

boost::shared_ptr<ParameterInterface> Track::createDefaultParameter(const std::string& name) const {
    if (name != "volume") return SubTimelineParts<SubTimeline>::createDefaultParameter(name);
    const auto made = InterpolatingParam<double>::create(projectMutex(), name, 1.0);
    made->setTimeScalable(sharedTimeScale());
    return made;
}

// A clip is on this track only when the track is its parent; every timing
// edit of a placed clip goes through the track, so it is keyed by its start.
Track::MediaMap::const_iterator Track::findMedia(const MediaPtr& media) const {
    if (!media || trackOf(media).get() != this) return medias_.end();
    const auto keyed = medias_.find(media->lockedTrackRange().start());
    return keyed != medias_.end() && keyed->second == media ? keyed : medias_.end();
}

void Track::refuseCollision(const Range<VelaTime>& range, const MediaPtr& media) const {
    if (!mediasIntersectingRange(range, media).empty()) throw CollisionException(range, media, range.start());
}

bool Track::isMadeOfClips(const Media& media) {
    const std::type_info& kind = typeid(media);
    return kind == typeid(Group) || kind == typeid(StitchedMedia) || kind == typeid(UnifiedMedia);
}

MediaPtr Track::enclosingClip() const {
    ScopedReadLock lock(projectLock());
    if (const MediaPtr stitched = parentStitched_.lock()) return stitched;
    const boost::shared_ptr<Mixer> mixer = parentMixer_.lock();
    return mixer ? mixer->parentGroup() : MediaPtr();
}

MediaPtr Track::enclosingClipOf(const Media& media) {
    const boost::shared_ptr<SubTimeline> parent = media.parent();
    if (const auto track = boost::dynamic_pointer_cast<const Track>(parent)) return track->enclosingClip();
    return boost::dynamic_pointer_cast<Media>(parent); // a unified clip's part
}

// Outward through the clips holding the container: a clip put inside itself
// would own itself.
bool Track::isWithin(const Media* container, const Media& clip) {
    for (MediaPtr outer; container; container = outer.get()) {
        if (container == &clip) return true;
        outer = enclosingClipOf(*container);
    }
    return false;
}

void Track::refuseEnclosingGroup(const MediaPtr& media) const {
    const MediaPtr container = enclosingClip();
    if (container && isWithin(container.get(), *media))
        throw AddRemoveException("a group cannot be placed inside itself");
}

// A clip lies on one track at most: one with a live parent elsewhere is refused.
void Track::addMediaSansTypeCheck(const MediaPtr& media, VelaTime start) {
    if (!media) throw AddRemoveException("no clip to add");
    bool moved = false;
    {
        ScopedWriteLock lock(projectMutex());
        const boost::shared_ptr<SubTimeline> parent = media->parent();
        if (parent.get() == this) throw AddRemoveException("the clip is already on this track");
        if (parent) throw AddRemoveException("the clip is already on another track or in a group");
        refuseEnclosingGroup(media);
        const MediaState placed =
            media->stateAfter(Media::TimingEdit::of(Media::TimingEdit::SetStart, start));
        refuseCollision(placed.trackRange(), media);
        const auto keyed = medias_.emplace(start, media).first;
        try {
            index_.insert(start, placed.trackRange().end(), media);
        } catch (...) {
            medias_.erase(keyed);
            throw;
        }
        moved = media->takeStateUnnotified(placed);
        media->setParent(boost::shared_ptr<SubTimeline>(shared_from_this()));
        Transition::mergeMediaPairTransitions(mediaAtTime(start));
        Transition::mergeMediaPairTransitions(mediaAtTime(media->endTime()));
        addObservers_.tell([&](TrackAddObserver& o) { o.onTrackAddMedia(*this, media); });
    }
    if (moved) media->notify();
}

void Track::removeMedia(const MediaPtr& media) {
    ScopedWriteLock lock(projectMutex());
    const auto found = findMedia(media);
    if (found == medias_.end()) throw AddRemoveException("the clip is not on this track");
    index_.erase(found->first);
    medias_.erase(found);
    media->setParent(boost::weak_ptr<SubTimeline>());
    addObservers_.tell([&](TrackAddObserver& o) { o.onTrackRemoveMedia(*this, media); });
}

bool Track::hasMedia(const MediaPtr& media) const {
    ScopedReadLock lock(projectLock());
    return findMedia(media) != medias_.end();
}

size_t Track::numMedias() const {
    ScopedReadLock lock(projectLock());
    return medias_.size();
}

std::vector<MediaPtr> Track::medias() const {
    ScopedReadLock lock(projectLock());
    std::vector<MediaPtr> clips;
    clips.reserve(medias_.size());
    for (const auto& entry : medias_) clips.push_back(entry.second);
    return clips;
}

std::vector<MediaPtr> Track::allMedias() const {
    std::vector<MediaPtr> clips;
    recursivelyVisitAllMedia([&](const MediaPtr& media) { clips.push_back(media); });
    return clips;
}

Track::MediaMap Track::mediaMap() const {
    ScopedReadLock lock(projectLock());
    return medias_;
}

std::vector<TransitionPtr> Track::transitions() const {
    std::vector<TransitionPtr> found;
    for (const MediaPtr& media : medias())
        for (const TransitionPtr& transition : {media->leftTransition(), media->rightTransition()})
            if (transition && std::find(found.begin(), found.end(), transition) == found.end())
                found.push_back(transition);
    return found;
}

// The last clip starting at or before t holds t, unless t is where it starts
// and the clip before ends: then both touching clips hold it. `Answer` makes
// the safe or the raw pair straight from the index's clips (building the pair
// from positions or conditional temporaries costs the query a fifth more).
template <typename Answer>
typename Answer::Result Track::answerAtTime(VelaTime time) const {
    const size_t count = index_.countStartingBy(time);
    if (count == 0) return typename Answer::Result();
    const size_t at = count - 1;
    if (index_.start(at) == time && at > 0 && index_.end(at - 1) == time)
        return Answer::two(index_.media(at - 1), index_.media(at));
    return time < index_.end(at) ? Answer::one(index_.media(at)) : typename Answer::Result();
}

namespace {

struct SharedAnswer {
    typedef Track::Pair Result;
    static Result one(const MediaPtr& media) { return Result(media, MediaPtr()); }
    static Result two(const MediaPtr& left, const MediaPtr& right) { return Result(left, right); }
};

struct RawAnswer {
    typedef Track::RawPair Result;
    static Result one(const MediaPtr& media) { return Result(media.get(), nullptr); }
    static Result two(const MediaPtr& left, const MediaPtr& right) { return Result(left.get(), right.get()); }
};

} // namespace

Track::Pair Track::mediaAtTime(VelaTime time) const {
    ScopedReadLock lock(projectLock());
    return answerAtTime<SharedAnswer>(time);
}

Track::RawPair Track::mediaAtTimeUnderLock(VelaTime time) const {
    assert((!projectLock() || projectLock()->heldByThisThread()) &&
           "mediaAtTimeUnderLock needs the read lock held");
    return answerAtTime<RawAnswer>(time);
}

namespace {

template <typename LeftOut>
std::vector<MediaPtr> intersecting(const Track::MediaMap& medias, const Range<VelaTime>& range,
                                   LeftOut leftOut) {
    std::vector<MediaPtr> found;
    if (range.duration() <= 0) return found;
    auto at = medias.upper_bound(range.start());
    if (at != medias.begin()) --at; // a clip that starts earlier may reach into the range
    for (; at != medias.end() && at->first < range.end(); ++at)
        if (shareATick(at->first, at->second->lockedTrackRange().end(), range) && !leftOut(at->second))
            found.push_back(at->second);
    return found;
}

} // namespace

std::vector<MediaPtr> Track::mediasIntersectingRange(const Range<VelaTime>& range,
                                                     const MediaPtr& leftOut) const {
    ScopedReadLock lock(projectLock());
    return intersecting(medias_, range, [&](const MediaPtr& media) { return media == leftOut; });
}

std::vector<MediaPtr> Track::mediasIntersectingRange(const Range<VelaTime>& range,
                                                     const std::vector<MediaPtr>& leftOut) const {
    ScopedReadLock lock(projectLock());
    return intersecting(medias_, range, [&](const MediaPtr& media) {
        return std::find(leftOut.begin(), leftOut.end(), media) != leftOut.end();
    });
}

std::vector<MediaPtr> Track::mediasIntersectingRange(const Range<VelaTime>& range,
                                                     const std::set<MediaPtr>& leftOut) const {
    ScopedReadLock lock(projectLock());
    return intersecting(medias_, range, [&](const MediaPtr& media) { return leftOut.count(media) > 0; });
}

bool Track::intersectionAtRange(const Range<VelaTime>& range) const {
    return !mediasIntersectingRange(range).empty();
}

std::vector<Track::MediaRange> Track::subSection(const Range<VelaTime>& range) const {
    std::vector<MediaRange> parts;
    for (const MediaPtr& media : mediasIntersectingRange(range)) {
        const VelaTime start = std::max(media->startTime(), range.start());
        const VelaTime end = std::min(media->endTime(), range.end());
        parts.push_back(MediaRange{media, Range<VelaTime>(start, end - start)});
    }
    return parts;
}

MediaPtr Track::getLeftOfMedia(const MediaPtr& media) {
    const boost::shared_ptr<Track> track = trackOf(media);
    if (!track) return MediaPtr();
    ScopedReadLock lock(track->projectLock());
    const auto at = track->findMedia(media);
    return at == track->medias_.end() || at == track->medias_.begin() ? MediaPtr() : std::prev(at)->second;
}

MediaPtr Track::getRightOfMedia(const MediaPtr& media) {
    const boost::shared_ptr<Track> track = trackOf(media);
    if (!track) return MediaPtr();
    ScopedReadLock lock(track->projectLock());
    const auto at = track->findMedia(media);
    if (at == track->medias_.end()) return MediaPtr();
    const auto next = std::next(at);
    return next == track->medias_.end() ? MediaPtr() : next->second;
}

MediaPtr Track::getTouchingMediaToLeftOfMedia(const MediaPtr& media) {
    const MediaPtr left = getLeftOfMedia(media);
    return left && left->endTime() == media->startTime() ? left : MediaPtr();
}

MediaPtr Track::getTouchingMediaToRightOfMedia(const MediaPtr& media) {
    const MediaPtr right = getRightOfMedia(media);
    return right && right->startTime() == media->endTime() ? right : MediaPtr();
}

Track::TransitionAndNeighbour Track::editLocked(const MediaPtr& media, const Media::TimingEdit& edit,
                                                bool& changed, MediaState* after) {
    ScopedWriteLock lock(projectMutex());
    const auto at = findMedia(media);
    if (at == medias_.end()) throw AddRemoveException("the clip is not on this track");
    const Range<VelaTime> preview = previewOf(*media, edit);
    refuseCollision(preview, media);
    const MediaState next = media->stateAfter(edit); // throws, changing nothing, when the clip refuses
    if (next.trackRange() != preview) refuseCollision(next.trackRange(), media);
    const TransitionAndNeighbour before = media->splitMergeTransitions();
    changed = media->takeStateUnnotified(next);
    index_.retime(at->first, next.start, next.trackRange().end());
    if (at->first != next.start) {
        auto node = medias_.extract(at);
        node.key() = next.start;
        medias_.insert(std::move(node));
    }
    if (after) *after = next;
    const bool separated =
        before.first && before.second && next.trackRange().end() != before.second->startTime();
    return separated ? before : TransitionAndNeighbour();
}

Track::TransitionAndNeighbour Track::editPlaced(const MediaPtr& media, const Media::TimingEdit& edit,
                                                MediaState* after) {
    bool changed = false;
    TransitionAndNeighbour separated;
    {
        ScopedWriteLock lock(projectMutex());
        separated = editLocked(media, edit, changed, after);
    }
    if (changed) media->notify();
    return separated;
}

Track::TransitionAndNeighbour Track::move(const MediaPtr& media, VelaTime offset) {
    return editPlaced(media, Media::TimingEdit::of(Media::TimingEdit::Move, offset));
}

Track::TransitionAndNeighbour Track::trimStart(const MediaPtr& media, VelaTime offset) {
    return editPlaced(media, Media::TimingEdit::of(Media::TimingEdit::TrimStart, offset));
}

Track::TransitionAndNeighbour Track::trimEnd(const MediaPtr& media, VelaTime offset) {
    return editPlaced(media, Media::TimingEdit::of(Media::TimingEdit::TrimEnd, offset));
}

SafeRational Track::stretch(const MediaPtr& media, const SafeRational& factor) {
    MediaState after;
    editPlaced(media, Media::TimingEdit::stretch(factor), &after);
    return after.scalar;
}

double Track::stretch(const MediaPtr& media, double factor) {
    return stretch(media, RationalUtil::fromDoubleApprox(factor)).asDouble();
}

void Track::restoreMediaState(const MediaPtr& media, const MediaState& state, VelaTime tolerance) {
    editPlaced(media, Media::TimingEdit::restore(state, tolerance));
}

boost::shared_ptr<Track> Track::copyPortion(const Range<VelaTime>& range,
                                            std::map<MediaPtr, MediaPtr>* copied) const {
    const boost::shared_ptr<Track> portion = cloneEmpty();
    for (const MediaPtr& media : mediasIntersectingRange(range)) {
        const MediaPtr copy = media->clone();
        media->setupSharedClone(copy);
        if (copy->startTime() < range.start()) copy->trimStart(range.start() - copy->startTime());
        if (copy->endTime() > range.end()) copy->trimEnd(copy->endTime() - range.end());
        portion->addMediaSansTypeCheck(copy, copy->startTime() - range.start());
        if (copied) (*copied)[media] = copy;
    }
    return portion;
}

boost::shared_ptr<Track> Track::copyPortion(const std::vector<MediaPtr>& clips,
                                            std::map<MediaPtr, MediaPtr>* copied) const {
    const boost::shared_ptr<Track> portion = cloneEmpty();
    if (clips.empty()) return portion;
    VelaTime earliest = clips.front()->startTime();
    for (const MediaPtr& media : clips) {
        if (!hasMedia(media)) throw AddRemoveException("copyPortion: a clip is not on this track");
        earliest = std::min(earliest, media->startTime());
    }
    for (const MediaPtr& media : clips) {
        const MediaPtr copy = media->clone();
        media->setupSharedClone(copy);
        portion->addMediaSansTypeCheck(copy, media->startTime() - earliest);
        if (copied) (*copied)[media] = copy;
    }
    return portion;
}

void Track::recursivelyVisitAllMedia(const MediaVisitor& visitor) const {
    recursivelyVisitAllMediaWithEarlyExitFlag([&](const MediaPtr& media, bool&) { visitor(media); });
}

namespace {

/// The clips a stitched or unified clip is made of (a group walks its own).
std::vector<MediaPtr> partsOf(const Media& media) {
    const std::type_info& kind = typeid(media); // the cast only for the kinds that have parts
    if (kind == typeid(StitchedMedia)) return dynamic_cast<const StitchedMedia&>(media).medias();
    if (kind == typeid(UnifiedMedia)) {
        const auto& unified = dynamic_cast<const UnifiedMedia&>(media);
        std::vector<MediaPtr> parts;
        if (const MediaPtr visual = unified.internalVisualMedia()) parts.push_back(visual);
        if (const MediaPtr audio = unified.internalAudioMedia()) parts.push_back(audio);
        return parts;
    }
    return std::vector<MediaPtr>();
}

} // namespace

bool Track::visitWithin(const MediaPtr& media, const MediaVisitorWithExit& visitor) {
    bool stop = false;
    visitor(media, stop);
    if (stop) return true;
    if (const Group* group = Group::asGroup(media.get())) return group->recursivelyVisitAllMedia(visitor);
    for (const MediaPtr& part : partsOf(*media))
        if (visitWithin(part, visitor)) return true;
    return false;
}

bool Track::recursivelyVisitAllMediaWithEarlyExitFlag(const MediaVisitorWithExit& visitor) const {
    for (const MediaPtr& media : medias())
        if (visitWithin(media, visitor)) return true;
    return false;
}

void Track::collectInside(const Media& media, const SafeRational& time, std::vector<MediaAtTime>& out) {
    if (const Group* group = Group::asGroup(&media)) return group->collectMediasAtParametricTime(time, out);
    if (typeid(media) == typeid(StitchedMedia)) {
        const auto part = dynamic_cast<const StitchedMedia&>(media).mediaAndSubTimeForParametricTime(time);
        if (!part.first) return;
        out.push_back(MediaAtTime{part.first, part.second});
        return collectInside(*part.first, part.second, out);
    }
    for (const MediaPtr& part : partsOf(media)) { // a unified clip's parts share its time
        out.push_back(MediaAtTime{part, time});
        collectInside(*part, time, out);
    }
}

void Track::recursivelyCollectMediasAtTime(const SafeRational& time, std::vector<MediaAtTime>& out) const {
    ScopedReadLock lock(projectLock());
    const SafeRational tick = RationalUtil::Floor(time);
    const Pair found = mediaAtTime(RationalUtil::toVelaTime(tick));
    for (const MediaPtr& media : {found.first, found.second}) {
        if (!media) continue;
        const Range<VelaTime> range = media->lockedTrackRange();
        if (time != tick && !(time >= range.start() && time < range.end())) continue;
        const SafeRational local = time - SafeRational(range.start());
        out.push_back(MediaAtTime{media, local});
        collectInside(*media, local, out);
    }
}

bool Track::isLocked() const { return metaDataValue(isLockedMetaDataKey()) == "true"; }

void Track::setIsLocked(bool locked) { addMetaData(isLockedMetaDataKey(), locked ? "true" : "false"); }

bool Track::isParentMixerInSoloMode() const {
    const boost::shared_ptr<Mixer> mixer = parentMixer();
    return mixer && mixer->isInSoloMode();
}

bool Track::isAudible(bool soloMode) const {
    return soloMode ? attributeValue("solo", false) : !attributeValue("audioMuted", false);
}

bool Track::isVisible(bool soloMode) const {
    return soloMode ? attributeValue("solo", false) : !attributeValue("videoHidden", false);
}

boost::shared_ptr<Mixer> Track::parentMixer() const {
    ScopedReadLock lock(projectLock());
    return parentMixer_.lock();
}

void Track::setParentMixer(const boost::weak_ptr<Mixer>& mixer) {
    ScopedWriteLock lock(projectMutex());
    parentMixer_ = mixer;
}

MediaPtr Track::parentStitchedMedia() const {
    ScopedReadLock lock(projectLock());
    return parentStitched_.lock();
}

void Track::setParentStitchedMedia(const boost::weak_ptr<Media>& media) {
    ScopedWriteLock lock(projectMutex());
    parentStitched_ = media;
}

void Track::attachAddObserver(TrackAddObserver* observer) { addObservers_.attach(observer); }

void Track::detachAddObserver(TrackAddObserver* observer) { addObservers_.detach(observer, mutex()); }

VelaTime Track::startTime() const {
    ScopedReadLock lock(projectLock());
    return medias_.empty() ? 0 : medias_.begin()->first;
}

VelaTime Track::endTime() const {
    ScopedReadLock lock(projectLock());
    return medias_.empty() ? 0 : medias_.rbegin()->second->lockedTrackRange().end();
}

TimeConverterPtr Track::parentTimeConverter() const {
    ScopedReadLock lock(projectLock());
    if (const boost::shared_ptr<Mixer> mixer = parentMixer_.lock()) return mixer;
    return parentStitched_.lock();
}

boost::shared_ptr<Timeline> Track::parentTimeline() const {
    ScopedReadLock lock(projectLock());
    if (const boost::shared_ptr<Mixer> mixer = parentMixer_.lock()) return mixer->enclosingTimeline();
    if (const MediaPtr stitched = parentStitched_.lock()) return stitched->parentTimeline().lock();
    return boost::shared_ptr<Timeline>();
}

void Track::copyFlagsInto(Track& other) const {
    for (const char* key : kFlags) other.addAttribute<bool>(key, attributeValue(key, false));
    other.setIdentifier(identifier());
    other.setIsLocked(isLocked());
    cloneParametersInto(other);
}

} // namespace VelaMediaLib

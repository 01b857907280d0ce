#include <VelaMediaLib/model/timeline/Mixer.h>

#include <VelaMediaLib/model/media/AudioMedia.h>
#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/project/Sourceable.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/model/media/VisualMedia.h>

#include <algorithm>

namespace VelaMediaLib {

Mixer::~Mixer() {
    for (const TrackPtr& track : tracks_) track->detachAddObserver(this);
}

void Mixer::addTrackSansTypeCheck(const TrackPtr& track, int index) {
    if (!track) throw AddRemoveException("no track to add");
    ScopedWriteLock lock(projectMutex());
    if (index < -1 || index > int(tracks_.size())) throw ValueException<int>("invalid index", index);
    if (std::find(tracks_.begin(), tracks_.end(), track) != tracks_.end())
        throw AddRemoveException("the track is already in this mixer");
    if (track->parentMixer() || track->parentStitchedMedia())
        throw AddRemoveException("the track is already in another mixer or a stitched clip");
    tracks_.insert(index == -1 ? tracks_.end() : tracks_.begin() + index, track);
    track->setParentMixer(shared_from_this());
    track->attachAddObserver(this);
    addObservers_.tell([&](MixerAddObserver& o) { o.onMixerAddTrack(*this, track); });
}

RemoveTrackInfo Mixer::removeTrackImpl(const TrackPtr& track) {
    ScopedWriteLock lock(projectMutex());
    const auto found = std::find(tracks_.begin(), tracks_.end(), track);
    if (found == tracks_.end()) throw AddRemoveException("the track is not in this mixer");
    RemoveTrackInfo info;
    info.track = track;
    info.mixer = shared_from_this();
    info.index = int(found - tracks_.begin());
    tracks_.erase(found);
    track->detachAddObserver(this);
    track->setParentMixer(boost::weak_ptr<Mixer>());
    addObservers_.tell([&](MixerAddObserver& o) { o.onMixerRemoveTrack(*this, track); });
    return info;
}

bool Mixer::removeTrack(const TrackPtr& track) {
    if (!hasTrack(track)) return false;
    removeTrackImpl(track);
    return true;
}

void Mixer::removeTracks(const Tracks& tracks) {
    for (const TrackPtr& track : tracks) removeTrack(track);
}

bool Mixer::swapTrackOrder(const TrackPtr& first, const TrackPtr& second) {
    {
        ScopedWriteLock lock(projectMutex());
        const auto a = std::find(tracks_.begin(), tracks_.end(), first);
        const auto b = std::find(tracks_.begin(), tracks_.end(), second);
        if (a == tracks_.end() || b == tracks_.end()) return false;
        std::iter_swap(a, b);
    }
    notify();
    return true;
}

TrackPtr Mixer::trackAtIndex(unsigned index) const {
    ScopedReadLock lock(projectLock());
    if (index >= tracks_.size())
        throw IndexException("track index " + std::to_string(index) + " out of range");
    return tracks_[index];
}

int Mixer::indexForTrack(const TrackPtr& track) const {
    ScopedReadLock lock(projectLock());
    const auto found = std::find(tracks_.begin(), tracks_.end(), track);
    return found == tracks_.end() ? -1 : int(found - tracks_.begin());
}

Mixer::Tracks Mixer::tracks() const {
    ScopedReadLock lock(projectLock());
    return tracks_;
}

size_t Mixer::numTracks() const {
    ScopedReadLock lock(projectLock());
    return tracks_.size();
}

bool Mixer::hasTrack(const TrackPtr& track) const { return indexForTrack(track) >= 0; }

bool Mixer::sortTracksByIndex(const TrackPtr& a, const TrackPtr& b) {
    const MixerPtr mixerA = a->parentMixer(), mixerB = b->parentMixer();
    return (mixerA ? mixerA->indexForTrack(a) : -1) < (mixerB ? mixerB->indexForTrack(b) : -1);
}

std::vector<MediaPtr> Mixer::allMedias() const {
    std::vector<MediaPtr> clips;
    eachTrack([&](const Track& track) {
        const std::vector<MediaPtr> more = track.allMedias();
        clips.insert(clips.end(), more.begin(), more.end());
    });
    return clips;
}

std::vector<boost::shared_ptr<const Source>> Mixer::allSources() const {
    return Sourceable::sourcesOf(allMedias());
}

namespace {

// A clip made of clips is seen and heard through its parts, which the list holds too.
template <typename Kind>
bool anyOf(const std::vector<MediaPtr>& clips) {
    return std::any_of(clips.begin(), clips.end(), [](const MediaPtr& m) {
        return !Track::isMadeOfClips(*m) && boost::dynamic_pointer_cast<Kind>(m);
    });
}

} // namespace

bool Mixer::hasAudio() const { return anyOf<AudioMedia>(allMedias()); }

bool Mixer::hasVisual() const { return anyOf<VisualMedia>(allMedias()); }

VelaTime Mixer::startTime() const {
    bool any = false;
    VelaTime start = 0;
    eachTrack([&](const Track& track) {
        if (track.numMedias() == 0) return;
        start = any ? std::min(start, track.startTime()) : track.startTime();
        any = true;
    });
    return start;
}

VelaTime Mixer::endTime() const {
    VelaTime end = 0;
    eachTrack([&](const Track& track) { end = std::max(end, track.endTime()); });
    return end;
}

VelaTime Mixer::endTimeNotIncludingHiddenAndMutedTracks() const {
    ScopedReadLock lock(projectLock()); // the solo mode and the ends read together
    const bool solo = isInSoloMode();
    VelaTime end = 0;
    eachTrack([&](const Track& track) {
        if (track.isRenderable(solo)) end = std::max(end, track.endTime());
    });
    return end;
}

bool Mixer::isInSoloMode() const {
    bool solo = false;
    eachTrack([&](const Track& track) { solo = solo || track.attributeValue("solo", false); });
    return solo;
}

boost::shared_ptr<Timeline> Mixer::parentTimeline() const {
    ScopedReadLock lock(projectLock());
    return timeline_.lock();
}

void Mixer::setParentTimeline(const boost::weak_ptr<Timeline>& timeline) {
    ScopedWriteLock lock(projectMutex());
    if (!timeline.expired() && !group_.expired())
        throw VelaMediaLibException("Cannot set parent timeline on a mixer that has a parent group");
    timeline_ = timeline;
}

boost::shared_ptr<Timeline> Mixer::enclosingTimeline() const {
    ScopedReadLock lock(projectLock());
    if (const boost::shared_ptr<Timeline> timeline = timeline_.lock()) return timeline;
    const MediaPtr group = group_.lock();
    return group ? group->parentTimeline().lock() : boost::shared_ptr<Timeline>();
}

// A group's children count their time in the group's media, which its
// children's converter maps from the group's own parametric time.
TimeConverterPtr Mixer::parentTimeConverter() const {
    ScopedReadLock lock(projectLock());
    const MediaPtr owner = group_.lock();
    if (const auto group = boost::dynamic_pointer_cast<Group>(owner)) return group->childrensTimeConverter();
    if (owner) return owner;
    return timeline_.lock();
}

MediaPtr Mixer::parentGroup() const {
    ScopedReadLock lock(projectLock());
    return group_.lock();
}

void Mixer::setParentGroup(const boost::weak_ptr<Media>& group) {
    ScopedWriteLock lock(projectMutex());
    if (!group.expired() && !timeline_.expired())
        throw VelaMediaLibException("Cannot set parent group on a mixer that has a parent timeline");
    group_ = group;
}

void Mixer::attachAddObserver(MixerAddObserver* observer) { addObservers_.attach(observer); }

void Mixer::detachAddObserver(MixerAddObserver* observer) { addObservers_.detach(observer, mutex()); }

void Mixer::onTrackAddMedia(Track& track, const MediaPtr& media) {
    addObservers_.tell([&](MixerAddObserver& o) { o.onMixerAddMedia(*this, track, media); });
}

void Mixer::onTrackRemoveMedia(Track& track, const MediaPtr& media) {
    addObservers_.tell([&](MixerAddObserver& o) { o.onMixerRemoveMedia(*this, track, media); });
}

MixerPtr Mixer::copyPortion(const Range<VelaTime>& range, std::map<MediaPtr, MediaPtr>* copied) const {
    const MixerPtr portion = cloneEmpty();
    for (const TrackPtr& track : tracks())
        portion->addTrackSansTypeCheck(track->copyPortion(range, copied), -1);
    return portion;
}

} // namespace VelaMediaLib

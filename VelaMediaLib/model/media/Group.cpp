#include <VelaMediaLib/model/media/Group.h>

#include <VelaMediaLib/model/media/FileMedia.h>
#include <VelaMediaLib/model/media/MediaDispatcher.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <algorithm>
#include <sstream>

namespace VelaMediaLib {
namespace {

const std::string kAnimationTrackPrefix = "animationTrack:";

bool sameProject(const boost::weak_ptr<const ThreadSafe>& a, const boost::weak_ptr<const ThreadSafe>& b) {
    return !a.owner_before(b) && !b.owner_before(a);
}

bool hasClips(const Mixer& mixer) {
    for (const TrackPtr& track : mixer.tracks())
        if (track->numMedias() > 0) return true;
    return false;
}

// Clips, not the clips made of them: those are seen and heard only through
// their parts.
template <typename Test>
bool anyLeaf(const Group& group, Test test) {
    return group.recursivelyVisitAllMedia([&](const MediaPtr& media, bool& stop) {
        if (!Track::isMadeOfClips(*media) && test(media)) stop = true;
    });
}

int channelsOf(const Media& media) {
    if (media.attributeValue<bool>("mixToMono", false)) return 1;
    if (const FileMedia* file = dynamic_cast<const FileMedia*>(&media)) {
        const boost::shared_ptr<const Source> source = file->source();
        const boost::shared_ptr<MediaFileStats> stats = source ? source->stats() : nullptr;
        if (stats && file->streamIndex() < stats->numTracks()) return stats->numChannels(file->streamIndex());
    }
    return 2;
}

} // namespace

Group::Group(const boost::weak_ptr<const ThreadSafe>& token, const boost::weak_ptr<ProjectEditRate>& rate,
             const MediaState& initial, const boost::shared_ptr<GenericMixer>& mixer)
    : Media(token), VisualMedia(token), AudioMedia(token),
      AbstractUnifiedMedia(token, rate, initial, MediaImpl::Temporal), mixer_(mixer), childrensTime_(*this) {}

Group::~Group() { mixer_->detachAddObserver(this); }

boost::shared_ptr<Group> Group::create(const boost::weak_ptr<const ThreadSafe>& token,
                                       const boost::weak_ptr<ProjectEditRate>& rate, VelaTime start,
                                       VelaTime duration) {
    MediaState state = MediaState::unbounded(start, duration);
    state.minMediaStart = SafeRational(0);
    state.maxMediaEnd = SafeRational(duration);
    return adopt(boost::shared_ptr<Group>(new Group(token, rate, state, GenericMixer::create(token))));
}

boost::shared_ptr<Group> Group::create(const boost::weak_ptr<const ThreadSafe>& token,
                                       const boost::weak_ptr<ProjectEditRate>& rate,
                                       const boost::shared_ptr<GenericMixer>& mixer, VelaTime start) {
    if (!mixer) throw AddRemoveException("no mixer for the group");
    if (!hasClips(*mixer)) throw ValueException<long long>("a group needs clips to play", 0);
    const VelaTime first = mixer->startTime(), end = mixer->endTime();
    return createFromMediaRange(token, rate, mixer, start, SafeRational(first), SafeRational(end - first));
}

boost::shared_ptr<Group> Group::createFromMediaRange(const boost::weak_ptr<const ThreadSafe>& token,
                                                     const boost::weak_ptr<ProjectEditRate>& rate,
                                                     const boost::shared_ptr<GenericMixer>& mixer,
                                                     VelaTime start, const SafeRational& mediaStart,
                                                     const SafeRational& mediaDuration,
                                                     const SafeRational& scalar) {
    if (!mixer) throw AddRemoveException("no mixer for the group");
    if (!sameProject(token, mixer->projectMutex()))
        throw AddRemoveException("the mixer belongs to another project");
    MediaState state = MediaState::ofSlice(start, mediaStart, mediaDuration, scalar);
    if (hasClips(*mixer)) {
        state.minMediaStart = std::min(state.minMediaStart, SafeRational(mixer->startTime()));
        state.maxMediaEnd = std::max(state.maxMediaEnd, SafeRational(mixer->endTime()));
    }
    return adopt(boost::shared_ptr<Group>(new Group(token, rate, state, mixer)));
}

// The mixer is checked before it changes, so a refused mixer stays as it was.
boost::shared_ptr<Group> Group::adopt(const boost::shared_ptr<Group>& group) {
    const boost::shared_ptr<GenericMixer>& mixer = group->mixer_;
    if (mixer->parentGroup()) throw AddRemoveException("the mixer already belongs to a group");
    mixer->setParentGroup(group);
    mixer->attachAddObserver(group.get());
    group->addAttribute<int>("widthAttr", 0);
    group->addAttribute<int>("heightAttr", 0);
    group->addAttribute<std::string>("quickPropertyList", std::string());
    return group;
}

TimeConverterPtr Group::childrensTimeConverter() const {
    return TimeConverterPtr(shared_from_this(), &childrensTime_);
}

void Group::setGroupWidthAndHeight(int width, int height) {
    for (const int side : {width, height})
        if (side < 0) throw ValueException<int>("a group's size must not be negative", side);
    addAttribute<int>("widthAttr", width);
    addAttribute<int>("heightAttr", height);
}

bool Group::updateGroupWidthAndHeightIfNotSet() {
    const int width = this->width(), height = this->height();
    if (width > 0 && height > 0) return false;
    const std::pair<int, int> derived = derivedSize();
    if (derived.first <= 0 || derived.second <= 0) return false;
    setGroupWidthAndHeight(width > 0 ? width : derived.first, height > 0 ? height : derived.second);
    return true;
}

std::pair<int, int> Group::declaredSize() const {
    const int width = this->width(), height = this->height();
    return width > 0 && height > 0 ? std::make_pair(width, height) : derivedSize();
}

std::pair<int, int> Group::derivedSize() const {
    std::pair<int, int> largest(0, 0);
    for (const TrackPtr& track : mixer_->tracks())
        for (const MediaPtr& media : track->medias()) {
            std::pair<int, int> size(media->attributeValue<int>("width", 0),
                                     media->attributeValue<int>("height", 0));
            if (const auto group = boost::dynamic_pointer_cast<Group>(media)) size = group->declaredSize();
            if (size.first <= 0 || size.second <= 0) continue;
            if ((long long)size.first * size.second > (long long)largest.first * largest.second)
                largest = size;
        }
    if (largest.first > 0) return largest;
    if (const TimelinePtr timeline = parentTimeline().lock())
        return std::make_pair(timeline->attributeValue<int>("width", 0),
                              timeline->attributeValue<int>("height", 0));
    return largest;
}

std::vector<std::string> Group::quickPropertyList() const {
    std::vector<std::string> names;
    std::istringstream lines(attributeValue<std::string>("quickPropertyList", std::string()));
    for (std::string name; std::getline(lines, name);)
        if (!name.empty()) names.push_back(name);
    return names;
}

void Group::setQuickPropertyList(const std::vector<std::string>& names) {
    std::string joined;
    for (const std::string& name : names) {
        if (name.empty() || name.find('\n') != std::string::npos)
            throw ValueException<std::string>("a quick property needs a name on one line", name);
        joined += (joined.empty() ? "" : "\n") + name;
    }
    addAttribute<std::string>("quickPropertyList", joined);
}

std::vector<std::string> Group::autoQuickPropertyList() const {
    std::vector<std::string> names;
    if (hasVisual()) names = {"translation", "scale", "rotation", "opacity"};
    if (hasAudio()) names.push_back("volume");
    return names;
}

std::vector<std::string> Group::unusedQuickPropertyList() const {
    const std::vector<std::string> chosen = quickPropertyList();
    std::vector<std::string> unused;
    for (const std::string& name : autoQuickPropertyList())
        if (std::find(chosen.begin(), chosen.end(), name) == chosen.end()) unused.push_back(name);
    return unused;
}

std::vector<std::string> Group::animationTrackNames() const {
    std::vector<std::string> names;
    for (const std::string& name : parameterNames())
        if (name.compare(0, kAnimationTrackPrefix.size(), kAnimationTrackPrefix) == 0)
            names.push_back(name.substr(kAnimationTrackPrefix.size()));
    return names;
}

boost::shared_ptr<Parameter<double>> Group::animationTrackWithName(const std::string& name) const {
    if (!hasMadeParameter(kAnimationTrackPrefix + name)) return boost::shared_ptr<Parameter<double>>();
    return typedParameter<double>(kAnimationTrackPrefix + name);
}

boost::shared_ptr<Parameter<double>> Group::addAnimationTrack(const std::string& name) {
    if (name.empty()) throw ValueException<std::string>("an animation track needs a name", name);
    if (const auto existing = animationTrackWithName(name)) return existing;
    const auto made = InterpolatingParam<double>::create(projectMutex(), kAnimationTrackPrefix + name, 0.0);
    made->setTimeScalable(sharedTimeScale());
    addParameter(kAnimationTrackPrefix + name, made);
    return made;
}

bool Group::hasAudio() const {
    return anyLeaf(*this, [](const MediaPtr& m) { return bool(boost::dynamic_pointer_cast<AudioMedia>(m)); });
}

bool Group::hasVisual() const {
    return anyLeaf(*this,
                   [](const MediaPtr& m) { return bool(boost::dynamic_pointer_cast<VisualMedia>(m)); });
}

int Group::numChannels() const {
    int most = 0;
    anyLeaf(*this, [&](const MediaPtr& m) {
        if (boost::dynamic_pointer_cast<AudioMedia>(m)) most = std::max(most, channelsOf(*m));
        return false;
    });
    return most;
}

bool Group::recursivelyContainsMedia(const MediaPtr& media) const {
    if (!media) return false;
    return recursivelyVisitAllMedia([&](const MediaPtr& inside, bool& stop) { stop = inside == media; });
}

Range<SafeRational> Group::visualMediaRange() const {
    const MediaState state = this->state();
    SafeRational first = state.mediaEnd(), last = state.mediaStart;
    for (const TrackPtr& track : mixer_->tracks())
        for (const MediaPtr& media : track->medias()) {
            const auto group = boost::dynamic_pointer_cast<Group>(media);
            if (group ? !group->hasVisual() : !boost::dynamic_pointer_cast<VisualMedia>(media)) continue;
            const Range<VelaTime> range = media->trackRange();
            first = std::min(first, std::max(SafeRational(range.start()), state.mediaStart));
            last = std::max(last, std::min(SafeRational(range.end()), state.mediaEnd()));
        }
    if (last <= first) return Range<SafeRational>(state.mediaStart, SafeRational(0));
    return Range<SafeRational>(first, last - first);
}

bool Group::recursivelyVisitAllMedia(const Track::MediaVisitorWithExit& visitor) const {
    for (const TrackPtr& track : mixer_->tracks())
        if (track->recursivelyVisitAllMediaWithEarlyExitFlag(visitor)) return true;
    return false;
}

void Group::collectMediasAtParametricTime(const SafeRational& time,
                                          std::vector<Track::MediaAtTime>& out) const {
    ScopedReadLock lock(projectLock()); // one snapshot of the group and what it plays
    if (time < 0 || time >= SafeRational(lockedTrackRange().duration())) return;
    const SafeRational inner = childrensTime_.parentParametricTimeToThisParametricTime(time);
    for (auto track = mixer_->trackBegin(); track != mixer_->trackEnd(); ++track)
        (*track)->recursivelyCollectMediasAtTime(inner, out);
}

GroupMediaState Group::groupMediaState() const {
    ScopedReadLock lock(projectLock());
    return GroupMediaState(state(), width(), height());
}

void Group::restoreGroupMediaState(const GroupMediaState& saved, VelaTime tolerance) {
    for (const int side : {saved.width, saved.height})
        if (side < 0) throw ValueException<int>("a group's size must not be negative", side);
    restoreState(saved, tolerance);
    setGroupWidthAndHeight(saved.width, saved.height);
}

void Group::restoreGroupMediaState(const MediaState&, VelaTime) {
    throw VelaMediaLibException("Cannot restore state with non-GroupMediaState MediaState");
}

void Group::checkTrim(TimingEdit::Kind kind, VelaTime offset) const {
    if (offset == 0) return;
    if (kind == TimingEdit::TrimStart && !validTrimStart(offset))
        throw InvalidTrimRangeException("invalid trimStart for Group.", offset, trackRange());
    if (kind == TimingEdit::TrimEnd && !validTrimEnd(offset))
        throw InvalidTrimRangeException("invalid trimEnd for Group.", offset, trackRange());
}

void Group::trimStart(VelaTime offset) {
    checkTrim(TimingEdit::TrimStart, offset);
    AbstractUnifiedMedia::trimStart(offset);
}

void Group::trimEnd(VelaTime offset) {
    checkTrim(TimingEdit::TrimEnd, offset);
    AbstractUnifiedMedia::trimEnd(offset);
}

MediaState Group::stateAfter(const TimingEdit& edit) const {
    checkTrim(edit.kind, edit.amount);
    return AbstractUnifiedMedia::stateAfter(edit);
}

Rect<float> Group::sourceCropRectAtTime(const RationalTime&) const {
    throw VelaMediaLibException("deprecated call sourceCropRectAtTime on Group");
}

// Each track is copied empty, then takes a clone of each of its clips where
// the clip stands; a group inside clones its own tracks the same way.
boost::shared_ptr<Media> Group::clone() const {
    const auto mixer = boost::dynamic_pointer_cast<GenericMixer>(mixer_->cloneEmpty());
    for (const TrackPtr& track : mixer_->tracks()) {
        const auto copy = boost::dynamic_pointer_cast<GenericTrack>(track->cloneEmpty());
        if (!copy) throw TypeException("a group's tracks must be generic tracks");
        mixer->addTrack(copy);
        for (const MediaPtr& media : track->medias()) {
            const MediaPtr child = media->clone();
            media->setupSharedClone(child);
            copy->addMedia(child, media->startTime());
        }
    }
    const boost::shared_ptr<Group> group =
        adopt(boost::shared_ptr<Group>(new Group(projectMutex(), projectEditRate(), state(), mixer)));
    copyContentInto(*group);
    group->assetProperties_ = assetProperties(); // the copy is not shared yet
    return group;
}

void Group::dispatch(MediaDispatcher& dispatcher) { dispatcher.dispatchGroup(*this); }
void Group::dispatch(ConstMediaDispatcher& dispatcher) const { dispatcher.dispatchGroup(*this); }

void Group::onMixerAddTrack(Mixer& mixer, const TrackPtr& track) {
    addObservers_.tell([&](MixerAddObserver& o) { o.onMixerAddTrack(mixer, track); });
}

void Group::onMixerRemoveTrack(Mixer& mixer, const TrackPtr& track) {
    addObservers_.tell([&](MixerAddObserver& o) { o.onMixerRemoveTrack(mixer, track); });
}

void Group::onMixerAddMedia(Mixer& mixer, Track& track, const MediaPtr& media) {
    addObservers_.tell([&](MixerAddObserver& o) { o.onMixerAddMedia(mixer, track, media); });
}

void Group::onMixerRemoveMedia(Mixer& mixer, Track& track, const MediaPtr& media) {
    addObservers_.tell([&](MixerAddObserver& o) { o.onMixerRemoveMedia(mixer, track, media); });
}

} // namespace VelaMediaLib

#include <VelaMediaLib/model/timeline/Timeline.h>

#include <VelaMediaLib/model/media/Group.h>

#include <VelaMediaLib/model/project/Sourceable.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/parameters/LeftParameter.h>

#include <algorithm>
#include <cmath>

namespace VelaMediaLib {
namespace {

const double kDefaultFovDegrees = 45.0;

Point3d minus(const Point3d& a, const Point3d& b) { return Point3d(a.x - b.x, a.y - b.y, a.z - b.z); }
double dot(const Point3d& a, const Point3d& b) { return a.x * b.x + a.y * b.y + a.z * b.z; }
Point3d cross(const Point3d& a, const Point3d& b) {
    return Point3d(a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x);
}
Point3d normalized(const Point3d& v) {
    const double length = std::sqrt(dot(v, v));
    return length > 0 ? Point3d(v.x / length, v.y / length, v.z / length) : v;
}

// Rows x, y, z of a view matrix with the eye moved to the origin.
TransformMatrix view(const Point3d& x, const Point3d& y, const Point3d& z, const Point3d& eye) {
    return TransformMatrix(
        {x.x, x.y, x.z, -dot(x, eye), y.x, y.y, y.z, -dot(y, eye), z.x, z.y, z.z, -dot(z, eye), 0, 0, 0, 1});
}

} // namespace

Timeline::Timeline(const boost::weak_ptr<const ThreadSafe>& token)
    : SubProject(token), ObjectSubject(token), Parametric(token), Attributable(token),
      deletionPoints_(new DeletionPointList(token)) {}

Timeline::~Timeline() {
    for (const auto& entry : mixers_) entry.second->detachAddObserver(this);
}

boost::shared_ptr<Timeline> Timeline::create(const boost::weak_ptr<const ThreadSafe>& token, int width,
                                             int height) {
    const boost::shared_ptr<Timeline> timeline(new Timeline(token));
    timeline->addAttribute<int>("width", width);
    timeline->addAttribute<int>("height", height);
    timeline->addAttribute("backgroundColor", TemplatedColor<int>(0, 0, 0, 255));
    timeline->addAttribute<double>("gain", 1.0);
    timeline->addAttribute<bool>("legacyAttenuateAudioMix", false);
    return timeline;
}

std::vector<std::string> Timeline::defaultParameterNames() const {
    return {"eyePosition",      "eyeLookAtPosition", "eyeUpVector", "fov",
            "nearClipDistance", "farClipDistance",   "markers"};
}

double Timeline::defaultEyeDistance() const {
    return attributeValue<int>("height", 1080) / 2.0 / std::tan(kDefaultFovDegrees * M_PI / 360.0);
}

boost::shared_ptr<ParameterInterface> Timeline::createDefaultParameter(const std::string& name) const {
    const boost::weak_ptr<const ThreadSafe> token = projectMutex();
    if (name == "eyePosition")
        return InterpolatingParam<Point3d>::create(token, name, Point3d(0, 0, defaultEyeDistance()));
    if (name == "eyeLookAtPosition")
        return InterpolatingParam<Point3d>::create(token, name, Point3d(0, 0, 0));
    if (name == "eyeUpVector") return InterpolatingParam<Point3d>::create(token, name, Point3d(0, 1, 0));
    if (name == "fov") return InterpolatingParam<double>::create(token, name, kDefaultFovDegrees);
    if (name == "nearClipDistance") return InterpolatingParam<double>::create(token, name, 1.0);
    if (name == "farClipDistance") return InterpolatingParam<double>::create(token, name, 100000.0);
    if (name == "markers") return LeftParameter<std::string>::create(token, name, std::string());
    return Parametric::createDefaultParameter(name);
}

MixerPtr Timeline::mixer(const std::string& name) const {
    ScopedReadLock lock(projectLock());
    const auto found = mixers_.find(name);
    return found == mixers_.end() ? MixerPtr() : found->second;
}

MixerPtr Timeline::mixer() const {
    ScopedReadLock lock(projectLock());
    return mixers_.empty() ? MixerPtr() : mixers_.begin()->second;
}

std::vector<std::string> Timeline::mixerNames() const {
    ScopedReadLock lock(projectLock());
    std::vector<std::string> names;
    for (const auto& entry : mixers_) names.push_back(entry.first);
    return names;
}

std::vector<MixerPtr> Timeline::mixers() const {
    std::vector<MixerPtr> all;
    ScopedReadLock lock(projectLock());
    for (const auto& entry : mixers_) all.push_back(entry.second);
    return all;
}

boost::shared_ptr<GenericMixer> Timeline::newMixer(const std::string& name) {
    const boost::shared_ptr<GenericMixer> made = GenericMixer::create(projectMutex());
    made->setIdentifier(name);
    addMixer(name, made);
    return made;
}

void Timeline::addMixer(const std::string& name, const MixerPtr& mixer) {
    if (!mixer) throw AddRemoveException("no mixer to add");
    {
        ScopedWriteLock lock(projectMutex());
        if (mixers_.count(name)) throw AddRemoveException("the timeline already has a mixer named " + name);
        if (mixer->parentTimeline()) throw AddRemoveException("the mixer already belongs to a timeline");
        mixer->setParentTimeline(shared_from_this()); // throws when the mixer has a group
        mixers_[name] = mixer;
        mixer->attachAddObserver(this);
    }
    addObservers_.tell([&](TimelineAddObserver& o) { o.onTimelineAddMixer(*this, mixer); });
}

void Timeline::removeMixer(const MixerPtr& mixer) {
    {
        ScopedWriteLock lock(projectMutex());
        const auto found =
            std::find_if(mixers_.begin(), mixers_.end(), [&](const auto& e) { return e.second == mixer; });
        if (found == mixers_.end()) throw VelaMediaLibException("unable to find mixer");
        mixers_.erase(found);
        mixer->detachAddObserver(this);
        mixer->setParentTimeline(boost::weak_ptr<Timeline>());
    }
    addObservers_.tell([&](TimelineAddObserver& o) { o.onTimelineRemoveMixer(*this, mixer); });
}

boost::shared_ptr<GenericTrack> Timeline::newTrack() const { return GenericTrack::create(projectMutex()); }

void Timeline::addTrack(const MixerPtr& mixer, const TrackPtr& track, int index) {
    ScopedWriteLock lock(projectMutex()); // the mixer stays on this timeline meanwhile
    const boost::shared_ptr<GenericMixer> generic = boost::dynamic_pointer_cast<GenericMixer>(mixer);
    if (!generic || mixer->parentTimeline().get() != this)
        throw AddRemoveException("the mixer does not belong to this timeline");
    generic->addTrack(track, index);
}

RemoveTrackInfo Timeline::removeTrack(const MixerPtr& mixer, const TrackPtr& track) {
    ScopedWriteLock lock(projectMutex());
    for (const auto& entry : mixers_)
        if (entry.second == mixer && mixer->hasTrack(track)) return mixer->removeTrackImpl(track);
    throw VelaMediaLibException("track doesn't belong to project");
}

size_t Timeline::numTracks() const {
    size_t count = 0;
    eachMixer([&](const Mixer& mixer) { count += mixer.numTracks(); });
    return count;
}

std::vector<MediaPtr> Timeline::allMedias() const {
    std::vector<MediaPtr> clips;
    eachMixer([&](const Mixer& mixer) {
        const std::vector<MediaPtr> more = mixer.allMedias();
        clips.insert(clips.end(), more.begin(), more.end());
    });
    return clips;
}

namespace {

// What a clip made of clips plays at the tick, after the clip itself.
void addInside(const MediaPtr& media, VelaTime time, std::vector<MediaPtr>& clips) {
    std::vector<Track::MediaAtTime> inside;
    Track::collectInside(*media, SafeRational(time - media->lockedTrackRange().start()), inside);
    for (const Track::MediaAtTime& found : inside) clips.push_back(found.media);
}

} // namespace

std::vector<MediaPtr> Timeline::allMediasAtTime(VelaTime time) const {
    ScopedReadLock lock(projectLock());
    std::vector<MediaPtr> clips;
    for (const auto& entry : mixers_)
        for (auto track = entry.second->trackBegin(); track != entry.second->trackEnd(); ++track) {
            const Track::Pair pair = (*track)->mediaAtTime(time);
            if (pair.first) clips.push_back(pair.first);
            if (pair.first && Track::isMadeOfClips(*pair.first)) addInside(pair.first, time, clips);
            if (pair.second) clips.push_back(pair.second);
            if (pair.second && Track::isMadeOfClips(*pair.second)) addInside(pair.second, time, clips);
        }
    return clips;
}

std::vector<Track::MediaAtTime> Timeline::allMediasAndTimesAtTime(VelaTime time) const {
    ScopedReadLock lock(projectLock());
    std::vector<Track::MediaAtTime> found;
    for (const auto& entry : mixers_)
        for (auto track = entry.second->trackBegin(); track != entry.second->trackEnd(); ++track)
            (*track)->recursivelyCollectMediasAtTime(SafeRational(time), found);
    return found;
}

std::vector<boost::shared_ptr<const Source>> Timeline::allSources() const {
    return Sourceable::sourcesOf(allMedias());
}

std::vector<MediaPtr> Timeline::instancesOf(const boost::shared_ptr<const Source>& source) const {
    return Sourceable::clipsOf(allMedias(), source);
}

namespace {

void collectHeld(const DeletionPoint& point, std::vector<MediaPtr>& held) {
    for (const DeletionPoint::RemovedClip& clip : point.clips()) {
        Track::visitWithin(clip.media, [&](const MediaPtr& inner, bool&) { held.push_back(inner); });
    }
    for (const DeletionPoint::InnerPoint& inner : point.innerPoints()) collectHeld(*inner.point, held);
}

} // namespace

bool Timeline::hasInstanceOf(const boost::shared_ptr<const Source>& source) const {
    if (!instancesOf(source).empty()) return true;
    std::vector<MediaPtr> held;
    for (const DeletionPointPtr& point : deletionPoints_->allPoints()) collectHeld(*point, held);
    return !Sourceable::clipsOf(held, source).empty();
}

size_t Timeline::swapSourceForTimelineMedias(const boost::shared_ptr<const Source>& from,
                                             const boost::shared_ptr<const Source>& to) {
    const std::vector<MediaPtr> clips = instancesOf(from);
    // Every clip must be able to play the new source before any takes it.
    for (const MediaPtr& media : clips) boost::dynamic_pointer_cast<Sourceable>(media)->checkSource(to);
    for (const MediaPtr& media : clips) {
        boost::dynamic_pointer_cast<Sourceable>(media)->setSource(to);
        media->mediaSourceChanged();
    }
    return clips.size();
}

VelaTime Timeline::endTime() const {
    VelaTime end = 0;
    eachMixer([&](const Mixer& mixer) { end = std::max(end, mixer.endTime()); });
    return end;
}

VelaTime Timeline::endTimeNotIncludingHiddenAndMutedTracks() const {
    VelaTime end = 0;
    eachMixer(
        [&](const Mixer& mixer) { end = std::max(end, mixer.endTimeNotIncludingHiddenAndMutedTracks()); });
    return end;
}

CaptionAttributes Timeline::captionAttributes() const {
    ScopedReadLock lock(projectLock());
    return captions_;
}

void Timeline::setCaptionAttributes(const CaptionAttributes& attributes) {
    {
        ScopedWriteLock lock(projectMutex());
        captions_ = attributes;
    }
    notify();
}

Timeline::Camera Timeline::cameraAtTime(const RationalTime& time) const {
    Camera camera;
    camera.eye = parameterValueAtTime("eyePosition", time, Point3d(0, 0, defaultEyeDistance()));
    camera.lookAt = parameterValueAtTime("eyeLookAtPosition", time, Point3d(0, 0, 0));
    camera.up = parameterValueAtTime("eyeUpVector", time, Point3d(0, 1, 0));
    camera.fovDegrees = parameterValueAtTime("fov", time, kDefaultFovDegrees);
    camera.nearClip = parameterValueAtTime("nearClipDistance", time, 1.0);
    camera.farClip = parameterValueAtTime("farClipDistance", time, 100000.0);
    camera.aspect = double(attributeValue<int>("width", 1920)) / double(attributeValue<int>("height", 1080));
    return camera;
}

TransformMatrix Timeline::cameraTransformAtTime(const RationalTime& time) const {
    const Camera c = cameraAtTime(time);
    const Point3d forward = normalized(minus(c.lookAt, c.eye));
    const Point3d side = normalized(cross(forward, c.up));
    const Point3d up = cross(side, forward);
    return view(side, up, Point3d(-forward.x, -forward.y, -forward.z), c.eye);
}

TransformMatrix Timeline::cameraTransformAtTimeLH(const RationalTime& time) const {
    const Camera c = cameraAtTime(time);
    const Point3d z = normalized(minus(c.lookAt, c.eye));
    const Point3d x = normalized(cross(c.up, z));
    return view(x, cross(z, x), z, c.eye);
}

TransformMatrix Timeline::projectionTransformAtTime(const RationalTime& time) const {
    const Camera c = cameraAtTime(time);
    const double f = 1.0 / std::tan(c.fovDegrees * M_PI / 360.0), n = c.nearClip, far = c.farClip;
    return TransformMatrix({f / c.aspect, 0, 0, 0, 0, f, 0, 0, 0, 0, (far + n) / (n - far),
                            2 * far * n / (n - far), 0, 0, -1, 0});
}

TransformMatrix Timeline::projectionTransformAtTimeLH(const RationalTime& time) const {
    const Camera c = cameraAtTime(time);
    const double f = 1.0 / std::tan(c.fovDegrees * M_PI / 360.0), n = c.nearClip, far = c.farClip;
    return TransformMatrix(
        {f / c.aspect, 0, 0, 0, 0, f, 0, 0, 0, 0, far / (far - n), -n * far / (far - n), 0, 0, 1, 0});
}

TransformMatrix Timeline::calcScreenTransformAtTime(const RationalTime& time) const {
    const double width = attributeValue<int>("width", 1920), height = attributeValue<int>("height", 1080);
    const TransformMatrix viewport(
        {width / 2, 0, 0, width / 2, 0, -height / 2, 0, height / 2, 0, 0, 1, 0, 0, 0, 0, 1});
    return viewport * projectionTransformAtTime(time) * cameraTransformAtTime(time);
}

void Timeline::attachAddObserver(TimelineAddObserver* observer) { addObservers_.attach(observer); }

void Timeline::detachAddObserver(TimelineAddObserver* observer) { addObservers_.detach(observer, mutex()); }

void Timeline::onMixerAddTrack(Mixer& mixer, const TrackPtr& track) {
    addObservers_.tell([&](TimelineAddObserver& o) { o.onTimelineAddTrack(*this, mixer, track); });
}

void Timeline::onMixerRemoveTrack(Mixer& mixer, const TrackPtr& track) {
    addObservers_.tell([&](TimelineAddObserver& o) { o.onTimelineRemoveTrack(*this, mixer, track); });
}

// A clip's parent timeline follows from its track, so relaying is all there is to do.
void Timeline::onMixerAddMedia(Mixer&, Track& track, const MediaPtr& media) {
    addObservers_.tell([&](TimelineAddObserver& o) { o.onTimelineAddMedia(*this, track, media); });
}

void Timeline::onMixerRemoveMedia(Mixer&, Track& track, const MediaPtr& media) {
    addObservers_.tell([&](TimelineAddObserver& o) { o.onTimelineRemoveMedia(*this, track, media); });
}

} // namespace VelaMediaLib

#include <VelaMediaLib/model/media/AudioMediaImpl.h>

#include <VelaMediaLib/model/timeline/Track.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>

namespace VelaMediaLib {

AudioMediaImpl::AudioMediaImpl(const boost::weak_ptr<const ThreadSafe>& token,
                               const boost::weak_ptr<ProjectEditRate>& rate, const MediaState& initial,
                               EditorKind editor)
    : Media(token), AudioMedia(token), MediaImpl(token, rate, initial, editor) {}

boost::shared_ptr<ParameterInterface> AudioMediaImpl::createDefaultParameter(const std::string& name) const {
    if (name != "volume") return MediaImpl::createDefaultParameter(name);
    const auto made = InterpolatingParam<double>::create(projectMutex(), name, 1.0);
    made->setTimeScalable(sharedTimeScale());
    return made;
}

boost::shared_ptr<Attribute<double>> AudioMediaImpl::gain() { return attributeOrAdd<double>("gain", 1.0); }

boost::shared_ptr<Attribute<bool>> AudioMediaImpl::mixToMono() {
    return attributeOrAdd<bool>("mixToMono", false);
}

boost::shared_ptr<Attribute<bool>> AudioMediaImpl::shouldApplyLoudnessNormalizationAttribute() {
    return attributeOrAdd<bool>("loudnessNormalization", false);
}

boost::shared_ptr<Attribute<long long>> AudioMediaImpl::sourceFileOffset() {
    return attributeOrAdd<long long>("sourceFileOffset", 0);
}

boost::shared_ptr<SubTimeline> AudioMediaImpl::parentTrack() const {
    const boost::shared_ptr<SubTimeline> container = parent();
    return boost::dynamic_pointer_cast<Track>(container) ? container : boost::shared_ptr<SubTimeline>();
}

boost::shared_ptr<Media> AudioMediaImpl::parentUnifiedMedia() const {
    ScopedReadLock lock(projectLock());
    return parentUnified_.lock();
}

void AudioMediaImpl::setParentUnifiedMedia(const boost::weak_ptr<Media>& unified) {
    ScopedWriteLock lock(projectMutex());
    parentUnified_ = unified;
}

// A fade is an edge modification towards silence (in) or from it (out).
void AudioMediaImpl::addAudioFadeEdgeMods(VelaTime fadeIn, VelaTime fadeOut) {
    const std::string group = audioFadeEdgeModGroupName();
    for (const EdgeModificationPtr& modification : leftEdgeModifications())
        if (modification->group() == group) removeLeftEdgeModification(modification);
    for (const EdgeModificationPtr& modification : rightEdgeModifications())
        if (modification->group() == group) removeRightEdgeModification(modification);
    if (fadeIn > 0) addLeftEdgeModification(EdgeModificationPtr(new EdgeModification(fadeIn, group, 0.0)));
    if (fadeOut > 0) addRightEdgeModification(EdgeModificationPtr(new EdgeModification(fadeOut, group, 0.0)));
}

std::vector<CaptionData> AudioMediaImpl::captions() const {
    ScopedReadLock lock(projectLock());
    return captions_;
}

void AudioMediaImpl::setCaptions(const std::vector<CaptionData>& captions) {
    {
        ScopedWriteLock lock(projectMutex());
        captions_ = captions;
    }
    notify();
}

std::string AudioMediaImpl::transcription() const {
    ScopedReadLock lock(projectLock());
    return transcription_;
}

void AudioMediaImpl::setTranscription(const std::string& text) {
    {
        ScopedWriteLock lock(projectMutex());
        transcription_ = text;
    }
    notify();
}

} // namespace VelaMediaLib

#include <VelaMediaLib/model/media/AudioSide.h>

#include <VelaMediaLib/model/timeline/Track.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>

namespace VelaMediaLib {

template <typename Base>
AudioSide<Base>::AudioSide(const boost::weak_ptr<const ThreadSafe>& token,
                           const boost::weak_ptr<ProjectEditRate>& rate, const MediaState& initial,
                           MediaImpl::EditorKind editor)
    : Media(token), AudioMedia(token), Base(token, rate, initial, editor) {}

template <typename Base>
boost::shared_ptr<ParameterInterface> AudioSide<Base>::createDefaultParameter(const std::string& name) const {
    if (name != "volume") return Base::createDefaultParameter(name);
    const auto made = InterpolatingParam<double>::create(this->projectMutex(), name, 1.0);
    made->setTimeScalable(this->sharedTimeScale());
    return made;
}

template <typename Base>
std::vector<std::string> AudioSide<Base>::defaultParameterNames() const {
    std::vector<std::string> names = Base::defaultParameterNames();
    names.push_back("volume");
    return names;
}

template <typename Base>
boost::shared_ptr<Attribute<double>> AudioSide<Base>::gain() {
    return this->template attributeOrAdd<double>("gain", 1.0);
}

template <typename Base>
boost::shared_ptr<Attribute<bool>> AudioSide<Base>::mixToMono() {
    return this->template attributeOrAdd<bool>("mixToMono", false);
}

template <typename Base>
boost::shared_ptr<Attribute<bool>> AudioSide<Base>::shouldApplyLoudnessNormalizationAttribute() {
    return this->template attributeOrAdd<bool>("loudnessNormalization", false);
}

template <typename Base>
boost::shared_ptr<Attribute<long long>> AudioSide<Base>::sourceFileOffset() {
    return this->template attributeOrAdd<long long>("sourceFileOffset", 0);
}

template <typename Base>
boost::shared_ptr<SubTimeline> AudioSide<Base>::parentTrack() const {
    const boost::shared_ptr<SubTimeline> container = this->parent();
    return boost::dynamic_pointer_cast<Track>(container) ? container : boost::shared_ptr<SubTimeline>();
}

template <typename Base>
boost::shared_ptr<Media> AudioSide<Base>::parentUnifiedMedia() const {
    ScopedReadLock lock(this->projectLock());
    return parentUnified_.lock();
}

template <typename Base>
void AudioSide<Base>::setParentUnifiedMedia(const boost::weak_ptr<Media>& unified) {
    ScopedWriteLock lock(this->projectMutex());
    parentUnified_ = unified;
}

// A fade is an edge modification towards silence (in) or from it (out).
template <typename Base>
void AudioSide<Base>::addAudioFadeEdgeMods(VelaTime fadeIn, VelaTime fadeOut) {
    const std::string group = audioFadeEdgeModGroupName();
    for (const EdgeModificationPtr& modification : this->leftEdgeModifications())
        if (modification->group() == group) this->removeLeftEdgeModification(modification);
    for (const EdgeModificationPtr& modification : this->rightEdgeModifications())
        if (modification->group() == group) this->removeRightEdgeModification(modification);
    if (fadeIn > 0)
        this->addLeftEdgeModification(EdgeModificationPtr(new EdgeModification(fadeIn, group, 0.0)));
    if (fadeOut > 0)
        this->addRightEdgeModification(EdgeModificationPtr(new EdgeModification(fadeOut, group, 0.0)));
}

template <typename Base>
std::vector<CaptionData> AudioSide<Base>::captions() const {
    ScopedReadLock lock(this->projectLock());
    return captions_;
}

template <typename Base>
void AudioSide<Base>::setCaptions(const std::vector<CaptionData>& captions) {
    {
        ScopedWriteLock lock(this->projectMutex());
        captions_ = captions;
    }
    this->notify();
}

template <typename Base>
std::string AudioSide<Base>::transcription() const {
    ScopedReadLock lock(this->projectLock());
    return transcription_;
}

template <typename Base>
void AudioSide<Base>::setTranscription(const std::string& text) {
    {
        ScopedWriteLock lock(this->projectMutex());
        transcription_ = text;
    }
    this->notify();
}

template class VELAMEDIALIB_INSTANTIATION AudioSide<MediaImpl>;
template class VELAMEDIALIB_INSTANTIATION AudioSide<VisualMediaImpl>;

} // namespace VelaMediaLib

#pragma once
// ParameterImpl: construction, description and queries.

namespace VelaMediaLib {

// What is read from the other parameter is gathered under its read lock; the
// copy is known to no one yet, so filling it takes no lock at all (a caller
// may be inside a reader's snapshot). Empty optional parts are not copied.
template <typename T>
ParameterImpl<T>::ParameterImpl(const ParameterImpl& other)
    : Base(other.projectMutex()), identifier_(other.identifier()), scalable_(other.scalable_) {
    std::map<std::string, std::string> metadata;
    {
        ScopedReadLock lock(other.projectLock());
        for (const auto& entry : other.keyframes_)
            keyframes_.push_back({entry.time, entry.keyframe->clone()});
        const Extras* theirs = other.extras_.get();
        if (theirs && (theirs->bounds || theirs->hints)) {
            extras().bounds = theirs->bounds;
            extras().hints = theirs->hints;
        }
        metadata = other.generateMetaDataMap();
    }
    if (metadata.empty()) return;
    MetaDatable* copied = new MetaDatable();
    extras().metadata.reset(copied);
    for (const auto& entry : metadata) copied->addMetaData(entry.first, entry.second);
    copied->setMetaDataProjectMutex(this->projectMutex());
}

template <typename T>
MetaDatable& ParameterImpl<T>::metadata() const {
    return extras().metadata.getOrMake([this] { return new MetaDatable(this->projectMutex()); });
}

template <typename T>
bool ParameterImpl<T>::describedBeyondTheCurve() const {
    const Extras* e = extras_.get();
    if (!e) return false;
    const MetaDatable* metadata = e->metadata.get();
    return e->bounds || e->hints || (metadata && !metadata->metaDataKeys().empty());
}

template <typename T>
std::string ParameterImpl<T>::identifier() const {
    ScopedReadLock lock(this->projectLock());
    const Extras* e = extras_.get();
    const boost::shared_ptr<Attribute<std::string>>* attribute = e ? e->identAttribute.get() : nullptr;
    return attribute ? (*attribute)->value() : identifier_;
}

template <typename T>
boost::shared_ptr<Attribute<std::string>> ParameterImpl<T>::identAttribute() {
    ScopedReadLock lock(this->projectLock());
    return extras().identAttribute.getOrMake([this] {
        return new boost::shared_ptr<Attribute<std::string>>(
            new Attribute<std::string>("ident", identifier_, this->projectMutex()));
    });
}

template <typename T>
bool ParameterImpl<T>::hasValueBounds() const {
    ScopedReadLock lock(this->projectLock());
    const Extras* e = extras_.get();
    return e && e->bounds;
}

template <typename T>
bool ParameterImpl<T>::hasUIHints() const {
    ScopedReadLock lock(this->projectLock());
    const Extras* e = extras_.get();
    return e && e->hints;
}

template <typename T>
boost::optional<ValueBounds<T>> ParameterImpl<T>::valueBounds() const {
    ScopedReadLock lock(this->projectLock());
    const Extras* e = extras_.get();
    return e ? e->bounds : boost::none;
}

template <typename T>
void ParameterImpl<T>::setValueBounds(const T& minValue, const T& maxValue, const T& defaultValue) {
    edit([&] { extras().bounds = ValueBounds<T>{minValue, maxValue, defaultValue}; });
}

template <typename T>
boost::optional<UIHints> ParameterImpl<T>::uiHints() const {
    ScopedReadLock lock(this->projectLock());
    const Extras* e = extras_.get();
    return e ? e->hints : boost::none;
}

template <typename T>
void ParameterImpl<T>::setUIHints(const std::string& userInterfaceType, const std::string& unitType) {
    edit([&] { extras().hints = UIHints{userInterfaceType, unitType}; });
}

template <typename T>
MetaDatable* ParameterImpl<T>::metaDataPtr() {
    ScopedReadLock lock(this->projectLock());
    return &metadata();
}

template <typename T>
std::map<std::string, std::string> ParameterImpl<T>::generateMetaDataMap() const {
    ScopedReadLock lock(this->projectLock());
    const Extras* e = extras_.get();
    const MetaDatable* metadata = e ? e->metadata.get() : nullptr;
    return metadata ? metadata->metaDataCopy() : std::map<std::string, std::string>();
}

template <typename T>
T ParameterImpl<T>::valueAtTime(const RationalTime& time) const {
    ScopedReadLock lock(this->projectLock());
    return valueAtTimeLocked(time);
}

// No extrapolation: before the first and after the last keyframe the end
// values hold; a time less than one tick before a keyframe is that keyframe.
template <typename T>
T ParameterImpl<T>::valueAtTimeLocked(const RationalTime& time) const {
    if (keyframes_.empty())
        throw KeyFrameException("parameter " + identifier_ + " has no keyframe", RationalTime(0),
                                identifier_);
    if (keyframes_.size() == 1) return keyframes_.front().keyframe->value_;
    const double seconds = time.asDouble();
    const auto next = MapUtil::locate(keyframes_, time, seconds);
    if (next == keyframes_.begin()) return next->keyframe->value_;
    if (next == keyframes_.end()) return keyframes_.back().keyframe->value_;
    const KeyFrame<T>& end = *next->keyframe;
    if (next->time == time) return end.value_;
    if (scalable_ && (next->time.asRational() - time.asRational()) * scalable_->timeScale() < SafeRational(1))
        return end.value_;
    const auto previous = next - 1;
    return segmentInterpolater(end)->interpolate(previous->keyframe->value_, end.value_, previous->time,
                                                 next->time, seconds, end.leadIn_);
}

template <typename T>
size_t ParameterImpl<T>::numKeyFrames() const {
    ScopedReadLock lock(this->projectLock());
    return keyframes_.size();
}

template <typename T>
typename ParameterImpl<T>::KeyFramePtr ParameterImpl<T>::exactKeyFrame(const RationalTime& time) const {
    const auto found = MapUtil::find(keyframes_, time);
    return found == keyframes_.end() ? KeyFramePtr() : found->keyframe;
}

template <typename T>
typename ParameterImpl<T>::KeyFramePtr ParameterImpl<T>::exactKeyFrameOrThrow(const RationalTime& time,
                                                                              const char* operation) const {
    const KeyFramePtr keyframe = exactKeyFrame(time);
    if (!keyframe) refuse(std::string(operation) + ": no keyframe", time);
    return keyframe;
}

template <typename T>
typename ParameterImpl<T>::KeyFramePtr ParameterImpl<T>::keyframeAtTime(const RationalTime& time) {
    ScopedReadLock lock(this->projectLock());
    return exactKeyFrame(time);
}

template <typename T>
typename ParameterImpl<T>::ConstKeyFramePtr ParameterImpl<T>::keyframeAtTime(const RationalTime& time) const {
    ScopedReadLock lock(this->projectLock());
    return exactKeyFrame(time);
}

template <typename T>
boost::shared_ptr<KeyFrameInterface>
ParameterImpl<T>::keyFrameInterfaceAtTime(const RationalTime& time) const {
    ScopedReadLock lock(this->projectLock());
    return exactKeyFrame(time);
}

template <typename T>
bool ParameterImpl<T>::hasKeyFrameAtTime(const RationalTime& time) const {
    return bool(keyFrameInterfaceAtTime(time));
}

template <typename T>
bool ParameterImpl<T>::hasKeyFrameInRange(const Range<RationalTime>& range) const {
    ScopedReadLock lock(this->projectLock());
    return MapUtil::anyInRange(keyframes_, range.start(), range.start() + range.duration());
}

template <typename T>
boost::shared_ptr<std::vector<RationalTime>> ParameterImpl<T>::keyframeTimes() const {
    ScopedReadLock lock(this->projectLock());
    boost::shared_ptr<std::vector<RationalTime>> times(new std::vector<RationalTime>);
    times->reserve(keyframes_.size());
    for (const auto& entry : keyframes_) times->push_back(entry.time);
    return times;
}

template <typename T>
Range<RationalTime> ParameterImpl<T>::keyframeRange() const {
    ScopedReadLock lock(this->projectLock());
    if (keyframes_.empty()) return Range<RationalTime>();
    return Range<RationalTime>(keyframes_.front().time, keyframes_.back().time - keyframes_.front().time);
}

template <typename T>
RationalTime ParameterImpl<T>::firstKeyFrameTime() const {
    ScopedReadLock lock(this->projectLock());
    if (keyframes_.empty()) refuse("firstKeyFrameTime: no keyframe", RationalTime(0));
    return keyframes_.front().time;
}

template <typename T>
RationalTime ParameterImpl<T>::nextKeyFrameTime(const RationalTime& time) const {
    ScopedReadLock lock(this->projectLock());
    const auto next = MapUtil::firstAfter(keyframes_, time);
    return next == keyframes_.end() ? time : next->time;
}

template <typename T>
RationalTime ParameterImpl<T>::previousKeyFrameTime(const RationalTime& time) const {
    ScopedReadLock lock(this->projectLock());
    const auto atOrAfter = MapUtil::firstAtOrAfter(keyframes_, time);
    return atOrAfter == keyframes_.begin() ? time : (atOrAfter - 1)->time;
}

template <typename T>
bool ParameterImpl<T>::valuesDifferAtTimes(const RationalTime& a, const RationalTime& b) const {
    ScopedReadLock lock(this->projectLock());
    return !ValueTraits<T>::same(valueAtTimeLocked(a), valueAtTimeLocked(b));
}

template <typename T>
typename ParameterImpl<T>::InterpolaterPtr
ParameterImpl<T>::interpolaterForKeyFrame(const ConstKeyFramePtr& keyframe) const {
    ScopedReadLock lock(this->projectLock());
    return keyframe ? segmentInterpolater(*keyframe) : defaultInterpolater();
}

namespace ParameterComparison {

template <typename T>
bool sameInterpolater(const boost::shared_ptr<Interpolater<T>>& a,
                      const boost::shared_ptr<Interpolater<T>>& b) {
    return a == b || (a && b && a->sameAs(*b));
}

/// Value, lead-in and metadata; the time is the one both were found at.
template <typename T>
bool sameKeyFrame(const KeyFrame<T>& a, const KeyFrame<T>& b) {
    return ValueTraits<T>::same(a.value(), b.value()) && a.duration() == b.duration() &&
           a.metaDataCopy() == b.metaDataCopy();
}

} // namespace ParameterComparison

// Whole keyframes: time, value, lead-in, metadata and the interpolater that
// shapes the segment each one ends, compared by what it does.
template <typename T>
bool ParameterImpl<T>::operator==(const Parameter<T>& other) const {
    if (this == &other) return true;
    if (parameterTypeString() != other.parameterTypeString() || numKeyFrames() != other.numKeyFrames())
        return false;
    const boost::shared_ptr<std::vector<RationalTime>> times = keyframeTimes();
    for (const RationalTime& time : *times) {
        const ConstKeyFramePtr mine = keyframeAtTime(time), theirs = other.keyframeAtTime(time);
        if (!mine || !theirs || !ParameterComparison::sameKeyFrame(*mine, *theirs) ||
            !ParameterComparison::sameInterpolater(interpolaterForKeyFrame(mine),
                                                   other.interpolaterForKeyFrame(theirs)))
            return false;
    }
    return true;
}

} // namespace VelaMediaLib

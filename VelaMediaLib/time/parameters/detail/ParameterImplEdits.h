#pragma once
// ParameterImpl: edits and copies. Every edit checks before it changes
// anything, so a refused edit leaves the parameter as it was.

namespace VelaMediaLib {

template <typename T>
bool ParameterImpl<T>::canAddKeyFrame(const RationalTime& time, const RationalTime& leadIn,
                                      const KeyFrame<T>* ignoring) const {
    if (leadIn < RationalTime(0)) return false;
    for (auto it = MapUtil::firstAtOrAfter(keyframes_, time); it != keyframes_.begin();) {
        --it;
        if (it->keyframe.get() == ignoring) continue;
        if (time - leadIn < it->time) return false; // the transition would start before the previous keyframe
        break;
    }
    for (auto it = MapUtil::firstAfter(keyframes_, time); it != keyframes_.end(); ++it) {
        if (it->keyframe.get() == ignoring) continue;
        return it->time - it->keyframe->leadIn_ >= time; // not inside the next keyframe's lead-in
    }
    return true;
}

// Checks a whole candidate curve by putting it in place for the test.
template <typename T>
bool ParameterImpl<T>::placementHolds(KeyFrameMap& curve) {
    keyframes_.swap(curve);
    bool holds = true;
    for (const auto& entry : keyframes_)
        if (!canAddKeyFrame(entry.time, entry.keyframe->leadIn_, entry.keyframe.get())) {
            holds = false;
            break;
        }
    keyframes_.swap(curve);
    return holds;
}

template <typename T>
T ParameterImpl<T>::setDefaultValue(const T& value) {
    T previous = value;
    edit([&] {
        if (!keyframes_.empty()) previous = valueAtTimeLocked(RationalTime(0));
        KeyFrameMap constant;
        constant.push_back({RationalTime(0), newKeyFrame(RationalTime(0), value, RationalTime(0))});
        keyframes_.swap(constant);
    });
    return previous;
}

template <typename T>
T ParameterImpl<T>::setValueAtTime(const T& value, const RationalTime& time) {
    T previous = value;
    edit([&] {
        const KeyFramePtr keyframe = exactKeyFrame(time);
        if (!keyframe) throw VelaMediaLibException("error");
        previous = keyframe->value_;
        keyframe->value_ = value;
    });
    return previous;
}

template <typename T>
void ParameterImpl<T>::addKeyFrame(const RationalTime& time, const T& value, const RationalTime& leadIn) {
    edit([&] {
        const KeyFramePtr existing = exactKeyFrame(time);
        if (!canAddKeyFrame(time, leadIn, existing.get()))
            refuse("addKeyFrame: a keyframe may not stand", time);
        if (existing) {
            existing->value_ = value;
            existing->leadIn_ = leadIn;
        } else {
            MapUtil::put(keyframes_, time, newKeyFrame(time, value, leadIn));
        }
    });
}

template <typename T>
void ParameterImpl<T>::addKeyFrame(const KeyFramePtr& keyframe) {
    if (!keyframe) throw KeyFrameException("addKeyFrame: no keyframe given", RationalTime(0), identifier());
    edit([&] {
        const RationalTime time = keyframe->endTime_;
        if (!canAddKeyFrame(time, keyframe->leadIn_, exactKeyFrame(time).get()))
            refuse("addKeyFrame: a keyframe may not stand", time);
        MapUtil::put(keyframes_, time, keyframe);
    });
}

template <typename T>
typename ParameterImpl<T>::KeyFramePtr ParameterImpl<T>::removeKeyFrame(const RationalTime& time) {
    KeyFramePtr removed;
    {
        ScopedWriteLock lock(this->projectMutex());
        const auto found = MapUtil::find(keyframes_, time);
        if (found == keyframes_.end() || keyframes_.size() == 1) return removed;
        removed = found->keyframe;
        keyframes_.erase(found);
        keyframesEdited();
    }
    this->notify();
    return removed;
}

template <typename T>
T ParameterImpl<T>::changeKeyFrame(const RationalTime& time, const T& value) {
    T previous = value;
    edit([&] {
        const KeyFramePtr keyframe = exactKeyFrameOrThrow(time, "changeKeyFrame");
        previous = keyframe->value_;
        keyframe->value_ = value;
    });
    return previous;
}

template <typename T>
T ParameterImpl<T>::changeKeyFrame(const ConstKeyFramePtr& keyframe, const T& value) {
    T previous = value;
    edit([&] {
        const auto found =
            std::find_if(keyframes_.begin(), keyframes_.end(),
                         [&](const KeyFrameEntry<KeyFrame<T>>& e) { return e.keyframe == keyframe; });
        if (found == keyframes_.end())
            refuse("changeKeyFrame: the keyframe is not in this parameter",
                   keyframe ? keyframe->endTime() : RationalTime());
        previous = found->keyframe->value_;
        found->keyframe->value_ = value;
    });
    return previous;
}

template <typename T>
typename ParameterImpl<T>::KeyFramePtr ParameterImpl<T>::changeKeyFrame(const RationalTime& time,
                                                                        const KeyFramePtr& keyframe) {
    if (!keyframe) throw KeyFrameException("changeKeyFrame: no keyframe given", time, identifier());
    KeyFramePtr replaced;
    edit([&] {
        if (!canAddKeyFrame(time, keyframe->leadIn_, exactKeyFrame(time).get()))
            refuse("changeKeyFrame: a keyframe may not stand", time);
        keyframe->endTime_ = time;
        replaced = MapUtil::put(keyframes_, time, keyframe);
    });
    return replaced;
}

template <typename T>
RationalTime ParameterImpl<T>::changeKeyFrameLeadInLength(const RationalTime& time,
                                                          const RationalTime& leadIn) {
    RationalTime previous;
    edit([&] {
        const KeyFramePtr keyframe = exactKeyFrameOrThrow(time, "changeKeyFrameLeadInLength");
        if (!canAddKeyFrame(time, leadIn, keyframe.get()))
            refuse("changeKeyFrameLeadInLength: the lead-in does not fit", time);
        previous = keyframe->leadIn_;
        keyframe->leadIn_ = leadIn;
    });
    return previous;
}

template <typename T>
void ParameterImpl<T>::moveKeyFrame(const RationalTime& from, const RationalTime& to) {
    edit([&] {
        const KeyFramePtr keyframe = exactKeyFrameOrThrow(from, "moveKeyFrame");
        if (from == to) return;
        if (exactKeyFrame(to)) refuse("moveKeyFrame: another keyframe stands", to);
        if (!canAddKeyFrame(to, keyframe->leadIn_, keyframe.get()))
            refuse("moveKeyFrame: a keyframe may not stand", to);
        keyframes_.erase(MapUtil::find(keyframes_, from));
        keyframe->endTime_ = to;
        MapUtil::put(keyframes_, to, keyframe);
    });
}

template <typename T>
void ParameterImpl<T>::moveKeyframes(const RationalTime& offset, std::function<bool(RationalTime)> select) {
    edit([&] {
        KeyFrameMap moved;
        for (const auto& entry : keyframes_)
            MapUtil::put(moved, select(entry.time) ? entry.time + offset : entry.time, entry.keyframe);
        if (moved.size() != keyframes_.size()) refuse("moveKeyframes: keyframes would meet", offset);
        if (!placementHolds(moved)) refuse("moveKeyframes: a lead-in would reach past a keyframe", offset);
        for (auto& entry : moved) entry.keyframe->endTime_ = entry.time;
        keyframes_.swap(moved);
    });
}

template <typename T>
boost::shared_ptr<Parameter<T>> ParameterImpl<T>::copyPortion(const Range<RationalTime>& range) const {
    const boost::shared_ptr<ParameterImpl> portion = cloneImpl();
    ScopedReadLock lock(this->projectLock());
    const RationalTime start = range.start(), end = range.start() + range.duration();
    KeyFrameMap kept;
    auto keep = [&](const RationalTime& time, const KeyFramePtr& keyframe) {
        keyframe->endTime_ = time - start;
        if (keyframe->leadIn_ > keyframe->endTime_)
            keyframe->leadIn_ = keyframe->endTime_; // starts inside the range
        MapUtil::put(kept, keyframe->endTime_, keyframe);
    };
    if (keyframes_.size() > 1 && !exactKeyFrame(start))
        keep(start, newKeyFrame(start, valueAtTimeLocked(start), RationalTime(0)));
    for (auto it = MapUtil::firstAtOrAfter(keyframes_, start); it != keyframes_.end() && it->time <= end;
         ++it)
        keep(it->time, it->keyframe->clone());
    if (keyframes_.size() > 1 && !exactKeyFrame(end) && end > start) {
        const auto cut = MapUtil::firstAfter(keyframes_, end);
        const KeyFramePtr edge = newKeyFrame(end, valueAtTimeLocked(end), RationalTime(0));
        if (cut != keyframes_.end()) edge->interpolater_ = cut->keyframe->interpolater_;
        edge->leadIn_ = edgeLeadIn(end - start - kept.back().time);
        keep(end, edge);
    }
    if (kept.empty()) keep(start, newKeyFrame(start, valueAtTimeLocked(start), RationalTime(0)));
    portion->keyframes_.swap(kept);
    return portion;
}

template <typename T>
void ParameterImpl<T>::setupSharedClone(const boost::shared_ptr<ParameterInterface>& clone) const {
    const boost::shared_ptr<ParameterImpl> target = boost::dynamic_pointer_cast<ParameterImpl>(clone);
    if (!target || target.get() == this) return;
    boost::optional<ValueBounds<T>> bounds = valueBounds();
    boost::optional<UIHints> hints = uiHints();
    target->setTimeScalable(scalable_);
    target->edit([&] {
        if (!bounds && !hints && !target->extras_.get()) return; // nothing to share or to clear
        target->extras().bounds = bounds;
        target->extras().hints = hints;
    });
}

} // namespace VelaMediaLib

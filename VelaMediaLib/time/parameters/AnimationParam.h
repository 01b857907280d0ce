#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>

#include <vector>

namespace VelaMediaLib {

/// One animation of an animation track: a transition over a span of time
/// (start and duration) with the interpolater that shapes it.
struct VELAMEDIALIB_API Animation {
    Range<RationalTime> span;
    std::string interpolaterName;
};

/// A parameter of an animation on an animation track. Its keyframes come in
/// pairs around animations: a keyframe with a lead-in ends an animation over
/// that lead-in, which the track records. When read from a document, a
/// keyframe without a lead-in adds no keyframe: its value goes to the keyframe
/// in force at its time (the last one at or before it, else the first). So
/// that what is written reads back, every keyframe but the first has a lead-in.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API AnimationParam : public InterpolatingParam<T> {
public:
    typedef typename ParameterImpl<T>::KeyFramePtr KeyFramePtr;
    using InterpolatingParam<T>::InterpolatingParam;

    static boost::shared_ptr<AnimationParam>
    create(const boost::weak_ptr<const ThreadSafe>& token, const std::string& identifier, const T& value,
           const boost::shared_ptr<const TimeScalable>& scalable = boost::shared_ptr<const TimeScalable>()) {
        return ParameterImpl<T>::template createHolding<AnimationParam>(value, token, identifier, scalable);
    }

    std::vector<Animation> animations() const {
        ScopedReadLock lock(this->projectLock());
        return animations_;
    }
    /// Records an animation unless one already starts at the span's start.
    bool addAnimation(const Range<RationalTime>& span, const std::string& interpolaterName) {
        bool added = false;
        this->edit([&] { added = addAnimationLocked(span, interpolaterName); });
        return added;
    }

protected:
    boost::shared_ptr<ParameterImpl<T>> cloneImpl() const override {
        return boost::shared_ptr<ParameterImpl<T>>(new AnimationParam(*this));
    }

    bool canAddKeyFrame(const RationalTime& time, const RationalTime& leadIn,
                        const KeyFrame<T>* ignoring) const override {
        if (!ParameterImpl<T>::canAddKeyFrame(time, leadIn, ignoring)) return false;
        for (const auto& entry : this->keyframes_) {
            if (entry.keyframe.get() == ignoring || entry.time == time) continue;
            if (entry.time < time) return leadIn > RationalTime(0); // it would not be the first
            return entry.keyframe->duration() > RationalTime(0);    // the first would follow it
        }
        return true;
    }
    RationalTime edgeLeadIn(const RationalTime& segment) const override { return segment; }
    void clearForReading() override {
        InterpolatingParam<T>::clearForReading();
        animations_.clear();
    }

    KeyFramePtr placeReadKeyFrame(const RationalTime& end, const T& value,
                                  const RationalTime& leadIn) override {
        if (leadIn <= RationalTime(0) && !this->keyframes_.empty() && !this->exactKeyFrame(end)) {
            auto inForce = KeyFrameMapUtil<KeyFrame<T>>::firstAfter(this->keyframes_, end);
            if (inForce != this->keyframes_.begin()) --inForce;
            this->changeKeyFrame(inForce->time, value);
            return KeyFramePtr();
        }
        const KeyFramePtr keyframe = ParameterImpl<T>::placeReadKeyFrame(end, value, leadIn);
        if (leadIn > RationalTime(0))
            addAnimationLocked(Range<RationalTime>(end - leadIn, leadIn),
                               this->defaultInterpolater()->name());
        return keyframe;
    }

    void takeStateFrom(ParameterImpl<T>& read) override {
        InterpolatingParam<T>::takeStateFrom(read);
        animations_ = static_cast<AnimationParam&>(read).animations_;
    }

private:
    bool addAnimationLocked(const Range<RationalTime>& span, const std::string& interpolaterName) {
        for (const Animation& animation : animations_)
            if (animation.span.start() == span.start()) return false;
        animations_.push_back(Animation{span, interpolaterName});
        return true;
    }

    std::vector<Animation> animations_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/interpolaters/Interpolater.h>
#include <VelaMediaLib/time/parameters/KeyFrameInterface.h>
#include <VelaMediaLib/time/parameters/ValueTraits.h>

namespace VelaMediaLib {

template <typename T>
class ParameterImpl;

/// One keyframe of a parameter of value type T. Its interpolater governs the
/// transition that ends at this keyframe; an empty one means the parameter's
/// own default.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API KeyFrame : public KeyFrameInterface {
public:
    typedef boost::shared_ptr<Interpolater<T>> InterpolaterPtr;

    KeyFrame(const boost::weak_ptr<const ThreadSafe>& token, const RationalTime& endTime, const T& value,
             const RationalTime& leadIn = RationalTime(),
             const InterpolaterPtr& interpolater = InterpolaterPtr())
        : KeyFrameInterface(token, endTime, leadIn), value_(value), interpolater_(interpolater) {}

    T value() const {
        ScopedReadLock lock(this->projectLock());
        return value_;
    }
    InterpolaterPtr interpolater() const {
        ScopedReadLock lock(this->projectLock());
        return interpolater_;
    }
    void setInterpolater(const InterpolaterPtr& interpolater) {
        ScopedWriteLock lock(metaDataProjectMutex());
        interpolater_ = interpolater;
    }

    std::string interpolaterName() const override {
        const InterpolaterPtr interp = interpolater();
        return interp ? interp->name() : std::string();
    }

    boost::shared_ptr<KeyFrameInterface> cloneKeyFrame() const override { return clone(); }

    /// A copy with the same times, value, interpolater and metadata. The copy
    /// joins the project only when it is complete, so making it takes no
    /// write lock (a caller may hold the read lock).
    boost::shared_ptr<KeyFrame> clone() const {
        boost::shared_ptr<KeyFrame> copy;
        std::map<std::string, std::string> metadata;
        {
            ScopedReadLock lock(this->projectLock());
            copy.reset(
                new KeyFrame(boost::weak_ptr<const ThreadSafe>(), endTime_, value_, leadIn_, interpolater_));
            metadata = metaDataCopy();
        }
        for (const auto& entry : metadata) copy->addMetaData(entry.first, entry.second);
        copy->setMetaDataProjectMutex(metaDataProjectMutex());
        return copy;
    }

protected:
    /// Whether the value equals the given one within the type's tolerance.
    bool similarToValue(const T& value) const {
        ScopedReadLock lock(this->projectLock());
        return ValueTraits<T>::similar(value_, value);
    }

    void writeValue(XMLOptions& options, int indent) const override {
        ValueTraits<T>::write(options, indent, value_);
    }
    std::string interpolaterJson() const override {
        return interpolater_ ? interpolater_->asJson() : std::string();
    }

private:
    template <typename>
    friend class ParameterImpl;

    T value_;
    InterpolaterPtr interpolater_;
};

} // namespace VelaMediaLib

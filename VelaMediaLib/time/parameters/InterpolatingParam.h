#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/parameters/ParameterImpl.h>

namespace VelaMediaLib {

/// A numeric parameter with an interpolater of its own that its keyframes
/// follow unless they name one; the document carries it as the parameter's
/// "interp".
template <typename T>
class VELAMEDIALIB_TEMPLATE_API InterpolatingParam : public ParameterImpl<T> {
public:
    typedef typename ParameterImpl<T>::InterpolaterPtr InterpolaterPtr;

    InterpolatingParam(
        const boost::weak_ptr<const ThreadSafe>& token, const std::string& identifier,
        const boost::shared_ptr<const TimeScalable>& scalable = boost::shared_ptr<const TimeScalable>(),
        const InterpolaterPtr& interpolater = InterpolaterFactory<T>::defaultInterpolater())
        : ParameterImpl<T>(token, identifier, scalable), interpolater_(interpolater) {}

    static boost::shared_ptr<InterpolatingParam>
    create(const boost::weak_ptr<const ThreadSafe>& token, const std::string& identifier, const T& value,
           const InterpolaterPtr& interpolater = InterpolaterFactory<T>::defaultInterpolater(),
           const boost::shared_ptr<const TimeScalable>& scalable = boost::shared_ptr<const TimeScalable>()) {
        return ParameterImpl<T>::template createHolding<InterpolatingParam>(value, token, identifier,
                                                                            scalable, interpolater);
    }

    InterpolaterPtr parameterInterpolater() const {
        ScopedReadLock lock(this->projectLock());
        return interpolater_;
    }
    void setParameterInterpolater(const InterpolaterPtr& interpolater) {
        if (!interpolater) throw VelaMediaLibException("an interpolating parameter needs an interpolater");
        this->edit([&] { interpolater_ = interpolater; });
    }

protected:
    boost::shared_ptr<ParameterImpl<T>> cloneImpl() const override {
        return boost::shared_ptr<ParameterImpl<T>>(new InterpolatingParam(*this));
    }
    const InterpolaterPtr& defaultInterpolater() const override { return interpolater_; }
    std::string parameterInterpolaterName() const override { return interpolater_->name(); }
    void readParameterInterpolater(const std::string& name) override {
        interpolater_ = InterpolaterFactory<T>::byName(name);
    }
    void takeStateFrom(ParameterImpl<T>& read) override {
        ParameterImpl<T>::takeStateFrom(read);
        interpolater_ = static_cast<InterpolatingParam&>(read).interpolater_;
    }

private:
    InterpolaterPtr interpolater_;
};

} // namespace VelaMediaLib

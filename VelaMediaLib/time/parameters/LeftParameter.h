#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/parameters/ParameterImpl.h>

namespace VelaMediaLib {

/// A parameter that only steps: every segment holds the earlier keyframe's
/// value until the next keyframe, whatever interpolater a keyframe names.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API LeftParameter : public ParameterImpl<T> {
public:
    typedef typename ParameterImpl<T>::InterpolaterPtr InterpolaterPtr;
    using ParameterImpl<T>::ParameterImpl;

    static boost::shared_ptr<LeftParameter>
    create(const boost::weak_ptr<const ThreadSafe>& token, const std::string& identifier, const T& value,
           const boost::shared_ptr<const TimeScalable>& scalable = boost::shared_ptr<const TimeScalable>()) {
        return ParameterImpl<T>::template createHolding<LeftParameter>(value, token, identifier, scalable);
    }

protected:
    boost::shared_ptr<ParameterImpl<T>> cloneImpl() const override {
        return boost::shared_ptr<ParameterImpl<T>>(new LeftParameter(*this));
    }
    const InterpolaterPtr& defaultInterpolater() const override {
        static const InterpolaterPtr step = LeftInterpolater<T>::getInstance();
        return step;
    }
    const InterpolaterPtr& segmentInterpolater(const KeyFrame<T>&) const override {
        return defaultInterpolater();
    }
};

} // namespace VelaMediaLib

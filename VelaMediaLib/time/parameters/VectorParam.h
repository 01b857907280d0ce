#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/parameters/ParameterImpl.h>

#include <vector>

namespace VelaMediaLib {

/// A parameter whose value is a vector of doubles (a curve, a set of weights).
/// Vectors step from keyframe to keyframe.
class VELAMEDIALIB_API VectorParam : public ParameterImpl<std::vector<double>> {
public:
    using ParameterImpl<std::vector<double>>::ParameterImpl;

    static boost::shared_ptr<VectorParam> create(const boost::weak_ptr<const ThreadSafe>& token,
                                                 const std::string& identifier,
                                                 const std::vector<double>& value) {
        return createHolding<VectorParam>(value, token, identifier);
    }

protected:
    boost::shared_ptr<ParameterImpl<std::vector<double>>> cloneImpl() const override {
        return boost::shared_ptr<ParameterImpl<std::vector<double>>>(new VectorParam(*this));
    }
};

} // namespace VelaMediaLib

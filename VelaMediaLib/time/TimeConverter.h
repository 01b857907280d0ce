#pragma once

#include <VelaMediaLib/time/SafeRational.h>

namespace VelaMediaLib {

/// Maps times between a container's parametric time and the parametric time
/// of an object inside it. Containers nest; `parentTimeConverter` names the
/// next converter outward (none for an object directly on the timeline), and
/// the recursive helpers compose the single steps along that chain.
class TimeConverter {
public:
    virtual ~TimeConverter() = default;

    virtual SafeRational parentParametricTimeToThisParametricTime(const SafeRational& time) const = 0;
    virtual SafeRational clippingParentParametricTimeToThisParametricTime(const SafeRational& time) const = 0;
    virtual SafeRational thisParametricTimeToParentParametricTime(const SafeRational& time) const = 0;
    /// The converter of the container that holds this object's container, or null.
    virtual const TimeConverter* parentTimeConverter() const { return nullptr; }

    long long parentParametricTimeToThisParametricVelaTime(long long time) const;
    long long clippingParentParametricTimeToThisParametricVelaTime(long long time) const;
    long long thisParametricTimeToParentParametricVelaTime(long long time) const;

    /// Global timeline time to the object's time, outermost container first.
    static SafeRational recursiveFromGlobalToParametricTime(const TimeConverter* converter,
                                                            const SafeRational& time);
    static SafeRational clippingRecursiveFromGlobalToParametricTime(const TimeConverter* converter,
                                                                    const SafeRational& time);
    /// The object's time back to global timeline time, innermost first.
    static SafeRational recursiveFromParametricToGlobalTime(const TimeConverter* converter,
                                                            const SafeRational& time);
};

} // namespace VelaMediaLib

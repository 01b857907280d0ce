#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/SafeRational.h>

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

/// Maps times between a container's parametric time and the parametric time
/// of an object inside it. Containers nest; `parentTimeConverter` names the
/// next converter outward (none for the timeline, or for an object that has
/// lost its container), and the recursive helpers compose the single steps
/// along that chain. The chain is walked through shared pointers, so a
/// container that goes away during a walk stays alive until the walk ends.
class VELAMEDIALIB_API TimeConverter {
public:
    virtual ~TimeConverter() = default;

    virtual SafeRational parentParametricTimeToThisParametricTime(const SafeRational& time) const = 0;
    virtual SafeRational clippingParentParametricTimeToThisParametricTime(const SafeRational& time) const = 0;
    virtual SafeRational thisParametricTimeToParentParametricTime(const SafeRational& time) const = 0;
    /// The converter of the container that holds this object, or null.
    virtual boost::shared_ptr<const TimeConverter> parentTimeConverter() const {
        return boost::shared_ptr<const TimeConverter>();
    }

    long long parentParametricTimeToThisParametricVelaTime(long long time) const;
    long long clippingParentParametricTimeToThisParametricVelaTime(long long time) const;
    long long thisParametricTimeToParentParametricVelaTime(long long time) const;

    /// Global timeline time to the object's time, outermost container first.
    /// The converter itself is borrowed for the call; may be null.
    static SafeRational recursiveFromGlobalToParametricTime(const TimeConverter* converter,
                                                            const SafeRational& time);
    static SafeRational clippingRecursiveFromGlobalToParametricTime(const TimeConverter* converter,
                                                                    const SafeRational& time);
    /// The object's time back to global timeline time, innermost first.
    static SafeRational recursiveFromParametricToGlobalTime(const TimeConverter* converter,
                                                            const SafeRational& time);
};

typedef boost::shared_ptr<const TimeConverter> TimeConverterPtr;

} // namespace VelaMediaLib

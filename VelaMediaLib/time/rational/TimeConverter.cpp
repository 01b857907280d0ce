#include <VelaMediaLib/time/rational/TimeConverter.h>

#include <VelaMediaLib/time/rational/RationalUtil.h>

namespace VelaMediaLib {
namespace {

// The outer containers' steps first, then this converter's. Each parent is
// held by the stack frame that converts through it.
template <typename Step>
SafeRational inward(const TimeConverter& converter, const SafeRational& time, Step step) {
    const TimeConverterPtr parent = converter.parentTimeConverter();
    return step(converter, parent ? inward(*parent, time, step) : time);
}

} // namespace

long long TimeConverter::parentParametricTimeToThisParametricVelaTime(long long time) const {
    return RationalUtil::toVelaTime(parentParametricTimeToThisParametricTime(SafeRational(time)));
}

long long TimeConverter::clippingParentParametricTimeToThisParametricVelaTime(long long time) const {
    return RationalUtil::toVelaTime(clippingParentParametricTimeToThisParametricTime(SafeRational(time)));
}

long long TimeConverter::thisParametricTimeToParentParametricVelaTime(long long time) const {
    return RationalUtil::toVelaTime(thisParametricTimeToParentParametricTime(SafeRational(time)));
}

SafeRational TimeConverter::recursiveFromGlobalToParametricTime(const TimeConverter* converter,
                                                                const SafeRational& time) {
    if (!converter) return time;
    return inward(*converter, time, [](const TimeConverter& c, const SafeRational& t) {
        return c.parentParametricTimeToThisParametricTime(t);
    });
}

SafeRational TimeConverter::clippingRecursiveFromGlobalToParametricTime(const TimeConverter* converter,
                                                                        const SafeRational& time) {
    if (!converter) return time;
    return inward(*converter, time, [](const TimeConverter& c, const SafeRational& t) {
        return c.clippingParentParametricTimeToThisParametricTime(t);
    });
}

SafeRational TimeConverter::recursiveFromParametricToGlobalTime(const TimeConverter* converter,
                                                                const SafeRational& time) {
    if (!converter) return time;
    SafeRational result = converter->thisParametricTimeToParentParametricTime(time);
    for (TimeConverterPtr outer = converter->parentTimeConverter(); outer;
         outer = outer->parentTimeConverter())
        result = outer->thisParametricTimeToParentParametricTime(result);
    return result;
}

} // namespace VelaMediaLib

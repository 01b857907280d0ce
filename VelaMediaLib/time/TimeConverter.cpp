#include <VelaMediaLib/time/TimeConverter.h>

#include <VelaMediaLib/time/RationalUtil.h>

#include <vector>

namespace VelaMediaLib {
namespace {

// The chain from the given converter outward.
std::vector<const TimeConverter*> chainOf(const TimeConverter* converter) {
    std::vector<const TimeConverter*> chain;
    for (; converter; converter = converter->parentTimeConverter()) chain.push_back(converter);
    return chain;
}

template <typename Step>
SafeRational inward(const TimeConverter* converter, SafeRational time, Step step) {
    const std::vector<const TimeConverter*> chain = chainOf(converter);
    for (auto it = chain.rbegin(); it != chain.rend(); ++it) time = step(**it, time);
    return time;
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
    return inward(converter, time, [](const TimeConverter& c, const SafeRational& t) {
        return c.parentParametricTimeToThisParametricTime(t);
    });
}

SafeRational TimeConverter::clippingRecursiveFromGlobalToParametricTime(const TimeConverter* converter,
                                                                        const SafeRational& time) {
    return inward(converter, time, [](const TimeConverter& c, const SafeRational& t) {
        return c.clippingParentParametricTimeToThisParametricTime(t);
    });
}

SafeRational TimeConverter::recursiveFromParametricToGlobalTime(const TimeConverter* converter,
                                                                const SafeRational& time) {
    SafeRational result = time;
    for (; converter; converter = converter->parentTimeConverter())
        result = converter->thisParametricTimeToParentParametricTime(result);
    return result;
}

} // namespace VelaMediaLib

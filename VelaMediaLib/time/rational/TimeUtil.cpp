#include <VelaMediaLib/time/rational/TimeUtil.h>

#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <cmath>

namespace VelaMediaLib {
namespace {

double ticksPerSecond(const boost::rational<unsigned long>& rate) {
    return double(rate.numerator()) / double(rate.denominator());
}

SafeRational asRational(const boost::rational<unsigned long>& rate) {
    return SafeRational((long long)rate.numerator(), (long long)rate.denominator());
}

} // namespace

long long TimeUtil::durationWithScalarRoundedToEditingUnit(const SafeRational& duration,
                                                           const SafeRational& scalar,
                                                           long long editingUnit) {
    const long long ticks = RationalUtil::toVelaTime(RationalUtil::Round(duration * scalar));
    return (ticks / editingUnit) * editingUnit;
}

long long TimeUtil::fromSecondsToVelaTimeRounded(double seconds,
                                                 const boost::rational<unsigned long>& editRate) {
    return std::llround(ticksPerSecond(editRate) * seconds);
}

long long TimeUtil::fromSecondsToVelaTimeTruncated(double seconds,
                                                   const boost::rational<unsigned long>& editRate) {
    return (long long)(ticksPerSecond(editRate) * seconds);
}

double TimeUtil::fromVelaTimeToSeconds(const long long& time,
                                       const boost::rational<unsigned long>& editRate) {
    return (SafeRational(time) / asRational(editRate)).asDouble();
}

double TimeUtil::fromVelaRationalToSeconds(const SafeRational& time,
                                           const boost::rational<unsigned long>& editRate) {
    return (time / asRational(editRate)).asDouble();
}

} // namespace VelaMediaLib

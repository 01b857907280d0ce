#pragma once
// Conversions between ticks, seconds and scaled durations.

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/SafeRational.h>

#include <boost/rational.hpp>

namespace VelaMediaLib {

class VELAMEDIALIB_API TimeUtil {
public:
    /// Round(duration * scalar) in ticks, with any partial editing unit dropped.
    static long long durationWithScalarRoundedToEditingUnit(const SafeRational& duration,
                                                            const SafeRational& scalar,
                                                            long long editingUnit);
    /// Halves away from zero.
    static long long fromSecondsToVelaTimeRounded(double seconds,
                                                  const boost::rational<unsigned long>& editRate);
    static long long fromSecondsToVelaTimeTruncated(double seconds,
                                                    const boost::rational<unsigned long>& editRate);
    static double fromVelaTimeToSeconds(const long long& time,
                                        const boost::rational<unsigned long>& editRate);
    static double fromVelaRationalToSeconds(const SafeRational& time,
                                            const boost::rational<unsigned long>& editRate);
};

} // namespace VelaMediaLib

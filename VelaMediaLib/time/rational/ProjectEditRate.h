#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/rational.hpp>
#include <cstdint>

namespace VelaMediaLib {

class Observer;

/// Tells the whole project its tick rate and who to tell when it changes.
class VELAMEDIALIB_API ProjectEditRate {
public:
    virtual ~ProjectEditRate() = default;
    /// Ticks per second of the project.
    virtual boost::rational<unsigned long> editRate() const = 0;
    virtual int32_t durationPerFrame() const = 0;
    virtual uint64_t editingUnit() const = 0;
    virtual int videoFrameRate() const = 0;
    virtual int audioSampleRate() const = 0;
    virtual void attachEditRateObserver(Observer* observer) const = 0;
    virtual void detachEditRateObserver(Observer* observer) const = 0;
    virtual void setEditRate(const boost::rational<unsigned long>& rate) = 0;
};

} // namespace VelaMediaLib

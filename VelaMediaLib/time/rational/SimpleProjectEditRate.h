#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/ProjectEditRate.h>
#include <VelaMediaLib/time/sync/SubjectWithMutex.h>

#include <atomic>

namespace VelaMediaLib {

/// An edit rate held as a value, with fixed frame and sample answers. The
/// rate itself is read and written atomically so that a reader on another
/// thread never sees a torn rational.
class VELAMEDIALIB_API SimpleProjectEditRate : public ProjectEditRate {
public:
    /// Throws ValueException for a zero rate.
    explicit SimpleProjectEditRate(const boost::rational<unsigned long>& rate);

    boost::rational<unsigned long> editRate() const override;
    int32_t durationPerFrame() const override { return 1; }
    uint64_t editingUnit() const override { return 1; }
    int videoFrameRate() const override { return 30; }
    int audioSampleRate() const override { return 44100; }
    void attachEditRateObserver(Observer* observer) const override { subject_.attach(observer); }
    void detachEditRateObserver(Observer* observer) const override { subject_.detach(observer); }
    /// Stores the rate, then notifies every attached observer.
    void setEditRate(const boost::rational<unsigned long>& rate) override;

private:
    std::atomic<unsigned long> numerator_;
    std::atomic<unsigned long> denominator_;
    mutable SubjectWithMutex subject_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/ProjectEditRate.h>
#include <VelaMediaLib/time/sync/SubjectWithMutex.h>

#include <mutex>

namespace VelaMediaLib {

/// An edit rate held as a value, with fixed frame and sample answers; the
/// project keeps its rate in one of these. Every rate that reaches it is a
/// reduced rational: a zero numerator is the rate 0/1, and a zero denominator
/// never gets this far (the rational refuses it, see rateOf).
class VELAMEDIALIB_API SimpleProjectEditRate : public ProjectEditRate {
public:
    explicit SimpleProjectEditRate(const boost::rational<unsigned long>& rate);

    /// The rate of the frames per seconds given, as every entry point builds
    /// it: reduced, a zero numerator giving 0/1. Throws boost::bad_rational
    /// ("bad rational: zero denominator") for a zero denominator.
    static boost::rational<unsigned long> rateOf(unsigned long numerator, unsigned long denominator);

    boost::rational<unsigned long> editRate() const override;
    int32_t durationPerFrame() const override { return 1; }
    uint64_t editingUnit() const override { return 1; }
    int videoFrameRate() const override { return 30; }
    int audioSampleRate() const override { return 44100; }
    void attachEditRateObserver(Observer* observer) const override { subject_.attach(observer); }
    void detachEditRateObserver(Observer* observer) const override { subject_.detach(observer); }
    /// Stores the rate, then notifies every attached observer.
    void setEditRate(const boost::rational<unsigned long>& rate) override;
    /// The two steps apart, for an owner that changes more with the rate
    /// and tells the observers once all of it is done.
    void storeEditRate(const boost::rational<unsigned long>& rate);
    void notifyEditRateObservers() { subject_.notify(); }
    /// The project whose lock and delays its observers are told under, like
    /// every other subject of that project. Set before the rate is shared.
    void setProjectMutex(const boost::weak_ptr<const ThreadSafe>& token) { subject_.setProjectMutex(token); }

private:
    // Numerator and denominator change together: a reader never sees half of
    // a new rate.
    mutable std::mutex rateMutex_;
    boost::rational<unsigned long> rate_;
    mutable SubjectWithMutex subject_;
};

} // namespace VelaMediaLib

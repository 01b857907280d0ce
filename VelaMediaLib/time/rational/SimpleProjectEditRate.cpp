#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>

namespace VelaMediaLib {

SimpleProjectEditRate::SimpleProjectEditRate(const boost::rational<unsigned long>& rate) : rate_(rate) {}

boost::rational<unsigned long> SimpleProjectEditRate::rateOf(unsigned long numerator,
                                                             unsigned long denominator) {
    return boost::rational<unsigned long>(numerator, denominator); // a zero denominator throws bad_rational
}

boost::rational<unsigned long> SimpleProjectEditRate::editRate() const {
    std::lock_guard<std::mutex> lock(rateMutex_);
    return rate_;
}

void SimpleProjectEditRate::setEditRate(const boost::rational<unsigned long>& rate) {
    storeEditRate(rate);
    notifyEditRateObservers();
}

void SimpleProjectEditRate::storeEditRate(const boost::rational<unsigned long>& rate) {
    std::lock_guard<std::mutex> lock(rateMutex_);
    rate_ = rate;
}

} // namespace VelaMediaLib

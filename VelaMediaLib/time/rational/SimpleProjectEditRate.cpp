#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>

namespace VelaMediaLib {
namespace {

void checkRate(const boost::rational<unsigned long>& rate) {
    if (rate.numerator() == 0)
        throw ValueException<boost::rational<unsigned long>>("edit rate must not be zero", rate);
}

} // namespace

SimpleProjectEditRate::SimpleProjectEditRate(const boost::rational<unsigned long>& rate)
    : numerator_(rate.numerator()), denominator_(rate.denominator()) {
    checkRate(rate);
}

boost::rational<unsigned long> SimpleProjectEditRate::editRate() const {
    return boost::rational<unsigned long>(numerator_.load(), denominator_.load());
}

void SimpleProjectEditRate::setEditRate(const boost::rational<unsigned long>& rate) {
    checkRate(rate);
    numerator_.store(rate.numerator());
    denominator_.store(rate.denominator());
    subject_.notify();
}

} // namespace VelaMediaLib

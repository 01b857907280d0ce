#include <VelaMediaLib/time/rational/TimeConverter.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

using namespace VelaMediaLib;

namespace {

// A container that starts its content at `offset` and plays it at `speed`,
// showing at most `length` of it.
class OffsetConverter : public TimeConverter {
public:
    OffsetConverter(SafeRational offset, SafeRational speed, SafeRational length, TimeConverterPtr parent)
        : offset_(offset), speed_(speed), length_(length), parent_(parent) {}
    SafeRational parentParametricTimeToThisParametricTime(const SafeRational& t) const override {
        return (t - offset_) * speed_;
    }
    SafeRational clippingParentParametricTimeToThisParametricTime(const SafeRational& t) const override {
        const SafeRational inside = parentParametricTimeToThisParametricTime(t);
        return inside < 0 ? SafeRational(0) : (inside > length_ ? length_ : inside);
    }
    SafeRational thisParametricTimeToParentParametricTime(const SafeRational& t) const override {
        return t / speed_ + offset_;
    }
    TimeConverterPtr parentTimeConverter() const override { return parent_; }

private:
    SafeRational offset_, speed_, length_;
    TimeConverterPtr parent_;
};

} // namespace

TEST(TimeConverter, ComposesFromTheOutermostContainerInward) {
    const auto outer = boost::make_shared<const OffsetConverter>(10, 2, 100, TimeConverterPtr());
    const OffsetConverter inner(4, SafeRational(1, 3), 5, outer);
    // Global 13 -> outer (13-10)*2 = 6 -> inner (6-4)/3 = 2/3.
    EXPECT_EQ(TimeConverter::recursiveFromGlobalToParametricTime(&inner, 13), SafeRational(2, 3));
    EXPECT_EQ(TimeConverter::recursiveFromParametricToGlobalTime(&inner, SafeRational(2, 3)), 13);
    // Global 100 -> outer 180 clipped to 100 -> inner 32 clipped to 5.
    EXPECT_EQ(TimeConverter::clippingRecursiveFromGlobalToParametricTime(&inner, 100), 5);
    EXPECT_EQ(inner.parentParametricTimeToThisParametricVelaTime(9), 1); // 5/3 truncated
    EXPECT_EQ(inner.thisParametricTimeToParentParametricVelaTime(1), 7);
    EXPECT_EQ(inner.clippingParentParametricTimeToThisParametricVelaTime(100), 5);
    EXPECT_EQ(TimeConverter::recursiveFromGlobalToParametricTime(nullptr, 7), 7);
}

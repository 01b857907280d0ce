#include <VelaMediaLib/time/rational/ScaledTimeRange.h>
#include <VelaMediaLib/time/rational/TimeConverter.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <sstream>

using namespace VelaMediaLib;

TEST(ScaledTime, FlicksScaleConversionAndEquality) {
    EXPECT_EQ(ScaledTime(30, 1).toFlicks(), 23520000);
    EXPECT_EQ((long long)ScaledTime(44100, 44100), 705600000);
    EXPECT_EQ(ScaledTime(30, 7).toScale(24), ScaledTime(24, 5)); // 5.6 truncates
    EXPECT_EQ(ScaledTime(30, -7).toScale(24), ScaledTime(24, -5));
    EXPECT_EQ(ScaledTime::convertTimeToScale(1, 30, ScaledTime::kFlickScale), 23520000);
    // A day at the flick scale converted to 48 kHz does not wrap.
    const long long day = 86400LL * ScaledTime::kFlickScale;
    EXPECT_EQ(ScaledTime::convertTimeToScale(day, ScaledTime::kFlickScale, 48000), 86400LL * 48000);
    // Equality is fieldwise, but integers compare in flicks.
    EXPECT_FALSE(ScaledTime(4, 2) == ScaledTime(2, 1));
    EXPECT_TRUE(ScaledTime(4, 2) == 352800000LL);
    EXPECT_TRUE(352800000LL == ScaledTime(2, 1));
}

TEST(ScaledTime, InvalidScaleCarriesTheScale) {
    try {
        ScaledTime(0, 5);
        FAIL();
    } catch (const ValueException<long long>& e) {
        EXPECT_STREQ(e.what(), "Invalid scale for ScaledTime");
        EXPECT_EQ(e.value(), 0);
    }
    EXPECT_THROW(ScaledTime(-30, 1), VelaMediaLibException);
}

// Frames of 30 per second on the flick grid: floor, ceiling and rounding (half away from zero) mirror each
// other around zero.
TEST(ScaledTime, GridAlignmentIsSymmetricAroundZero) {
    const long long flick = ScaledTime::kFlickScale, frame = 23520000;
    const long long cases[][4] = {
        {frame + 1, frame, 2 * frame, frame}, {-frame - 1, -2 * frame, -frame, -frame},
        {frame, frame, frame, frame},         {frame / 2, 0, frame, frame},
        {-frame / 2, -frame, 0, -frame},      {frame / 2 - 1, 0, frame, 0}};
    for (const auto& c : cases) {
        const ScaledTime time(flick, c[0]);
        EXPECT_EQ(time.alignedFloored(30), ScaledTime(flick, c[1])) << c[0];
        EXPECT_EQ(time.alignedCeiled(30), ScaledTime(flick, c[2])) << c[0];
        EXPECT_EQ(time.alignedRounded(30), ScaledTime(flick, c[3])) << c[0];
    }
    EXPECT_EQ(ScaledTime(30, 7).alignedFloored(30), ScaledTime(30, 7));
}

TEST(ScaledTimeRange, EndsConversionsAndTextForm) {
    const ScaledTimeRange range = ScaledTimeRange::fromStartEnd(30, 10, 25);
    EXPECT_EQ(range.duration().time(), 15);
    EXPECT_EQ(range.end().time(), 25);
    EXPECT_TRUE(range == Range<long long>(10, 15));
    EXPECT_EQ(range.toFlicks(), Range<long long>(10 * 23520000LL, 15 * 23520000LL));
    // Start and duration truncate separately: 1.6 + 1.6 ticks end at 2, not 3.
    EXPECT_EQ(ScaledTimeRange(30, 2, 2).toScale(24).range(), Range<long long>(1, 1));
    EXPECT_EQ(ScaledTimeRange::convertRangeToScale(Range<long long>(30, 60), 30, 1000),
              Range<long long>(1000, 2000));
    std::ostringstream out;
    out << ScaledTime(30, 1) << " " << ScaledTimeRange(30, 0, 30);
    EXPECT_EQ(out.str(),
              "{ time: 1, scale: 30} { start: { time: 0, scale: 30}, duration: { time: 30, scale: 30}}");
}

namespace {

// A container that starts its content at `offset` and plays it at `speed`, showing at most `length` of it.
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

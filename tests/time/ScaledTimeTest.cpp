#include <VelaMediaLib/time/rational/ScaledTimeRange.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <gtest/gtest.h>
#include <sstream>

using namespace VelaMediaLib;

TEST(ScaledTime, FlicksAndScaleConversion) {
    EXPECT_EQ(ScaledTime(30, 1).toFlicks(), 23520000);
    EXPECT_EQ((long long)ScaledTime(44100, 44100), 705600000);
    EXPECT_EQ(ScaledTime(30, 7).toScale(24), ScaledTime(24, 5)); // 5.6 truncates
    EXPECT_EQ(ScaledTime(30, -7).toScale(24), ScaledTime(24, -5));
    EXPECT_EQ(ScaledTime::convertTimeToScale(1, 30, ScaledTime::kFlickScale), 23520000);
    // A day at the flick scale converted to 48 kHz does not wrap.
    const long long day = 86400LL * ScaledTime::kFlickScale;
    EXPECT_EQ(ScaledTime::convertTimeToScale(day, ScaledTime::kFlickScale, 48000), 86400LL * 48000);
}

TEST(ScaledTime, EqualityIsFieldwiseButIntegersCompareInFlicks) {
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

TEST(ScaledTime, GridAlignmentIsSymmetricAroundZero) {
    const long long flick = ScaledTime::kFlickScale;
    EXPECT_EQ(ScaledTime(flick, 23520001).alignedFloored(30).time(), 23520000);
    EXPECT_EQ(ScaledTime(flick, 23520001).alignedCeiled(30).time(), 47040000);
    EXPECT_EQ(ScaledTime(flick, -23520001).alignedFloored(30).time(), -47040000);
    EXPECT_EQ(ScaledTime(flick, -23520001).alignedCeiled(30).time(), -23520000);
    EXPECT_EQ(ScaledTime(flick, 23520000).alignedCeiled(30).time(), 23520000);
    EXPECT_EQ(ScaledTime(flick, 11760000).alignedRounded(30).time(), 23520000); // half a frame
    EXPECT_EQ(ScaledTime(flick, -11760000).alignedRounded(30).time(), -23520000);
    EXPECT_EQ(ScaledTime(flick, 11759999).alignedRounded(30).time(), 0);
    EXPECT_EQ(ScaledTime(flick, 11759999).alignedRounded(30).scale(), flick);
    EXPECT_EQ(ScaledTime(30, 7).alignedFloored(30), ScaledTime(30, 7));
}

TEST(ScaledTimeRange, EndsAndConversions) {
    const ScaledTimeRange range = ScaledTimeRange::fromStartEnd(30, 10, 25);
    EXPECT_EQ(range.duration().time(), 15);
    EXPECT_EQ(range.end().time(), 25);
    EXPECT_TRUE(range == Range<long long>(10, 15));
    EXPECT_EQ(range.toFlicks(), Range<long long>(10 * 23520000LL, 15 * 23520000LL));
    // Start and duration truncate separately: 1.6 + 1.6 ticks end at 2, not 3.
    const ScaledTimeRange converted = ScaledTimeRange(30, 2, 2).toScale(24);
    EXPECT_EQ(converted.range(), Range<long long>(1, 1));
    EXPECT_EQ(ScaledTimeRange::convertRangeToScale(Range<long long>(30, 60), 30, 1000),
              Range<long long>(1000, 2000));
}

TEST(ScaledTime, TextForm) {
    std::ostringstream out;
    out << ScaledTime(30, 1) << " " << ScaledTimeRange(30, 0, 30);
    EXPECT_EQ(out.str(),
              "{ time: 1, scale: 30} { start: { time: 0, scale: 30}, duration: { time: 30, scale: 30}}");
}

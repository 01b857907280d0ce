#include <VelaMediaLib/time/rational/RationalTime.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>
#include <VelaMediaLib/time/rational/TimeUtil.h>

#include <boost/lexical_cast.hpp>
#include <gtest/gtest.h>

using namespace VelaMediaLib;

TEST(RationalUtil, RoundingOnBothSidesOfZero) {
    struct Case {
        SafeRational x;
        long long floor, ceil, round;
    };
    const Case cases[] = {{SafeRational(5, 2), 2, 3, 3},    {SafeRational(-5, 2), -3, -2, -3},
                          {SafeRational(-1, 2), -1, 0, -1}, {SafeRational(1, 3), 0, 1, 0},
                          {SafeRational(-1, 3), -1, 0, 0},  {SafeRational(4), 4, 4, 4},
                          {SafeRational(-4), -4, -4, -4},   {SafeRational(7, 3), 2, 3, 2}};
    for (const Case& c : cases) {
        EXPECT_EQ(RationalUtil::Floor(c.x), c.floor) << c.x;
        EXPECT_EQ(RationalUtil::Ceil(c.x), c.ceil) << c.x;
        EXPECT_EQ(RationalUtil::Round(c.x), c.round) << c.x;
    }
}

TEST(RationalUtil, ModResAndTicks) {
    EXPECT_EQ(RationalUtil::Mod(SafeRational(-7, 2)), -1);
    EXPECT_EQ(RationalUtil::Mod(SafeRational(7, 3)), 1);
    EXPECT_EQ(RationalUtil::Res(SafeRational(7, 3)), 2);
    EXPECT_EQ(RationalUtil::Res(SafeRational(6, 3)), 0);
    EXPECT_EQ(RationalUtil::Res(SafeRational(-1, 3)), 4);
    EXPECT_EQ(RationalUtil::toVelaTime(SafeRational(-7, 2)), -3);
    EXPECT_EQ(RationalUtil::toVelaTimeRange(Range<SafeRational>(SafeRational(7, 2), SafeRational(-7, 2))),
              Range<long long>(3, -3));
    EXPECT_FLOAT_EQ(RationalUtil::toFloat(SafeRational(1, 4)), 0.25f);
    EXPECT_EQ(RationalUtil::toDoubleRange(Range<SafeRational>(SafeRational(1, 2), 2)),
              Range<double>(0.5, 2.0));
}

TEST(RationalUtil, FromDoubleApproxBisectsTenThousandths) {
    EXPECT_EQ(RationalUtil::fromDoubleApprox(0.5), SafeRational(1, 2));
    EXPECT_EQ(RationalUtil::fromDoubleApprox(3.0), SafeRational(3));
    EXPECT_EQ(RationalUtil::fromDoubleApprox(-2.25), SafeRational(-9, 4));
    EXPECT_EQ(RationalUtil::fromDoubleApprox(-0.75), SafeRational(-3, 4));
    // The last candidate is kept even when an earlier one was closer.
    const SafeRational third = RationalUtil::fromDoubleApprox(1.0 / 3.0);
    EXPECT_NEAR(third.asDouble(), 1.0 / 3.0, 5e-4);
    EXPECT_EQ(10000 % third.denominator(), 0);
}

TEST(RationalUtil, FromStringAcceptsIntegersAndFractionsOnly) {
    EXPECT_EQ(RationalUtil::fromString("1/30"), SafeRational(1, 30));
    EXPECT_EQ(RationalUtil::fromString("-4/6"), SafeRational(-2, 3));
    EXPECT_EQ(RationalUtil::fromString("+42"), SafeRational(42));
    for (const char* bad : {"", "1.5", "abc", "1/", "1/0", "99999999999999999999", "2 "})
        EXPECT_THROW(RationalUtil::fromString(bad), boost::bad_lexical_cast) << '"' << bad << '"';
}

TEST(TimeUtil, SecondsAndTicksAtNtscRates) {
    const boost::rational<unsigned long> ntsc(30000, 1001);
    EXPECT_EQ(TimeUtil::fromSecondsToVelaTimeRounded(1.0, ntsc), 30);
    EXPECT_EQ(TimeUtil::fromSecondsToVelaTimeTruncated(1.0, ntsc), 29);
    EXPECT_EQ(TimeUtil::fromSecondsToVelaTimeRounded(-1.0, ntsc), -30);
    EXPECT_DOUBLE_EQ(TimeUtil::fromVelaTimeToSeconds(30000, ntsc), 1001.0);
    EXPECT_DOUBLE_EQ(
        TimeUtil::fromVelaRationalToSeconds(SafeRational(1, 2), boost::rational<unsigned long>(30)),
        1.0 / 60.0);
    // 10 * 5/4 = 12.5 rounds to 13, then whole units of 4 keep 12.
    EXPECT_EQ(TimeUtil::durationWithScalarRoundedToEditingUnit(10, SafeRational(5, 4), 4), 12);
    EXPECT_EQ(TimeUtil::durationWithScalarRoundedToEditingUnit(10, SafeRational(5, 4), 1), 13);
}

TEST(RationalTime, DelegatesToItsRational) {
    const RationalTime a(1, 30), b(SafeRational(2, 60));
    EXPECT_EQ(a, b);
    EXPECT_LT(-a, a);
    EXPECT_EQ(RationalTime(5).asRational(), SafeRational(5));
    EXPECT_DOUBLE_EQ(a.asDouble(), 1.0 / 30.0);
}

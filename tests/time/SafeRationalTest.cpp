#include <VelaMediaLib/base/detail/Int128.h>
#include <VelaMediaLib/time/rational/RationalTime.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>
#include <VelaMediaLib/time/rational/TimeUtil.h>

#include <boost/lexical_cast.hpp>
#include <gtest/gtest.h>
#include <limits>
#include <random>
#include <sstream>
#include <tuple>
#include <vector>

using namespace VelaMediaLib;

namespace {

const long long kMax = std::numeric_limits<long long>::max(), kMin = std::numeric_limits<long long>::min();

void expectFields(const SafeRational& value, long long num, long long den) {
    EXPECT_EQ(value.numerator(), num) << value;
    EXPECT_EQ(value.denominator(), den) << value;
}

std::string messageOf(long long n, long long d) {
    try {
        SafeRational value(n, d);
    } catch (const boost::bad_rational& e) {
        return e.what();
    }
    return "no exception";
}

} // namespace

TEST(SafeRational, ConstructionReducesMovesTheSignAndRefusesZero) {
    expectFields(SafeRational(), 0, 1);
    expectFields(SafeRational(2, -4), -1, 2);
    expectFields(SafeRational(0, 5), 0, 1);
    expectFields(SafeRational(-6, -9), 2, 3);
    SafeRational value;
    value.assign(10, -20);
    expectFields(value, -1, 2);
    EXPECT_EQ(messageOf(1, 0), "bad rational: zero denominator");
    EXPECT_EQ(messageOf(1, kMin), "bad rational: non-zero singular denominator");
    EXPECT_THROW(SafeRational(0).invert(), boost::bad_rational);
    EXPECT_THROW(SafeRational(1) / SafeRational(0), boost::bad_rational);
    expectFields(SafeRational(-2, 3).invert(), -3, 2);
    // Conversions truncate toward zero.
    EXPECT_EQ(SafeRational(7, 2).asVelaTime(), 3);
    EXPECT_EQ(SafeRational(-7, 2).asVelaTime(), -3);
    EXPECT_DOUBLE_EQ(SafeRational(30000, 1001).asDouble(), 30000.0 / 1001.0);
    EXPECT_EQ(SafeRational(1, 3).get(), boost::rational<long long>(1, 3));
}

TEST(SafeRational, ExactArithmetic) {
    expectFields(SafeRational(1, 3) + SafeRational(1, 6), 1, 2);
    expectFields(SafeRational(1, 3) - SafeRational(1, 2), -1, 6);
    expectFields(SafeRational(2, 3) * SafeRational(9, 4), 3, 2);
    expectFields(SafeRational(2, 3) / SafeRational(-4, 9), -3, 2);
    expectFields(SafeRational(0) / SafeRational(7, 3), 0, 1);
    expectFields(SafeRational(0) * SafeRational(7, 3), 0, 1);
    expectFields(-SafeRational(1, 30), -1, 30);
    SafeRational x(1, 30);
    x += SafeRational(1, 30);
    x *= 3;
    x -= SafeRational(1, 10);
    x /= SafeRational(1, 2);
    expectFields(x, 1, 5);
    expectFields(abs(SafeRational(-7, 2)), 7, 2);
}

TEST(SafeRational, OverflowFallsBackToTheDecimalApproximation) {
    // 3037000500^2 is just past 2^63: the exact denominator wraps negative.
    const SafeRational a(3037000499, 3037000500), b(3037000501, 3037000500);
    EXPECT_EQ(a * b, SafeRational(SafeRational::fromDouble(a.asDouble() * b.asDouble())));
    expectFields(a * b, 1, 1); // 0.99999999989... prints as 1.000000
    const SafeRational half = SafeRational(3037000499, 3037000500 * 2) * b;
    EXPECT_EQ(1000000 % half.denominator(), 0) << half;
    expectFields(half, 1, 2);
    expectFields(SafeRational(kMax) + SafeRational(1), kMax, 1);
    expectFields(SafeRational(kMin) - SafeRational(1), kMin, 1);
    expectFields(-SafeRational(kMin), kMax, 1);
    // A non-zero result too small for the double check is approximated to zero.
    expectFields(SafeRational(1, 1000000000) * SafeRational(1, 1000), 0, 1);
    // fromDouble follows the printed decimals and saturates.
    typedef boost::rational<long long> R;
    EXPECT_EQ(SafeRational::fromDouble(0.5), R(1, 2));
    EXPECT_EQ(SafeRational::fromDouble(3.0), R(3, 1));
    EXPECT_EQ(SafeRational::fromDouble(1.0 / 3.0), R(333333, 1000000));
    EXPECT_EQ(SafeRational::fromDouble(-2.25), R(-9, 4));
    EXPECT_EQ(SafeRational::fromDouble(1e30), R(kMax, 1));
    EXPECT_EQ(SafeRational::fromDouble(-1e30), R(kMin, 1));
}

TEST(SafeRational, ComparisonsAreExactAndMixWithIntegers) {
    const SafeRational third(1, 3), big(kMax - 1, kMax);
    EXPECT_LT(third, SafeRational(1, 2));
    EXPECT_LT(SafeRational(kMax, kMax - 1), SafeRational(kMax - 1, kMax - 2)); // differ by ~1e-37
    EXPECT_LT(big, 1);
    EXPECT_TRUE(1 > big);
    EXPECT_TRUE(SafeRational(6, 3) == 2);
    EXPECT_TRUE(2 == SafeRational(4, 2));
    EXPECT_TRUE(SafeRational(-1, 2) <= 0);
    EXPECT_TRUE(0 >= SafeRational(-1, 2));
    EXPECT_TRUE(SafeRational(5, 2) >= 2);
    EXPECT_NE(third, SafeRational(2, 6) + SafeRational(1, 1000));
    const RationalTime time(1, 30);
    EXPECT_EQ(time, RationalTime(SafeRational(2, 60)));
    EXPECT_LT(-time, time);
    EXPECT_EQ(RationalTime(5).asRational(), SafeRational(5));
    EXPECT_DOUBLE_EQ(time.asDouble(), 1.0 / 30.0);
}

TEST(SafeRational, TextFormRoundTrips) {
    std::ostringstream out;
    out << SafeRational(1, 30) << ' ' << SafeRational();
    EXPECT_EQ(out.str(), "1/30 0/1");
    EXPECT_EQ(boost::lexical_cast<SafeRational>("-3/6"), SafeRational(-1, 2));
    EXPECT_EQ(boost::lexical_cast<SafeRational>("7"), SafeRational(7));
    EXPECT_THROW(boost::lexical_cast<SafeRational>("1/2x"), boost::bad_lexical_cast);
    std::istringstream in("1/0");
    SafeRational value;
    EXPECT_THROW(in >> value, boost::bad_rational);
    EXPECT_EQ(RationalUtil::fromString("1/30"), SafeRational(1, 30));
    EXPECT_EQ(RationalUtil::fromString("-4/6"), SafeRational(-2, 3));
    EXPECT_EQ(RationalUtil::fromString("+42"), SafeRational(42));
    for (const char* bad : {"", "1.5", "abc", "1/", "1/0", "99999999999999999999", "2 "})
        EXPECT_THROW(RationalUtil::fromString(bad), boost::bad_lexical_cast) << '"' << bad << '"';
}

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

// The portable type is what compilers without a 128-bit integer use: it must agree with the built-in one
// wherever the time code uses it (products of two 64-bit values, then +, -, /, % and comparisons).
#if defined(__SIZEOF_INT128__)
TEST(PortableInt128, AgreesWithTheBuiltInTypeOnProductsOfTwo64BitValues) {
    using detail::PortableInt128;
    __extension__ typedef __int128 Native;
    std::vector<long long> values = {0, 1, -1, 3, -7, kMax, kMin + 1, 1LL << 40, -(1LL << 62)};
    std::mt19937_64 random(5);
    for (int i = 0; i < 200; ++i) values.push_back((long long)random() >> (random() % 60));
    for (size_t i = 0; i + 3 < values.size(); ++i) {
        const long long a = values[i], b = values[i + 1], c = values[i + 2] == 0 ? 3 : values[i + 2],
                        d = b == 0 ? 5 : b;
        const PortableInt128 p = PortableInt128(a) * b, q = PortableInt128(c) * a;
        const Native n = (Native)a * b, m = (Native)c * a;
        EXPECT_EQ((long long)(p / c), (long long)(n / c)) << a << " * " << b << " / " << c;
        EXPECT_EQ((long long)(p % c), (long long)(n % c)) << a << " * " << b << " % " << c;
        EXPECT_EQ((long long)((p - p % c) / d), (long long)((n - n % c) / d));
        EXPECT_EQ(std::make_tuple(p<q, p> q, p == q, p != q, p <= q, p >= q),
                  std::make_tuple(n<m, n> m, n == m, n != m, n <= m, n >= m));
        EXPECT_TRUE(p <= p && p >= p && !(p < p) && !(p > p) && !(p != p)); // equal values
        EXPECT_EQ((long long)(p + q - q), (long long)(n + m - m));
    }
}
#endif

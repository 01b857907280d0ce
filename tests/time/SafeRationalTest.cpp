#include <VelaMediaLib/time/rational/SafeRational.h>

#include <boost/lexical_cast.hpp>
#include <gtest/gtest.h>
#include <limits>
#include <sstream>

using VelaMediaLib::SafeRational;

namespace {

const long long kMax = std::numeric_limits<long long>::max();
const long long kMin = std::numeric_limits<long long>::min();

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

TEST(SafeRational, ConstructionReducesAndMovesTheSign) {
    expectFields(SafeRational(), 0, 1);
    expectFields(SafeRational(2, -4), -1, 2);
    expectFields(SafeRational(0, 5), 0, 1);
    expectFields(SafeRational(-6, -9), 2, 3);
    SafeRational value;
    value.assign(10, -20);
    expectFields(value, -1, 2);
}

TEST(SafeRational, InvalidDenominatorsThrowBoostsMessages) {
    EXPECT_EQ(messageOf(1, 0), "bad rational: zero denominator");
    EXPECT_EQ(messageOf(1, kMin), "bad rational: non-zero singular denominator");
    EXPECT_THROW(SafeRational(0).invert(), boost::bad_rational);
    EXPECT_THROW(SafeRational(1) / SafeRational(0), boost::bad_rational);
    expectFields(SafeRational(-2, 3).invert(), -3, 2);
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
    const SafeRational product = a * b;
    EXPECT_EQ(product, SafeRational(SafeRational::fromDouble(a.asDouble() * b.asDouble())));
    expectFields(product, 1, 1); // 0.99999999989... prints as 1.000000

    const SafeRational c(3037000499, 3037000500 * 2), d(3037000501, 3037000500);
    const SafeRational half = c * d;
    EXPECT_EQ(1000000 % half.denominator(), 0) << half;
    expectFields(half, 1, 2);

    expectFields(SafeRational(kMax) + SafeRational(1), kMax, 1);
    expectFields(SafeRational(kMin) - SafeRational(1), kMin, 1);
    expectFields(-SafeRational(kMin), kMax, 1);
    // A non-zero result too small for the double check is approximated to zero.
    expectFields(SafeRational(1, 1000000000) * SafeRational(1, 1000), 0, 1);
}

TEST(SafeRational, FromDoubleFollowsThePrintedDecimals) {
    EXPECT_EQ(SafeRational::fromDouble(0.5), boost::rational<long long>(1, 2));
    EXPECT_EQ(SafeRational::fromDouble(3.0), boost::rational<long long>(3, 1));
    EXPECT_EQ(SafeRational::fromDouble(1.0 / 3.0), boost::rational<long long>(333333, 1000000));
    EXPECT_EQ(SafeRational::fromDouble(-2.25), boost::rational<long long>(-9, 4));
    EXPECT_EQ(SafeRational::fromDouble(1e30), boost::rational<long long>(kMax, 1));
    EXPECT_EQ(SafeRational::fromDouble(-1e30), boost::rational<long long>(kMin, 1));
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
}

TEST(SafeRational, ConversionsTruncateTowardZero) {
    EXPECT_EQ(SafeRational(7, 2).asVelaTime(), 3);
    EXPECT_EQ(SafeRational(-7, 2).asVelaTime(), -3);
    EXPECT_DOUBLE_EQ(SafeRational(30000, 1001).asDouble(), 30000.0 / 1001.0);
    EXPECT_EQ(SafeRational(1, 3).get(), boost::rational<long long>(1, 3));
}

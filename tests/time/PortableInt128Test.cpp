#include <VelaMediaLib/base/detail/Int128.h>

#include <gtest/gtest.h>
#include <limits>
#include <random>

using VelaMediaLib::detail::PortableInt128;

// The portable type is what compilers without a 128-bit integer use: it
// must agree with the built-in one wherever the time code uses it
// (products of two 64-bit values, then +, -, /, % and comparisons).
#if defined(__SIZEOF_INT128__)
TEST(PortableInt128, AgreesWithTheBuiltInTypeOnProductsOfTwo64BitValues) {
    __extension__ typedef __int128 Native;
    const long long extremes[] = {0,
                                  1,
                                  -1,
                                  3,
                                  -7,
                                  std::numeric_limits<long long>::max(),
                                  std::numeric_limits<long long>::min() + 1,
                                  1LL << 40,
                                  -(1LL << 62)};
    std::mt19937_64 random(5);
    std::vector<long long> values(std::begin(extremes), std::end(extremes));
    for (int i = 0; i < 200; ++i) values.push_back((long long)random() >> (random() % 60));
    for (size_t i = 0; i + 3 < values.size(); ++i) {
        const long long a = values[i], b = values[i + 1], c = values[i + 2] == 0 ? 3 : values[i + 2];
        const PortableInt128 p = PortableInt128(a) * b;
        const Native n = (Native)a * b;
        EXPECT_EQ((long long)(p / c), (long long)(n / c)) << a << " * " << b << " / " << c;
        EXPECT_EQ((long long)(p % c), (long long)(n % c)) << a << " * " << b << " % " << c;
        if (b != 0) {
            EXPECT_EQ((long long)((p - p % c) / b), (long long)((n - n % c) / b));
        }
        const PortableInt128 q = PortableInt128(c) * a;
        const Native m = (Native)c * a;
        EXPECT_EQ(p < q, n < m);
        EXPECT_EQ(p > q, n > m);
        EXPECT_EQ(p == q, n == m);
        EXPECT_EQ(p != q, n != m);
        EXPECT_EQ(p <= q, n <= m);
        EXPECT_EQ(p >= q, n >= m);
        EXPECT_TRUE(p <= p && p >= p && !(p < p) && !(p > p) && !(p != p)); // equal values
        EXPECT_EQ((long long)(p + q - q), (long long)(n + m - m));
    }
}
#endif

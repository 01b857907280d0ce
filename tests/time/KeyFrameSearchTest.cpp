// A query finds its segment by the keyframes' times as doubles and settles it
// exactly: times closer than a double can tell apart still resolve exactly.
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

using namespace VelaMediaLib;

TEST(KeyFrameSearch, TimesThatRoundToOneDoubleResolveExactly) {
    const long long n = 100000000000000000LL;
    const RationalTime third(1, 3), justAfter(n + 1, 3 * n + 2);
    ASSERT_EQ(third.asDouble(), justAfter.asDouble());
    ASSERT_LT(third, justAfter);

    const auto project = boost::make_shared<ThreadSafe>();
    const auto parameter = InterpolatingParam<double>::create(project, "x", 0.0); // 0 at time 0
    parameter->addKeyFrame(third, 1.0, RationalTime(0));
    parameter->addKeyFrame(justAfter, 2.0, RationalTime(0));
    parameter->addKeyFrame(RationalTime(1), 3.0, RationalTime(0));
    EXPECT_EQ(parameter->valueAtTime(third), 1.0);
    EXPECT_EQ(parameter->valueAtTime(justAfter), 2.0);
    EXPECT_EQ(parameter->valueAtTime(RationalTime(1)), 3.0);
    EXPECT_DOUBLE_EQ(parameter->valueAtTime(RationalTime(2, 3)), 2.5);
    EXPECT_DOUBLE_EQ(parameter->valueAtTime(RationalTime(1, 6)), 0.5); // from the keyframe made at 0
    EXPECT_NEAR(parameter->valueAtTime(RationalTime(n, 3 * n + 1)), 1.0, 1e-9);
}

// Doubles of 64-bit fractions may even fall out of order: the first time is
// the smaller, its double the larger. The exact steps still find each.
TEST(KeyFrameSearch, DoublesOutOfOrderStillResolveExactly) {
    const RationalTime smaller(2627956128310171712LL, 2929486927966052356LL),
        larger(2627956128310172410LL, 2929486927966053133LL);
    ASSERT_LT(smaller, larger);
    ASSERT_GT(smaller.asDouble(), larger.asDouble());
    const auto parameter = InterpolatingParam<double>::create(boost::make_shared<ThreadSafe>(), "x", 0.0);
    parameter->addKeyFrame(smaller, 1.0, RationalTime(0));
    parameter->addKeyFrame(larger, 2.0, RationalTime(0));
    parameter->addKeyFrame(RationalTime(1), 3.0, RationalTime(0));
    EXPECT_EQ(parameter->valueAtTime(smaller), 1.0);
    EXPECT_EQ(parameter->valueAtTime(larger), 2.0);

    // A crowd of times one double cannot tell apart: every one still found.
    KeyFrameMapUtil<int>::Map crowd;
    const long long base = 1LL << 62;
    for (long long i = 0; i < 64; ++i)
        crowd.push_back({RationalTime(base + 3 * i, base), boost::make_shared<int>(int(i))});
    for (long long i = 0; i < 64 * 3; ++i) {
        const RationalTime t(base + i, base);
        EXPECT_EQ(KeyFrameMapUtil<int>::locate(crowd, t, t.asDouble()),
                  KeyFrameMapUtil<int>::firstAtOrAfter(crowd, t));
    }
}

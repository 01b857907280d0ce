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

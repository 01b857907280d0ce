#include <VelaMediaLib/time/interpolaters/InterpolaterFactory.h>

#include <cmath>
#include <gtest/gtest.h>

using namespace VelaMediaLib;

namespace {

// Value between 10 at time 0 and 20 at time 2, at time t.
template <typename Kind>
double tween(double t) {
    return Kind::getInstance()->interpolate(10.0, 20.0, 0, 2, t);
}

} // namespace

TEST(Interpolater, TweenedKindsAndLeadInsAgainstHandComputedValues) {
    EXPECT_DOUBLE_EQ(tween<LinearInterpolater<double>>(1.0), 15.0);
    EXPECT_DOUBLE_EQ(tween<EaseInInterpolater<double>>(1.0), 12.5);
    EXPECT_DOUBLE_EQ(tween<EaseOutInterpolater<double>>(1.0), 10.0 + 10.0 * std::sqrt(0.5));
    EXPECT_DOUBLE_EQ(tween<EaseInOutSinusoidalInterpolater<double>>(1.0), 15.0);
    // Sigmoid at u = 0.25: 0.5 * (0.5)^2 = 0.125.
    EXPECT_DOUBLE_EQ(tween<EaseInOutDoubleExponentialSigmoidInterpolater<double>>(0.5), 11.25);
    EXPECT_DOUBLE_EQ(tween<EaseInOutDoubleExponentialSigmoidInterpolater<double>>(1.5), 18.75);
    EXPECT_DOUBLE_EQ(tween<LeftInterpolater<double>>(1.999), 10.0);
    EXPECT_DOUBLE_EQ(EaseInInterpolater<double>::getInstance()->exponent(), 2.0);
    EXPECT_DOUBLE_EQ(EaseOutInterpolater<double>::getInstance()->exponent(), 0.5);
    // A curve does what it does; another curve does not.
    const auto easeIn = EaseInInterpolater<double>::getInstance();
    EXPECT_TRUE(easeIn->sameAs(*easeIn));
    EXPECT_FALSE(easeIn->sameAs(*EaseOutInterpolater<double>::getInstance()));
    // Keyframes 0 at 0 and 10 at 10 with a lead-in: the transition holds until 10 - leadIn; a lead-in longer
    // than the segment starts at the earlier keyframe.
    const auto led = [](double t, long long leadIn) {
        return LinearInterpolater<double>::getInstance()->interpolate(0.0, 10.0, 0, 10, t, leadIn);
    };
    EXPECT_DOUBLE_EQ(led(5, 4), 0.0);
    EXPECT_DOUBLE_EQ(led(8, 4), 5.0);
    EXPECT_DOUBLE_EQ(led(5, 40), 5.0);
}

TEST(Interpolater, BounceEndsOnTheValueAndBouncesOnTheWay) {
    EXPECT_NEAR(InterpolaterUtil::bounce(0.0), 0.0, 1e-12);
    EXPECT_NEAR(InterpolaterUtil::bounce(1.0), 1.0, 1e-9);
    // By hand: total 1.817903, v 1.158952, p = 0.45, v - 1 = 0.158952, g = 0.185050.
    EXPECT_NEAR(InterpolaterUtil::bounce(0.5), 0.814950, 1e-5);
    EXPECT_NEAR(tween<BounceInterpolater<double>>(1.0), 10.0 + 10.0 * 0.814950, 1e-4);
}

TEST(Interpolater, SpringSettlesOnTheValueAfterOvershooting) {
    const SpringResponse spring(10.0, 100.0);
    // r(0.1) = 1 - e^-0.5 (cos(0.866) + 0.57735 sin(0.866)) by hand.
    EXPECT_NEAR(spring.response(0.1), 0.34029, 1e-4);
    for (double tau = spring.settlingTime(); tau < 3.0 * spring.settlingTime(); tau += 0.01)
        EXPECT_LE(std::fabs(1.0 - spring.response(tau)), SpringResponse::kSettlingTolerance * 1.0001) << tau;
    const auto shared = SpringInterpolater<double>::getInstance();
    EXPECT_DOUBLE_EQ(shared->ease(0.0), 0.0);
    EXPECT_DOUBLE_EQ(shared->ease(1.0), 1.0);
    double highest = 0.0;
    for (double u = 0.0; u <= 1.0; u += 0.001) highest = std::max(highest, shared->ease(u));
    EXPECT_GT(highest, 1.05); // damping 10 with stiffness 100 overshoots by about 16%
    // Critically damped and overdamped springs rise without overshoot and still end on 1.
    for (const double damping : {20.0, 40.0}) {
        const SpringInterpolater<double> spring2(damping, 100.0);
        EXPECT_DOUBLE_EQ(spring2.ease(1.0), 1.0);
        for (double u = 0.05; u <= 1.0; u += 0.05) EXPECT_GE(spring2.ease(u), spring2.ease(u - 0.05)) << u;
        EXPECT_LT(spring2.ease(0.5), 1.0);
    }
    // By hand: critical r(0.1) = 1 - e^-1 (1 + 1); overdamped (half 20, root of 300) r(0.1) = 1 - (fast
    // e^(-slow 0.1) - slow e^(-fast 0.1)) / (fast - slow).
    EXPECT_NEAR(SpringResponse(20.0, 100.0).response(0.1), 0.264241, 1e-6);
    EXPECT_NEAR(SpringResponse(40.0, 100.0).response(0.1), 0.177737, 1e-6);
    EXPECT_THROW(SpringInterpolater<double>(0.0, 100.0), VelaMediaLibException);
    EXPECT_THROW(SpringInterpolater<double>(10.0, -1.0), VelaMediaLibException);
    EXPECT_THROW(SpringInterpolater<double>(10.0, 0.0), VelaMediaLibException); // no stiffness, no spring
}

TEST(Interpolater, CompoundValuesBlendMemberByMemberAndIntegersRound) {
    const auto point = LinearInterpolater<Point3d>::getInstance()->interpolate(
        Point3d(0, 0, 0), Point3d(10, 20, -30), 0, 4, 1.0);
    EXPECT_EQ(point, Point3d(2.5, 5, -7.5));
    const auto colour = LinearInterpolater<TemplatedColor<int>>::getInstance()->interpolate(
        TemplatedColor<int>(0, 0, 0, 255), TemplatedColor<int>(255, 10, 3, 255), 0, 2, 1.0);
    EXPECT_EQ(colour, TemplatedColor<int>(128, 5, 2, 255)); // 127.5 and 1.5 round away from zero
    EXPECT_EQ(LinearInterpolater<int>::getInstance()->interpolate(0, 3, 0, 2, 1.0), 2);
    const TransformMatrix halfway = LinearInterpolater<TransformMatrix>::getInstance()->interpolate(
        TransformMatrix(), TransformMatrix::translation(4, 0, 0), 0, 2, 1.0);
    EXPECT_DOUBLE_EQ(halfway.at(0, 3), 2.0);
}

TEST(Interpolater, NamesSharedInstancesAndUnknownNames) {
    EXPECT_EQ(InterpolaterFactory<double>::byName("linr"), LinearInterpolater<double>::getInstance());
    EXPECT_EQ(InterpolaterFactory<double>::byName("sprg")->asJson(), "\"sprg\"");
    EXPECT_EQ(InterpolaterFactory<std::string>::byName("left")->name(), "left");
    EXPECT_EQ(InterpolaterFactory<long long>::byName("esOt")->name(), "esOt");
    for (const char* name : {"linr", "nope", ""})
        EXPECT_THROW(InterpolaterFactory<std::string>::byName(name), ParserException) << name;
    try {
        InterpolaterFactory<double>::byName("nope");
        ADD_FAILURE() << "an unknown name was read";
    } catch (const ParserException& e) {
        EXPECT_STREQ(e.what(), "trying to read an unknown interpolater");
    }
    EXPECT_FALSE(InterpolaterFactory<long long>::find("eios")); // in-out curves are not for 64-bit integers
}

TEST(BezierInterpolater, FollowsTheCurveAndSurvivesItsName) {
    // Control points a third and two thirds along a straight line make the curve that line.
    const BezierInterpolater straight(Point3d(10, 0, 0), Point3d(20, 0, 0), "linr");
    const Point3d middle = straight.interpolate(Point3d(0, 0, 0), Point3d(30, 0, 0), 0, 2, 1.0);
    EXPECT_NEAR(middle.x, 15.0, 1e-12);
    // A bent curve at s = 0.5: (a + 3 cp1 + 3 cp2 + b) / 8.
    const BezierInterpolater bent(Point3d(0, 8, 4), Point3d(8, 8, 4), "linr");
    EXPECT_EQ(bent.pointAt(Point3d(0, 0, 0), Point3d(8, 0, 0), 0.5), Point3d(4, 6, 3));
    const auto parsed = BezierInterpolater::fromName("bezr(esIn;0,8,0;8,8.5,-1)");
    ASSERT_TRUE(parsed);
    EXPECT_EQ(parsed->controlPoint2(), Point3d(8, 8.5, -1));
    EXPECT_EQ(parsed->temporalInterpolaterName(), "esIn");
    EXPECT_EQ(parsed->asJson(), "\"bezr(esIn;0.0,8.0,0.0;8.0,8.5,-1.0)\"");
    EXPECT_EQ(InterpolaterFactory<Point3d>::byName("bezr(esIn;0.0,8.0,0.0;8.0,8.5,-1.0)")->asJson(),
              parsed->asJson());
    for (const char* malformed : {"bezr(linr;1,2;3,4,5)", "bezr(linr;1,x,2;3,4,5)", "bezr(linr;1,2,3;3,4,5,)",
                                  "bezr(linr;1,2,3 ;3,4,5)", "bezr(linr;1,2,3)", "bezr(linr;1,2,3;3,4,5"})
        EXPECT_FALSE(BezierInterpolater::fromName(malformed)) << malformed;
    EXPECT_THROW(BezierInterpolater(Point3d(), Point3d(), "what"), ParserException);
}

#include <VelaMediaLib/time/parameters/AnimationParam.h>
#include <VelaMediaLib/time/parameters/DiffParameter.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/parameters/LeftParameter.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

using namespace VelaMediaLib;

namespace {

typedef std::vector<RationalTime> Times;

struct TicksPerUnit : TimeScalable {
    SafeRational scale;
    explicit TicksPerUnit(SafeRational s) : scale(s) {}
    SafeRational timeScale() const override { return scale; }
};

struct Counter : Observer {
    int count = 0;
    void update(Observable*) override { ++count; }
};

// The time and identifier a refused call names.
template <typename Call>
std::pair<RationalTime, std::string> refusal(Call call) {
    try {
        call();
    } catch (const KeyFrameException& e) {
        return {e.time(), e.identifier()};
    }
    return {-1, "nothing thrown"};
}

class ParameterTest : public ::testing::Test {
protected:
    // 0 at time 0 and 10 at time 10, linear.
    boost::shared_ptr<ParameterImpl<double>> ramp() {
        auto parameter = ParameterImpl<double>::create(project, "opacity", 0.0);
        parameter->addKeyFrame(10, 10.0, 0);
        return parameter;
    }
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
};

} // namespace

TEST_F(ParameterTest, ValueAtTimeFollowsItsSteps) {
    ParameterImpl<double> empty(project, "empty");
    EXPECT_EQ(refusal([&] { empty.valueAtTime(3); }), std::make_pair(RationalTime(0), std::string("empty")));
    EXPECT_EQ(ParameterImpl<double>::create(project, "constant", 7.0)->valueAtTime(-100), 7.0);
    auto parameter = ramp();
    EXPECT_EQ(parameter->valueAtTime(5), 5.0);
    EXPECT_EQ(parameter->valueAtTime(-1), 0.0);
    EXPECT_EQ(parameter->valueAtTime(11), 10.0);
    EXPECT_EQ(parameter->valueAtTime(10), 10.0);
    EXPECT_DOUBLE_EQ(parameter->valueAtTime(RationalTime(19, 2)), 9.5);
    // With two ticks per unit, 9.6 lies less than one tick before 10 and snaps to it.
    parameter->setTimeScalable(boost::make_shared<TicksPerUnit>(2));
    EXPECT_EQ(parameter->valueAtTime(RationalTime(48, 5)), 10.0);
    EXPECT_DOUBLE_EQ(parameter->valueAtTime(RationalTime(19, 2)), 9.5); // exactly one tick before
    // The end keyframe's interpolater and lead-in shape the segment.
    parameter = ramp();
    parameter->keyframeAtTime(10)->setInterpolater(EaseInInterpolater<double>::getInstance());
    EXPECT_DOUBLE_EQ(parameter->valueAtTime(5), 2.5);
    EXPECT_EQ(parameter->changeKeyFrameLeadInLength(10, 4), RationalTime(0));
    EXPECT_EQ(parameter->valueAtTime(5), 0.0);        // holds until 6
    EXPECT_DOUBLE_EQ(parameter->valueAtTime(8), 2.5); // eased half-way through the lead-in
    EXPECT_EQ(parameter->keyframeAtTime(10)->time(), RationalTime(6));
}

TEST_F(ParameterTest, RefusedEditsLeaveTheParameterAsItWas) {
    auto parameter = ramp();
    const auto before = parameter->clone();
    Counter observer;
    parameter->attach(&observer);
    // A keyframe at 12 whose transition would start before 10.
    EXPECT_EQ(refusal([&] { parameter->addKeyFrame(12, 1.0, 5); }),
              std::make_pair(RationalTime(12), std::string("opacity")));
    EXPECT_THROW(parameter->addKeyFrame(5, 1.0, -1), KeyFrameException);
    try {
        parameter->setValueAtTime(3.0, 4);
        FAIL();
    } catch (const VelaMediaLibException& e) {
        EXPECT_STREQ(e.what(), "error");
    }
    EXPECT_THROW(parameter->changeKeyFrame(4, 3.0), KeyFrameException);
    EXPECT_THROW(parameter->moveKeyFrame(0, 10), KeyFrameException);
    EXPECT_THROW(parameter->moveKeyframes(10, [](RationalTime t) { return t == 0; }), KeyFrameException);
    EXPECT_THROW(parameter->changeKeyFrameLeadInLength(10, 11), KeyFrameException);
    EXPECT_FALSE(ParameterImpl<double>::create(project, "one", 1.0)->removeKeyFrame(0));
    EXPECT_TRUE(*parameter == *before);
    EXPECT_EQ(observer.count, 0);
    parameter->detach(&observer);
}

TEST_F(ParameterTest, EditsReturnWhatWasThereAndTellObservers) {
    auto parameter = ramp();
    Counter observer;
    parameter->attach(&observer);
    EXPECT_EQ(parameter->changeKeyFrame(10, 20.0), 10.0);
    EXPECT_EQ(parameter->setValueAtTime(30.0, 10), 20.0);
    const auto last = parameter->keyframeAtTime(10);
    EXPECT_EQ(parameter->changeKeyFrame(boost::const_pointer_cast<const KeyFrame<double>>(last), 40.0), 30.0);
    parameter->moveKeyFrame(10, 20);
    EXPECT_EQ(last->endTime(), RationalTime(20));
    parameter->moveKeyframes(-5, [](RationalTime t) { return t > 0; });
    EXPECT_EQ(*parameter->keyframeTimes(), (Times{0, 15}));
    EXPECT_EQ(parameter->removeKeyFrame(15), last);
    EXPECT_EQ(parameter->setDefaultValue(5.0), 0.0);
    EXPECT_EQ(parameter->numKeyFrames(), 1u);
    EXPECT_EQ(observer.count, 7);
    parameter->detach(&observer);
}

TEST_F(ParameterTest, KeyFrameQueries) {
    auto parameter = ramp();
    parameter->addKeyFrame(20, 0.0, 0);
    EXPECT_EQ(parameter->nextKeyFrameTime(10), RationalTime(20));
    EXPECT_EQ(parameter->nextKeyFrameTime(20), RationalTime(20));
    EXPECT_EQ(parameter->previousKeyFrameTime(10), RationalTime(0));
    EXPECT_EQ(parameter->previousKeyFrameTime(0), RationalTime(0));
    EXPECT_EQ(parameter->keyframeRange(), Range<RationalTime>(0, 20));
    EXPECT_TRUE(parameter->hasKeyFrameInRange(Range<RationalTime>(5, 5)));
    EXPECT_FALSE(parameter->hasKeyFrameInRange(Range<RationalTime>(11, 8)));
    EXPECT_TRUE(parameter->valuesDifferAtTimes(5, 6));
    EXPECT_FALSE(parameter->valuesDifferAtTimes(5, 15));
    EXPECT_EQ(parameter->interpolaterForKeyFrame(parameter->keyframeAtTime(10))->name(), "linr");
}

TEST_F(ParameterTest, CopyPortionCutsTheCurveAtTheRangeEdges) {
    auto parameter = ramp();
    const auto portion = parameter->copyPortion(Range<RationalTime>(2, 4));
    EXPECT_EQ(*portion->keyframeTimes(), (Times{0, 4}));
    EXPECT_EQ(portion->valueAtTime(0), 2.0);
    EXPECT_EQ(portion->valueAtTime(2), 4.0);
    EXPECT_EQ(portion->valueAtTime(4), 6.0);
    EXPECT_EQ(parameter->numKeyFrames(), 2u);
    EXPECT_EQ(parameter->copyPortion(Range<RationalTime>(-5, 20))->valueAtTime(10), 5.0);
    const auto constant = ParameterImpl<double>::create(project, "c", 3.0);
    EXPECT_EQ(constant->copyPortion(Range<RationalTime>(7, 1))->numKeyFrames(), 1u);
    // An empty range copies the value there alone.
    const auto empty = parameter->copyPortion(Range<RationalTime>(4, 0));
    EXPECT_EQ(*empty->keyframeTimes(), Times{0});
    EXPECT_EQ(empty->valueAtTime(0), 4.0);
    // A shared clone takes this parameter's bounds and hints, none included.
    const auto clone = ramp();
    clone->setValueBounds(0.0, 1.0, 0.5);
    parameter->setupSharedClone(clone);
    EXPECT_FALSE(clone->hasValueBounds());
    parameter->setValueBounds(-1.0, 1.0, 0.0);
    parameter->setupSharedClone(clone);
    EXPECT_TRUE(clone->hasValueBounds());
}

TEST_F(ParameterTest, KindsStepInterpolateAndDiffer) {
    EXPECT_EQ(ParameterImpl<float>::create(project, "f", 1.0f)->parameterTypeString(), "?");
    auto step = LeftParameter<double>::create(project, "step", 0.0);
    step->addKeyFrame(10, 10.0, 0);
    step->keyframeAtTime(10)->setInterpolater(LinearInterpolater<double>::getInstance());
    EXPECT_EQ(step->valueAtTime(9), 0.0);
    auto eased =
        InterpolatingParam<double>::create(project, "eased", 0.0, EaseInInterpolater<double>::getInstance());
    eased->addKeyFrame(10, 10.0, 0);
    EXPECT_DOUBLE_EQ(eased->valueAtTime(5), 2.5);
    eased->setParameterInterpolater(LinearInterpolater<double>::getInstance());
    EXPECT_DOUBLE_EQ(eased->valueAtTime(5), 5.0);
    auto source = ramp();
    auto diff = DiffParameter<double>::create(project, "diff", source);
    EXPECT_EQ(diff->valueAtTime(5), 5.0);
    diff->addKeyFrame(5, 0.0, 0);
    EXPECT_EQ(diff->editTimes(), Times{5});
    source->changeKeyFrame(10, 20.0); // the diff follows its source
    EXPECT_EQ(diff->valueAtTime(10), 20.0);
    EXPECT_EQ(diff->valueAtTime(5), 0.0);
    EXPECT_TRUE(diff->removeKeyFrame(0));
    EXPECT_EQ(diff->deletions(), std::set<RationalTime>{0});
    EXPECT_EQ(source->numKeyFrames(), 2u);
    diff->setIgnoreSource(true);
    EXPECT_EQ(diff->numKeyFrames(), 1u);
}

// No curve ever holds a lead-in reaching back before the previous keyframe.
TEST_F(ParameterTest, MovesAndDifferencesKeepEveryLeadInWithinItsSegment) {
    auto parameter = ramp();
    parameter->addKeyFrame(20, 5.0, 8); // its transition starts at 12
    const auto before = parameter->clone();
    Counter observer;
    parameter->attach(&observer);
    const auto atTen = [](RationalTime t) { return t == 10; };
    EXPECT_THROW(parameter->moveKeyframes(5, atTen), KeyFrameException);
    EXPECT_TRUE(*parameter == *before);
    EXPECT_EQ(parameter->keyframeAtTime(10)->endTime(), RationalTime(10));
    EXPECT_EQ(observer.count, 0);
    parameter->moveKeyframes(2, atTen);
    EXPECT_EQ(observer.count, 1);
    parameter->detach(&observer);
    // A source keyframe arriving inside an edit's lead-in cuts that lead-in to start at it: the values stay,
    // and the curve may stand as it is.
    auto source = ramp();
    auto diff = DiffParameter<double>::create(project, "diff", source);
    diff->addKeyFrame(20, 0.0, 8);
    const double halfway = diff->valueAtTime(16);
    source->addKeyFrame(15, 10.0, 0);
    EXPECT_EQ(diff->keyframeAtTime(20)->duration(), RationalTime(5));
    EXPECT_EQ(diff->valueAtTime(16), 8.0); // the transition now runs from 15
    EXPECT_NE(diff->valueAtTime(16), halfway);
    EXPECT_NO_THROW(diff->changeKeyFrameLeadInLength(20, 5));
}

// Equal parameters hold the same keyframes through and through.
TEST_F(ParameterTest, EqualityComparesWholeKeyFrames) {
    auto a = ramp(), b = ramp();
    EXPECT_TRUE(*a == *b);
    b->keyframeAtTime(10)->addMetaData("note", "x");
    EXPECT_FALSE(*a == *b);
    b = ramp();
    b->changeKeyFrameLeadInLength(10, 2);
    EXPECT_FALSE(*a == *b);
    b = ramp();
    b->keyframeAtTime(10)->setInterpolater(LinearInterpolater<double>::getInstance());
    EXPECT_TRUE(*a == *b); // the same curve: linear is what the keyframe followed
    b->keyframeAtTime(10)->setInterpolater(EaseInInterpolater<double>::getInstance());
    EXPECT_FALSE(*a == *b);
    b = ramp();
    b->addKeyFrame(20, 10.0, 0); // one more keyframe, where a's curve holds the same value
    EXPECT_FALSE(*a == *b);
    // Bezier paths compare their control points and temporal curve.
    const auto curve = [&](const Point3d& cp2, const char* temporal) {
        auto parameter = ParameterImpl<Point3d>::create(project, "p", Point3d(0, 0, 0));
        parameter->addKeyFrame(10, Point3d(10, 0, 0), 0);
        parameter->keyframeAtTime(10)->setInterpolater(
            boost::make_shared<BezierInterpolater>(Point3d(1, 2, 3), cp2, temporal));
        return parameter;
    };
    const auto bezier = curve(Point3d(4, 5, 6), "linr");
    EXPECT_TRUE(*bezier == *curve(Point3d(4, 5, 6), "linr"));
    EXPECT_FALSE(*bezier == *curve(Point3d(4, 5, 7), "linr"));
    EXPECT_FALSE(*bezier == *curve(Point3d(4, 5, 6), "esIn"));
}

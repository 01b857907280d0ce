#include <VelaMediaLib/time/parameters/AnimationParam.h>
#include <VelaMediaLib/time/parameters/DiffParameter.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/parameters/LeftParameter.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

using namespace VelaMediaLib;

namespace {

struct TicksPerUnit : TimeScalable {
    SafeRational scale;
    explicit TicksPerUnit(SafeRational s) : scale(s) {}
    SafeRational timeScale() const override { return scale; }
};

struct Counter : Observer {
    int count = 0;
    void update(Observable*) override { ++count; }
};

class ParameterTest : public ::testing::Test {
protected:
    // 0 at time 0 and 10 at time 10, linear.
    boost::shared_ptr<ParameterImpl<double>> ramp() {
        auto parameter = ParameterImpl<double>::create(project, "opacity", 0.0);
        parameter->addKeyFrame(RationalTime(10), 10.0, RationalTime(0));
        return parameter;
    }
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
};

} // namespace

TEST_F(ParameterTest, ValueAtTimeFollowsItsSteps) {
    ParameterImpl<double> empty(project, "empty");
    try {
        empty.valueAtTime(RationalTime(3));
        FAIL();
    } catch (const KeyFrameException& e) {
        EXPECT_EQ(e.time(), RationalTime(0));
        EXPECT_EQ(e.identifier(), "empty");
    }
    auto constant = ParameterImpl<double>::create(project, "constant", 7.0);
    EXPECT_EQ(constant->valueAtTime(RationalTime(-100)), 7.0);

    auto parameter = ramp();
    EXPECT_EQ(parameter->valueAtTime(RationalTime(5)), 5.0);
    EXPECT_EQ(parameter->valueAtTime(RationalTime(-1)), 0.0);
    EXPECT_EQ(parameter->valueAtTime(RationalTime(11)), 10.0);
    EXPECT_EQ(parameter->valueAtTime(RationalTime(10)), 10.0);
    EXPECT_DOUBLE_EQ(parameter->valueAtTime(RationalTime(19, 2)), 9.5);

    // With two ticks per unit, 9.6 lies less than one tick before 10 and snaps to it.
    parameter->setTimeScalable(boost::make_shared<TicksPerUnit>(2));
    EXPECT_EQ(parameter->valueAtTime(RationalTime(48, 5)), 10.0);
    EXPECT_DOUBLE_EQ(parameter->valueAtTime(RationalTime(19, 2)), 9.5); // exactly one tick before
}

TEST_F(ParameterTest, TheEndKeyFramesInterpolaterAndLeadInShapeTheSegment) {
    auto parameter = ramp();
    parameter->keyframeAtTime(RationalTime(10))->setInterpolater(EaseInInterpolater<double>::getInstance());
    EXPECT_DOUBLE_EQ(parameter->valueAtTime(RationalTime(5)), 2.5);
    EXPECT_EQ(parameter->changeKeyFrameLeadInLength(RationalTime(10), RationalTime(4)), RationalTime(0));
    EXPECT_EQ(parameter->valueAtTime(RationalTime(5)), 0.0);        // holds until 6
    EXPECT_DOUBLE_EQ(parameter->valueAtTime(RationalTime(8)), 2.5); // eased half-way through the lead-in
    EXPECT_EQ(parameter->keyframeAtTime(RationalTime(10))->time(), RationalTime(6));
}

TEST_F(ParameterTest, RefusedEditsLeaveTheParameterAsItWas) {
    auto parameter = ramp();
    const auto before = parameter->clone();
    Counter observer;
    parameter->attach(&observer);

    try {
        parameter->addKeyFrame(RationalTime(12), 1.0, RationalTime(5)); // would start before 10
        FAIL();
    } catch (const KeyFrameException& e) {
        EXPECT_EQ(e.time(), RationalTime(12));
        EXPECT_EQ(e.identifier(), "opacity");
    }
    EXPECT_THROW(parameter->addKeyFrame(RationalTime(5), 1.0, RationalTime(-1)), KeyFrameException);
    try {
        parameter->setValueAtTime(3.0, RationalTime(4));
        FAIL();
    } catch (const VelaMediaLibException& e) {
        EXPECT_STREQ(e.what(), "error");
    }
    EXPECT_THROW(parameter->changeKeyFrame(RationalTime(4), 3.0), KeyFrameException);
    EXPECT_THROW(parameter->moveKeyFrame(RationalTime(0), RationalTime(10)), KeyFrameException);
    EXPECT_THROW(
        parameter->moveKeyframes(RationalTime(10), [](RationalTime t) { return t == RationalTime(0); }),
        KeyFrameException);
    EXPECT_THROW(parameter->changeKeyFrameLeadInLength(RationalTime(10), RationalTime(11)),
                 KeyFrameException);
    EXPECT_FALSE(ParameterImpl<double>::create(project, "one", 1.0)->removeKeyFrame(RationalTime(0)));

    EXPECT_TRUE(*parameter == *before);
    EXPECT_EQ(observer.count, 0);
    parameter->detach(&observer);
}

TEST_F(ParameterTest, EditsReturnWhatWasThereAndTellObservers) {
    auto parameter = ramp();
    Counter observer;
    parameter->attach(&observer);
    EXPECT_EQ(parameter->changeKeyFrame(RationalTime(10), 20.0), 10.0);
    EXPECT_EQ(parameter->setValueAtTime(30.0, RationalTime(10)), 20.0);
    const auto last = parameter->keyframeAtTime(RationalTime(10));
    EXPECT_EQ(parameter->changeKeyFrame(boost::const_pointer_cast<const KeyFrame<double>>(last), 40.0), 30.0);
    parameter->moveKeyFrame(RationalTime(10), RationalTime(20));
    EXPECT_EQ(last->endTime(), RationalTime(20));
    parameter->moveKeyframes(RationalTime(-5), [](RationalTime t) { return t > RationalTime(0); });
    EXPECT_EQ(*parameter->keyframeTimes(), (std::vector<RationalTime>{RationalTime(0), RationalTime(15)}));
    EXPECT_EQ(parameter->removeKeyFrame(RationalTime(15)), last);
    EXPECT_EQ(parameter->setDefaultValue(5.0), 0.0);
    EXPECT_EQ(parameter->numKeyFrames(), 1u);
    EXPECT_EQ(observer.count, 7);
    parameter->detach(&observer);
}

TEST_F(ParameterTest, KeyFrameQueries) {
    auto parameter = ramp();
    parameter->addKeyFrame(RationalTime(20), 0.0, RationalTime(0));
    EXPECT_EQ(parameter->nextKeyFrameTime(RationalTime(10)), RationalTime(20));
    EXPECT_EQ(parameter->nextKeyFrameTime(RationalTime(20)), RationalTime(20));
    EXPECT_EQ(parameter->previousKeyFrameTime(RationalTime(10)), RationalTime(0));
    EXPECT_EQ(parameter->previousKeyFrameTime(RationalTime(0)), RationalTime(0));
    EXPECT_EQ(parameter->keyframeRange(), Range<RationalTime>(RationalTime(0), RationalTime(20)));
    EXPECT_TRUE(parameter->hasKeyFrameInRange(Range<RationalTime>(RationalTime(5), RationalTime(5))));
    EXPECT_FALSE(parameter->hasKeyFrameInRange(Range<RationalTime>(RationalTime(11), RationalTime(8))));
    EXPECT_TRUE(parameter->valuesDifferAtTimes(RationalTime(5), RationalTime(6)));
    EXPECT_FALSE(parameter->valuesDifferAtTimes(RationalTime(5), RationalTime(15)));
    EXPECT_EQ(parameter->interpolaterForKeyFrame(parameter->keyframeAtTime(RationalTime(10)))->name(),
              "linr");
}

TEST_F(ParameterTest, CopyPortionCutsTheCurveAtTheRangeEdges) {
    auto parameter = ramp();
    const auto portion = parameter->copyPortion(Range<RationalTime>(RationalTime(2), RationalTime(4)));
    EXPECT_EQ(*portion->keyframeTimes(), (std::vector<RationalTime>{RationalTime(0), RationalTime(4)}));
    EXPECT_EQ(portion->valueAtTime(RationalTime(0)), 2.0);
    EXPECT_EQ(portion->valueAtTime(RationalTime(2)), 4.0);
    EXPECT_EQ(portion->valueAtTime(RationalTime(4)), 6.0);
    EXPECT_EQ(parameter->numKeyFrames(), 2u);
    const auto whole = parameter->copyPortion(Range<RationalTime>(RationalTime(-5), RationalTime(20)));
    EXPECT_EQ(whole->valueAtTime(RationalTime(10)), 5.0);
    EXPECT_EQ(ParameterImpl<double>::create(project, "c", 3.0)
                  ->copyPortion(Range<RationalTime>(RationalTime(7), RationalTime(1)))
                  ->numKeyFrames(),
              1u);
    // An empty range copies the value there alone.
    const auto empty = parameter->copyPortion(Range<RationalTime>(RationalTime(4), RationalTime(0)));
    EXPECT_EQ(*empty->keyframeTimes(), std::vector<RationalTime>{RationalTime(0)});
    EXPECT_EQ(empty->valueAtTime(RationalTime(0)), 4.0);
}

// A shared clone takes this parameter's bounds and hints, none included.
TEST_F(ParameterTest, ASharedCloneTakesTheBoundsItsSourceHas) {
    const auto source = ramp(), clone = ramp();
    clone->setValueBounds(0.0, 1.0, 0.5);
    source->setupSharedClone(clone);
    EXPECT_FALSE(clone->hasValueBounds());
    source->setValueBounds(-1.0, 1.0, 0.0);
    source->setupSharedClone(clone);
    EXPECT_TRUE(clone->hasValueBounds());
}

TEST_F(ParameterTest, KindsStepInterpolateAndDiffer) {
    EXPECT_EQ(ParameterImpl<float>::create(project, "f", 1.0f)->parameterTypeString(), "?");

    auto step = LeftParameter<double>::create(project, "step", 0.0);
    step->addKeyFrame(RationalTime(10), 10.0, RationalTime(0));
    step->keyframeAtTime(RationalTime(10))->setInterpolater(LinearInterpolater<double>::getInstance());
    EXPECT_EQ(step->valueAtTime(RationalTime(9)), 0.0);

    auto eased =
        InterpolatingParam<double>::create(project, "eased", 0.0, EaseInInterpolater<double>::getInstance());
    eased->addKeyFrame(RationalTime(10), 10.0, RationalTime(0));
    EXPECT_DOUBLE_EQ(eased->valueAtTime(RationalTime(5)), 2.5);
    eased->setParameterInterpolater(LinearInterpolater<double>::getInstance());
    EXPECT_DOUBLE_EQ(eased->valueAtTime(RationalTime(5)), 5.0);

    auto source = ramp();
    auto diff = DiffParameter<double>::create(project, "diff", source);
    EXPECT_EQ(diff->valueAtTime(RationalTime(5)), 5.0);
    diff->addKeyFrame(RationalTime(5), 0.0, RationalTime(0));
    EXPECT_EQ(diff->editTimes(), std::vector<RationalTime>{RationalTime(5)});
    source->changeKeyFrame(RationalTime(10), 20.0); // the diff follows its source
    EXPECT_EQ(diff->valueAtTime(RationalTime(10)), 20.0);
    EXPECT_EQ(diff->valueAtTime(RationalTime(5)), 0.0);
    EXPECT_TRUE(diff->removeKeyFrame(RationalTime(0)));
    EXPECT_EQ(diff->deletions(), std::set<RationalTime>{RationalTime(0)});
    EXPECT_EQ(source->numKeyFrames(), 2u);
    diff->setIgnoreSource(true);
    EXPECT_EQ(diff->numKeyFrames(), 1u);
}

// No curve ever holds a lead-in reaching back before the previous keyframe.
TEST_F(ParameterTest, MovesAndDifferencesKeepEveryLeadInWithinItsSegment) {
    auto parameter = ramp();
    parameter->addKeyFrame(RationalTime(20), 5.0, RationalTime(8)); // its transition starts at 12
    const auto before = parameter->clone();
    Counter observer;
    parameter->attach(&observer);
    EXPECT_THROW(
        parameter->moveKeyframes(RationalTime(5), [](RationalTime t) { return t == RationalTime(10); }),
        KeyFrameException);
    EXPECT_TRUE(*parameter == *before);
    EXPECT_EQ(parameter->keyframeAtTime(RationalTime(10))->endTime(), RationalTime(10));
    EXPECT_EQ(observer.count, 0);
    parameter->moveKeyframes(RationalTime(2), [](RationalTime t) { return t == RationalTime(10); });
    EXPECT_EQ(observer.count, 1);
    parameter->detach(&observer);

    // A source keyframe arriving inside an edit's lead-in cuts that lead-in
    // to start at it: the values stay, and the curve may stand as it is.
    auto source = ramp();
    auto diff = DiffParameter<double>::create(project, "diff", source);
    diff->addKeyFrame(RationalTime(20), 0.0, RationalTime(8));
    const double halfway = diff->valueAtTime(RationalTime(16));
    source->addKeyFrame(RationalTime(15), 10.0, RationalTime(0));
    EXPECT_EQ(diff->keyframeAtTime(RationalTime(20))->duration(), RationalTime(5));
    EXPECT_EQ(diff->valueAtTime(RationalTime(16)), 8.0); // the transition now runs from 15
    EXPECT_NE(diff->valueAtTime(RationalTime(16)), halfway);
    EXPECT_NO_THROW(diff->changeKeyFrameLeadInLength(RationalTime(20), RationalTime(5)));
}

// Equal parameters hold the same keyframes through and through.
TEST_F(ParameterTest, EqualityComparesWholeKeyFrames) {
    auto a = ramp(), b = ramp();
    EXPECT_TRUE(*a == *b);
    b->keyframeAtTime(RationalTime(10))->addMetaData("note", "x");
    EXPECT_FALSE(*a == *b);
    b = ramp();
    b->changeKeyFrameLeadInLength(RationalTime(10), RationalTime(2));
    EXPECT_FALSE(*a == *b);
    b = ramp();
    b->keyframeAtTime(RationalTime(10))->setInterpolater(LinearInterpolater<double>::getInstance());
    EXPECT_TRUE(*a == *b); // the same curve: linear is what the keyframe followed
    b->keyframeAtTime(RationalTime(10))->setInterpolater(EaseInInterpolater<double>::getInstance());
    EXPECT_FALSE(*a == *b);

    typedef boost::shared_ptr<Interpolater<Point3d>> PointInterpolater;
    auto curve = [&](const PointInterpolater& interpolater) {
        auto parameter = ParameterImpl<Point3d>::create(project, "p", Point3d(0, 0, 0));
        parameter->addKeyFrame(RationalTime(10), Point3d(10, 0, 0), RationalTime(0));
        parameter->keyframeAtTime(RationalTime(10))->setInterpolater(interpolater);
        return parameter;
    };
    const PointInterpolater bezier(new BezierInterpolater(Point3d(1, 2, 3), Point3d(4, 5, 6), "linr"));
    EXPECT_TRUE(*curve(bezier) == *curve(PointInterpolater(
                                      new BezierInterpolater(Point3d(1, 2, 3), Point3d(4, 5, 6), "linr"))));
    EXPECT_FALSE(*curve(bezier) == *curve(PointInterpolater(
                                       new BezierInterpolater(Point3d(1, 2, 3), Point3d(4, 5, 7), "linr"))));
    EXPECT_FALSE(*curve(bezier) == *curve(PointInterpolater(
                                       new BezierInterpolater(Point3d(1, 2, 3), Point3d(4, 5, 6), "esIn"))));
}

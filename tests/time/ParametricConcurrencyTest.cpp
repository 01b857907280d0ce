#include "TimeTestSupport.h"

#include <VelaMediaLib/time/sync/NotifyDelay.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
#include <functional>
#include <gtest/gtest.h>
#include <memory>
#include <vector>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

struct AtomicCounter : Observer {
    std::atomic<int> count{0};
    void update(Observable*) override { ++count; }
};

// A reader holds the read lock while a writer waits for the write lock. What the reader first uses inside its
// snapshot (and is made on demand) must not let the writer in: the writer's change stays unseen until the
// reader lets go.
class ReaderSnapshotConcurrency : public ::testing::Test {
protected:
    void expectSnapshotHoldsAcross(const std::function<void()>& firstUse) {
        Deadline deadline;
        const auto witness = ParameterImpl<double>::create(project, "witness", 0.0);
        std::thread writer;
        {
            ScopedReadLock snapshot(project);
            writer = std::thread([&] { witness->setDefaultValue(1.0); });
            while (!project->mutex().hasWriter()) std::this_thread::yield();
            firstUse();
            EXPECT_EQ(witness->valueAtTime(RationalTime(0)), 0.0);
        }
        writer.join();
        EXPECT_EQ(witness->valueAtTime(RationalTime(0)), 1.0);
    }
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    Knob knob{project};
};

} // namespace

// Readers evaluate a curve while one thread edits its keyframes (some rounds under a notify delay) and
// another attaches and detaches observers. Every value a reader sees lies between the curve's bounds; parts
// of other objects it first touches inside a snapshot leave its answers there agreeing; and the observer
// attached throughout hears of every round, held back or not.
TEST(ParametricConcurrency, ReadersSeeWholeCurvesAndSnapshotsWhileEditsRunAndObserversComeAndGo) {
    Deadline deadline;
    const auto project = boost::make_shared<ThreadSafe>();
    auto parameter = InterpolatingParam<double>::create(project, "x", 0.0);
    parameter->addKeyFrame(100, 100.0, 0);
    std::vector<std::unique_ptr<Knob>> knobs;
    for (int i = 0; i < 2000; ++i) knobs.emplace_back(new Knob(project));
    AtomicCounter steady;
    std::vector<AtomicCounter> coming(8);
    parameter->attach(&steady);
    std::atomic<bool> done{false};
    std::atomic<int> outside{0}, reads{0}, disagreements{0};
    auto reader = [&](int seed) {
        for (long long t = 0; !done.load(); t = (t + 7) % 120) {
            const double value = parameter->valueAtTime(t);
            if (value < 0.0 || value > 100.0) ++outside;
            parameter->keyframeTimes();
            Knob& knob = *knobs[(reads++ * 7 + seed) % knobs.size()];
            ScopedReadLock snapshot(project);
            const auto level = knob.typedParameter<double>("level");
            const double before = level->valueAtTime(5);
            knob.parameter("pan")->identAttribute();
            knob.parameter("pan")->metaDataPtr();
            knob.attributeOrAdd<bool>("solo", false);
            if (level->valueAtTime(5) != before || knob.typedParameter<double>("level") != level)
                ++disagreements;
        }
    };
    std::thread first(reader, 0), second(reader, 1), churn([&] {
        for (size_t i = 0; !done.load(); ++i) {
            const auto level = knobs[i % knobs.size()]->parameter("level");
            AtomicCounter& each = coming[i % coming.size()];
            i % 2 ? level->attach(&each) : level->attachWithoutNotifyDelay(&each);
            level->detach(&coming[(i + 3) % coming.size()]);
            knobs[i % knobs.size()]->attributeOrAdd<bool>("solo", false)->attach(&each);
        }
    });
    int rounds = 0;
    for (; rounds < 300 || reads.load() < 8000; ++rounds) {
        std::unique_ptr<NotifyDelay> delay(rounds % 4 == 0 ? new NotifyDelay(project) : nullptr);
        const RationalTime time(10 + rounds % 80);
        parameter->addKeyFrame(time, double(rounds % 100), 0);
        parameter->changeKeyFrame(time, 50.0);
        parameter->moveKeyFrame(time, time + RationalTime(1, 2));
        parameter->removeKeyFrame(time + RationalTime(1, 2));
        const auto level = knobs[rounds % knobs.size()]->typedParameter<double>("level");
        level->setDefaultValue(double(rounds % 10));
        level->addKeyFrame(10, double(rounds), 2);
    }
    done = true;
    for (std::thread* thread : {&first, &second, &churn}) thread->join();
    EXPECT_EQ(outside.load(), 0);
    EXPECT_EQ(disagreements.load(), 0);
    EXPECT_EQ(parameter->numKeyFrames(), 2u);
    EXPECT_GE(steady.count.load(), rounds);
    for (const auto& knob : knobs)
        for (AtomicCounter& each : coming) knob->parameter("level")->detach(&each);
    parameter->detach(&steady);
}

TEST_F(ReaderSnapshotConcurrency, PartsMadeOnFirstUseLetNoWriterIn) {
    const auto parameter = ParameterImpl<double>::create(project, "gain", 2.0);
    const std::pair<const char*, std::function<void()>> firstUses[] = {
        {"a declared parameter",
         [&] { EXPECT_EQ(knob.typedParameter<double>("level")->valueAtTime(0), 1.0); }},
        {"a parameter's identifier attribute",
         [&] { EXPECT_EQ(parameter->identAttribute()->value(), "gain"); }},
        {"a parameter's metadata", [&] { EXPECT_TRUE(parameter->metaDataPtr()->metaDataKeys().empty()); }},
        {"an attribute made with its initial value",
         [&] { EXPECT_FALSE(knob.attributeOrAdd<bool>("solo", false)->value()); }}};
    for (const auto& firstUse : firstUses) {
        SCOPED_TRACE(firstUse.first);
        expectSnapshotHoldsAcross(firstUse.second);
    }
    EXPECT_TRUE(knob.hasMadeParameter("level"));
    EXPECT_EQ(parameter->identAttribute(), parameter->identAttribute()); // made once
    EXPECT_EQ(parameter->metaDataPtr(), parameter->metaDataPtr());
}

TEST_F(ReaderSnapshotConcurrency, AttributesKeepOneTypePerName) {
    knob.addAttribute<int>("width", 640);
    EXPECT_EQ(knob.attributeOrAdd<int>("width", 1)->value(), 640);
    EXPECT_THROW(knob.attributeOrAdd<bool>("width", false), TypeException);
    EXPECT_THROW(knob.addAttribute<bool>("width", false), TypeException);
    EXPECT_EQ(knob.attributeNames(), std::vector<std::string>{"width"});
}

#include "TimeTestSupport.h"

#include <VelaMediaLib/time/sync/NotifyDelay.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
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

} // namespace

// Readers evaluate while one writer moves, changes, adds and removes keyframes. Every value a reader sees
// lies between the curve's bounds.
TEST(ParameterConcurrency, ReadersSeeWholeCurvesWhileAWriterEdits) {
    Deadline deadline;
    auto parameter = InterpolatingParam<double>::create(boost::make_shared<ThreadSafe>(), "x", 0.0);
    parameter->addKeyFrame(100, 100.0, 0);
    std::atomic<bool> done{false};
    std::atomic<int> outside{0}, reads{0};
    auto reader = [&] {
        for (long long t = 0; !done.load() || reads.load() < 2000; t = (t + 7) % 120) {
            const double value = parameter->valueAtTime(t);
            if (value < 0.0 || value > 100.0) ++outside;
            parameter->keyframeTimes();
            ++reads;
        }
    };
    std::thread first(reader), second(reader);
    for (int i = 0; i < 300; ++i) {
        const RationalTime time(10 + i % 80);
        parameter->addKeyFrame(time, double(i % 100), 0);
        parameter->changeKeyFrame(time, 50.0);
        parameter->moveKeyFrame(time, time + RationalTime(1, 2));
        parameter->removeKeyFrame(time + RationalTime(1, 2));
    }
    done = true;
    first.join();
    second.join();
    EXPECT_EQ(outside.load(), 0);
    EXPECT_EQ(parameter->numKeyFrames(), 2u);
}

// Readers take snapshots of objects whose parameters, identifier attributes, metadata and attributes they
// touch first inside the snapshot, while one thread attaches and detaches observers on those parameters and
// another edits them (some edits under a notify delay). Within a snapshot a reader's answers agree, and the
// observer attached throughout hears of every round.
TEST(ParametricConcurrency, ReadersFirstTouchPartsWhileObserversComeAndGoAndEditsRun) {
    Deadline deadline;
    const auto project = boost::make_shared<ThreadSafe>();
    const int knobCount = 2000;
    std::vector<std::unique_ptr<Knob>> knobs;
    for (int i = 0; i < knobCount; ++i) knobs.emplace_back(new Knob(project));
    AtomicCounter steady;
    std::vector<AtomicCounter> coming(8);
    std::atomic<int> readersDone{0}, disagreements{0};
    std::atomic<bool> editsDone{false};
    auto reader = [&](int seed) {
        for (int i = 0; i < 2 * knobCount; ++i) {
            Knob& knob = *knobs[(i * 7 + seed) % knobCount];
            ScopedReadLock snapshot(project);
            const auto level = knob.typedParameter<double>("level");
            const double before = level->valueAtTime(5);
            knob.parameter("pan")->identAttribute();
            knob.parameter("pan")->metaDataPtr();
            knob.attributeOrAdd<bool>("solo", false);
            if (level->valueAtTime(5) != before || knob.typedParameter<double>("level") != level)
                ++disagreements;
        }
        ++readersDone;
    };
    auto churn = [&] {
        for (size_t i = 0; readersDone.load() < 2 || !editsDone.load(); ++i) {
            const auto level = knobs[i % knobCount]->parameter("level");
            AtomicCounter& each = coming[i % coming.size()];
            i % 2 ? level->attach(&each) : level->attachWithoutNotifyDelay(&each);
            level->detach(&coming[(i + 3) % coming.size()]);
            knobs[i % knobCount]->attributeOrAdd<bool>("solo", false)->attach(&each);
        }
    };
    std::thread first(reader, 0), second(reader, 1), observers(churn);
    const auto watched = knobs[0]->typedParameter<double>("level");
    watched->attach(&steady);
    int edits = 0;
    for (int i = 0; readersDone.load() < 2 || edits < 300; ++i, ++edits) {
        std::unique_ptr<NotifyDelay> delay(i % 4 == 0 ? new NotifyDelay(project) : nullptr);
        for (int k = 0; k < 3; ++k) {
            const auto level = knobs[(i * 3 + k) % knobCount]->typedParameter<double>("level");
            level->setDefaultValue(double(i % 10));
            level->addKeyFrame(10, double(k), 2);
        }
        watched->changeKeyFrame(RationalTime(0), double(i));
    }
    editsDone = true;
    first.join();
    second.join();
    observers.join();
    EXPECT_EQ(disagreements.load(), 0);
    EXPECT_GE(steady.count.load(), edits); // each round changes it, held back or not
    for (const auto& knob : knobs) {
        EXPECT_TRUE(knob->hasMadeParameter("pan"));
        for (AtomicCounter& each : coming) knob->parameter("level")->detach(&each);
    }
}

#include "TimeTestSupport.h"

#include <VelaMediaLib/time/sync/NotifyDelay.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <atomic>
#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <memory>
#include <thread>
#include <vector>

using namespace VelaMediaLib;
using VelaMediaLib::testing::Deadline;
using VelaMediaLib::testing::Knob;

namespace {

struct AtomicCounter : Observer {
    std::atomic<int> count{0};
    void update(Observable*) override { ++count; }
};

} // namespace

// Readers take snapshots of objects whose parameters, identifier attributes, metadata and attributes they
// touch first inside the snapshot, while one thread attaches and detaches observers on those parameters and
// another edits them (some edits under a notify delay). Within a snapshot a reader's answers agree, and the
// observer attached throughout hears of every round.
TEST(ParametricConcurrency, ReadersFirstTouchPartsWhileObserversComeAndGoAndEditsRun) {
    Deadline deadline(std::chrono::seconds(60));
    const auto project = boost::make_shared<ThreadSafe>();
    const int knobCount = 2000;
    std::vector<std::unique_ptr<Knob>> knobs;
    for (int i = 0; i < knobCount; ++i) knobs.emplace_back(new Knob(project));
    AtomicCounter steady;
    std::vector<AtomicCounter> coming(8);
    std::atomic<int> readersDone{0}, disagreements{0};
    std::atomic<bool> editsDone{false};

    auto reader = [&](int seed) {
        for (int pass = 0; pass < 2; ++pass)
            for (int i = 0; i < knobCount; ++i) {
                Knob& knob = *knobs[(i * 7 + seed) % knobCount];
                ScopedReadLock snapshot(project);
                const auto level = knob.typedParameter<double>("level");
                const double before = level->valueAtTime(RationalTime(5));
                const auto pan = knob.parameter("pan");
                pan->identAttribute();
                pan->metaDataPtr();
                knob.attributeOrAdd<bool>("solo", false);
                if (level->valueAtTime(RationalTime(5)) != before ||
                    knob.typedParameter<double>("level") != level)
                    ++disagreements;
            }
        ++readersDone;
    };
    auto churn = [&] {
        for (size_t i = 0; readersDone.load() < 2 || !editsDone.load(); ++i) {
            const auto level = knobs[i % knobCount]->parameter("level");
            AtomicCounter& each = coming[i % coming.size()];
            if (i % 2)
                level->attach(&each);
            else
                level->attachWithoutNotifyDelay(&each);
            level->detach(&coming[(i + 3) % coming.size()]);
            knobs[i % knobCount]->attributeOrAdd<bool>("solo", false)->attach(&each);
        }
    };
    auto editor = [&] {
        const auto watched = knobs[0]->typedParameter<double>("level");
        watched->attach(&steady);
        int edits = 0;
        for (int i = 0; readersDone.load() < 2 || edits < 300; ++i) {
            std::unique_ptr<NotifyDelay> delay(i % 4 == 0 ? new NotifyDelay(project) : nullptr);
            for (int k = 0; k < 3; ++k) {
                const auto level = knobs[(i * 3 + k) % knobCount]->typedParameter<double>("level");
                level->setDefaultValue(double(i % 10));
                level->addKeyFrame(RationalTime(10), double(k), RationalTime(2));
            }
            watched->changeKeyFrame(RationalTime(0), double(i));
            ++edits;
        }
        editsDone = true;
        return edits;
    };

    std::thread first(reader, 0), second(reader, 1), observers(churn);
    const int edits = editor();
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

#include "../ThreadTestSupport.h"

#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <atomic>
#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <thread>
#include <vector>

using namespace VelaMediaLib;

// Readers evaluate while one writer moves, changes, adds and removes keyframes. Every value a reader sees
// lies between the curve's bounds.
TEST(ParameterConcurrency, ReadersSeeWholeCurvesWhileAWriterEdits) {
    VelaMediaLib::testing::Deadline deadline;
    const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    auto parameter = InterpolatingParam<double>::create(project, "x", 0.0);
    parameter->addKeyFrame(RationalTime(100), 100.0, RationalTime(0));
    std::atomic<bool> done{false};
    std::atomic<int> outside{0}, reads{0};
    auto reader = [&] {
        for (long long t = 0; !done.load() || reads.load() < 2000; t = (t + 7) % 120) {
            const double value = parameter->valueAtTime(RationalTime(t));
            if (value < 0.0 || value > 100.0) ++outside;
            parameter->keyframeTimes();
            ++reads;
        }
    };
    std::vector<std::thread> readers;
    for (int i = 0; i < 2; ++i) readers.emplace_back(reader);
    for (int i = 0; i < 300; ++i) {
        const RationalTime time(10 + i % 80);
        parameter->addKeyFrame(time, double(i % 100), RationalTime(0));
        parameter->changeKeyFrame(time, 50.0);
        parameter->moveKeyFrame(time, time + RationalTime(1, 2));
        parameter->removeKeyFrame(time + RationalTime(1, 2));
    }
    done = true;
    for (std::thread& thread : readers) thread.join();
    EXPECT_EQ(outside.load(), 0);
    EXPECT_EQ(parameter->numKeyFrames(), 2u);
}

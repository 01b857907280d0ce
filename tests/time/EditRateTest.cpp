#include "TimeTestSupport.h"

#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>

#include <atomic>
#include <gtest/gtest.h>
#include <thread>
#include <tuple>

using namespace VelaMediaLib;
using VelaMediaLib::testing::Deadline;
using VelaMediaLib::testing::Rate;
using VelaMediaLib::testing::RateReader;

// Every entry point builds a rate alike: reduced, a zero numerator giving 0/1, a zero denominator refused by
// the rational itself. A zero rate is then a rate like any other: kept as 0/1 and told to observers, at
// construction and when set. The frame and sample answers stay fixed.
TEST(EditRate, RatesAreBuiltByOneRuleAndAZeroRateIsKeptAndTold) {
    EXPECT_EQ(SimpleProjectEditRate::rateOf(60, 2), Rate(30, 1));
    EXPECT_EQ(SimpleProjectEditRate::rateOf(30000, 1001), Rate(30000, 1001));
    EXPECT_EQ(SimpleProjectEditRate::rateOf(0, 7), Rate(0, 1));
    EXPECT_THROW(SimpleProjectEditRate::rateOf(30, 0), boost::bad_rational);
    EXPECT_THROW(SimpleProjectEditRate::rateOf(0, 0), boost::bad_rational);
    SimpleProjectEditRate rate(Rate(0));
    EXPECT_EQ(rate.editRate(), Rate(0, 1));
    EXPECT_EQ(std::make_tuple(rate.videoFrameRate(), rate.audioSampleRate(), rate.durationPerFrame()),
              std::make_tuple(30, 44100, 1));
    EXPECT_EQ(rate.editingUnit(), 1u);
    RateReader reader;
    reader.rate = &rate;
    rate.attachEditRateObserver(&reader);
    rate.setEditRate(Rate(25));
    rate.setEditRate(SimpleProjectEditRate::rateOf(0, 3));
    EXPECT_EQ(reader.seen, (std::vector<Rate>{Rate(25), Rate(0, 1)}));
    EXPECT_EQ(rate.editRate(), Rate(0, 1));
    rate.detachEditRateObserver(&reader);
}

// The numerator and the denominator change together: a reader on another thread sees one of the rates set,
// never the numerator of one with the denominator of the other.
TEST(EditRateConcurrency, ReadersNeverSeeHalfOfANewRate) {
    Deadline deadline;
    const Rate ntsc(30000, 1001), whole(30, 1);
    SimpleProjectEditRate rate(whole);
    std::atomic<bool> done{false};
    std::thread writer([&] {
        for (int i = 0; i < 20000; ++i) rate.setEditRate(i % 2 ? whole : ntsc);
        done = true;
    });
    int torn = 0;
    while (!done.load()) {
        const Rate seen = rate.editRate();
        if (seen != ntsc && seen != whole) ++torn;
    }
    writer.join();
    EXPECT_EQ(torn, 0);
}

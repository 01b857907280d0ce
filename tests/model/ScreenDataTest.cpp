// A screen recording's metadata: the cursor path between and beyond its
// samples, events in half-open ranges, order whatever the order of adding,
// and what a holder without data answers.
#include "MediaTestSupport.h"

#include <VelaMediaLib/model/media/ScreenDataProvider.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

using Span = Range<RationalTime>;

std::vector<RationalTime> timesOf(const std::vector<ScreenClick>& clicks) {
    std::vector<RationalTime> times;
    for (const ScreenClick& click : clicks) times.push_back(click.time);
    return times;
}

} // namespace

TEST(ScreenData, CursorMovesStraightBetweenSamplesAndStaysBeyondThem) {
    ScreenRecordingData data(Rect<int>(0, 0, 1920, 1080));
    data.addCursorSample(RationalTime(20), Point3d(10, 0, 0));
    data.addCursorSample(RationalTime(40), Point3d(10, 20, 0));
    data.addCursorSample(RationalTime(10), Point3d(0, 0, 0));
    EXPECT_TRUE(data.hasCursorData());
    EXPECT_EQ(data.cursorSamples().front().time, RationalTime(10));
    EXPECT_EQ(data.cursorPositionAtTime(RationalTime(15)), Point3d(5, 0, 0));
    EXPECT_EQ(data.cursorPositionAtTime(RationalTime(25, 2)), Point3d(2.5, 0, 0)); // between ticks
    EXPECT_EQ(data.cursorPositionAtTime(RationalTime(30)), Point3d(10, 10, 0));
    EXPECT_EQ(data.cursorPositionAtTime(RationalTime(20)), Point3d(10, 0, 0));
    EXPECT_EQ(data.cursorPositionAtTime(RationalTime(-5)), Point3d(0, 0, 0));
    EXPECT_EQ(data.cursorPositionAtTime(RationalTime(1000)), Point3d(10, 20, 0));
    data.addCursorSample(RationalTime(20), Point3d(20, 0, 0)); // replaces the sample there
    EXPECT_EQ(data.cursorSamples().size(), 3u);
    EXPECT_EQ(data.cursorPositionAtTime(RationalTime(15)), Point3d(10, 0, 0));
    EXPECT_EQ(data.recordingRect(), Rect<int>(0, 0, 1920, 1080));
}

// Copies compare equal; the rectangle and each kind of sample count.
TEST(ScreenData, EqualityTakesEveryPartIntoAccount) {
    ScreenRecordingData data(Rect<int>(0, 0, 1920, 1080));
    data.addCursorSample(RationalTime(20), Point3d(10, 0, 0));
    const ScreenRecordingData copy = data;
    EXPECT_TRUE(copy == data);
    EXPECT_FALSE(copy != data);
    ScreenRecordingData moved = data;
    moved.addCursorSample(RationalTime(30), Point3d(1, 0, 0));
    EXPECT_FALSE(moved == data);
    ScreenRecordingData other(Rect<int>(0, 0, 1280, 720));
    other.addCursorSample(RationalTime(20), Point3d(10, 0, 0));
    EXPECT_FALSE(other == data);
    EXPECT_TRUE(other != data);
}

TEST(ScreenData, RangesHoldTheirStartButNotTheirEnd) {
    ScreenRecordingData data;
    data.addClick(RationalTime(30), ScreenClick::Left);
    data.addClick(RationalTime(20), ScreenClick::Left);
    data.addClick(RationalTime(10), ScreenClick::Middle);
    data.addClick(RationalTime(20), ScreenClick::Right);
    EXPECT_EQ(data.clicksInRange(Span(10, 10)), std::vector<ScreenClick>({{10, ScreenClick::Middle}}));
    EXPECT_EQ(data.clicksInRange(Span(20, 11)),
              std::vector<ScreenClick>(
                  {{20, ScreenClick::Left}, {20, ScreenClick::Right}, {30, ScreenClick::Left}}));
    EXPECT_EQ(timesOf(data.clicksInRange(Span(-100, 1000))), std::vector<RationalTime>({10, 20, 20, 30}));
    EXPECT_TRUE(data.clicksInRange(Span(20, 0)).empty());
    EXPECT_TRUE(data.clicksInRange(Span(RationalTime(61, 2), 100)).empty());
    EXPECT_THROW(data.clicksInRange(Span(20, -1)), ValueException<const SafeRational>);

    data.addKeystroke(RationalTime(5), KeystrokeData("b"));
    data.addKeystroke(RationalTime(3, 2), KeystrokeData("a", KeystrokeData::Shift));
    EXPECT_EQ(data.keystrokesInRange(Span(RationalTime(3, 2), RationalTime(7, 2))),
              std::vector<ScreenKeystroke>({{RationalTime(3, 2), KeystrokeData("a", KeystrokeData::Shift)}}));
    EXPECT_EQ(data.keystrokesInRange(Span(2, 4)), std::vector<ScreenKeystroke>({{5, KeystrokeData("b")}}));
    EXPECT_FALSE(data.hasCursorData());
}

TEST(ScreenData, WithoutDataAHolderAnswersARecordingOfNothing) {
    const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    ScreenDataHolder holder(project);
    auto expectNothing = [&](const ScreenMetaDataProvider& provider) {
        EXPECT_FALSE(provider.hasCursorData());
        EXPECT_EQ(provider.cursorPositionAtTime(RationalTime(7)), Point3d());
        EXPECT_TRUE(provider.clicksInRange(Span(0, 100)).empty());
        EXPECT_TRUE(provider.keystrokesInRange(Span(0, 100)).empty());
        EXPECT_EQ(provider.recordingRect(), Rect<int>());
    };
    expectNothing(ScreenRecordingData());
    expectNothing(holder);
    EXPECT_FALSE(holder.screenData());
    EXPECT_THROW(holder.clicksInRange(Span(0, -1)), ValueException<const SafeRational>);

    const auto data = boost::make_shared<ScreenRecordingData>(Rect<int>(10, 20, 640, 480));
    data->addCursorSample(RationalTime(0), Point3d(1, 2, 0));
    data->addClick(RationalTime(3), ScreenClick::Right);
    holder.setScreenData(data);
    EXPECT_EQ(holder.screenData(), data);
    EXPECT_EQ(holder.cursorPositionAtTime(RationalTime(9)), Point3d(1, 2, 0));
    EXPECT_EQ(holder.clicksInRange(Span(0, 4)), data->clicks());
    EXPECT_EQ(holder.recordingRect(), Rect<int>(10, 20, 640, 480));
    holder.setScreenData(boost::shared_ptr<const ScreenRecordingData>());
    expectNothing(holder);
}

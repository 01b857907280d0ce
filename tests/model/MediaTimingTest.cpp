#include "MediaTestSupport.h"

#include <VelaMediaLib/model/ColorMedia.h>
#include <VelaMediaLib/model/IdentManager.h>
#include <VelaMediaLib/model/MediaEditor.h>
#include <VelaMediaLib/model/PlaceholderMedia.h>

#include <gtest/gtest.h>
#include <limits>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

const long long kMin = std::numeric_limits<long long>::min();

class MediaTiming : public ::testing::Test {
protected:
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));

    boost::shared_ptr<PlaceholderMedia> placeholder(VelaTime start, SafeRational mediaDuration,
                                                    SafeRational scalar) {
        return PlaceholderMedia::createFromMediaRange(project, rate, start, SafeRational(0), mediaDuration,
                                                      scalar);
    }
    boost::shared_ptr<TestClip> clip(const MediaState& state,
                                     MediaImpl::EditorKind editor = MediaImpl::Temporal) {
        return boost::make_shared<TestClip>(project, rate, state, editor);
    }
};

void expectTiming(const Media& media, VelaTime start, VelaTime duration, SafeRational mediaStart,
                  SafeRational mediaDuration) {
    EXPECT_EQ(media.trackRange(), Range<VelaTime>(start, duration));
    EXPECT_EQ(media.rationalMediaRange(), Range<SafeRational>(mediaStart, mediaDuration));
}

// Runs the edit, expecting the message, and checks that nothing changed.
template <typename Exception, typename Edit>
void expectRefused(Media& media, Edit edit, const std::string& message) {
    const MediaState before = media.state();
    try {
        edit();
        ADD_FAILURE() << "no exception for " << message;
    } catch (const Exception& e) {
        EXPECT_EQ(std::string(e.what()), message);
    }
    EXPECT_TRUE(media.state() == before) << message;
}

} // namespace

TEST_F(MediaTiming, ScalarOneTrimsAndMoves) {
    auto media = PlaceholderMedia::create(project, rate, 100, 100);
    EXPECT_EQ(media->trimStartLimit(), 0);
    EXPECT_EQ(media->trimEndLimit(), 0);
    expectRefused<InvalidTrimRangeException>(
        *media, [&] { media->trimEnd(-1); }, "invalid media trim end offset");
    expectRefused<InvalidTrimRangeException>(
        *media, [&] { media->trimStart(-1); }, "invalid media start trim offset");
    media->trimStart(10);
    expectTiming(*media, 110, 90, 10, 90);
    EXPECT_EQ(media->trimStartLimit(), -10);
    media->trimEnd(30);
    expectTiming(*media, 110, 60, 10, 60);
    EXPECT_EQ(media->trimEndLimit(), -30);
    media->move(-5);
    expectTiming(*media, 105, 60, 10, 60);
    media->setTrackStart(0);
    EXPECT_EQ(media->startTime(), 0);
    EXPECT_EQ(media->endTime(), 60);
    try {
        media->trimStart(61);
        FAIL();
    } catch (const InvalidTrimRangeException& e) {
        EXPECT_EQ(e.value(), 61);
        EXPECT_EQ(e.trackRange(), Range<long long>(0, 60));
    }
}

TEST_F(MediaTiming, ScalarTwoTrimsInHalfTicksOfMedia) {
    auto media = placeholder(0, 50, 2);
    EXPECT_EQ(media->duration(), 100);
    media->trimStart(10);
    expectTiming(*media, 10, 90, 5, 45);
    EXPECT_EQ(media->trimStartLimit(), -10);
    media->trimEnd(20);
    expectTiming(*media, 10, 70, 5, 35);
    EXPECT_EQ(media->trimEndLimit(), -20);
    EXPECT_DOUBLE_EQ(media->scalar(), 2.0);
}

TEST_F(MediaTiming, ScalarTwoThirdsKeepsExactMediaTimes) {
    auto media = placeholder(0, 90, SafeRational(2, 3));
    EXPECT_EQ(media->duration(), 60);
    media->trimStart(1);
    expectTiming(*media, 1, 59, SafeRational(3, 2), SafeRational(177, 2));
    EXPECT_EQ(media->trimStartLimit(), -1);
    media->trimEnd(2);
    expectTiming(*media, 1, 57, SafeRational(3, 2), SafeRational(171, 2));
    EXPECT_EQ(media->trimEndLimit(), -2);
    // Stretching by 3/2 plays at scalar 1: 85.5 ticks round to 86.
    EXPECT_EQ(media->rationalStretch(SafeRational(3, 2)), SafeRational(1));
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(1, 86));
    EXPECT_EQ(media->rationalMediaRange().duration(), SafeRational(171, 2));
}

TEST_F(MediaTiming, MediaWithinATenThousandthOfTheSourceSnapsToIt) {
    auto media = placeholder(0, 10, SafeRational(100001, 100000));
    EXPECT_EQ(media->duration(), 10);
    media->trimEnd(1);
    media->trimEnd(-1);
    EXPECT_EQ(media->rationalMediaRange().duration(), SafeRational(10)); // 10 / 1.00001 snapped
}

TEST_F(MediaTiming, UnboundedLimitsExtendWithoutLimit) {
    auto unbounded = clip(timing(0, 100, 0, 100, 1, 0, MediaState::unboundedEnd()));
    EXPECT_EQ(unbounded->trimEndLimit(), kMin);
    unbounded->trimEnd(-100000);
    expectTiming(*unbounded, 0, 100100, 0, 100100);
    auto colour = ColorMedia::create(project, rate, 0, 10);
    EXPECT_EQ(colour->trimStartLimit(), kMin);
    EXPECT_EQ(colour->trimEndLimit(), kMin);
    colour->trimStart(-1000);
    EXPECT_EQ(colour->trackRange(), Range<VelaTime>(-1000, 1010));
}

TEST_F(MediaTiming, TransitionsKeepOneTickLessOnTheTemporalEditor) {
    auto temporal = clip(timing(0, 100, 0, 100, 1, 0, 1000));
    auto fixed = ColorMedia::create(project, rate, 0, 100);
    for (const boost::shared_ptr<Media>& media :
         {boost::shared_ptr<Media>(temporal), boost::shared_ptr<Media>(fixed)}) {
        media->setLeftTransition(TransitionPtr(new Transition("fade", 20)));
        media->setRightTransition(TransitionPtr(new Transition("fade", 30)));
    }
    EXPECT_TRUE(temporal->validTrimEnd(51));
    EXPECT_FALSE(temporal->validTrimEnd(52));
    EXPECT_TRUE(fixed->validTrimEnd(50));
    EXPECT_FALSE(fixed->validTrimEnd(51));
    expectRefused<InvalidTrimRangeException>(
        *fixed, [&] { fixed->trimStart(51); }, "invalid media start trim offset");
    temporal->trimEnd(51);
    fixed->trimEnd(50);
    EXPECT_EQ(temporal->duration(), 49);
    EXPECT_EQ(fixed->duration(), 50);
    EXPECT_EQ(temporal->transitionAtTime(10)->duration(), 20);
    EXPECT_EQ(temporal->transitionAtTime(48)->duration(), 30);
    EXPECT_EQ(temporal->leftTransition()->rightMedia(), temporal);
}

TEST_F(MediaTiming, StretchAndTheOlderEditors) {
    auto media = PlaceholderMedia::create(project, rate, 0, 100);
    expectRefused<ValueException<double>>(
        *media, [&] { media->rationalStretch(SafeRational(1, 1000)); },
        "invalid duration after media stretch (<=0)");
    EXPECT_EQ(media->trackRangeWithStretch(2.0), Range<VelaTime>(0, 200));
    EXPECT_EQ(media->trackRangeWithTrimStart(10), Range<VelaTime>(10, 90));
    EXPECT_EQ(media->trackRangeWithMove(7), Range<VelaTime>(7, 100));
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(0, 100)); // previews changed nothing
    EXPECT_DOUBLE_EQ(media->stretch(2.0), 2.0);
    expectTiming(*media, 0, 200, 0, 100);
    EXPECT_DOUBLE_EQ(media->findScalar(50), 0.5);
    expectRefused<InvalidTrimRangeException>(
        *media, [&] { media->mediaEditor().trimEnd(-1); }, "invalid media duration trim offset");
    media->mediaEditor().trimEnd(100);
    EXPECT_EQ(media->duration(), 100);
    auto colour = ColorMedia::create(project, rate, 0, 10);
    colour->mediaEditor().trimEnd(-5);
    EXPECT_EQ(colour->duration(), 15);
}

TEST_F(MediaTiming, RestoreChecksEachInconsistency) {
    auto media = clip(timing(0, 100, 0, 100, 1, 0, 1000));
    const MediaState good = media->state();
    auto with = [&](void (*change)(MediaState&)) {
        MediaState state = good;
        change(state);
        return state;
    };
    expectRefused<VelaMediaLibException>(
        *media, [&] { media->restoreState(with([](MediaState& s) { s.mediaStart = -1; }), 2); },
        "restored mediaRange start is less than minimum");
    expectRefused<VelaMediaLibException>(
        *media, [&] { media->restoreState(with([](MediaState& s) { s.mediaStart = 1001; }), 2); },
        "restored mediaRange start is greater than maximum");
    expectRefused<VelaMediaLibException>(
        *media, [&] { media->restoreState(with([](MediaState& s) { s.mediaStart = 950; }), 2); },
        "restored mediaRange end is greater than maximum");
    expectRefused<VelaMediaLibException>(
        *media, [&] { media->restoreState(with([](MediaState& s) { s.duration = 110; }), 2); },
        "restored scalar is inconsistent with restored ranges");
    try {
        media->restoreState(with([](MediaState& s) { s.mediaStart = -3; }), 2);
    } catch (const ValueException<const SafeRational>& e) {
        EXPECT_EQ(e.value(), SafeRational(-3));
    }
    media->restoreState(with([](MediaState& s) {
                            s.duration = 104;
                            s.start = 7;
                        }),
                        2);
    EXPECT_EQ(media->trackRange(), Range<VelaTime>(7, 104));
}

TEST(IdentManager, RetiredIdentifiersComeBackLastInFirstOut) {
    IdentManager manager;
    for (uint32_t expected = 0; expected < 9; ++expected) EXPECT_EQ(manager.newIdent(), expected);
    manager.retireIdent(5);
    manager.retireIdent(7);
    EXPECT_EQ(manager.newIdent(), 7u);
    EXPECT_EQ(manager.newIdent(), 5u);
    EXPECT_EQ(manager.newIdent(), 9u);
}

#include "MediaTestSupport.h"

#include <VelaMediaLib/model/media/ColorMedia.h>
#include <VelaMediaLib/base/IdentManager.h>
#include <VelaMediaLib/model/media/MediaEditor.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/media/RationalTemporalEditor.h>

#include <gtest/gtest.h>
#include <limits>
#include <random>

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
    // Without transitions the limit is the clip itself.
    EXPECT_FALSE(fixed->validTrimEnd(100));
    EXPECT_TRUE(fixed->validTrimEnd(99));
    EXPECT_FALSE(temporal->validTrimEnd(101));
    EXPECT_FALSE(temporal->validTrimStart(101));
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

TEST_F(MediaTiming, DurationIsAlwaysTheMediaDurationTimesTheScalarRounded) {
    auto media = placeholder(0, 10, 1);
    const MediaState original = media->state();
    media->rationalStretch(SafeRational(1, 3)); // 10/3 rounds to 3
    EXPECT_EQ(media->duration(), 3);
    media->rationalStretch(SafeRational(3)); // back to 10, not 3 * 3
    EXPECT_EQ(media->duration(), 10);
    EXPECT_EQ(media->rationalScalar(), SafeRational(1));
    media->rationalStretch(SafeRational(1, 3));
    media->restoreState(original, 0); // its own earlier state, exactly
    EXPECT_TRUE(media->state() == original);

    // A static clip's media follows its track range, so its state restores too.
    auto colour = ColorMedia::create(project, rate, 0, 10);
    colour->trimEnd(-5);
    colour->trimStart(3);
    colour->restoreState(colour->state(), 0);
    EXPECT_EQ(colour->rationalMediaRange().duration(), SafeRational(12));
}

TEST_F(MediaTiming, SeededEditsKeepTheDurationRuleAndRestoreExactly) {
    std::mt19937 random(20240611);
    for (const MediaImpl::EditorKind kind : {MediaImpl::Temporal, MediaImpl::Static}) {
        auto media = clip(timing(0, 60, 20, 60, 1, 0, 200), kind);
        std::vector<MediaState> history{media->state()};
        for (int step = 0; step < 400; ++step) {
            const MediaState before = media->state();
            const int amount = int(random() % 41) - 20;
            try {
                switch (random() % 4) {
                case 0:
                    media->trimStart(amount);
                    break;
                case 1:
                    media->trimEnd(amount);
                    break;
                case 2:
                    media->move(amount);
                    break;
                default: {
                    const long long numerator = 1 + random() % 5; // drawn in a fixed order
                    media->rationalStretch(SafeRational(numerator, 1 + random() % 5));
                    break;
                }
                }
            } catch (const VelaMediaLibException&) {
                EXPECT_TRUE(media->state() == before) << "a refused edit changed the clip";
            }
            const MediaState now = media->state();
            ASSERT_EQ(now.duration, RationalMediaEditor::durationFor(now.mediaDuration, now.scalar))
                << "step " << step;
            ASSERT_TRUE(now.mediaStart >= now.minMediaStart && now.mediaEnd() <= now.maxMediaEnd)
                << "step " << step << " of editor " << kind << " plays outside its media";
            history.push_back(now);
        }
        for (auto state = history.rbegin(); state != history.rend(); ++state) {
            media->restoreState(*state, 0);
            ASSERT_TRUE(media->state() == *state);
        }
    }
}

TEST_F(MediaTiming, RestoreRefusesWhatConstructionRefuses) {
    auto media = clip(timing(0, 100, 0, 100, 1, 0, 1000));
    const MediaState good = media->state();
    auto expectRefusedState = [&](const MediaState& bad, const std::string& message) {
        expectRefused<ValueException<const SafeRational>>(
            *media, [&] { media->restoreState(bad, 2); }, message);
    };
    MediaState bad = good;
    bad.duration = 0;
    bad.mediaDuration = 0;
    expectRefusedState(bad, "restored duration is not greater than 0");
    bad = good;
    bad.mediaDuration = SafeRational(-100);
    bad.scalar = SafeRational(-1);
    expectRefusedState(bad, "restored media duration is not greater than 0");
    bad = good;
    bad.mediaDuration = SafeRational(1, 1000000);
    bad.scalar = SafeRational(0);
    bad.duration = 1;
    expectRefusedState(bad, "restored scalar is not greater than 0");
    EXPECT_THROW(clip(timing(0, 10, 0, 0, 1, 0, 10)), ValueException<double>);
    EXPECT_THROW(clip(timing(0, 10, 0, 10, 0, 0, 10)), ValueException<double>); // scalar 0
}

TEST_F(MediaTiming, StretchPreviewsRefuseWhatTheStretchRefuses) {
    auto media = PlaceholderMedia::create(project, rate, 0, 100);
    EXPECT_THROW(media->trackRangeWithRationalStretch(SafeRational(1, 1000)), ValueException<double>);
    EXPECT_THROW(media->trackRangeWithStretch(-2.0), ValueException<double>);
    EXPECT_THROW(media->rationalStretch(SafeRational(-2)), ValueException<double>);
    EXPECT_EQ(media->trackRangeWithRationalStretch(SafeRational(1, 3)), Range<VelaTime>(0, 33));
    EXPECT_EQ(media->duration(), 100);
}

TEST_F(MediaTiming, DefaultStateKeepsTheDurationRule) {
    auto media = placeholder(0, SafeRational(1, 4), 8); // two ticks of a quarter tick of media
    const MediaState whole = media->defaultState();
    EXPECT_EQ(whole.duration, RationalMediaEditor::durationFor(whole.mediaDuration, whole.scalar));
    media->restoreState(whole, 0);
    auto longer = placeholder(0, 50, 2);
    longer->trimStart(10);
    EXPECT_EQ(longer->defaultState().trackRange(), Range<VelaTime>(10, 50));
    EXPECT_EQ(longer->defaultState().scalar, SafeRational(1));
    EXPECT_EQ(longer->defaultState().mediaStart, SafeRational(0)); // all the media again
    EXPECT_EQ(longer->defaultState().mediaDuration, SafeRational(50));
}

TEST_F(MediaTiming, AnEditorsStretchCanBeReplacedByAKind) {
    struct Doubling : RationalTemporalEditor {
        using RationalTemporalEditor::RationalTemporalEditor;
        MediaState stretch(const MediaState& state, const SafeRational& factor) const override {
            return RationalTemporalEditor::stretch(state, factor * SafeRational(2));
        }
    };
    auto media = clip(timing(0, 10, 0, 10, 1, 0, 100));
    const Doubling doubling(*media);
    const RationalMediaEditor& editor = doubling;
    EXPECT_EQ(editor.stretch(media->state(), SafeRational(2)).duration, 40);
}

// A duration rounded up leaves less media past the end than the limit says:
// an extension that would play past the media's end is refused.
TEST_F(MediaTiming, ExtendingTheEndNeverPlaysPastTheMedia) {
    auto rounded = clip(timing(0, 8, 1, SafeRational(45, 2), SafeRational(1, 3), 0, 30));
    EXPECT_EQ(rounded->trimEndLimit(), -2);
    EXPECT_FALSE(rounded->validTrimEnd(-2));
    expectRefused<InvalidTrimRangeException>(
        *rounded, [&] { rounded->trimEnd(-2); }, "invalid media trim end offset");
    rounded->trimEnd(-1);
    EXPECT_LE(rounded->state().mediaEnd(), SafeRational(30));
}

#include "MediaTestSupport.h"

#include <VelaMediaLib/time/rational/RationalUtil.h>
#include <VelaMediaLib/model/media/ColorMedia.h>
#include <VelaMediaLib/model/media/MediaEditor.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/media/RationalTemporalEditor.h>

#include <limits>
#include <random>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

using Trim = InvalidTrimRangeException;
using Ticks = Range<VelaTime>;
using Media_ = Range<SafeRational>;
const long long kMin = std::numeric_limits<long long>::min();

class MediaTiming : public ModelTest {
protected:
    boost::shared_ptr<PlaceholderMedia> placeholder(VelaTime start, SafeRational duration,
                                                    SafeRational scalar) {
        return PlaceholderMedia::createFromMediaRange(project, rate, start, 0, duration, scalar);
    }
    boost::shared_ptr<TestClip> clip(const MediaState& state,
                                     MediaImpl::EditorKind editor = MediaImpl::Temporal) {
        return boost::make_shared<TestClip>(project, rate, state, editor);
    }
};

} // namespace

// Trims move the clip's edges by whole ticks and its media by ticks over the scalar, exactly.
TEST_F(MediaTiming, TrimsAtScalarsOneTwoAndTwoThirds) {
    struct Row {
        VelaTime start;
        SafeRational mediaDuration, scalar;
        VelaTime duration, trimStart, trimEnd;
        SafeRational mediaStart, mediaAfterStart, mediaAfterEnd;
    };
    const SafeRational half(1, 2);
    for (const Row& row : {Row{100, 100, 1, 100, 10, 30, 10, 90, 60}, Row{0, 50, 2, 100, 10, 20, 5, 45, 35},
                           Row{0, 90, SafeRational(2, 3), 60, 1, 2, 3 * half, 177 * half, 171 * half}}) {
        SCOPED_TRACE(row.scalar.asDouble());
        auto media = placeholder(row.start, row.mediaDuration, row.scalar);
        EXPECT_EQ(media->duration(), row.duration);
        EXPECT_EQ(Ticks(media->trimStartLimit(), media->trimEndLimit()), Ticks(0, 0));
        expectRefused<Trim>(*media, "invalid media trim end offset", [&] { media->trimEnd(-1); });
        expectRefused<Trim>(*media, "invalid media start trim offset", [&] { media->trimStart(-1); });
        media->trimStart(row.trimStart);
        const VelaTime start = row.start + row.trimStart, duration = row.duration - row.trimStart;
        EXPECT_EQ(media->trackRange(), Ticks(start, duration));
        EXPECT_EQ(media->rationalMediaRange(), Media_(row.mediaStart, row.mediaAfterStart));
        media->trimEnd(row.trimEnd);
        EXPECT_EQ(media->trackRange(), Ticks(start, duration - row.trimEnd));
        EXPECT_EQ(media->rationalMediaRange(), Media_(row.mediaStart, row.mediaAfterEnd));
        EXPECT_EQ(Ticks(media->trimStartLimit(), media->trimEndLimit()), Ticks(-row.trimStart, -row.trimEnd));
    }
}

TEST_F(MediaTiming, MovesAndStretchesKeepExactMediaTimes) {
    auto media = PlaceholderMedia::create(project, rate, 100, 60);
    media->move(-5);
    EXPECT_EQ(media->trackRange(), Ticks(95, 60));
    media->setTrackStart(0);
    EXPECT_EQ(Ticks(media->startTime(), media->endTime()), Ticks(0, 60));
    const auto e = thrown<Trim>([&] { media->trimStart(61); });
    EXPECT_TRUE(e && e->value() == 61 && e->trackRange() == Ticks(0, 60));
    EXPECT_DOUBLE_EQ(placeholder(0, 50, 2)->scalar(), 2.0);
    // 85.5 ticks of media stretched by 3/2 from 2/3 play at scalar 1: they round to 86.
    auto thirds = placeholder(1, SafeRational(171, 2), SafeRational(2, 3));
    EXPECT_EQ(thirds->rationalStretch(SafeRational(3, 2)), SafeRational(1));
    EXPECT_EQ(thirds->trackRange(), Ticks(1, 86));
    EXPECT_EQ(thirds->rationalMediaRange().duration(), SafeRational(171, 2));
    // Media within a ten-thousandth of the source snaps to it: 10 / 1.00001.
    auto near = placeholder(0, 10, SafeRational(100001, 100000));
    EXPECT_EQ(near->duration(), 10);
    near->trimEnd(1);
    near->trimEnd(-1);
    EXPECT_EQ(near->rationalMediaRange().duration(), SafeRational(10));
}

TEST_F(MediaTiming, UnboundedLimitsExtendWithoutLimit) {
    auto unbounded = clip(timing(0, 100, 0, 100, 1, 0, MediaState::unboundedEnd()));
    EXPECT_EQ(unbounded->trimEndLimit(), kMin);
    unbounded->trimEnd(-100000);
    EXPECT_EQ(unbounded->rationalMediaRange(), Media_(0, 100100));
    EXPECT_EQ(unbounded->duration(), 100100);
    auto colour = ColorMedia::create(project, rate, 0, 10);
    EXPECT_EQ(Ticks(colour->trimStartLimit(), colour->trimEndLimit()), Ticks(kMin, kMin));
    colour->trimStart(-1000);
    EXPECT_EQ(colour->trackRange(), Ticks(-1000, 1010));
}

// Transitions need the clip to keep their length less one tick on the temporal editor, all of it on the
// static.
TEST_F(MediaTiming, TransitionsKeepOneTickLessOnTheTemporalEditor) {
    auto temporal = clip(timing(0, 100, 0, 100, 1, 0, 1000));
    auto fixed = ColorMedia::create(project, rate, 0, 100);
    auto lastValidEnd = [](const Media& media, VelaTime last) {
        return media.validTrimEnd(last) && !media.validTrimEnd(last + 1);
    };
    EXPECT_TRUE(lastValidEnd(*fixed, 99)); // without transitions the limit is the clip itself
    EXPECT_FALSE(temporal->validTrimEnd(101) || temporal->validTrimStart(101));
    for (const boost::shared_ptr<Media>& media :
         {boost::shared_ptr<Media>(temporal), boost::shared_ptr<Media>(fixed)}) {
        media->setLeftTransition(TransitionPtr(new Transition("fade", 20)));
        media->setRightTransition(TransitionPtr(new Transition("fade", 30)));
    }
    EXPECT_TRUE(lastValidEnd(*temporal, 51));
    EXPECT_TRUE(lastValidEnd(*fixed, 50));
    expectRefused<Trim>(*fixed, "invalid media start trim offset", [&] { fixed->trimStart(51); });
    temporal->trimEnd(51);
    fixed->trimEnd(50);
    EXPECT_EQ(Ticks(temporal->duration(), fixed->duration()), Ticks(49, 50));
    EXPECT_EQ(temporal->transitionAtTime(10)->duration(), 20);
    EXPECT_EQ(temporal->transitionAtTime(48)->duration(), 30);
    EXPECT_EQ(temporal->leftTransition()->rightMedia(), temporal);
}

TEST_F(MediaTiming, StretchAndTheOlderEditors) {
    auto media = PlaceholderMedia::create(project, rate, 0, 100);
    expectRefused<ValueException<double>>(*media, "invalid duration after media stretch (<=0)",
                                          [&] { media->rationalStretch(SafeRational(1, 1000)); });
    // Previews refuse what the edit refuses and change nothing.
    EXPECT_THROW(media->trackRangeWithRationalStretch(SafeRational(1, 1000)), ValueException<double>);
    EXPECT_THROW(media->trackRangeWithStretch(-2.0), ValueException<double>);
    EXPECT_EQ(media->trackRangeWithRationalStretch(SafeRational(1, 3)), Ticks(0, 33));
    EXPECT_EQ(media->trackRangeWithStretch(2.0), Ticks(0, 200));
    EXPECT_EQ(media->trackRangeWithTrimStart(10), Ticks(10, 90));
    EXPECT_EQ(media->trackRangeWithMove(7), Ticks(7, 100));
    EXPECT_EQ(media->trackRange(), Ticks(0, 100));
    EXPECT_DOUBLE_EQ(media->stretch(2.0), 2.0);
    EXPECT_EQ(media->trackRange(), Ticks(0, 200));
    EXPECT_EQ(media->rationalMediaRange(), Media_(0, 100));
    EXPECT_DOUBLE_EQ(media->findScalar(50), 0.5);
    expectRefused<Trim>(*media, "invalid media duration trim offset",
                        [&] { media->mediaEditor().trimEnd(-1); });
    expectRefused<Trim>(*media, "invalid media duration trim offset",
                        [&] { media->mediaEditor().trimStart(-1); });
    media->mediaEditor().trimEnd(100);
    EXPECT_EQ(media->duration(), 100);
    auto colour = ColorMedia::create(project, rate, 0, 10);
    colour->mediaEditor().trimEnd(-5);
    EXPECT_EQ(colour->duration(), 15);
}

// A restore checks what construction checks, each with its own message and the value refused.
TEST_F(MediaTiming, RestoreRefusesEachInconsistency) {
    auto media = clip(timing(0, 100, 0, 100, 1, 0, 1000));
    const MediaState good = media->state();
    struct Row {
        void (*change)(MediaState&);
        SafeRational value;
        const char* message;
    };
    const Row rows[] = {
        {[](MediaState& s) { s.duration = 0, s.mediaDuration = 0; }, 0,
         "restored duration is not greater than 0"},
        {[](MediaState& s) { s.mediaDuration = s.scalar = -1; }, -1,
         "restored media duration is not greater than 0"},
        {[](MediaState& s) { s.mediaDuration = SafeRational(1, 1000000), s.scalar = 0, s.duration = 1; }, 0,
         "restored scalar is not greater than 0"},
        {[](MediaState& s) { s.mediaStart = -3; }, -3, "restored mediaRange start is less than minimum"},
        {[](MediaState& s) { s.mediaStart = 1001; }, 1001,
         "restored mediaRange start is greater than maximum"},
        {[](MediaState& s) { s.mediaStart = 950; }, 1050, "restored mediaRange end is greater than maximum"},
        {[](MediaState& s) { s.duration = 110; }, 1, "restored scalar is inconsistent with restored ranges"},
    };
    for (const Row& row : rows) {
        MediaState bad = good;
        row.change(bad);
        const auto e = thrown<ValueException<const SafeRational>>([&] { media->restoreState(bad, 2); });
        EXPECT_TRUE(e && e->value() == row.value && e->message() == row.message) << row.message;
        EXPECT_TRUE(media->state() == good) << row.message;
    }
    MediaState within = good; // four ticks off, within twice the tolerance
    within.duration = 104;
    within.start = 7;
    media->restoreState(within, 2);
    EXPECT_EQ(media->trackRange(), Ticks(7, 104));
    EXPECT_THROW(clip(timing(0, 10, 0, 0, 1, 0, 10)), ValueException<double>);
    EXPECT_THROW(clip(timing(0, 10, 0, 10, 0, 0, 10)), ValueException<double>); // scalar 0
}

TEST_F(MediaTiming, DurationIsAlwaysTheMediaDurationTimesTheScalarRounded) {
    auto media = placeholder(0, 10, 1);
    media->rationalStretch(SafeRational(1, 3)); // 10/3 rounds to 3
    EXPECT_EQ(media->duration(), 3);
    media->rationalStretch(SafeRational(3)); // back to 10, not 3 * 3
    EXPECT_EQ(media->duration(), 10);
    EXPECT_EQ(media->rationalScalar(), SafeRational(1));
    // A static clip's media follows its track range, so its state restores too.
    auto colour = ColorMedia::create(project, rate, 0, 10);
    colour->trimEnd(-5);
    colour->trimStart(3);
    colour->restoreState(colour->state(), 0);
    EXPECT_EQ(colour->rationalMediaRange().duration(), SafeRational(12));
    // The default state plays all the media again, and keeps the rule too.
    auto quarter = placeholder(0, SafeRational(1, 4), 8); // two ticks of a quarter tick of media
    const MediaState whole = quarter->defaultState();
    EXPECT_EQ(whole.duration,
              RationalUtil::toVelaTime(RationalUtil::Round(whole.mediaDuration * whole.scalar)));
    quarter->restoreState(whole, 0);
    auto longer = placeholder(0, 50, 2);
    longer->trimStart(10);
    EXPECT_EQ(longer->defaultState(), timing(10, 50, 0, 50, 1, 0, 50));
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
                const auto edit = random() % 4;
                if (edit == 0) media->trimStart(amount);
                if (edit == 1) media->trimEnd(amount);
                if (edit == 2) media->move(amount);
                if (edit == 3) {
                    const long long numerator = 1 + random() % 5; // drawn in a fixed order
                    media->rationalStretch(SafeRational(numerator, 1 + random() % 5));
                }
            } catch (const VelaMediaLibException&) {
                EXPECT_TRUE(media->state() == before) << "a refused edit changed the clip";
            }
            const MediaState now = media->state();
            ASSERT_EQ(now.duration,
                      RationalUtil::toVelaTime(RationalUtil::Round(now.mediaDuration * now.scalar)))
                << step;
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

TEST_F(MediaTiming, AnEditorsStretchCanBeReplacedByAKind) {
    struct Doubling : RationalTemporalEditor {
        using RationalTemporalEditor::RationalTemporalEditor;
        MediaState stretch(const MediaState& state, const SafeRational& factor) const override {
            return RationalTemporalEditor::stretch(state, factor * SafeRational(2));
        }
    };
    auto media = clip(timing(0, 10, 0, 10, 1, 0, 100));
    const Doubling doubling(*media);
    EXPECT_EQ(static_cast<const RationalMediaEditor&>(doubling).stretch(media->state(), 2).duration, 40);
}

// A duration rounded up leaves less media past the end than the limit says:
// an extension that would play past the media's end is refused.
TEST_F(MediaTiming, ExtendingTheEndNeverPlaysPastTheMedia) {
    auto rounded = clip(timing(0, 8, 1, SafeRational(45, 2), SafeRational(1, 3), 0, 30));
    EXPECT_EQ(rounded->trimEndLimit(), -2);
    EXPECT_FALSE(rounded->validTrimEnd(-2));
    expectRefused<Trim>(*rounded, "invalid media trim end offset", [&] { rounded->trimEnd(-2); });
    rounded->trimEnd(-1);
    EXPECT_LE(rounded->state().mediaEnd(), SafeRational(30));
}

// A static clip's start offset moves by the trim over the edit rate; with a
// rate of 0/1 there is no such time, and the trim is refused wholly.
TEST_F(MediaTiming, AStaticTrimAtRateZeroIsRefusedWholly) {
    MediaState state = timing(0, 30, 0, 30, 1, 0, 1000);
    state.hasStartOffset = true;
    state.startOffset = RationalTime(1, 2);
    const auto media = clip(state, MediaImpl::Static);
    media->trimStart(3);
    EXPECT_EQ(media->state().startOffset, RationalTime(SafeRational(1, 2) + SafeRational(1, 10)));
    rate->setEditRate(boost::rational<unsigned long>(0));
    const MediaState before = media->state();
    EXPECT_THROW(media->trimStart(3), boost::bad_rational);
    EXPECT_EQ(media->state(), before);
}

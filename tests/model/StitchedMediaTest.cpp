// Stitched media: parts end to end on an internal track, times mapped through
// them exactly, stitches, extended time, additions that refuse whole, screen
// data across the parts, the parameter seen through them, copies.
#include "MediaTestSupport.h"
#include "SourceTestSupport.h"

#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/effects/Effect.h>
#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/media/RationalMediaEditor.h>
#include <VelaMediaLib/model/media/ScreenVMFile.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/media/StitchedParameter.h>
#include <VelaMediaLib/model/project/SourceBin.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>

#include <boost/optional/optional_io.hpp>
#include <json/reader.h>
#include <stdexcept>

namespace VelaMediaLib {
namespace testing {
namespace {

using Span = Range<RationalTime>;

Json::Value parsed(const std::string& text) {
    Json::Value value;
    std::string errors;
    std::istringstream in(text);
    EXPECT_TRUE(Json::parseFromStream(Json::CharReaderBuilder(), in, &value, &errors)) << errors;
    return value;
}

class NamedEffect : public Effect {
public:
    explicit NamedEffect(std::string name) : name_(std::move(name)) {}
    std::string effectName() const override { return name_; }
    boost::shared_ptr<Effect> cloneEffect() const override { return boost::make_shared<NamedEffect>(name_); }

private:
    std::string name_;
};

class StitchedMediaTest : public ModelTest {
protected:
    // A part playing the media slice at the scalar, its media within [minStart, maxEnd].
    MediaPtr part(SafeRational mediaStart, SafeRational mediaDuration, SafeRational scalar = 1,
                  SafeRational minStart = 0, SafeRational maxEnd = 1000) {
        const VelaTime duration = RationalMediaEditor::durationFor(mediaDuration, scalar);
        return boost::make_shared<TestClip>(
            project, rate, timing(0, duration, mediaStart, mediaDuration, scalar, minStart, maxEnd),
            MediaImpl::Temporal);
    }
    // Parts of 10, 20 (10 of media at half speed) and 15 ticks.
    boost::shared_ptr<StitchedMedia> threeParts(VelaTime start = 100) {
        a = part(0, 10);
        b = part(100, 10, 2);
        c = part(200, 15);
        return StitchedMedia::create({a, b, c}, start);
    }
    static std::vector<std::string> states(const std::vector<MediaPtr>& parts) {
        std::vector<std::string> lines;
        for (const MediaPtr& media : parts) {
            const MediaState s = media->state();
            std::ostringstream out;
            out << s.start << "+" << s.duration << " " << s.mediaStart << "+" << s.mediaDuration << " x"
                << s.scalar << " " << bool(media->parent());
            lines.push_back(out.str());
        }
        return lines;
    }

    MediaPtr a, b, c;
};

TEST_F(StitchedMediaTest, PartsLieEndToEndAndTimesMapThroughThemExactly) {
    const auto stitched = threeParts();
    EXPECT_EQ(stitched->medias(), (std::vector<MediaPtr>{a, b, c}));
    EXPECT_EQ(stitched->trackRange(), Range<VelaTime>(100, 45));
    EXPECT_EQ(stitched->fullDuration(), 45);
    EXPECT_EQ(stitched->stitchTimes(), (std::vector<VelaTime>{10, 30}));
    EXPECT_EQ(stitched->numStitches(), 2u);
    EXPECT_EQ(b->parent(), stitched->track());
    EXPECT_EQ(stitched->visualMedias().size(), 3u);
    EXPECT_TRUE(stitched->audioMedias().empty());

    EXPECT_EQ(stitched->mediaAtTime(9), a);
    EXPECT_EQ(stitched->mediaAtTime(10), b); // a part holds its start, not its end
    EXPECT_EQ(stitched->mediaAtTime(44), c);
    EXPECT_EQ(stitched->mediaAtTime(45), MediaPtr());
    EXPECT_EQ(stitched->mediaAtTime(-1), MediaPtr());
    EXPECT_EQ(stitched->mediaAndSubTimeForParametricTime(25), StitchedMedia::MediaAndSubTime(b, 15));
    EXPECT_EQ(stitched->toSubMediaSourceTime(25), SafeRational(215, 2)); // 100 + 15 / 2

    // Trimmed by 5 and stretched by 3/2, the same content plays at the
    // global times the trim and the stretch give it, and parts follow.
    stitched->trimStart(5);
    stitched->rationalStretch(SafeRational(3, 2));
    EXPECT_EQ(stitched->trackRange(), Range<VelaTime>(105, 60));
    EXPECT_EQ(stitched->mediaAndSubTimeForParametricTime(30), StitchedMedia::MediaAndSubTime(b, 15));
    EXPECT_EQ(b->fromGlobalToParametricTime(RationalTime(135)), RationalTime(15));
    EXPECT_EQ(b->fromGlobalToParametricTime(RationalTime(136)), RationalTime(47, 3)); // 15 + 2/3
    EXPECT_EQ(b->fromParametricToGlobalTime(RationalTime(47, 3)), RationalTime(136));
    EXPECT_EQ(stitched->toSubMediaSourceTime(1), SafeRational(17, 3)); // 5 + 2/3 into the first part
    EXPECT_EQ(stitched->parametricStitchTimes(),
              (std::vector<SafeRational>{SafeRational(15, 2), SafeRational(75, 2)}));
}

TEST_F(StitchedMediaTest, TheChildrensConverterMapsBothWaysAndCannotBeReparented) {
    const auto stitched = threeParts(0);
    stitched->trimStart(3);
    stitched->rationalStretch(SafeRational(7, 3));
    const auto converter = stitched->childrensTimeConverter();
    EXPECT_EQ(stitched->track()->parentTimeConverter(), converter);
    EXPECT_EQ(converter->parentTimeConverter(), stitched);
    EXPECT_EQ(converter->parentParametricTimeToThisParametricTime(7), SafeRational(6));
    EXPECT_EQ(converter->thisParametricTimeToParentParametricTime(SafeRational(6)), SafeRational(7));
    EXPECT_EQ(converter->parentParametricTimeToThisParametricTime(1), SafeRational(24, 7));
    EXPECT_EQ(converter->clippingParentParametricTimeToThisParametricTime(-20), SafeRational(3));
    const SafeRational end(stitched->duration());
    EXPECT_EQ(converter->clippingParentParametricTimeToThisParametricTime(end + 9),
              converter->parentParametricTimeToThisParametricTime(end));
    try {
        boost::const_pointer_cast<StitchedMediaChildrensTimeConverter>(converter)->setTimeConverterParent(
            stitched->track());
        ADD_FAILURE() << "no exception";
    } catch (const std::runtime_error& e) {
        EXPECT_EQ(std::string(e.what()), "ChildrensTimeConverter::setTimeConverterParent not supported");
    }
    EXPECT_EQ(stitched->track()->parentTimeConverter(), converter);
}

TEST_F(StitchedMediaTest, StitchesAreFoundWithinHalfATickOfParametricTime) {
    const auto stitched = threeParts();
    stitched->rationalStretch(SafeRational(3, 2)); // stitches at 15 and 45
    EXPECT_EQ(stitched->stitchIndexNearTime(SafeRational(29, 2)), 0);
    EXPECT_EQ(stitched->stitchIndexNearTime(SafeRational(45)), 1);
    EXPECT_EQ(stitched->stitchIndexNearTime(SafeRational(46)), -1);
    EXPECT_EQ(stitched->stitchNearTime(SafeRational(31, 2)), boost::optional<SafeRational>(SafeRational(15)));
    EXPECT_EQ(stitched->stitchNearTime(SafeRational(27, 2)), boost::none);
    EXPECT_TRUE(stitched->isTimeNearStitch(SafeRational(45)));
    EXPECT_FALSE(stitched->isTimeNearStitch(SafeRational(43)));

    // Trimmed by a tick, the window starts a third into its media: the
    // stitches fall between ticks, and both ticks around each find it.
    stitched->trimStart(1);
    EXPECT_EQ(stitched->parametricStitchTimes(),
              (std::vector<SafeRational>{SafeRational(29, 2), SafeRational(89, 2)}));
    EXPECT_EQ(stitched->stitchNearTime(SafeRational(14)), boost::optional<SafeRational>(SafeRational(29, 2)));
    EXPECT_TRUE(stitched->isTimeNearStitch(15));
    EXPECT_FALSE(stitched->isTimeNearStitch(16));
    EXPECT_EQ(stitched->stitchIndexNearTime(44), 1);
}

TEST_F(StitchedMediaTest, ExtendedTimePlaysBeyondThePartsUntilTheyTakeItOver) {
    a = part(10, 10);    // 10 ticks of media before it
    b = part(50, 10, 2); // 940 ticks of media after it, at half speed
    const auto stitched = StitchedMedia::create({a, b}, 0);
    EXPECT_EQ(stitched->extendedTimeRange(), Range<SafeRational>(-10, 1920));
    EXPECT_EQ(stitched->extendedParametricTime(), std::make_pair(SafeRational(0), SafeRational(0)));

    stitched->trimStart(-4);
    stitched->trimEnd(-3);
    EXPECT_EQ(stitched->trackRange(), Range<VelaTime>(-4, 37));
    EXPECT_EQ(stitched->extendedParametricTime(), std::make_pair(SafeRational(4), SafeRational(3)));
    EXPECT_EQ(stitched->mediaAndSubTimeForParametricTime(0), StitchedMedia::MediaAndSubTime(a, -4));
    EXPECT_EQ(stitched->toSubMediaSourceTime(0), SafeRational(6));
    EXPECT_EQ(stitched->toSubMediaSourceTime(36), SafeRational(61)); // 50 + 22 / 2
    EXPECT_EQ(stitched->extendFrameTrimAmount(0), 3);
    EXPECT_EQ(stitched->extendFrameTrimAmount(-2), 5);
    EXPECT_EQ(stitched->extendFrameTrimAmount(5), 0);

    EXPECT_TRUE(stitched->removeExtendedTime());
    EXPECT_EQ(stitched->extendedParametricTime(), std::make_pair(SafeRational(0), SafeRational(0)));
    EXPECT_EQ(stitched->trackRange(), Range<VelaTime>(-4, 37));
    EXPECT_EQ(stitched->rationalMediaRange(), Range<SafeRational>(0, 37));
    EXPECT_EQ(states({a, b}), (std::vector<std::string>{"0+14 6/1+14/1 x1/1 1", "14+23 50/1+23/2 x2/1 1"}));
    EXPECT_EQ(stitched->toSubMediaSourceTime(0), SafeRational(6));
    EXPECT_EQ(stitched->toSubMediaSourceTime(36), SafeRational(61));
    EXPECT_FALSE(stitched->removeExtendedTime());

    // The limits moved with the parts: 6 ticks are left before the first.
    expectRefused<InvalidTrimRangeException>(*stitched, "invalid media start trim offset",
                                             [&] { stitched->trimStart(-7); });
    EXPECT_NO_THROW(stitched->trimStart(-6));
}

TEST_F(StitchedMediaTest, AddingPartsGrowsAWindowThatPlayedToTheEnd) {
    a = part(0, 10, 1, 0, 50);
    const auto stitched = StitchedMedia::create({a}, 0);
    stitched->trimEnd(-5); // plays 5 ticks beyond its part
    const SafeRational beyond = stitched->toSubMediaSourceTime(12);
    b = part(100, 10, 1, 0, 110);
    stitched->addMedia(b);
    EXPECT_EQ(stitched->toSubMediaSourceTime(12), beyond); // the last part took its extension over
    EXPECT_EQ(stitched->stitchTimes(), (std::vector<VelaTime>{15}));
    EXPECT_EQ(stitched->trackRange(), Range<VelaTime>(0, 25));
    EXPECT_EQ(stitched->maxRationalMediaEnd(), SafeRational(25));

    stitched->trimEnd(5); // no longer plays to the end: the window stays
    c = part(200, 10, 1, 0, 300);
    stitched->addMedia(c);
    EXPECT_EQ(stitched->trackRange(), Range<VelaTime>(0, 20));
    EXPECT_EQ(stitched->fullDuration(), 35);
    EXPECT_EQ(stitched->maxRationalMediaEnd(), SafeRational(125));

    const auto refitted = StitchedMedia::create({part(0, 10)}, 0);
    refitted->addMediaToTrackAndUpdateRanges(part(0, 10, 1, 0, 40));
    EXPECT_EQ(refitted->trackRange(), Range<VelaTime>(0, 10));
    EXPECT_EQ(refitted->maxRationalMediaEnd(), SafeRational(50));
    // A stitched media made empty may take its first part's look.
    const MediaPtr intro = part(0, 10);
    intro->setIdentifier("intro");
    boost::dynamic_pointer_cast<VisualMedia>(intro)->opacity()->setDefaultValue(0.5);
    const auto looking = StitchedMedia::create(project, rate, MediaState::unbounded(0, 1));
    looking->addMediasWithPropertiesOptional({intro}, true);
    EXPECT_EQ(looking->identifier(), "intro");
    EXPECT_EQ(looking->opacity()->valueAtTime(RationalTime(0)), 0.5);
    EXPECT_EQ(looking->trackRange(), Range<VelaTime>(0, 10));
    looking->addMediasWithPropertiesOptional({part(0, 10)}, true); // has parts: only added
    EXPECT_EQ(looking->identifier(), "intro");
    EXPECT_EQ(looking->trackRange(), Range<VelaTime>(0, 20));
    expectThrows<VelaMediaLibException>("a stitched media needs at least one clip",
                                        [] { StitchedMedia::create({}, 0); });
}

TEST_F(StitchedMediaTest, RefusedPartsLeaveEverythingAsItWas) {
    const auto stitched = threeParts(0);
    const auto track = GenericTrack::create(project);
    track->addMedia(stitched, 0);
    const MediaPtr neighbour = part(0, 5);
    track->addMedia(neighbour, 45);
    const auto before = states({a, b, c, stitched});
    const MediaPtr loose = part(300, 10);
    const auto looseBefore = states({loose});

    EXPECT_THROW(stitched->addMedias({loose, loose}), AddRemoveException);
    EXPECT_THROW(stitched->addMedia(neighbour), AddRemoveException); // on a track
    EXPECT_THROW(stitched->addMedia(stitched), AddRemoveException);
    EXPECT_THROW(stitched->addMedia(MediaPtr()), AddRemoveException);
    const auto otherProject = boost::make_shared<ThreadSafe>();
    EXPECT_THROW(stitched->addMedia(
                     boost::make_shared<TestClip>(otherProject, rate, loose->state(), MediaImpl::Temporal)),
                 AddRemoveException);
    const MediaPtr foreign =
        boost::make_shared<TestClip>(otherProject, rate, loose->state(), MediaImpl::Temporal);
    EXPECT_THROW(stitched->addMedias({loose, foreign}), AddRemoveException); // every part is checked
    EXPECT_THROW(stitched->addMedia(loose), CollisionException);             // growing onto the neighbour
    EXPECT_EQ(states({a, b, c, stitched}), before);
    EXPECT_EQ(states({loose}), looseBefore);
    EXPECT_EQ(stitched->medias().size(), 3u);

    track->removeMedia(neighbour);
    EXPECT_NO_THROW(stitched->addMedia(loose));
    EXPECT_EQ(stitched->trackRange(), Range<VelaTime>(0, 55));
}

TEST_F(StitchedMediaTest, UnsupportedOperationsSayWhyLineBreakIncluded) {
    const auto stitched = threeParts();
    expectThrows<VelaMediaLibException>("StitchedMedia::screenMetaData() unimplemented\n",
                                        [&] { stitched->screenMetaData(); });
    expectThrows<VelaMediaLibException>("StitchedMedia::screenMetaData() unimplemented\n",
                                        [&] { stitched->screenData(); });
    expectThrows<VelaMediaLibException>("StitchedMedia::splitChannels() unimplemented\n",
                                        [&] { stitched->splitChannels(); });
    expectThrows<VelaMediaLibException>(
        "double StitchedMedia::findScalar(double dSuggestedScalar) unimplemented\n",
        [&] { stitched->findScalar(1.5); });
    EXPECT_EQ(stitched->findScalar(VelaTime(90)), 2.0); // the clip's own question still answers
    const auto opacity = StitchedParameter<double>::create(stitched, "opacity");
    expectThrows<VelaMediaLibException>("StitchedParameter<T>::copyPortion not implemented", [&] {
        opacity->copyPortion(Span(RationalTime(0), RationalTime(10)));
    });
    EXPECT_EQ(MediaTypeFromMediaDispatcher::typeOf(*stitched), "StitchedMedia");
}

TEST_F(StitchedMediaTest, TheParameterOfThePartsStepsAtEachStitch) {
    const auto stitched = threeParts(0);
    boost::dynamic_pointer_cast<VisualMedia>(a)->opacity()->addKeyFrame(RationalTime(10), 0.0,
                                                                        RationalTime(10));
    boost::dynamic_pointer_cast<VisualMedia>(b)->opacity()->setDefaultValue(0.5);
    boost::dynamic_pointer_cast<VisualMedia>(c)->opacity()->addKeyFrame(RationalTime(5), 0.0,
                                                                        RationalTime(5));
    const auto opacity = StitchedParameter<double>::create(stitched, "opacity");
    EXPECT_EQ(opacity->valueAtTime(RationalTime(5)), 0.5);  // halfway down in the first part
    EXPECT_EQ(opacity->valueAtTime(RationalTime(10)), 0.5); // the second part's own value, no blend
    EXPECT_EQ(opacity->valueAtTime(RationalTime(30)), 1.0);
    EXPECT_EQ(opacity->valueAtTime(RationalTime(65, 2)), 0.5);
    EXPECT_EQ(opacity->valueAtTime(RationalTime(100)), 0.0);
    EXPECT_EQ(*opacity->keyframeTimes(), (std::vector<RationalTime>{RationalTime(0), RationalTime(10),
                                                                    RationalTime(30), RationalTime(35)}));

    boost::dynamic_pointer_cast<VisualMedia>(b)->opacity()->addKeyFrame(RationalTime(4), 0.25,
                                                                        RationalTime(0));
    EXPECT_EQ(opacity->valueAtTime(RationalTime(15)), 0.25);
    EXPECT_EQ(opacity->numKeyFrames(), 4u);
    opacity->refresh();
    EXPECT_EQ(opacity->numKeyFrames(), 5u);
    EXPECT_TRUE(opacity->hasKeyFrameAtTime(RationalTime(14)));

    stitched->removeAllMedias(); // nothing left to read: the parts' curve goes
    opacity->refresh();
    EXPECT_EQ(opacity->numKeyFrames(), 1u);
    EXPECT_EQ(opacity->valueAtTime(RationalTime(100)), 1.0);
}

TEST_F(StitchedMediaTest, ClonesAreDeepAndLookTheSame) {
    const auto stitched = threeParts();
    stitched->setIdentifier("take");
    stitched->setSourceEffect(boost::make_shared<NamedEffect>("cursor"));
    stitched->trimEnd(4);
    const auto copy = boost::dynamic_pointer_cast<StitchedMedia>(stitched->clone());
    ASSERT_TRUE(copy);
    EXPECT_EQ(copy->state(), stitched->state());
    EXPECT_EQ(copy->identifier(), "take");
    EXPECT_EQ(copy->sourceEffect()->effectName(), "cursor");
    EXPECT_NE(copy->sourceEffect(), stitched->sourceEffect());
    EXPECT_EQ(states(copy->medias()), states(stitched->medias()));
    EXPECT_EQ(copy->medias().front()->parent(), copy->track());
    EXPECT_NE(copy->medias().front(), a);
    EXPECT_EQ(copy->childrensTimeConverter()->parentTimeConverter(), copy);

    copy->medias().front()->trimStart(2);
    EXPECT_EQ(a->trackRange(), Range<VelaTime>(0, 10));
}

TEST_F(StitchedMediaTest, PlacementsTileItsTrackRangeWithWhatEachPartPlays) {
    const auto stitched = threeParts(100);
    stitched->trimStart(4);
    stitched->trimEnd(6);
    stitched->rationalStretch(2); // plays internal 4..39 over 70 ticks
    const auto placements = stitched->placementsWherePlayed();
    ASSERT_EQ(placements.size(), 3u);
    std::vector<std::string> lines;
    for (const auto& placement : placements) {
        const MediaState& s = placement.state;
        std::ostringstream out;
        out << s.start << "+" << s.duration << " " << s.mediaStart << "+" << s.mediaDuration << " x"
            << s.scalar;
        lines.push_back(out.str());
    }
    EXPECT_EQ(lines, (std::vector<std::string>{"104+12 4/1+6/1 x2/1", "116+40 100/1+10/1 x4/1",
                                               "156+18 200/1+9/1 x2/1"}));
    EXPECT_EQ(placements[1].media, b);
}

class StitchedScreenTest : public StitchedMediaTest {
protected:
    StitchedScreenTest() {
        loader->set("session.trec", {stream(TrackType::ScreenVideo, 0, 3000, 30)});
        loader->set("other.trec", {stream(TrackType::ScreenVideo, 0, 3000, 30)});
        bin->setFileSystem(files);
        data->addClick(RationalTime(110), ScreenClick::Left);
        data->addClick(RationalTime(125), ScreenClick::Right);
        data->addClick(RationalTime(305), ScreenClick::Left);
        data->addClick(RationalTime(400), ScreenClick::Middle);
        data->addKeystroke(RationalTime(306), KeystrokeData("a"));
        data->addCursorSample(RationalTime(300), Point3d(0, 0, 0));
        data->addCursorSample(RationalTime(310), Point3d(10, 0, 0));
    }
    boost::shared_ptr<ScreenVMFile> recording(const SourcePtr& source, SafeRational mediaStart,
                                              SafeRational mediaDuration, SafeRational scalar = 1) {
        const auto clip = ScreenVMFile::create(source, 0, 0, mediaStart, mediaDuration, scalar);
        clip->setScreenData(data);
        return clip;
    }

    RegisteredTableLoader loader;
    boost::shared_ptr<FakeFileSystem> files = boost::make_shared<FakeFileSystem>();
    boost::shared_ptr<SourceBin> bin = boost::make_shared<SourceBin>(project, rate);
    boost::shared_ptr<ScreenRecordingData> data =
        boost::make_shared<ScreenRecordingData>(Rect<int>(0, 0, 1920, 1080));
};

std::vector<RationalTime> timesOf(const std::vector<ScreenClick>& clicks) {
    std::vector<RationalTime> times;
    for (const ScreenClick& click : clicks) times.push_back(click.time);
    return times;
}

TEST_F(StitchedScreenTest, ScreenDataIsAskedOfThePartThatPlaysIt) {
    const SourcePtr session = bin->loadFile("session.trec");
    // 100..130 over internal 0..30, then 300..310 at half speed over 30..50.
    const auto stitched =
        StitchedMedia::create({recording(session, 100, 30), recording(session, 300, 10, 2)}, 0);
    EXPECT_EQ(timesOf(stitched->clicksInRange(Span(RationalTime(0), RationalTime(50)))),
              (std::vector<RationalTime>{RationalTime(10), RationalTime(25), RationalTime(40)}));
    EXPECT_EQ(timesOf(stitched->clicksInRange(Span(RationalTime(25), RationalTime(15)))),
              (std::vector<RationalTime>{RationalTime(25)})); // the end of a range is not in it
    // The last part answers beyond its end: 400 is played at 30 + 100 * 2.
    EXPECT_EQ(timesOf(stitched->clicksInRange(Span(RationalTime(45), RationalTime(1000)))),
              (std::vector<RationalTime>{RationalTime(230)}));
    const auto keys = stitched->keystrokesInRange(Span(RationalTime(0), RationalTime(50)));
    ASSERT_EQ(keys.size(), 1u);
    EXPECT_EQ(keys.front().time, RationalTime(42));
    EXPECT_EQ(keys.front().keystroke.key, "a");
    EXPECT_THROW(stitched->clicksInRange(Span(RationalTime(5), RationalTime(-1))),
                 ValueException<const SafeRational>);

    EXPECT_TRUE(stitched->hasCursorData());
    EXPECT_EQ(stitched->cursorPositionAtTime(RationalTime(40)), Point3d(5, 0, 0)); // source 305
    EXPECT_EQ(stitched->cursorPositionAtTime(RationalTime(41)), Point3d(5.5, 0, 0));
    EXPECT_EQ(stitched->recordingRect(), Rect<int>(0, 0, 1920, 1080));
    EXPECT_EQ(stitched->source(), session);
    EXPECT_EQ(stitched->trackNumber(), 0);
    EXPECT_FALSE(stitched->compatibleClipSpeeds());

    const auto plain = StitchedMedia::create({part(0, 10)}, 0); // no screen data, no source
    EXPECT_FALSE(plain->hasCursorData());
    EXPECT_EQ(plain->cursorPositionAtTime(RationalTime(3)), Point3d());
    EXPECT_EQ(plain->trackNumber(), -1);
    EXPECT_TRUE(plain->compatibleClipSpeeds());
}

TEST_F(StitchedScreenTest, PartsOfAnotherSourceAreRefusedAndTheSourceChangesWhole) {
    const SourcePtr session = bin->loadFile("session.trec");
    const SourcePtr other = bin->loadFile("other.trec");
    const auto first = recording(session, 100, 30);
    const auto stitched = StitchedMedia::create({first}, 0);
    expectThrows<VelaMediaLibException>("cannot stitch clips of different sources",
                                        [&] { stitched->addMedia(recording(other, 0, 10)); });
    EXPECT_THROW(stitched->addMedia(part(0, 10)), VelaMediaLibException); // plays no source
    EXPECT_EQ(stitched->medias().size(), 1u);

    stitched->setSource(other);
    EXPECT_EQ(first->source(), other);
    EXPECT_EQ(stitched->source(), other);
    const auto mixed = StitchedMedia::create({part(0, 10)}, 0);
    EXPECT_THROW(mixed->setSource(session), TypeException);
}

TEST_F(StitchedMediaTest, TheDocumentNamesTheKindAndHoldsTheParts) {
    const auto stitched = threeParts();
    std::ostringstream text;
    XMLOptions options(text);
    stitched->toJSON(options, 0);
    const Json::Value json = parsed(text.str());
    EXPECT_EQ(json["_type"].asString(), "StitchedMedia");
    ASSERT_EQ(json["medias"].size(), 3u);
    EXPECT_EQ(json["medias"][1]["start"].asInt(), 10);
    EXPECT_EQ(json["duration"].asInt(), 45);

    const auto read = StitchedMedia::create(project, rate, stitched->state());
    for (const MediaPtr& media : {part(0, 10), part(0, 10)}) {
        media->setTrackStart(read->fullDuration());
        read->addMediaWhileParsing(media);
    }
    EXPECT_EQ(read->state(), stitched->state()); // the document's state stays
    EXPECT_EQ(read->stitchTimes(), (std::vector<VelaTime>{10}));
}

} // namespace
} // namespace testing
} // namespace VelaMediaLib

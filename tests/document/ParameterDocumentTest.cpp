#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/time/parameters/AnimationParam.h>
#include <VelaMediaLib/time/parameters/DiffParameter.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
#include "../JsonTestSupport.h"

#include <gtest/gtest.h>
#include <json/reader.h>
#include <sstream>

using namespace VelaMediaLib;

namespace {

std::string written(const ParameterInterface& parameter, const std::string& name, int indent = 0) {
    std::ostringstream out;
    XMLOptions options(out);
    parameter.toJSON(options, indent, name);
    return out.str();
}

// Writes the parameter inside an object, as documents hold parameters, and parses that back.
Json::Value member(const ParameterInterface& parameter) {
    return VelaMediaLib::testing::parseJson("{" + written(parameter, "p", 1) + "}")["p"];
}

const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();

} // namespace

TEST(ParameterDocument, ABareParameterIsItsValue) {
    EXPECT_EQ(written(*ParameterImpl<double>::create(project, "opacity", 0.5), "opacity"),
              "\"opacity\" : 0.5");
    EXPECT_EQ(written(*ParameterImpl<double>::create(project, "opacity", 1.0), ""), "1.0");
    EXPECT_EQ(written(*ParameterImpl<Point3d>::create(project, "p", Point3d(1, 2, 3)), "p"),
              "\"p\" : [1.0, 2.0, 3.0]");
    ParameterImpl<double>::namesWrittenInFull().insert("always");
    EXPECT_NE(written(*ParameterImpl<double>::create(project, "always", 1.0), "always").find("keyframes"),
              std::string::npos);
    ParameterImpl<double>::namesWrittenInFull().erase("always");
}

TEST(ParameterDocument, AnObjectParameterIsWrittenMemberByMemberInItsOrder) {
    auto parameter =
        InterpolatingParam<double>::create(project, "volume", 0.0, EaseInInterpolater<double>::getInstance());
    parameter->setValueBounds(0.0, 2.0, 1.0);
    parameter->setUIHints("slider", "percent");
    parameter->addKeyFrame(RationalTime(30), 1.5, RationalTime(10));
    parameter->keyframeAtTime(RationalTime(30))->setInterpolater(LinearInterpolater<double>::getInstance());
    parameter->keyframeAtTime(RationalTime(30))->addMetaData("note", "fade \"in\"");
    const std::string expected = R"("volume" : {
    "type" : "double",
    "interp" : "esIn",
    "valueBounds" : {
      "minValue" : 0.0,
      "maxValue" : 2.0,
      "defaultValue" : 1.0
    },
    "uiHints" : {
      "userInterfaceType" : "slider",
      "unitType" : "percent"
    },
    "keyframes" : [
      {
        "time" : 0,
        "endTime" : 0,
        "value" : 0.0,
        "duration" : 0
      },
      {
        "time" : 20,
        "endTime" : 30,
        "value" : 1.5,
        "duration" : 10,
        "interp" : "linr",
        "metadata" : {
          "note" : "fade \"in\""
        }
      }
    ]
  })";
    EXPECT_EQ(written(*parameter, "volume", 1), expected);
}

TEST(ParameterDocument, ReadingKeyFramesFollowsItsSteps) {
    auto parameter = ParameterImpl<double>::create(project, "x", 0.0);
    parameter->addKeyFrame(RationalTime(10), 10.0, RationalTime(4));
    parameter->readFromJSON(VelaMediaLib::testing::parseJson(R"({"keyframes": [
        {"time": 1, "duration": 2, "value": 4.0},
        {"endTime": "7/2", "value": 8.0, "interp": "esIn", "metadata": {"k": "v"}},
        {"endTime": 3, "duration": 2, "value": 5.0},
        {"endTime": 10, "duration": 1, "value": 11.0}]})"));
    // The keyframes there were stay: entries at their times replace only the value.
    EXPECT_EQ(*parameter->keyframeTimes(), (std::vector<RationalTime>{RationalTime(0), RationalTime(3),
                                                                      RationalTime(7, 2), RationalTime(10)}));
    EXPECT_EQ(parameter->valueAtTime(RationalTime(0)), 0.0);
    EXPECT_EQ(parameter->keyframeAtTime(RationalTime(10))->value(), 11.0);
    EXPECT_EQ(parameter->keyframeAtTime(RationalTime(10))->duration(), RationalTime(4));
    EXPECT_EQ(parameter->keyframeAtTime(RationalTime(3))->value(), 5.0); // the later entry replaced the value
    EXPECT_EQ(parameter->keyframeAtTime(RationalTime(3))->duration(), RationalTime(2));
    EXPECT_EQ(parameter->keyframeAtTime(RationalTime(7, 2))->interpolaterName(), "esIn");
    EXPECT_EQ(parameter->keyframeAtTime(RationalTime(7, 2))->metaDataValue("k"), "v");
    EXPECT_EQ(parameter->keyframeAtTime(RationalTime(3))->interpolaterName(), ""); // follows the parameter

    parameter->readFromJSON(VelaMediaLib::testing::parseJson("2.5"));
    EXPECT_EQ(*parameter->keyframeTimes(), std::vector<RationalTime>{RationalTime(0)});
    EXPECT_EQ(parameter->valueAtTime(RationalTime(9)), 2.5);

    // An object without "keyframes" leaves the curve and reads the rest.
    EXPECT_FALSE(parameter->hasValueBounds());
    EXPECT_FALSE(parameter->hasUIHints());
    parameter->readFromJSON(VelaMediaLib::testing::parseJson(
        R"({"type": "double", "uiHints": {"userInterfaceType": "slider", "unitType": "percent"}})"));
    EXPECT_EQ(parameter->valueAtTime(RationalTime(9)), 2.5);
    EXPECT_TRUE(parameter->hasUIHints());
    EXPECT_FALSE(parameter->hasValueBounds());
}

TEST(ParameterDocument, AFailedReadChangesNothing) {
    auto parameter = ParameterImpl<double>::create(project, "x", 1.0);
    const auto before = parameter->clone();
    try {
        parameter->readFromJSON(VelaMediaLib::testing::parseJson(
            R"({"keyframes": [{"time": 0, "value": 3.0}, {"time": 5, "value": 1, "interp": "zzzz"}]})"));
        FAIL();
    } catch (const ParserException& e) {
        EXPECT_STREQ(e.what(), "trying to read an unknown interpolater");
    }
    EXPECT_THROW(parameter->readFromJSON(
                     VelaMediaLib::testing::parseJson(R"({"keyframes": [{"time": 0, "value": "text"}]})")),
                 ParserException);
    EXPECT_THROW(parameter->readFromJSON(VelaMediaLib::testing::parseJson(R"({"keyframes": [{"time": 0}]})")),
                 ParserException);
    EXPECT_THROW(parameter->readFromJSON(
                     VelaMediaLib::testing::parseJson(R"({"keyframes": [{"time": 1.5, "value": 1}]})")),
                 ParserException);
    EXPECT_TRUE(*parameter == *before);
}

TEST(ParameterDocument, AnAnimationTakesLeadInlessValuesWithoutNewKeyFrames) {
    auto parameter = AnimationParam<double>::create(project, "scale", 1.0);
    parameter->readFromJSON(VelaMediaLib::testing::parseJson(R"({"keyframes": [
        {"endTime": 0, "value": 1.0},
        {"endTime": 30, "duration": 10, "value": 2.0},
        {"endTime": 40, "value": 3.0}]})"));
    EXPECT_EQ(*parameter->keyframeTimes(), (std::vector<RationalTime>{RationalTime(0), RationalTime(30)}));
    EXPECT_EQ(parameter->valueAtTime(RationalTime(30)), 3.0);
    ASSERT_EQ(parameter->animations().size(), 1u);
    EXPECT_EQ(parameter->animations()[0].span, Range<RationalTime>(RationalTime(20), RationalTime(10)));

    auto constant = AnimationParam<double>::create(project, "scale", 4.0);
    constant->readFromJSON(
        VelaMediaLib::testing::parseJson(R"({"keyframes": [{"endTime": 5, "duration": 0, "value": 3}]})"));
    EXPECT_EQ(*constant->keyframeTimes(), std::vector<RationalTime>{RationalTime(0)});
    EXPECT_EQ(constant->valueAtTime(RationalTime(0)), 3.0);
    EXPECT_TRUE(constant->animations().empty());
}

// Asking for the identifier attribute or the metadata, sharing a clone's
// setup and copying make storage that may stay empty: it does not count.
TEST(ParameterDocument, AConstantParameterKeepsItsBareFormWhateverEmptyStorageItHas) {
    auto asked = ParameterImpl<double>::create(project, "opacity", 1.0);
    asked->identAttribute();
    EXPECT_EQ(written(*asked, "opacity"), "\"opacity\" : 1.0");
    asked->metaDataPtr();
    EXPECT_EQ(written(*asked, "opacity"), "\"opacity\" : 1.0");
    asked->metaDataPtr()->addMetaData("note", "x");
    EXPECT_NE(written(*asked, "opacity"), "\"opacity\" : 1.0");
    asked->metaDataPtr()->removeMetaData("note");
    EXPECT_EQ(written(*asked->clone(), "opacity"), "\"opacity\" : 1.0");

    auto target = ParameterImpl<double>::create(project, "opacity", 1.0);
    ParameterImpl<double>::create(project, "opacity", 0.5)->setupSharedClone(target);
    EXPECT_EQ(written(*target, "opacity"), "\"opacity\" : 1.0");
    EXPECT_EQ(written(*target->clone(), "opacity"), "\"opacity\" : 1.0");
}

namespace {

// Writes the parameter and reads it as a whole into a fresh one of its kind.
template <typename Kind>
boost::shared_ptr<Kind> readBack(const boost::shared_ptr<Kind>& parameter) {
    const auto fresh = boost::static_pointer_cast<Kind>(parameter->clone());
    fresh->setDefaultValue(typename Kind::ValueType()); // differs before reading
    fresh->replaceFromJSON(member(*parameter));
    return fresh;
}

} // namespace

TEST(ParameterDocument, ReadingAWholeParameterGivesBackTheWrittenCurve) {
    auto plain = ParameterImpl<double>::create(project, "x", 1.0);
    plain->addKeyFrame(RationalTime(5), 2.0, RationalTime(0));
    plain->addKeyFrame(RationalTime(10), 3.0, RationalTime(3));
    plain->removeKeyFrame(RationalTime(0)); // no keyframe at 0 in the document
    plain->keyframeAtTime(RationalTime(10))->addMetaData("k", "v");
    EXPECT_TRUE(*readBack(plain) == *plain);
    EXPECT_EQ(*readBack(plain)->keyframeTimes(),
              (std::vector<RationalTime>{RationalTime(5), RationalTime(10)}));

    auto animated = AnimationParam<double>::create(project, "scale", 1.0);
    animated->addKeyFrame(RationalTime(30), 2.0, RationalTime(10));
    animated->addKeyFrame(RationalTime(50), 0.5, RationalTime(5));
    const auto portion = animated->copyPortion(Range<RationalTime>(RationalTime(25), RationalTime(20)));
    EXPECT_TRUE(*readBack(animated) == *animated);
    EXPECT_TRUE(*readBack(boost::static_pointer_cast<AnimationParam<double>>(portion)) == *portion);
    EXPECT_EQ(readBack(animated)->animations().size(), 2u);

    auto withMetadata = ParameterImpl<double>::create(project, "y", 1.0);
    withMetadata->metaDataPtr()->addMetaData("a", "1");
    auto stale = withMetadata->clone();
    stale->metaDataPtr()->addMetaData("b", "2");
    MetaDatable* kept = stale->metaDataPtr();
    stale->replaceFromJSON(member(*withMetadata));
    EXPECT_EQ(stale->generateMetaDataMap(), (std::map<std::string, std::string>{{"a", "1"}}));
    EXPECT_EQ(stale->metaDataPtr(), kept); // the same metadata object, its entries replaced
}

// A keyframe without lead-in after the first would be read as a value for the
// keyframe in force, so an animation refuses it.
TEST(ParameterDocument, AnAnimationsLaterKeyFramesNeedALeadIn) {
    auto animated = AnimationParam<double>::create(project, "scale", 1.0);
    EXPECT_THROW(animated->addKeyFrame(RationalTime(10), 2.0, RationalTime(0)), KeyFrameException);
    EXPECT_THROW(animated->addKeyFrame(RationalTime(-10), 2.0, RationalTime(1)), KeyFrameException);
    animated->addKeyFrame(RationalTime(10), 2.0, RationalTime(4));
    animated->addKeyFrame(RationalTime(0), 3.0, RationalTime(0)); // the first may have none
    EXPECT_THROW(animated->changeKeyFrameLeadInLength(RationalTime(10), RationalTime(0)), KeyFrameException);
    EXPECT_EQ(animated->numKeyFrames(), 2u);
}

namespace {

template <typename Kind, typename T>
void expectRoundTrip(const boost::shared_ptr<Kind>& parameter, const T& later) {
    auto copy = parameter->clone();
    copy->setDefaultValue(later); // differs before reading
    copy->readFromJSON(member(*parameter));
    EXPECT_TRUE(*copy == *parameter) << written(*parameter, "p");
    parameter->addKeyFrame(RationalTime(7, 3), later, RationalTime(1, 3));
    copy->readFromJSON(member(*parameter));
    EXPECT_TRUE(*copy == *parameter) << written(*parameter, "p");
}

template <typename T>
void roundTrip(const T& first, const T& later) {
    expectRoundTrip(ParameterImpl<T>::create(project, "p", first), later);
}

} // namespace

TEST(ParameterDocument, EveryValueTypeReadsBackEqual) {
    roundTrip(3, -7);
    roundTrip(0.1f, 3.4028235e38f);
    roundTrip(0.1, 1.0 / 3.0);
    roundTrip(9007199254740993LL, -1LL);
    roundTrip(std::string("tab\there"), std::string("quote \" and \\ and \xc3\xa9"));
    roundTrip(Rect<float>(0, 0, 1920, 1080), Rect<float>(0.5f, -2, 3, 4));
    roundTrip(TemplatedColor<int>(255, 0, 0, 255), TemplatedColor<int>(1, 2, 3, 4));
    roundTrip(std::list<Rect<float>>{},
              std::list<Rect<float>>{Rect<float>(1, 2, 3, 4), Rect<float>(5, 6, 7, 8)});
    roundTrip(AudioPosition(-1, 0), AudioPosition(0.25, 1));
    roundTrip(CaptionData("Hello", "en"), CaptionData("Bonjour\n", "fr-CA"));
    roundTrip(KeystrokeData("S", KeystrokeData::Command), KeystrokeData("Tab"));
    TextAttributeList styled("bold text");
    styled.addRun(0, 4, "bold", "true");
    roundTrip(TextAttributeList("plain"), styled);
    roundTrip(Point3d(1e-300, 2, 3), Point3d(-0.0, 1e300, 5));
    roundTrip(SafeRational(1, 3), SafeRational(-5));
    roundTrip(TransformMatrix(), TransformMatrix::rotationZ(0.5) * TransformMatrix::translation(1, 2, 3));
    roundTrip(std::vector<double>{1, 2}, std::vector<double>{});
    roundTrip(InterpolaterFactory<double>::byName("linr"), InterpolaterFactory<double>::byName("bnce"));
    roundTrip(InterpolaterFactory<Point3d>::byName("sprg"),
              boost::shared_ptr<Interpolater<Point3d>>(
                  new BezierInterpolater(Point3d(1, 2, 3), Point3d(), "esOt")));
    expectRoundTrip(
        InterpolatingParam<double>::create(project, "p", 1.0, SpringInterpolater<double>::getInstance()),
        2.0);
}

TEST(ParameterDocument, ADiffParameterWritesOnlyItsDifference) {
    auto source = ParameterImpl<double>::create(project, "source", 0.0);
    source->addKeyFrame(RationalTime(10), 10.0, RationalTime(0));
    auto diff = DiffParameter<double>::create(project, "d", source);
    diff->addKeyFrame(RationalTime(5), 1.0, RationalTime(0));
    diff->removeKeyFrame(RationalTime(10));
    const Json::Value json = member(*diff);
    ASSERT_EQ(json["edits"].size(), 1u);
    EXPECT_EQ(json["edits"][0]["time"].asInt(), 5);
    EXPECT_EQ(json["deletions"][0].asInt(), 10);
    EXPECT_FALSE(json["ignoreSource"].asBool());
    auto read = DiffParameter<double>::create(project, "d", source);
    read->readFromJSON(json);
    EXPECT_TRUE(*read == *diff);
    for (const char* edit : {R"({"value": 1})", R"({"time": 1})", "1"}) {
        const std::string text = std::string(R"({"edits": [)") + edit + "]}";
        EXPECT_THROW(read->readFromJSON(VelaMediaLib::testing::parseJson(text)), ParserException) << text;
    }
    EXPECT_TRUE(*read == *diff); // a refused read changes nothing
}

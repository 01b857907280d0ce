#include "../JsonTestSupport.h"
#include "../time/TimeTestSupport.h"

#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/time/parameters/AnimationParam.h>
#include <VelaMediaLib/time/parameters/DiffParameter.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <sstream>

using namespace VelaMediaLib;
using VelaMediaLib::testing::parseJson;
using VelaMediaLib::testing::thrown;

namespace {

std::string written(const ParameterInterface& parameter, const std::string& name, int indent = 0) {
    std::ostringstream out;
    XMLOptions options(out);
    parameter.toJSON(options, indent, name);
    return out.str();
}

// Writes the parameter inside an object, as documents hold parameters, and parses that back.
Json::Value member(const ParameterInterface& parameter) {
    return parseJson("{" + written(parameter, "p", 1) + "}")["p"];
}

// Writes the parameter and reads it as a whole into a fresh one of its kind.
template <typename Kind>
boost::shared_ptr<Kind> readBack(const boost::shared_ptr<Kind>& parameter) {
    const auto fresh = boost::static_pointer_cast<Kind>(parameter->clone());
    fresh->setDefaultValue(typename Kind::ValueType()); // differs before reading
    fresh->replaceFromJSON(member(*parameter));
    return fresh;
}

const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();

} // namespace

// A constant parameter is written as its bare value. Asking for the
// identifier attribute or the metadata, sharing a clone's setup and copying
// make storage that may stay empty: it does not count.
TEST(ParameterDocument, AConstantParameterIsItsBareValueWhateverEmptyStorageItHas) {
    EXPECT_EQ(written(*ParameterImpl<double>::create(project, "opacity", 1.0), ""), "1.0");
    EXPECT_EQ(written(*ParameterImpl<Point3d>::create(project, "p", Point3d(1, 2, 3)), "p"),
              "\"p\" : [1.0, 2.0, 3.0]");
    ParameterImpl<double>::namesWrittenInFull().insert("always");
    EXPECT_NE(written(*ParameterImpl<double>::create(project, "always", 1.0), "always").find("keyframes"),
              std::string::npos);
    ParameterImpl<double>::namesWrittenInFull().erase("always");

    const std::string bare = "\"opacity\" : 0.5";
    auto asked = ParameterImpl<double>::create(project, "opacity", 0.5);
    asked->identAttribute();
    EXPECT_EQ(written(*asked, "opacity"), bare);
    asked->metaDataPtr();
    EXPECT_EQ(written(*asked, "opacity"), bare);
    asked->metaDataPtr()->addMetaData("note", "x");
    EXPECT_NE(written(*asked, "opacity"), bare);
    asked->metaDataPtr()->removeMetaData("note");
    EXPECT_EQ(written(*asked->clone(), "opacity"), bare);
    auto target = ParameterImpl<double>::create(project, "opacity", 0.5);
    ParameterImpl<double>::create(project, "opacity", 1.0)->setupSharedClone(target);
    EXPECT_EQ(written(*target, "opacity"), bare);
    EXPECT_EQ(written(*target->clone(), "opacity"), bare);
}

TEST(ParameterDocument, ReadingKeyFramesFollowsItsSteps) {
    auto parameter = ParameterImpl<double>::create(project, "x", 0.0);
    parameter->addKeyFrame(RationalTime(10), 10.0, RationalTime(4));
    parameter->readFromJSON(parseJson(R"({"keyframes": [
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

    parameter->readFromJSON(parseJson("2.5"));
    EXPECT_EQ(*parameter->keyframeTimes(), std::vector<RationalTime>{RationalTime(0)});
    EXPECT_EQ(parameter->valueAtTime(RationalTime(9)), 2.5);

    // An object without "keyframes" leaves the curve and reads the rest.
    EXPECT_FALSE(parameter->hasValueBounds());
    EXPECT_FALSE(parameter->hasUIHints());
    parameter->readFromJSON(parseJson(
        R"({"type": "double", "uiHints": {"userInterfaceType": "slider", "unitType": "percent"}})"));
    EXPECT_EQ(parameter->valueAtTime(RationalTime(9)), 2.5);
    EXPECT_TRUE(parameter->hasUIHints());
    EXPECT_FALSE(parameter->hasValueBounds());
}

TEST(ParameterDocument, AFailedReadChangesNothing) {
    auto parameter = ParameterImpl<double>::create(project, "x", 1.0);
    const auto before = parameter->clone();
    const auto read = [&](const std::string& keyframes) {
        return thrown<ParserException>(
            [&] { parameter->readFromJSON(parseJson(R"({"keyframes": )" + keyframes + "}")); });
    };
    EXPECT_EQ(read(R"([{"time": 0, "value": 3.0}, {"time": 5, "value": 1, "interp": "zzzz"}])"),
              "trying to read an unknown interpolater");
    for (const char* bad :
         {R"([{"time": 0, "value": "text"}])", R"([{"time": 0}])", R"([{"time": 1.5, "value": 1}])"})
        EXPECT_NE(read(bad), "no exception") << bad;
    EXPECT_TRUE(*parameter == *before);
}

// A keyframe without lead-in after the first would be read as a value for the
// keyframe in force, so an animation refuses it, and reads such an entry as one.
TEST(ParameterDocument, AnAnimationsLaterKeyFramesNeedALeadIn) {
    auto parameter = AnimationParam<double>::create(project, "scale", 1.0);
    parameter->readFromJSON(parseJson(R"({"keyframes": [
        {"endTime": 0, "value": 1.0},
        {"endTime": 30, "duration": 10, "value": 2.0},
        {"endTime": 40, "value": 3.0}]})"));
    EXPECT_EQ(*parameter->keyframeTimes(), (std::vector<RationalTime>{RationalTime(0), RationalTime(30)}));
    EXPECT_EQ(parameter->valueAtTime(RationalTime(30)), 3.0);
    ASSERT_EQ(parameter->animations().size(), 1u);
    EXPECT_EQ(parameter->animations()[0].span, Range<RationalTime>(RationalTime(20), RationalTime(10)));

    auto constant = AnimationParam<double>::create(project, "scale", 4.0);
    constant->readFromJSON(parseJson(R"({"keyframes": [{"endTime": 5, "duration": 0, "value": 3}]})"));
    EXPECT_EQ(*constant->keyframeTimes(), std::vector<RationalTime>{RationalTime(0)});
    EXPECT_EQ(constant->valueAtTime(RationalTime(0)), 3.0);
    EXPECT_TRUE(constant->animations().empty());
    auto animated = AnimationParam<double>::create(project, "scale", 1.0);
    EXPECT_THROW(animated->addKeyFrame(RationalTime(10), 2.0, RationalTime(0)), KeyFrameException);
    EXPECT_THROW(animated->addKeyFrame(RationalTime(-10), 2.0, RationalTime(1)), KeyFrameException);
    animated->addKeyFrame(RationalTime(10), 2.0, RationalTime(4));
    animated->addKeyFrame(RationalTime(0), 3.0, RationalTime(0)); // the first may have none
    EXPECT_THROW(animated->changeKeyFrameLeadInLength(RationalTime(10), RationalTime(0)), KeyFrameException);
    EXPECT_EQ(animated->numKeyFrames(), 2u);
}

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
        EXPECT_THROW(read->readFromJSON(parseJson(text)), ParserException) << text;
    }
    EXPECT_TRUE(*read == *diff); // a refused read changes nothing
}

namespace {

using VelaMediaLib::testing::Knob;

Json::Value parameterList(const Parametric& object) {
    std::ostringstream out;
    {
        XMLOptions options(out);
        JSONWriter root(options, 0);
        object.toJSONParameterList(options, root.memberLevel());
    }
    return parseJson(out.str())["parameters"];
}

} // namespace

// Each parameter is built from the document alone, whatever the object held.
TEST(ParametricDocument, ReadingAParameterListGivesBackExactlyTheWrittenCurves) {
    Knob written(project), read(project);
    const auto level = written.typedParameter<double>("level");
    level->addKeyFrame(RationalTime(5), 0.5, RationalTime(0));
    level->addKeyFrame(RationalTime(10), 0.25, RationalTime(2));
    level->removeKeyFrame(RationalTime(0));
    level->metaDataPtr()->addMetaData("k", "v");
    written.parameter("pan");

    const auto before = read.typedParameter<double>("level");
    before->addKeyFrame(RationalTime(3), 9.0, RationalTime(0));
    before->metaDataPtr()->addMetaData("stale", "yes");
    read.readParameterList(parameterList(written));

    const auto after = read.typedParameter<double>("level");
    EXPECT_TRUE(*after == *level);
    EXPECT_EQ(*after->keyframeTimes(), (std::vector<RationalTime>{RationalTime(5), RationalTime(10)}));
    EXPECT_EQ(after->generateMetaDataMap(), level->generateMetaDataMap());
    EXPECT_TRUE(*read.typedParameter<double>("pan") == *written.typedParameter<double>("pan"));
}

TEST(ParametricDocument, AParameterListThatFailsToReadChangesNothing) {
    Knob read(project);
    read.typedParameter<double>("level")->addKeyFrame(RationalTime(3), 9.0, RationalTime(0));
    const auto level = read.parameter("level");
    const Json::Value bad =
        parseJson(R"({"level": 0.5, "pan": {"keyframes": [{"time": 0, "value": "loud"}]}, "unknown": 1})");
    EXPECT_THROW(read.readParameterList(bad), ParserException);
    EXPECT_EQ(read.parameter("level"), level);
    EXPECT_EQ(level->numKeyFrames(), 2u);
    EXPECT_FALSE(read.hasMadeParameter("pan"));
    read.readParameterList(parseJson(R"({"level": 0.5, "unknown": 1})"));
    EXPECT_EQ(read.typedParameter<double>("level")->valueAtTime(RationalTime(3)), 0.5);
    EXPECT_FALSE(read.hasMadeParameter("unknown"));
}

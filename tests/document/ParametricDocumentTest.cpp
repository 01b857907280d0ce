#include "../JsonTestSupport.h"
#include "../time/TimeTestSupport.h"

#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <sstream>

using namespace VelaMediaLib;
using VelaMediaLib::testing::Knob;

namespace {

Json::Value parameterList(const Parametric& object) {
    std::ostringstream out;
    {
        XMLOptions options(out);
        JSONWriter root(options, 0);
        object.toJSONParameterList(options, root.memberLevel());
    }
    return VelaMediaLib::testing::parseJson(out.str())["parameters"];
}

class ParametricDocument : public ::testing::Test {
protected:
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    Knob written{project};
    Knob read{project};
};

} // namespace

// Each parameter is built from the document alone, whatever the object held.
TEST_F(ParametricDocument, ReadingAParameterListGivesBackExactlyTheWrittenCurves) {
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

TEST_F(ParametricDocument, AParameterListThatFailsToReadChangesNothing) {
    read.typedParameter<double>("level")->addKeyFrame(RationalTime(3), 9.0, RationalTime(0));
    const auto level = read.parameter("level");
    const Json::Value bad = VelaMediaLib::testing::parseJson(
        R"({"level": 0.5, "pan": {"keyframes": [{"time": 0, "value": "loud"}]}, "unknown": 1})");
    EXPECT_THROW(read.readParameterList(bad), ParserException);
    EXPECT_EQ(read.parameter("level"), level);
    EXPECT_EQ(level->numKeyFrames(), 2u);
    EXPECT_FALSE(read.hasMadeParameter("pan"));
    read.readParameterList(VelaMediaLib::testing::parseJson(R"({"level": 0.5, "unknown": 1})"));
    EXPECT_EQ(read.typedParameter<double>("level")->valueAtTime(RationalTime(3)), 0.5);
    EXPECT_FALSE(read.hasMadeParameter("unknown"));
}

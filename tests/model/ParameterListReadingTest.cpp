// Reading a document's parameter list into a clip keeps its parameter objects.
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <gtest/gtest.h>
#include <json/reader.h>

using namespace VelaMediaLib;

namespace {

struct Counter : Observer {
    int count = 0;
    void update(Observable*) override { ++count; }
};

class ParameterListReading : public ::testing::Test {
protected:
    ProjectPtr project = Project::create(30, 1);
    MediaPtr clip =
        PlaceholderMedia::createFromMediaRange(project->token(), project->editRateToken(), 0, 0, 10, 1);
    boost::shared_ptr<Parameter<double>> opacity = clip->typedParameter<double>("opacity");
    Counter parameterObserver, clipObserver;

    void SetUp() override {
        ASSERT_TRUE(opacity);
        opacity->attach(&parameterObserver);
        clip->attach(&clipObserver);
    }
    void TearDown() override {
        opacity->detach(&parameterObserver);
        clip->detach(&clipObserver);
    }
    static Json::Value parse(const std::string& text) {
        Json::Value value;
        EXPECT_TRUE(Json::Reader().parse(text, value));
        return value;
    }
};

} // namespace

// All or nothing first: a member that fails leaves every parameter as it was
// and tells nobody; then a read that succeeds keeps the objects and tells.
TEST_F(ParameterListReading, ParametersMadeKeepTheirObjectsAndHearOfTheRead) {
    opacity->setDefaultValue(0.75);
    parameterObserver.count = 0;
    EXPECT_THROW(clip->readParameterList(parse(R"({"opacity": 0.5, "scale": {"keyframes": 3}})")),
                 ParserException);
    EXPECT_EQ(opacity->valueAtTime(RationalTime(0)), 0.75);
    EXPECT_FALSE(clip->hasMadeParameter("scale"));
    EXPECT_EQ(parameterObserver.count + clipObserver.count, 0);

    clip->readParameterList(parse(R"({"opacity": {"keyframes": [
        {"endTime": 0, "duration": 0, "value": 0.5}, {"endTime": 6, "duration": 0, "value": 0.25}]},
        "rotation": [0.0, 0.0, 2.0]})"));
    EXPECT_EQ(clip->parameter("opacity"), opacity);
    EXPECT_EQ(opacity->numKeyFrames(), 2u);
    EXPECT_EQ(opacity->valueAtTime(RationalTime(0)), 0.5);
    EXPECT_EQ(opacity->valueAtTime(RationalTime(6)), 0.25);
    EXPECT_EQ(parameterObserver.count, 1);
    EXPECT_EQ(clipObserver.count, 1);
    EXPECT_TRUE(clip->hasMadeParameter("rotation")); // not made before: made by the read
}

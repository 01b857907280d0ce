// Callouts and captions: their text and captions as keyframed parameters,
// their own settings, clones, dispatch, their document members, and the
// static editor on a project's track.
#include "../JsonTestSupport.h"
#include "MediaTestSupport.h"

#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/model/media/Callout.h>
#include <VelaMediaLib/model/media/Caption.h>
#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

#include <limits>
#include <sstream>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class VisualContent : public ModelTest {
protected:
    boost::shared_ptr<Callout> callout = Callout::create(project, rate, 0, 100, TextAttributeList("Hello"));
    boost::shared_ptr<Caption> caption = Caption::create(project, rate, 0, 100, CaptionData("hi", "en"));
};

Json::Value written(const Media& media) {
    std::ostringstream out;
    XMLOptions options(out);
    media.toJSON(options, 0);
    return parseJson(out.str());
}

} // namespace

TEST_F(VisualContent, CalloutTextKeyframesSurviveCloneAndStayApart) {
    const auto bare = Callout::create(project, rate, 0, 10);
    EXPECT_EQ(bare->text(), TextAttributeList());
    EXPECT_FALSE(bare->hasMadeParameter("text")); // asked without making it
    EXPECT_EQ(bare->parameterNames().size(), 9u);
    EXPECT_FALSE(callout->autoRotateText());
    callout->setAutoRotateText(true);
    callout->textParam()->addKeyFrame(RationalTime(10), TextAttributeList("World"), RationalTime(0));
    EXPECT_EQ(callout->textParam()->valueAtTime(RationalTime(9)), TextAttributeList("Hello")); // steps

    const auto copy = boost::dynamic_pointer_cast<Callout>(callout->clone());
    ASSERT_TRUE(copy);
    EXPECT_TRUE(copy->autoRotateText());
    EXPECT_EQ(copy->textParam()->numKeyFrames(), 2u);
    EXPECT_EQ(copy->textParam()->valueAtTime(RationalTime(10)), TextAttributeList("World"));
    copy->textParam()->changeKeyFrame(RationalTime(10), TextAttributeList("Copy"));
    copy->setAutoRotateText(false);
    EXPECT_EQ(callout->textParam()->valueAtTime(RationalTime(10)), TextAttributeList("World"));
    EXPECT_TRUE(callout->autoRotateText());
    callout->setText(TextAttributeList("Once")); // one keyframe left
    EXPECT_EQ(std::make_pair(callout->textParam()->numKeyFrames(), callout->text()),
              std::make_pair(size_t(1), TextAttributeList("Once")));
    EXPECT_EQ(copy->text(), TextAttributeList("Hello"));
}

TEST_F(VisualContent, CaptionSettingsAndCaptionsSurviveClone) {
    EXPECT_EQ(std::make_pair(caption->maxMediaDuration(), caption->allowTrimOut()),
              std::make_pair(std::numeric_limits<long long>::max(), true));
    caption->captionParam()->addKeyFrame(RationalTime(40), CaptionData("bye", "en"), RationalTime(0));
    Counter counter;
    caption->attach(&counter);
    caption->setMaxMediaDuration(300);
    caption->setMaxMediaDuration(300); // the same: tells nobody
    caption->setAllowTrimOut(false);
    try {
        caption->setMaxMediaDuration(0);
        ADD_FAILURE() << "no exception";
    } catch (const ValueException<long long>& e) {
        EXPECT_EQ(std::make_pair(std::string(e.what()), e.value()),
                  std::make_pair(std::string("caption max media duration must be greater than 0"), 0LL));
    }
    caption->detach(&counter);
    EXPECT_EQ(counter.count, 2);
    EXPECT_EQ(caption->maxMediaDuration(), 300);

    const auto copy = boost::dynamic_pointer_cast<Caption>(caption->clone());
    ASSERT_TRUE(copy);
    EXPECT_EQ(std::make_pair(copy->maxMediaDuration(), copy->allowTrimOut()), std::make_pair(300LL, false));
    EXPECT_EQ(copy->captionAtTime(RationalTime(39)), CaptionData("hi", "en"));
    EXPECT_EQ(copy->captionAtTime(RationalTime(40)), CaptionData("bye", "en"));
    copy->setCaption(CaptionData("other"));
    copy->setMaxMediaDuration(20);
    EXPECT_EQ(caption->captionAtTime(RationalTime(40)), CaptionData("bye", "en"));
    EXPECT_EQ(caption->maxMediaDuration(), 300);
}

// A caption's settings are members of its object; a callout's rotation is an attribute.
TEST_F(VisualContent, DocumentsCarryTheKindsAndTheirSettings) {
    caption->setMaxMediaDuration(300);
    const Json::Value captionDoc = written(*caption), calloutDoc = written(*callout);
    EXPECT_EQ(captionDoc["_type"].asString(), "Caption");
    EXPECT_EQ(captionDoc["maxMediaDuration"].asInt64(), 300);
    EXPECT_TRUE(captionDoc["allowTrimOut"].asBool());
    EXPECT_FALSE(captionDoc["attributes"].isMember("maxMediaDuration"));
    EXPECT_EQ(captionDoc["parameters"]["caption"]["text"].asString(), "hi");
    EXPECT_EQ(calloutDoc["_type"].asString(), "Callout");
    EXPECT_FALSE(calloutDoc["attributes"]["autoRotateText"].asBool());
    EXPECT_TRUE(calloutDoc["attributes"].isMember("autoRotateText"));
    EXPECT_EQ(calloutDoc["parameters"]["text"]["textAttributeList"]["text"].asString(), "Hello");
}

TEST_F(VisualContent, EachKindDispatchesToItsOwnOperation) {
    EXPECT_EQ(MediaTypeFromMediaDispatcher::typeOf(*callout), "Callout");
    EXPECT_EQ(MediaTypeFromMediaDispatcher::typeOf(*caption), "Caption");
    struct Kinds : MediaDispatcher {
        std::string seen;
        void dispatchCallout(Callout& media) override { seen += "callout:" + media.text().text() + " "; }
        void dispatchCaption(Caption& media) override {
            seen += "caption:" + media.captionAtTime(RationalTime(0)).text + " ";
        }
    } kinds;
    callout->dispatch(kinds);
    caption->dispatch(kinds);
    EXPECT_EQ(kinds.seen, "callout:Hello caption:hi ");
    struct Others : ConstMediaDispatcher {
        int any = 0;
        void dispatchAnyMedia(const Media&) override { ++any; }
    } others; // kinds it does not handle fall through
    callout->dispatch(others);
    caption->dispatch(others);
    EXPECT_EQ(others.any, 2);
}

// Generated content has no media to run out of: on a track, either end extends as far as asked.
TEST(VisualContentOnATrack, StaticEditorExtendsWithoutLimit) {
    const ProjectPtr project = Project::create(30, 1);
    const TimelinePtr timeline = project->timeline();
    const auto track = timeline->newTrack();
    timeline->addTrack(timeline->newMixer("main"), track);
    const MediaPtr callout = Callout::create(project->token(), project->editRateToken(), 0, 50);
    const MediaPtr caption = Caption::create(project->token(), project->editRateToken(), 0, 10);
    track->addMedia(callout, 1000);
    track->addMedia(caption, 2000);
    const VelaTime kMin = std::numeric_limits<long long>::min();
    for (const MediaPtr& media : {callout, caption})
        EXPECT_EQ(Range<VelaTime>(media->trimStartLimit(), media->trimEndLimit()),
                  Range<VelaTime>(kMin, kMin));
    callout->trimStart(-1000);
    caption->trimEnd(-100000);
    EXPECT_EQ(callout->trackRange(), Range<VelaTime>(0, 1050));
    EXPECT_EQ(caption->trackRange(), Range<VelaTime>(2000, 100010));
    EXPECT_EQ(track->mediaAtTime(50000).first, caption);
    callout->trimEnd(1049);
    EXPECT_EQ(callout->trackRange(), Range<VelaTime>(0, 1));
    EXPECT_FALSE(callout->validTrimEnd(1));
}

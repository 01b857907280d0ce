#include "../JsonTestSupport.h"
#include "MediaTestSupport.h"

#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/model/media/ColorMedia.h>
#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/time/parameters/ParameterImpl.h>

#include <cmath>
#include <gtest/gtest.h>
#include <json/reader.h>
#include <sstream>
#include <thread>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

struct NamedEffect : Effect {
    explicit NamedEffect(std::string name_) : name(std::move(name_)) {}
    std::string effectName() const override { return name; }
    boost::shared_ptr<Effect> cloneEffect() const override { return boost::make_shared<NamedEffect>(name); }
    std::string name;
};

class MediaContent : public ::testing::Test {
protected:
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
    boost::shared_ptr<PlaceholderMedia> media =
        PlaceholderMedia::create(project, rate, 100, 50, 640, 480, "intro");
};

void expectPoint(const Point3d& actual, const Point3d& expected) {
    EXPECT_NEAR(actual.x, expected.x, 1e-9);
    EXPECT_NEAR(actual.y, expected.y, 1e-9);
    EXPECT_NEAR(actual.z, expected.z, 1e-9);
}

} // namespace

TEST_F(MediaContent, ParametersAreMadeWhenFirstAskedFor) {
    EXPECT_EQ(media->parameterNames().size(), 8u);
    EXPECT_FALSE(media->hasMadeParameter("opacity"));
    EXPECT_EQ(media->transformAtTime(RationalTime(0)), TransformMatrix());
    EXPECT_FALSE(media->hasMadeParameter("scale"));
    EXPECT_EQ(media->opacity()->valueAtTime(RationalTime(3)), 1.0);
    EXPECT_TRUE(media->hasMadeParameter("opacity"));
    EXPECT_EQ(media->opacity(), media->opacity());
    EXPECT_EQ(media->scale()->valueAtTime(RationalTime(0)), Point3d(1, 1, 1));
    EXPECT_FALSE(media->parameter("nonsense"));
    EXPECT_EQ(media->paramWithFullyQualifiedName("opacity"), media->opacity());
}

TEST_F(MediaContent, TransformsComposeTheParametersAtParametricTime) {
    media->scale()->setDefaultValue(Point3d(2, 2, 1));
    media->anchor()->setDefaultValue(Point3d(1, 1, 0));
    media->translation()->addKeyFrame(RationalTime(10), Point3d(10, 0, 0), RationalTime(0));
    // translate (5,0) * scale 2 * translate(-anchor): (3,1) -> (2,0) -> (4,0) -> (9,0) at parametric 5.
    expectPoint(media->transformAtTime(RationalTime(5)).apply(Point3d(3, 1, 0)), Point3d(9, 0, 0));
    // The clip starts at tick 100: global 105 is parametric 5.
    EXPECT_EQ(media->fromGlobalToParametricTime(RationalTime(105)), RationalTime(5));
    EXPECT_EQ(media->clippingFromGlobalToParametricTime(RationalTime(500)), RationalTime(50));
    expectPoint(media->mediaToModelTransformAtGlobalTime(RationalTime(105)).apply(Point3d(3, 1, 0)),
                Point3d(9, 0, 0));
    media->rotation()->setDefaultValue(Point3d(0, 0, M_PI / 2));
    expectPoint(
        media->calcTransformAtTimeWithScale(RationalTime(0), Point3d(1, 1, 1)).apply(Point3d(2, 1, 0)),
        Point3d(0, 1, 0)); // (1,0) turned a quarter
    expectPoint(
        media->calcTransformAtTimeWithTranslation(RationalTime(0), Point3d(0, 0, 7)).apply(Point3d(1, 1, 0)),
        Point3d(0, 0, 7));
    const auto scaleAndRotation = media->mediaToModelScaleAndRotation(RationalTime(100));
    EXPECT_EQ(scaleAndRotation.first, Point3d(2, 2, 1));
    EXPECT_EQ(scaleAndRotation.second, Point3d(0, 0, M_PI / 2));
    media->geometryCropParam()->setDefaultValue(Rect<float>(1, 2, 3, 4));
    EXPECT_EQ(media->geometryCropRectAtTime(RationalTime(0)), Rect<float>(1, 2, 3, 4));
    EXPECT_EQ(media->sourceCropRectAtTime(RationalTime(0)), Rect<float>(0, 0, 0, 0));
}

TEST_F(MediaContent, EffectsKeepTheirOrder) {
    media->addEffect(boost::make_shared<NamedEffect>("blur"));
    media->addEffect(boost::make_shared<NamedEffect>("tint"));
    media->insertEffect(boost::make_shared<NamedEffect>("blur"), 1);
    struct Counter : Observer {
        int heard = 0;
        void update(Observable*) override { ++heard; }
    } counter;
    media->attach(&counter);
    media->swapEffectOrder(1, 1); // changes nothing: tells nobody
    EXPECT_EQ(counter.heard, 0);
    media->swapEffectOrder(0, 2);
    EXPECT_EQ(counter.heard, 1);
    media->detach(&counter);
    EXPECT_EQ(media->effectAtIndex(0)->effectName(), "tint");
    EXPECT_EQ(media->effectsWithName("blur").size(), 2u);
    EXPECT_EQ(std::distance(media->effectBegin(), media->effectEnd()), 3);
    {
        ScopedWriteLock lock(project); // the list itself, changed in place
        *std::next(media->effectBegin()) = boost::make_shared<NamedEffect>("sharpen");
    }
    EXPECT_EQ(media->effectAtIndex(1)->effectName(), "sharpen");
    media->swapEffectOrder(1, 2);
    EXPECT_EQ(media->effectAtIndex(2)->effectName(), "sharpen");
    EXPECT_THROW(media->effectAtIndex(3), IndexException);
    EXPECT_THROW(media->insertEffect(boost::make_shared<NamedEffect>("x"), 5), IndexException);
    EXPECT_THROW(media->swapEffectOrder(0, 9), IndexException);
    EXPECT_TRUE(media->removeEffect(media->effectAtIndex(1)));
    EXPECT_FALSE(media->removeEffect(boost::make_shared<NamedEffect>("tint")));
    EXPECT_EQ(media->numEffects(), 2u);
    EXPECT_FALSE(media->supportsPerCharacterEffects());
}

TEST_F(MediaContent, AudioFadesAreEdgeModifications) {
    auto audio = boost::make_shared<TestAudioClip>(project, timing(0, 100, 0, 100, 1, 0, 100));
    audio->addAudioFadeEdgeMods(10, 20);
    EXPECT_EQ(audio->leftEdgeModificationLength(), 10);
    EXPECT_EQ(audio->rightEdgeModificationLength(), 20);
    EXPECT_EQ(audio->edgeModGroupNames(), std::set<std::string>{"audioFade"});
    EXPECT_EQ(audio->leftEdgeModifications()[0]->functionName(), "FadeToValueFunc");
    audio->addAudioFadeEdgeMods(5, 0);
    EXPECT_EQ(audio->leftEdgeModifications().size(), 1u);
    EXPECT_EQ(audio->leftEdgeModificationLength(), 5);
    EXPECT_TRUE(audio->rightEdgeModifications().empty());
    audio->setLeftEdgeModificationLength(8);
    EXPECT_EQ(audio->leftEdgeModificationLength(), 8);
    EXPECT_EQ(audio->volume()->valueAtTime(RationalTime(0)), 1.0);
    EXPECT_EQ(audio->gain()->value(), 1.0);
    EXPECT_FALSE(audio->mixToMono()->value());
    EXPECT_FALSE(audio->hasCaptions());
    audio->setCaptions({CaptionData("hello", "en")});
    EXPECT_TRUE(audio->hasCaptions());
    EXPECT_EQ(audio->captions(), std::vector<CaptionData>{CaptionData("hello", "en")});
    audio->mixToMono()->setValue(true);
    EXPECT_TRUE(audio->attributeValue("mixToMono", false));
}

TEST_F(MediaContent, ClonesCarryContentButNotPlacementOrIdentity) {
    media->setIdentifier("Intro");
    media->opacity()->addKeyFrame(RationalTime(10), 0.5, RationalTime(0));
    media->addEffect(boost::make_shared<NamedEffect>("blur"));
    media->addMetaData("origin", "test");
    media->setLeftTransition(TransitionPtr(new Transition("fade", 5)));
    boost::static_pointer_cast<ParameterImpl<double>>(media->opacity())->setValueBounds(0.0, 1.0, 1.0);
    const auto copy = boost::dynamic_pointer_cast<PlaceholderMedia>(media->clone());
    media->setupSharedClone(copy);
    EXPECT_TRUE(copy->state() == media->state());
    EXPECT_NE(copy->xmlIdent(), media->xmlIdent());
    EXPECT_EQ(copy->identifier(), "Intro");
    EXPECT_EQ(copy->note(), "intro");
    EXPECT_EQ(copy->width(), 640);
    EXPECT_EQ(copy->metaDataValue("origin"), "test");
    EXPECT_EQ(copy->numEffects(), 1u);
    EXPECT_NE(copy->effectAtIndex(0), media->effectAtIndex(0));
    EXPECT_FALSE(copy->leftTransition());
    EXPECT_EQ(copy->opacity()->valueAtTime(RationalTime(10)), 0.5);
    EXPECT_TRUE(copy->opacity()->hasValueBounds());
    copy->opacity()->changeKeyFrame(RationalTime(10), 0.25);
    EXPECT_EQ(media->opacity()->valueAtTime(RationalTime(10)), 0.5);
    copy->trimEnd(10);
    EXPECT_EQ(media->duration(), 50);
}

TEST_F(MediaContent, DispatchersNameKindsAndKeysMakeAttributes) {
    EXPECT_EQ(MediaTypeFromMediaDispatcher::typeOf(*media), "PlaceholderMedia");
    auto colour = ColorMedia::create(project, rate, 0, 10, TemplatedColor<int>(255, 0, 0, 255));
    EXPECT_EQ(MediaTypeFromMediaDispatcher::typeOf(*colour), "ColorMedia");
    EXPECT_EQ(colour->color(), TemplatedColor<int>(255, 0, 0, 255));
    struct Counter : MediaDispatcher {
        int placeholders = 0, others = 0;
        void dispatchPlaceholderMedia(PlaceholderMedia&) override { ++placeholders; }
        void dispatchAnyMedia(Media&) override { ++others; }
    } counter;
    media->dispatch(counter);
    colour->dispatch(counter);
    EXPECT_EQ(counter.placeholders, 1);
    EXPECT_EQ(counter.others, 1);

    EXPECT_FALSE(Media::clipSpeedAttributeForMedia(*media)->value());
    Media::clipSpeedAttributeForMedia(*media)->setValue(true);
    EXPECT_TRUE(media->attributeValue(Media::clipSpeedMetaDataKey(), false));
    Media::voxaneLinkedSessionAttributeForMedia(*media)->setValue("session-1");
    EXPECT_EQ(media->attributeValue<std::string>("voxaneLinkedSession", ""), "session-1");
    EXPECT_THROW(media->addAttribute<int>("note", 3), TypeException);
}

TEST_F(MediaContent, WrittenAsAMediaObject) {
    media->opacity()->setDefaultValue(0.5);
    std::ostringstream out;
    XMLOptions options(out);
    media->toJSON(options, 0);
    const Json::Value json = parseJson(out.str());
    EXPECT_EQ(json["id"].asInt(), 1);
    EXPECT_EQ(json["_type"].asString(), "PlaceholderMedia");
    EXPECT_EQ(json["attributes"]["note"].asString(), "intro");
    EXPECT_EQ(json["start"].asInt(), 100);
    EXPECT_EQ(json["mediaDuration"].asInt(), 50);
    EXPECT_EQ(json["parameters"]["opacity"].asDouble(), 0.5);
    EXPECT_FALSE(json["parameters"].isMember("scale")); // defaults not made are not written
}

TEST(MediaConcurrency, ReadersSeeWholeStatesWhileAWriterTrims) {
    const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    const auto media = PlaceholderMedia::create(project, boost::weak_ptr<ProjectEditRate>(), 0, 1000);
    std::atomic<bool> done{false};
    std::atomic<int> torn{0};
    std::vector<std::thread> readers;
    for (int i = 0; i < 2; ++i)
        readers.emplace_back([&] {
            while (!done.load()) {
                const MediaState state = media->state();
                if (state.start + state.duration != 1000 || state.mediaStart != SafeRational(state.start))
                    ++torn;
                media->validTrimStart(1);
                media->opacity()->valueAtTime(RationalTime(5));
            }
        });
    for (int i = 0; i < 2000; ++i) {
        media->trimStart(5);
        media->trimStart(-5);
    }
    done = true;
    for (std::thread& reader : readers) reader.join();
    EXPECT_EQ(torn.load(), 0);
}

#include "../JsonTestSupport.h"
#include "MediaTestSupport.h"

#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/model/media/ColorMedia.h>
#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/time/parameters/ParameterImpl.h>

#include <cmath>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

struct NamedEffect : Effect {
    explicit NamedEffect(std::string name_) : name(std::move(name_)) {}
    std::string effectName() const override { return name; }
    boost::shared_ptr<Effect> cloneEffect() const override { return boost::make_shared<NamedEffect>(name); }
    std::string name;
};

class MediaContent : public ModelTest {
protected:
    boost::shared_ptr<PlaceholderMedia> media =
        PlaceholderMedia::create(project, rate, 100, 50, 640, 480, "intro");
};

void expectPoint(const Point3d& actual, const Point3d& expected) {
    EXPECT_LT(std::abs(actual.x - expected.x) + std::abs(actual.y - expected.y) +
                  std::abs(actual.z - expected.z),
              1e-9);
}

} // namespace

TEST_F(MediaContent, ParametersAreMadeWhenFirstAskedFor) {
    EXPECT_EQ(media->parameterNames().size(), 8u);
    EXPECT_EQ(media->transformAtTime(RationalTime(0)), TransformMatrix()); // from defaults, making nothing
    EXPECT_FALSE(media->hasMadeParameter("opacity") || media->hasMadeParameter("scale"));
    EXPECT_EQ(media->opacity()->valueAtTime(RationalTime(3)), 1.0);
    EXPECT_TRUE(media->hasMadeParameter("opacity"));
    EXPECT_EQ(media->opacity(), media->opacity());
    EXPECT_EQ(media->paramWithFullyQualifiedName("opacity"), media->opacity());
    EXPECT_EQ(media->scale()->valueAtTime(RationalTime(0)), Point3d(1, 1, 1));
    EXPECT_FALSE(media->parameter("nonsense"));
}

TEST_F(MediaContent, TransformsComposeTheParametersAtParametricTime) {
    media->scale()->setDefaultValue(Point3d(2, 2, 1));
    media->anchor()->setDefaultValue(Point3d(1, 1, 0));
    media->translation()->addKeyFrame(RationalTime(10), Point3d(10, 0, 0), RationalTime(0));
    // translate (5,0) * scale 2 * translate(-anchor): (3,1) -> (2,0) -> (4,0) -> (9,0) at parametric 5.
    expectPoint(media->transformAtTime(RationalTime(5)).apply(Point3d(3, 1, 0)), Point3d(9, 0, 0));
    // The clip starts at tick 100: global 105 is parametric 5.
    expectPoint(media->mediaToModelTransformAtGlobalTime(RationalTime(105)).apply(Point3d(3, 1, 0)),
                Point3d(9, 0, 0));
    media->rotation()->setDefaultValue(Point3d(0, 0, M_PI / 2));
    const RationalTime zero(0);
    // (1,0) turned a quarter; then only the translation given.
    expectPoint(media->calcTransformAtTimeWithScale(zero, Point3d(1, 1, 1)).apply(Point3d(2, 1, 0)),
                Point3d(0, 1, 0));
    expectPoint(media->calcTransformAtTimeWithTranslation(zero, Point3d(0, 0, 7)).apply(Point3d(1, 1, 0)),
                Point3d(0, 0, 7));
    EXPECT_EQ(media->mediaToModelScaleAndRotation(RationalTime(100)),
              std::make_pair(Point3d(2, 2, 1), Point3d(0, 0, M_PI / 2)));
    media->geometryCropParam()->setDefaultValue(Rect<float>(1, 2, 3, 4));
    EXPECT_EQ(media->geometryCropRectAtTime(zero), Rect<float>(1, 2, 3, 4));
    EXPECT_EQ(media->sourceCropRectAtTime(zero), Rect<float>(0, 0, 0, 0));
}

TEST_F(MediaContent, EffectsKeepTheirOrder) {
    auto names = [&] {
        std::string all;
        for (size_t i = 0; i < media->numEffects(); ++i) all += media->effectAtIndex(i)->effectName() + " ";
        return all;
    };
    media->addEffect(boost::make_shared<NamedEffect>("blur"));
    media->addEffect(boost::make_shared<NamedEffect>("tint"));
    media->insertEffect(boost::make_shared<NamedEffect>("blur"), 1);
    Counter counter;
    media->attach(&counter);
    media->swapEffectOrder(1, 1); // changes nothing: tells nobody
    media->swapEffectOrder(0, 2);
    media->detach(&counter);
    EXPECT_EQ(counter.count, 1);
    EXPECT_EQ(names(), "tint blur blur ");
    EXPECT_EQ(media->effectsWithName("blur").size(), 2u);
    EXPECT_EQ(std::distance(media->effectBegin(), media->effectEnd()), 3);
    {
        ScopedWriteLock lock(project); // the list itself, changed in place
        *std::next(media->effectBegin()) = boost::make_shared<NamedEffect>("sharpen");
    }
    media->swapEffectOrder(1, 2);
    EXPECT_EQ(names(), "tint blur sharpen ");
    EXPECT_THROW(media->effectAtIndex(3), IndexException);
    EXPECT_THROW(media->insertEffect(boost::make_shared<NamedEffect>("x"), 5), IndexException);
    EXPECT_THROW(media->swapEffectOrder(0, 9), IndexException);
    EXPECT_TRUE(media->removeEffect(media->effectAtIndex(1)));
    EXPECT_FALSE(media->removeEffect(boost::make_shared<NamedEffect>("tint")));
    EXPECT_EQ(names(), "tint sharpen ");
    EXPECT_FALSE(media->supportsPerCharacterEffects());
}

TEST_F(MediaContent, AudioFadesAreEdgeModifications) {
    auto audio = boost::make_shared<TestAudioClip>(project, timing(0, 100, 0, 100, 1, 0, 100));
    auto lengths = [&] {
        return Range<VelaTime>(audio->leftEdgeModificationLength(), audio->rightEdgeModificationLength());
    };
    audio->addAudioFadeEdgeMods(10, 20);
    EXPECT_EQ(lengths(), Range<VelaTime>(10, 20));
    EXPECT_EQ(audio->edgeModGroupNames(), std::set<std::string>{"audioFade"});
    EXPECT_EQ(audio->leftEdgeModifications()[0]->functionName(), "FadeToValueFunc");
    audio->addAudioFadeEdgeMods(5, 0); // replaces both fades
    EXPECT_EQ(audio->leftEdgeModifications().size() + audio->rightEdgeModifications().size(), 1u);
    EXPECT_EQ(lengths(), Range<VelaTime>(5, 0));
    audio->setLeftEdgeModificationLength(8);
    EXPECT_EQ(lengths(), Range<VelaTime>(8, 0));
    EXPECT_EQ(std::make_tuple(audio->volume()->valueAtTime(RationalTime(0)), audio->gain()->value(),
                              audio->mixToMono()->value(), audio->hasCaptions()),
              std::make_tuple(1.0, 1.0, false, false));
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
    EXPECT_EQ(std::make_tuple(copy->identifier(), copy->note(), copy->width(), copy->metaDataValue("origin")),
              std::make_tuple("Intro", "intro", 640, "test"));
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
    struct Kinds : MediaDispatcher {
        std::string seen;
        void dispatchPlaceholderMedia(PlaceholderMedia&) override { seen += "placeholder "; }
        void dispatchAnyMedia(Media&) override { seen += "other "; }
    } kinds;
    media->dispatch(kinds);
    colour->dispatch(kinds);
    EXPECT_EQ(kinds.seen, "placeholder other ");
    EXPECT_FALSE(Media::clipSpeedAttributeForMedia(*media)->value());
    Media::clipSpeedAttributeForMedia(*media)->setValue(true);
    EXPECT_TRUE(media->attributeValue(Media::clipSpeedMetaDataKey(), false));
    Media::voxaneLinkedSessionAttributeForMedia(*media)->setValue("session-1");
    EXPECT_EQ(media->attributeValue<std::string>("voxaneLinkedSession", ""), "session-1");
}

// All or nothing first: a member that fails leaves every parameter as it was
// and tells nobody; then a read that succeeds keeps the objects and tells.
TEST(ParameterListReading, ParametersMadeKeepTheirObjectsAndHearOfTheRead) {
    const ProjectPtr project = Project::create(30, 1);
    const MediaPtr clip =
        PlaceholderMedia::createFromMediaRange(project->token(), project->editRateToken(), 0, 0, 10, 1);
    const auto opacity = clip->typedParameter<double>("opacity");
    opacity->setDefaultValue(0.75);
    Counter onParameter, onClip;
    opacity->attach(&onParameter);
    clip->attach(&onClip);
    EXPECT_THROW(clip->readParameterList(parseJson(R"({"opacity": 0.5, "scale": {"keyframes": 3}})")),
                 ParserException);
    EXPECT_EQ(opacity->valueAtTime(RationalTime(0)), 0.75);
    EXPECT_FALSE(clip->hasMadeParameter("scale"));
    EXPECT_EQ(onParameter.count + onClip.count, 0);
    clip->readParameterList(
        parseJson(R"({"opacity": {"keyframes": [{"endTime": 0, "duration": 0, "value": 0.5},
        {"endTime": 6, "duration": 0, "value": 0.25}]}, "rotation": [0.0, 0.0, 2.0]})"));
    opacity->detach(&onParameter);
    clip->detach(&onClip);
    EXPECT_EQ(clip->parameter("opacity"), opacity);
    EXPECT_EQ(opacity->numKeyFrames(), 2u);
    EXPECT_EQ(std::make_pair(opacity->valueAtTime(RationalTime(0)), opacity->valueAtTime(RationalTime(6))),
              std::make_pair(0.5, 0.25));
    EXPECT_EQ(std::make_pair(onParameter.count, onClip.count), std::make_pair(1, 1));
    EXPECT_TRUE(clip->hasMadeParameter("rotation")); // not made before: made by the read
}

// A visual and an audio clip bound into one clip: construction, timing that
// the parts follow, shared parameters, copies and copies of another source.
#include "MediaTestSupport.h"
#include "SourceTestSupport.h"

#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/model/media/AMFile.h>
#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/project/SourceBin.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>
#include <VelaMediaLib/time/rational/TimeExceptions.h>

#include <sstream>

namespace VelaMediaLib {
namespace testing {
namespace {

typedef boost::shared_ptr<UnifiedMedia> UnifiedPtr;

/// A visual clip whose copies carry its parameters, as every clip kind's do.
class CopyingClip : public TestClip {
public:
    CopyingClip(const boost::weak_ptr<const ThreadSafe>& token, const boost::weak_ptr<ProjectEditRate>& rate,
                const MediaState& state)
        : Media(token), VisualMedia(token), TestClip(token, rate, state, Temporal) {}
    boost::shared_ptr<Media> clone() const override {
        const auto copy = boost::make_shared<CopyingClip>(projectMutex(), projectEditRate(), state());
        copyContentInto(*copy);
        return copy;
    }
};

class UnifiedMediaTest : public ModelTest {
protected:
    // The video may play [0, 120], the sound [-10, 100]; the sound starts out on another slice.
    boost::shared_ptr<CopyingClip> visual =
        boost::make_shared<CopyingClip>(project, rate, timing(100, 60, 0, 60, 1, 0, 120));
    boost::shared_ptr<TestAudioClip> audio =
        boost::make_shared<TestAudioClip>(project, timing(7, 40, 5, 40, 1, -10, 100));
    boost::shared_ptr<GenericTrack> track = GenericTrack::create(project);

    UnifiedPtr unify() { return UnifiedMedia::create(visual, audio); }
    static MediaState part(VelaTime duration, SafeRational mediaStart, SafeRational scalar,
                           SafeRational minStart, SafeRational maxEnd) {
        return timing(0, duration, mediaStart, duration / scalar, scalar, minStart, maxEnd);
    }
};

TEST_F(UnifiedMediaTest, RefusesInOrderAndLeavesTheClipsWhereTheyWere) {
    expectThrows<VelaMediaLibException>("created a unified media without an audiomedia",
                                        [] { UnifiedMedia::create(nullptr, nullptr); });
    expectThrows<VelaMediaLibException>("created a unified media without an visualmedia",
                                        [&] { UnifiedMedia::create(nullptr, audio); });
    const auto other = GenericTrack::create(project);
    track->addMedia(audio, 0);
    other->addMedia(visual, 0);
    const MediaState audioBefore = audio->state(), visualBefore = visual->state();
    expectThrows<AddRemoveException>("unable to create unified media with audio media having a parent track",
                                     [&] { unify(); });
    EXPECT_EQ(audio->parentTrack(), track);
    EXPECT_TRUE(track->hasMedia(audio));
    EXPECT_EQ(audio->parentUnifiedMedia(), MediaPtr());
    EXPECT_EQ(audio->state(), audioBefore);
    track->removeMedia(audio);
    expectThrows<AddRemoveException>("unable to create unified media with video media having a parent track",
                                     [&] { unify(); });
    EXPECT_TRUE(other->hasMedia(visual));
    EXPECT_EQ(visual->state(), visualBefore);
    EXPECT_EQ(audio->state(), audioBefore);
    EXPECT_EQ(audio->parent(), nullptr);
}

TEST_F(UnifiedMediaTest, RefusesOneClipTwiceClipsTakenAndClipsOfTwoProjects) {
    const UnifiedPtr unified = unify();
    expectThrows<AddRemoveException>("a unified media needs two clips",
                                     [&] { UnifiedMedia::create(unified, unified); });
    const auto sound = boost::make_shared<TestAudioClip>(project, timing(0, 10, 0, 10, 1, 0, 10));
    expectThrows<AddRemoveException>("unable to create unified media with a clip inside another clip",
                                     [&] { UnifiedMedia::create(visual, sound); });
    const auto elsewhere =
        boost::make_shared<TestAudioClip>(boost::make_shared<ThreadSafe>(), sound->state());
    const auto picture = boost::make_shared<TestClip>(project, rate, sound->state(), MediaImpl::Temporal);
    expectThrows<AddRemoveException>("unable to create unified media with clips of two projects",
                                     [&] { UnifiedMedia::create(picture, elsewhere); });
    EXPECT_EQ(picture->parent(), nullptr);
    EXPECT_EQ(visual->parent(), unified);
}

TEST_F(UnifiedMediaTest, StandsWhereTheVisualClipStoodAndThePartsPlayItsSlice) {
    const UnifiedPtr unified = unify();
    EXPECT_EQ(unified->state(), timing(100, 60, 0, 60, 1, 0, 100)); // the limits both parts allow
    EXPECT_EQ(unified->internalVisualMedia(), visual);
    EXPECT_EQ(unified->internalAudioMedia(), audio);
    EXPECT_EQ(visual->state(), part(60, 0, 1, 0, 120));
    EXPECT_EQ(audio->state(), part(60, 0, 1, -10, 100));
    EXPECT_EQ(audio->parentUnifiedMedia(), unified);
    EXPECT_EQ(audio->parentTrack(), nullptr);
    EXPECT_EQ(visual->timeConverterParent(), unified);
    EXPECT_EQ(MediaTypeFromMediaDispatcher::typeOf(*unified), "UnifiedMedia");
    int visits = 0;
    unified->accessInternals(
        [&](const boost::shared_ptr<VisualMedia>& v, const boost::shared_ptr<AudioMedia>& a) {
            EXPECT_EQ(v, visual);
            EXPECT_EQ(a, audio);
            ++visits;
        });
    EXPECT_EQ(visits, 1);

    track->addMedia(unified, 30); // the parts' time is the unified clip's
    for (int global : {30, 45, 89})
        EXPECT_EQ(audio->fromGlobalToParametricTime(RationalTime(global)),
                  unified->fromGlobalToParametricTime(RationalTime(global)));
    EXPECT_EQ(visual->fromParametricToGlobalTime(RationalTime(5)), RationalTime(35));
}

TEST_F(UnifiedMediaTest, PartsFollowTrimsMovesStretchesAndRestores) {
    const UnifiedPtr unified = unify();
    track->addMedia(unified, 0);
    Counter told;
    visual->attach(&told);
    unified->trimStart(10);
    EXPECT_EQ(unified->state(), timing(10, 50, 10, 50, 1, 0, 100));
    EXPECT_EQ(visual->state(), part(50, 10, 1, 0, 120));
    EXPECT_EQ(audio->state(), part(50, 10, 1, -10, 100));
    EXPECT_EQ(told.count, 1);
    track->trimEnd(unified, -40); // out to the end of the sound
    EXPECT_EQ(audio->state(), part(90, 10, 1, -10, 100));
    unified->rationalStretch(SafeRational(3, 2));
    EXPECT_EQ(visual->state(), part(135, 10, SafeRational(3, 2), 0, 120));
    const UnifiedMediaState stretched = unified->unifiedMediaState();
    unified->move(5);
    EXPECT_EQ(unified->startTime(), 15);
    EXPECT_EQ(visual->state(), stretched.visual); // a move is the unified clip's alone
    unified->restoreState(timing(0, 60, 0, 60, 1, 0, 100), 0);
    EXPECT_EQ(visual->state(), part(60, 0, 1, 0, 120));
    EXPECT_EQ(audio->state(), part(60, 0, 1, -10, 100));
    visual->detach(&told);
}

TEST_F(UnifiedMediaTest, ATrimEitherPartRefusesIsRefusedAndChangesNothing) {
    const UnifiedPtr unified = unify();
    const UnifiedMediaState before = unified->unifiedMediaState();
    // The video could go on to 120; the sound ends at 100.
    const auto refused = [&](const char* what, const std::function<void()>& edit) {
        expectThrows<InvalidTrimRangeException>("invalid trim of unified media", edit);
        EXPECT_EQ(unified->unifiedMediaState(), before) << what;
    };
    refused("off a track", [&] { unified->trimEnd(-41); });
    refused("before the video's start", [&] { unified->trimStart(-1); });
    refused("all of it", [&] { unified->trimStart(60); });
    track->addMedia(unified, 100);
    refused("on a track", [&] { track->trimEnd(unified, -41); });
    EXPECT_TRUE(unified->validTrimEnd(-40));
    EXPECT_FALSE(unified->validTrimEnd(-41));
    unified->trimStart(0); // nothing to trim is no refusal
    EXPECT_EQ(unified->unifiedMediaState().unified.start, 100);
}

TEST_F(UnifiedMediaTest, ItsVisualParametersAndVolumeAreThePartsOwn) {
    visual->opacity()->addKeyFrame(RationalTime(10), 0.5, RationalTime(0)); // made before binding
    const UnifiedPtr unified = unify();
    EXPECT_EQ(unified->opacity(), visual->opacity());
    EXPECT_EQ(unified->calcTransformAtTime(RationalTime(0)), visual->calcTransformAtTime(RationalTime(0)));
    unified->volume()->addKeyFrame(RationalTime(4), 0.25, RationalTime(0));
    EXPECT_EQ(audio->volume()->valueAtTime(RationalTime(4)), 0.25);
    unified->scale()->setValueAtTime(Point3d(2, 2, 1), RationalTime(0));
    EXPECT_EQ(visual->scale()->valueAtTime(RationalTime(0)), Point3d(2, 2, 1));
}

TEST_F(UnifiedMediaTest, ClonesAreDeep) {
    const UnifiedPtr unified = unify();
    unified->opacity()->addKeyFrame(RationalTime(10), 0.5, RationalTime(0));
    unified->gain()->setValue(2.0);
    unified->trimEnd(20);
    const auto copy = boost::dynamic_pointer_cast<UnifiedMedia>(unified->clone());
    ASSERT_TRUE(copy);
    EXPECT_EQ(copy->unifiedMediaState(), unified->unifiedMediaState());
    EXPECT_NE(copy->internalVisualMedia(), visual);
    EXPECT_NE(copy->internalAudioMedia(), audio);
    EXPECT_EQ(copy->internalAudioMedia()->parentUnifiedMedia(), copy);
    EXPECT_EQ(copy->internalVisualMedia()->parent(), copy);
    EXPECT_EQ(copy->opacity(), copy->internalVisualMedia()->opacity());
    EXPECT_EQ(copy->opacity()->valueAtTime(RationalTime(10)), 0.5);
    EXPECT_EQ(copy->gain()->value(), 2.0);
    copy->opacity()->changeKeyFrame(RationalTime(10), 0.25);
    copy->trimStart(5);
    EXPECT_EQ(visual->opacity()->valueAtTime(RationalTime(10)), 0.5);
    EXPECT_EQ(visual->state(), part(40, 0, 1, 0, 120));
    EXPECT_EQ(copy->internalVisualMedia()->state(), part(35, 5, 1, 0, 120));
}

TEST_F(UnifiedMediaTest, ReleasedPartsGoTheirOwnWayUntilTakenBack) {
    const UnifiedPtr unified = unify();
    unified->releaseInternals();
    EXPECT_FALSE(unified->holdsInternals());
    EXPECT_EQ(audio->parentUnifiedMedia(), MediaPtr());
    EXPECT_EQ(visual->parent(), nullptr);
    unified->trimEnd(10);
    EXPECT_EQ(visual->duration(), 60);
    track->addMedia(visual, 0);
    expectThrows<AddRemoveException>("unable to create unified media with video media having a parent track",
                                     [&] { unified->adoptInternals(); });
    EXPECT_FALSE(unified->holdsInternals());
    track->removeMedia(visual);
    unified->adoptInternals();
    EXPECT_EQ(visual->state(), part(50, 0, 1, 0, 120));
    EXPECT_EQ(audio->parentUnifiedMedia(), unified);
}

TEST_F(UnifiedMediaTest, WritesItsPartsAsVideoAndAudio) {
    const UnifiedPtr unified = unify();
    std::ostringstream text;
    XMLOptions options(text);
    unified->toJSON(options, 0);
    const std::string written = text.str();
    EXPECT_NE(written.find("\"_type\" : \"UnifiedMedia\""), std::string::npos) << written;
    EXPECT_NE(written.find("\"video\" : {"), std::string::npos) << written;
    EXPECT_NE(written.find("\"audio\" : {"), std::string::npos) << written;
}

class UnifiedSourceTest : public ModelTest {
protected:
    UnifiedSourceTest() {
        loader->set("a.mov",
                    {stream(TrackType::Video, 0, 300, 30), stream(TrackType::Audio, 0, 480000, 48000, 2)});
        loader->set("b.mov",
                    {stream(TrackType::Video, 0, 600, 30), stream(TrackType::Audio, 0, 960000, 48000, 2)});
        loader->set("voice.wav", {stream(TrackType::Audio, 0, 48000, 48000, 1)});
    }
    UnifiedPtr unifiedOf(const SourcePtr& source) {
        return UnifiedMedia::create(VMFile::create(source, 0, 0), AMFile::create(source, 1, 0));
    }

    RegisteredTableLoader loader;
    boost::shared_ptr<SourceBin> bin = boost::make_shared<SourceBin>(project, rate);
};

TEST_F(UnifiedSourceTest, ACopyPlaysAnotherSourceWithItsLimits) {
    const SourcePtr a = bin->loadFile("a.mov"), b = bin->loadFile("b.mov");
    const UnifiedPtr unified = unifiedOf(a);
    unified->trimEnd(100);
    const UnifiedPtr copy = unified->cloneWithSource(b);
    const auto sourceOf = [](const boost::shared_ptr<Media>& part) {
        return boost::dynamic_pointer_cast<FileMedia>(part)->source();
    };
    EXPECT_EQ(sourceOf(copy->internalVisualMedia()), b);
    EXPECT_EQ(sourceOf(copy->internalAudioMedia()), b);
    EXPECT_EQ(sourceOf(unified->internalVisualMedia()), a);
    EXPECT_EQ(copy->state().mediaRange(), unified->state().mediaRange());
    EXPECT_EQ(copy->maxRationalMediaEnd(), SafeRational(600)); // b's streams are 20 s long
    EXPECT_EQ(unified->maxRationalMediaEnd(), SafeRational(300));
    copy->trimEnd(-400);
    EXPECT_EQ(copy->internalAudioMedia()->duration(), 600);
}

TEST_F(UnifiedSourceTest, ASourceEitherPartCannotPlayIsRefused) {
    const SourcePtr a = bin->loadFile("a.mov"), voice = bin->loadFile("voice.wav");
    const UnifiedPtr unified = unifiedOf(a);
    EXPECT_THROW(unified->cloneWithSource(voice), TypeException); // no video stream 0, no stream 1
    auto otherProject = boost::make_shared<ThreadSafe>();
    SourceBin otherBin(otherProject, rate);
    EXPECT_THROW(unified->cloneWithSource(otherBin.loadFile("b.mov")), AddRemoveException);
    EXPECT_THROW(unified->cloneWithSource(SourcePtr()), VelaMediaLibException);
    const auto sound = boost::make_shared<TestAudioClip>(project, timing(0, 10, 0, 10, 1, 0, 10));
    const auto picture = boost::make_shared<TestClip>(project, rate, sound->state(), MediaImpl::Temporal);
    expectThrows<TypeException>("a unified media without file clips plays no source",
                                [&] { UnifiedMedia::create(picture, sound)->cloneWithSource(a); });
}

} // namespace
} // namespace testing
} // namespace VelaMediaLib

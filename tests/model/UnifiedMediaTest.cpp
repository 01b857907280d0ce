// A visual and an audio clip bound into one clip: construction, timing that
// the parts follow, shared parameters, copies and copies of another source.
#include "MediaTestSupport.h"
#include "SourceTestSupport.h"

#include <VelaMediaLib/model/media/AMFile.h>
#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/project/SourceBin.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>
#include <VelaMediaLib/time/rational/TimeExceptions.h>

namespace VelaMediaLib {
namespace testing {
namespace {

typedef boost::shared_ptr<UnifiedMedia> UnifiedPtr;

/// A visual clip whose copies carry its parameters, as every clip kind's do.
class CopyingClip : public TestClip {
public:
    CopyingClip(const boost::weak_ptr<const ThreadSafe>& token, const MediaState& state)
        : Media(token), VisualMedia(token),
          TestClip(token, boost::weak_ptr<ProjectEditRate>(), state, Temporal) {}
    boost::shared_ptr<Media> clone() const override {
        const auto copy = boost::make_shared<CopyingClip>(projectMutex(), state());
        copyContentInto(*copy);
        return copy;
    }
};

class UnifiedMediaTest : public ModelTest {
protected:
    // The video may play [0, 120], the sound [-10, 100]; the sound starts out on another slice.
    boost::shared_ptr<CopyingClip> visual =
        boost::make_shared<CopyingClip>(project, timing(100, 60, 0, 60, 1, 0, 120));
    boost::shared_ptr<TestAudioClip> audio =
        boost::make_shared<TestAudioClip>(project, timing(7, 40, 5, 40, 1, -10, 100));
    boost::shared_ptr<GenericTrack> track = GenericTrack::create(project);

    UnifiedPtr unify() { return UnifiedMedia::create(visual, audio); }
    // A part plays the unified clip's slice from 0 in its time, within its own limits:
    // the video's, [0, 120], or the sound's, [-10, 100].
    static MediaState part(VelaTime duration, SafeRational mediaStart, SafeRational scalar,
                           SafeRational maxEnd) {
        return timing(0, duration, mediaStart, duration / scalar, scalar, maxEnd == 100 ? -10 : 0, maxEnd);
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
    EXPECT_EQ(audio->parentUnifiedMedia(), MediaPtr());
    track->removeMedia(audio);
    expectThrows<AddRemoveException>("unable to create unified media with video media having a parent track",
                                     [&] { unify(); });
    EXPECT_TRUE(other->hasMedia(visual));
    EXPECT_EQ(visual->state(), visualBefore);
    EXPECT_EQ(audio->state(), audioBefore);
    other->removeMedia(visual);

    const UnifiedPtr unified = unify();
    expectThrows<AddRemoveException>("a unified media needs two clips",
                                     [&] { UnifiedMedia::create(unified, unified); });
    const auto sound = boost::make_shared<TestAudioClip>(project, timing(0, 10, 0, 10, 1, 0, 10));
    expectThrows<AddRemoveException>("unable to create unified media with a clip inside another clip",
                                     [&] { UnifiedMedia::create(visual, sound); });
    const auto elsewhere = boost::make_shared<ThreadSafe>();
    expectThrows<AddRemoveException>("unable to create unified media with clips of two projects", [&] {
        UnifiedMedia::create(boost::make_shared<CopyingClip>(elsewhere, sound->state()), sound);
    });
    EXPECT_EQ(sound->parent(), nullptr);
}

TEST_F(UnifiedMediaTest, PartsFollowEveryEditInTheUnifiedClipsTime) {
    const UnifiedPtr unified = unify();
    EXPECT_EQ(unified->state(), timing(100, 60, 0, 60, 1, 0, 100)); // the limits both parts allow
    EXPECT_EQ(audio->state(), part(60, 0, 1, 100));
    EXPECT_EQ(audio->parentUnifiedMedia(), unified);
    EXPECT_EQ(audio->parentTrack(), nullptr);
    EXPECT_EQ(MediaTypeFromMediaDispatcher::typeOf(*unified), "UnifiedMedia");
    unified->accessInternals(
        [&](const boost::shared_ptr<VisualMedia>& v, const boost::shared_ptr<AudioMedia>& a) {
            EXPECT_EQ(std::make_pair(v, a),
                      std::make_pair(unified->internalVisualMedia(), unified->internalAudioMedia()));
            EXPECT_EQ(v, visual);
        });

    track->addMedia(unified, 0);
    Counter told;
    visual->attach(&told);
    unified->trimStart(10);
    EXPECT_EQ(unified->state(), timing(10, 50, 10, 50, 1, 0, 100));
    EXPECT_EQ(visual->state(), part(50, 10, 1, 120));
    EXPECT_EQ(told.count, 1);
    track->trimEnd(unified, -40); // out to the end of the sound
    EXPECT_EQ(audio->state(), part(90, 10, 1, 100));
    unified->rationalStretch(SafeRational(3, 2));
    EXPECT_EQ(visual->state(), part(135, 10, SafeRational(3, 2), 120));
    const MediaState stretched = visual->state();
    unified->move(5); // the unified clip's alone
    EXPECT_EQ(visual->state(), stretched);
    EXPECT_EQ(audio->fromGlobalToParametricTime(RationalTime(40)), RationalTime(25));
    EXPECT_EQ(visual->fromParametricToGlobalTime(RationalTime(5)), RationalTime(20));
    unified->restoreState(timing(0, 60, 0, 60, 1, 0, 100), 0);
    EXPECT_EQ(audio->state(), part(60, 0, 1, 100));
    visual->detach(&told);
}

TEST_F(UnifiedMediaTest, ATrimEitherPartRefusesIsRefusedAndChangesNothing) {
    const UnifiedPtr unified = unify();
    const UnifiedMediaState before = unified->unifiedMediaState();
    const auto refused = [&](const std::function<void()>& edit) {
        expectThrows<InvalidTrimRangeException>("invalid trim of unified media", edit);
        EXPECT_EQ(unified->unifiedMediaState(), before);
    };
    refused([&] { unified->trimEnd(-41); }); // the video could go on; the sound ends at 100
    refused([&] { unified->trimStart(-1); });
    refused([&] { unified->trimStart(60); });
    track->addMedia(unified, 100);
    refused([&] { track->trimEnd(unified, -41); });
}

TEST_F(UnifiedMediaTest, ClonesAreDeepAndItsParametersAreThePartsOwn) {
    visual->opacity()->addKeyFrame(RationalTime(10), 0.5, RationalTime(0)); // made before binding
    const UnifiedPtr unified = unify();
    EXPECT_EQ(unified->opacity(), visual->opacity());
    unified->volume()->addKeyFrame(RationalTime(4), 0.25, RationalTime(0));
    EXPECT_EQ(audio->volume()->valueAtTime(RationalTime(4)), 0.25);
    unified->trimEnd(20);

    const auto copy = boost::dynamic_pointer_cast<UnifiedMedia>(unified->clone());
    EXPECT_EQ(copy->unifiedMediaState(), unified->unifiedMediaState());
    EXPECT_NE(copy->internalVisualMedia(), visual);
    EXPECT_EQ(copy->internalAudioMedia()->parentUnifiedMedia(), copy);
    EXPECT_EQ(copy->opacity(), copy->internalVisualMedia()->opacity());
    EXPECT_EQ(copy->opacity()->valueAtTime(RationalTime(10)), 0.5);
    copy->opacity()->changeKeyFrame(RationalTime(10), 0.25);
    copy->trimStart(5);
    EXPECT_EQ(visual->opacity()->valueAtTime(RationalTime(10)), 0.5);
    EXPECT_EQ(visual->state(), part(40, 0, 1, 120));
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
    RegisteredTableLoader loader;
    boost::shared_ptr<SourceBin> bin = boost::make_shared<SourceBin>(project, rate);
};

TEST_F(UnifiedSourceTest, ACopyPlaysAnotherSourceItsPartsCanPlay) {
    const SourcePtr a = bin->loadFile("a.mov"), b = bin->loadFile("b.mov");
    const UnifiedPtr unified = UnifiedMedia::create(VMFile::create(a, 0, 0), AMFile::create(a, 1, 0));
    unified->trimEnd(100);
    const UnifiedPtr copy = unified->cloneWithSource(b);
    const auto sourceOf = [](const MediaPtr& part) {
        return boost::dynamic_pointer_cast<FileMedia>(part)->source();
    };
    EXPECT_EQ(sourceOf(copy->internalAudioMedia()), b);
    EXPECT_EQ(sourceOf(unified->internalAudioMedia()), a);
    EXPECT_EQ(copy->state().mediaRange(), unified->state().mediaRange());
    copy->trimEnd(-400); // b is 20 s long
    EXPECT_EQ(copy->internalVisualMedia()->duration(), 600);

    EXPECT_THROW(unified->cloneWithSource(bin->loadFile("voice.wav")), TypeException); // no video stream
    const auto otherProject = boost::make_shared<ThreadSafe>();
    EXPECT_THROW(unified->cloneWithSource(SourceBin(otherProject, rate).loadFile("b.mov")),
                 AddRemoveException);
    EXPECT_EQ(unified->maxRationalMediaEnd(), SafeRational(300));
}

} // namespace
} // namespace testing
} // namespace VelaMediaLib

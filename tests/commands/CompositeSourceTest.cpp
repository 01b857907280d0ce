// Composites and sources: refits reach clips inside composites, taking
// composites apart undoes exactly, and a clip answers with its outermost track.
#include "../model/SourceTestSupport.h"
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/GroupCmd.h>
#include <VelaMediaLib/commands/edits/StitchMediaCmd.h>
#include <VelaMediaLib/commands/edits/UnGroupCmd.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/commands/edits/SeparateVideoAudioCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/model/media/AMFile.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/time/sync/LambdaObserverWithoutNotifyDelay.h>
#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

#include <gtest/gtest.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class CompositeSourceTest : public ::testing::Test {
protected:
    CompositeSourceTest() {
        loader->set("a.mov",
                    {stream(TrackType::Video, 0, 3000, 600), stream(TrackType::Audio, 0, 48000, 48000, 2)});
        loader->set("longer.mov",
                    {stream(TrackType::Video, 0, 6000, 600), stream(TrackType::Audio, 0, 480000, 48000, 2)});
        project->sourceBin()->setFileSystem(files);
        project->timeline()->addTrack(project->newMixer("main"), track);
    }
    RegisteredTableLoader loader;
    boost::shared_ptr<FakeFileSystem> files = boost::make_shared<FakeFileSystem>();
    ProjectPtr project = Project::create(30, 1);
    boost::shared_ptr<GenericTrack> track = project->timeline()->newTrack();
};

// A refit of the source reaches the unified clip's own limits, not only its parts'.
TEST_F(CompositeSourceTest, AUnifiedClipTakesItsPartsNewLimitsOnARefit) {
    const SourcePtr a = project->loadSource("a.mov");
    const auto unified = UnifiedMedia::create(VMFile::create(a, 0, 0), AMFile::create(a, 1, 0));
    track->addMedia(unified, 0);
    EXPECT_EQ(unified->maxRationalMediaEnd(), SafeRational(150));
    project->changeSourcesFile(a, "longer.mov");
    EXPECT_EQ(unified->internalVisualMedia()->maxRationalMediaEnd(), SafeRational(300));
    EXPECT_EQ(unified->maxRationalMediaEnd(), SafeRational(300)) << "unified limits stale after refit";
    EXPECT_TRUE(project->execute(TrimEndCmd::create(track, unified, -100)));
}

// Separating and undoing gives back the unified clip and its parts exactly,
// and no observer of a part runs under the write lock.
TEST_F(CompositeSourceTest, SeparateUndoIsExactAndToldOutsideTheLock) {
    const SourcePtr a = project->loadSource("a.mov");
    const auto unified = UnifiedMedia::create(VMFile::create(a, 0, 0), AMFile::create(a, 1, 0));
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, unified, 10)));
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, unified, 30)));
    const UnifiedMediaState before = unified->unifiedMediaState();
    const auto opacity = unified->opacity();
    const auto volume = unified->volume();
    ASSERT_TRUE(project->execute(SeparateVideoAudioCmd::create(track, unified)));
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(unified->unifiedMediaState(), before);
    EXPECT_EQ(unified->opacity(), opacity);
    EXPECT_EQ(unified->volume(), volume);
    EXPECT_EQ(unified->internalAudioMedia()->parentUnifiedMedia(), unified);
    EXPECT_EQ(unified->internalVisualMedia()->parent(), unified);
    ASSERT_TRUE(project->redo());
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(unified->unifiedMediaState(), before);

    const ReadWriteMutex& lock = project->token().lock()->mutex();
    int calls = 0, underLock = 0;
    LambdaObserverWithoutNotifyDelay watcher([&](Observable*) {
        ++calls;
        underLock += lock.hasWriter();
    });
    unified->internalVisualMedia()->attachWithoutNotifyDelay(&watcher);
    unified->internalAudioMedia()->attachWithoutNotifyDelay(&watcher);
    unified->attachWithoutNotifyDelay(&watcher);
    unified->trimEnd(10);
    ASSERT_TRUE(project->execute(TrimStartCmd::create(track, unified, 5)));
    unified->internalVisualMedia()->detach(&watcher);
    unified->internalAudioMedia()->detach(&watcher);
    unified->detach(&watcher);
    EXPECT_GE(calls, 3);
    EXPECT_EQ(underLock, 0);
}

// After the file gets shorter the unified clip must not reach past it.
TEST_F(CompositeSourceTest, AUnifiedClipCannotBeTrimmedPastAShorterFile) {
    loader->set("short.mov",
                {stream(TrackType::Video, 0, 2400, 600), stream(TrackType::Audio, 0, 192000, 48000, 2)});
    const SourcePtr a = project->loadSource("a.mov");
    const auto unified = UnifiedMedia::create(VMFile::create(a, 0, 0), AMFile::create(a, 1, 0));
    track->addMedia(unified, 0);
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, unified, 50))); // plays [0, 100)
    project->changeSourcesFile(a, "short.mov");                            // 120 ticks now
    EXPECT_EQ(unified->internalVisualMedia()->maxRationalMediaEnd(), SafeRational(120));
    EXPECT_EQ(unified->maxRationalMediaEnd(), SafeRational(120));
    EXPECT_FALSE(project->execute(TrimEndCmd::create(track, unified, -40)));
    EXPECT_LE(unified->internalVisualMedia()->state().mediaEnd(), SafeRational(120));
}

class CompositeEditTest : public EditTest {};

// Unified clips stitched together: their files still count, and clips of two
// recordings do not stitch.
TEST_F(CompositeSourceTest, UnifiedClipsInsideAStitchedClipKeepTheirSourcesInUse) {
    loader->set("b.mov",
                {stream(TrackType::Video, 0, 3000, 600), stream(TrackType::Audio, 0, 48000, 48000, 2)});
    const SourcePtr a = project->loadSource("a.mov"), b = project->loadSource("b.mov");
    const auto ua = UnifiedMedia::create(VMFile::create(a, 0, 0), AMFile::create(a, 1, 0));
    const auto ub = UnifiedMedia::create(VMFile::create(b, 0, 0), AMFile::create(b, 1, 0));
    track->addMedia(ua, 0);
    track->addMedia(ub, 150);
    EXPECT_ANY_THROW(project->execute(StitchMediaCmd::create(track, {ua, ub})))
        << "clips of two recordings were stitched";
    const auto ua2 = UnifiedMedia::create(VMFile::create(a, 0, 0), AMFile::create(a, 1, 0));
    const auto stitched = StitchedMedia::create({ua2}, 0);
    const auto other = project->timeline()->newTrack();
    project->timeline()->addTrack(project->timeline()->mixer(), other);
    other->addMedia(stitched, 0);
    EXPECT_GE(project->timeline()->instancesOf(b).size(), 2u);
    EXPECT_ANY_THROW(project->unloadSource(b)) << "a source in use was unloaded";
}

} // namespace

#include <VelaMediaLib/commands/edits/LockData.h>
namespace {
TEST_F(CompositeEditTest, AClipInsideAGroupOnALockedTrackIsLocked) {
    const MediaPtr a = place(0, 20), b = place(20, 20);
    const auto stitch = StitchMediaCmd::create(track, {a, b});
    ASSERT_TRUE(project->execute(stitch));
    const auto command = GroupCmd::create({stitch->stitchedMedia()});
    ASSERT_TRUE(project->execute(command));
    track->setIsLocked(true);
    EXPECT_TRUE(LockData::IsMediaLocked(*command->createdGroup()));
    EXPECT_TRUE(LockData::IsMediaLocked(*stitch->stitchedMedia())) << "child of a group on a locked track";
    EXPECT_TRUE(LockData::IsMediaLocked(*a)) << "part of a stitched clip on a locked track";
    const MediaPtr loose = clip(10); // on no track: editable and shown
    EXPECT_FALSE(LockData::IsMediaLocked(*loose) || LockData::IsMediaHidden(*loose) ||
                 LockData::IsMediaInvisible(*loose));
}
} // namespace

// The project's source operations and the commands that load and unload sources.
#include "../model/SourceTestSupport.h"

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/commands/edits/LoadSourceCmd.h>
#include <VelaMediaLib/commands/edits/RippleDeleteRangeAndCreateDeletionPointCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/commands/edits/UnloadSourceCmd.h>
#include <VelaMediaLib/model/media/AMFile.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/time/sync/LambdaObserverWithoutNotifyDelay.h>
#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

#include <gtest/gtest.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class SourceCommandTest : public ::testing::Test {
protected:
    SourceCommandTest() {
        for (const char* path : {"a.mov", "b.mov", "c.mov"})
            loader->set(
                path, {stream(TrackType::Video, 0, 3000, 600), stream(TrackType::Audio, 0, 48000, 48000, 2)});
        project->sourceBin()->setFileSystem(files);
        project->timeline()->addTrack(project->newMixer("main"), track);
    }
    SourcePtr load(const std::string& path) {
        const auto command = LoadSourceCmd::create(path);
        EXPECT_TRUE(project->execute(command));
        return command->source();
    }
    SourceBin::Sources sources() const { return project->sourceBin()->sources(); }

    RegisteredTableLoader loader;
    boost::shared_ptr<FakeFileSystem> files = boost::make_shared<FakeFileSystem>();
    ProjectPtr project = Project::create(30, 1);
    boost::shared_ptr<GenericTrack> track = project->timeline()->newTrack();
};

TEST_F(SourceCommandTest, LoadsAndUnloadsUndoToTheSameSourcesInTheSameOrder) {
    const SourcePtr a = load("a.mov"), b = load("b.mov"), c = load("c.mov");
    EXPECT_FALSE(project->execute(LoadSourceCmd::create("b.mov"))); // loaded already: no step
    EXPECT_EQ(project->commandHistory()->undoStack().size(), 3u);

    const auto unload = UnloadSourceCmd::create(b);
    ASSERT_TRUE(project->execute(unload));
    EXPECT_EQ(unload->source(), b);
    EXPECT_EQ(sources(), (SourceBin::Sources{a, c}));
    project->undo();
    EXPECT_EQ(sources(), (SourceBin::Sources{a, b, c}));
    project->redo();
    project->undo();
    project->undo(); // the load of c
    EXPECT_EQ(sources(), (SourceBin::Sources{a, b}));
    project->redo();
    EXPECT_EQ(sources(), (SourceBin::Sources{a, b, c}));
    EXPECT_EQ(loader->asked, 3); // a redo does not read the file again

    const auto first = LoadSourceCmd::create("d.mov", 0);
    loader->set("d.mov", {stream(TrackType::Video, 0, 600, 600)});
    ASSERT_TRUE(project->execute(first));
    EXPECT_EQ(sources().front(), first->source());
    project->undo();
    project->redo();
    EXPECT_EQ(sources().front(), first->source());
}

TEST_F(SourceCommandTest, ASourceOnTheTimelineCannotBeUnloaded) {
    const SourcePtr a = load("a.mov");
    const MediaPtr clip = VMFile::create(a, 0, 0);
    track->addMedia(clip, 0);
    const auto before = project->commandHistory()->undoStack().size();
    try {
        project->execute(UnloadSourceCmd::create(a));
        FAIL() << "unloaded a source in use";
    } catch (const VelaMediaLibException& e) {
        EXPECT_STREQ(e.what(), "unable to remove a source that still has instances on the timeline.");
    }
    EXPECT_EQ(sources(), SourceBin::Sources{a});
    EXPECT_EQ(project->commandHistory()->undoStack().size(), before);
    EXPECT_THROW(project->undo(), VelaMediaLibException); // undoing the load is refused too
    EXPECT_EQ(sources(), SourceBin::Sources{a});

    track->removeMedia(clip);
    EXPECT_TRUE(project->execute(UnloadSourceCmd::create(a)));
    EXPECT_TRUE(project->sourceBin()->sources().empty());
    EXPECT_EQ(boost::dynamic_pointer_cast<VMFile>(clip)->source(), a); // the clip still plays it
}

TEST_F(SourceCommandTest, ASourceHeldByADeletionPointCannotBeUnloaded) {
    const SourcePtr a = load("a.mov");
    track->addMedia(VMFile::create(a, 0, 0), 0);
    const auto remove = RippleDeleteRangeAndCreateDeletionPointCmd::create(Range<VelaTime>(0, 1000));
    remove->addTrack(track);
    ASSERT_TRUE(project->execute(remove));
    ASSERT_EQ(track->numMedias(), 0u);
    // The clip waits in the point to be put back: its source must stay.
    EXPECT_THROW(project->execute(UnloadSourceCmd::create(a)), VelaMediaLibException);
    EXPECT_EQ(sources(), SourceBin::Sources{a});
}

/// Loads the file itself while the command reads it, as another thread might.
class RacingLoader : public StatsLoader {
public:
    explicit RacingLoader(const ProjectPtr& project) : project_(project) {}
    bool loadStats(const std::string& path, MediaFileStats& stats) override {
        if (path != "race.mov") return false;
        if (!racing_) {
            racing_ = true;
            project_->loadSource(path);
        }
        stats.addTrackStats(stream(TrackType::Video, 0, 600, 600));
        return true;
    }

private:
    ProjectPtr project_;
    bool racing_ = false;
};

TEST_F(SourceCommandTest, ALoadThatLosesARaceTakesNoEffect) {
    const auto racing = boost::make_shared<RacingLoader>(project);
    MediaFileStats::addStatsLoader(racing, 1);
    EXPECT_FALSE(project->execute(LoadSourceCmd::create("race.mov")));
    MediaFileStats::removeStatsLoader(racing);
    EXPECT_EQ(project->sourceBin()->numSources(), 1u);
    EXPECT_TRUE(project->commandHistory()->undoStack().empty());
}

TEST_F(SourceCommandTest, CommandsNeedAProjectAndASource) {
    EXPECT_THROW(LoadSourceCmd::create("a.mov")->execute(nullptr), VelaMediaLibException);
    EXPECT_THROW(LoadSourceCmd::create(SourcePtr()), VelaMediaLibException);
    EXPECT_THROW(UnloadSourceCmd::create(SourcePtr()), VelaMediaLibException);
    EXPECT_THROW(project->execute(LoadSourceCmd::create("missing.mov")), IOException);
    EXPECT_TRUE(sources().empty());
    EXPECT_TRUE(project->commandHistory()->undoStack().empty());
}

TEST_F(SourceCommandTest, OfflineSourcesComeBackWhenTheirFileMatches) {
    const SourcePtr a = project->loadSource("a.mov");
    int told = 0;
    LambdaObserverWithoutNotifyDelay sentry([&](Observable*) { ++told; });
    project->addSourceBinSentry(&sentry);
    project->dropSourceOffline(a);
    EXPECT_FALSE(a->isOnline());
    EXPECT_FALSE(project->bringSourceOnline(a)); // the file is missing
    files->present.insert("a.mov");
    loader->set("a.mov", {stream(TrackType::Video, 0, 600, 600)});
    EXPECT_FALSE(project->bringSourceOnline(a)); // it lost its sound
    loader->set("a.mov",
                {stream(TrackType::Video, 0, 1200, 600), stream(TrackType::Audio, 0, 4800, 48000, 2)});
    EXPECT_TRUE(project->bringSourceOnline(a));
    EXPECT_EQ(a->offlineStatus(), OfflineStatus::Online);
    EXPECT_EQ(a->timeRangeForTrack(0), Range<VelaTime>(0, 60));
    EXPECT_GE(told, 2);
    project->sourceBin()->detach(&sentry);
}

TEST_F(SourceCommandTest, TheEditRateReachesEverySource) {
    const SourcePtr a = project->loadSource("a.mov");
    EXPECT_EQ(a->mediaForTrackNumber(0)->duration(), 150);
    project->setEditRate(boost::rational<unsigned long>(60));
    EXPECT_EQ(a->editRate(), boost::rational<unsigned long>(60));
    EXPECT_EQ(a->mediaForTrackNumber(0)->duration(), 300);
    EXPECT_EQ(a->mediaForTrackNumber(1)->maxRationalMediaEnd(), SafeRational(60));
}

/// Names its records by another path, as loaders of real files may.
class RenamingLoader : public StatsLoader {
    bool loadStats(const std::string& path, MediaFileStats& stats) override {
        if (path != "rel.mov") return false;
        stats.addTrackStats(stream(TrackType::Video, 0, 600, 600));
        stats.setFilename("/abs/rel.mov");
        return true;
    }
};

TEST_F(SourceCommandTest, PathsAreKeptAsTheHostGaveThem) {
    const auto bin = project->sourceBin();
    for (const char* odd : {"/home/me/.cache/take.mov", "../take.mov", "", ".", "a/.."})
        EXPECT_FALSE(bin->isFileLoaded(odd)) << odd;
    const SourcePtr a = load("a.mov");
    EXPECT_EQ(bin->sourceForFile("x/../a.mov"), a);
    EXPECT_EQ(bin->sourceForFile("./x//../a.mov"), a);

    const auto renaming = boost::make_shared<RenamingLoader>();
    MediaFileStats::addStatsLoader(renaming, 1);
    const SourcePtr rel = load("rel.mov");
    MediaFileStats::removeStatsLoader(renaming);
    EXPECT_EQ(rel->filename(), "rel.mov");
    project->undo();
    EXPECT_FALSE(bin->isFileLoaded("rel.mov"));
    project->redo();
    EXPECT_EQ(bin->sourceForFile("rel.mov"), rel);
}

TEST_F(SourceCommandTest, AFileThatCannotTakeTheSourcesPlaceChangesNothing) {
    const SourcePtr a = project->loadSource("a.mov");
    const MediaPtr clip = VMFile::create(a, 0, 0);
    track->addMedia(clip, 0);
    loader->set("hollow.mov",
                {stream(TrackType::Video, 0, 1200, 600), stream(TrackType::Audio, 0, 0, 48000, 2)});
    TrackStats noRate = stream(TrackType::Video, 0, 600, 600);
    noRate.rangeEditRate = 0;
    loader->set("norate.mov", {noRate, stream(TrackType::Audio, 0, 48000, 48000, 2)});
    EXPECT_THROW(project->changeSourcesFile(a, "hollow.mov"), VelaMediaLibException);
    EXPECT_THROW(project->changeSourcesFile(a, "norate.mov"), IOException);
    EXPECT_THROW(project->loadSource("norate.mov"), IOException);
    EXPECT_EQ(a->filename(), "a.mov");
    EXPECT_EQ(a->mediaForTrackNumber(0)->duration(), 150);
    EXPECT_EQ(project->sourceBin()->sourceForFile("a.mov"), a);

    loader->set("longer.mov",
                {stream(TrackType::Video, 0, 6000, 600), stream(TrackType::Audio, 0, 48000, 48000, 2)});
    project->changeSourcesFile(a, "longer.mov");
    EXPECT_EQ(clip->maxRationalMediaEnd(), SafeRational(300)); // the placed clip may reach the new end
    EXPECT_FALSE(project->sourceBin()->isFileLoaded("a.mov"));
    EXPECT_EQ(project->sourceBin()->sourceForFile("longer.mov"), a);
}

TEST_F(SourceCommandTest, ASwapToASourceWithoutTheStreamIsRefusedWhole) {
    loader->set("mono.wav", {stream(TrackType::Audio, 0, 48000, 48000, 1)});
    const SourcePtr a = project->loadSource("a.mov"), mono = project->loadSource("mono.wav");
    const auto sound = AMFile::create(a, 1, 0);
    const auto picture = VMFile::create(a, 0, 0);
    track->addMedia(sound, 0);
    track->addMedia(picture, 500);
    EXPECT_THROW(project->timeline()->swapSourceForTimelineMedias(a, mono), IndexException);
    EXPECT_EQ(sound->source(), a);
    EXPECT_THROW(picture->setSource(mono), TypeException);
    EXPECT_EQ(picture->source(), a);
}

TEST_F(SourceCommandTest, RateChangesReachEveryClipBeforeTheyAreTold) {
    const SourcePtr a = project->loadSource("a.mov");
    loader->set("blip.wav", {stream(TrackType::Audio, 0, 1, 48000, 1)}); // a 48000th of a second
    const SourcePtr blip = project->loadSource("blip.wav");
    const auto loose = VMFile::create(a, 0, 0), clip = VMFile::create(a, 0, 0);
    track->addMedia(loose, 0);
    track->addMedia(clip, 1000);
    MediaState rounded = loose->state();
    rounded.duration += 1; // a restore with a tolerance leaves a clip one tick off
    loose->restoreState(rounded, 1);

    SafeRational seen;
    LambdaObserverWithoutNotifyDelay watcher([&](Observable*) { seen = clip->maxRationalMediaEnd(); });
    project->attachEditRateObserver(&watcher);
    project->setEditRate(boost::rational<unsigned long>(60));
    project->detachEditRateObserver(&watcher);
    EXPECT_EQ(seen, SafeRational(300));
    EXPECT_EQ(loose->maxRationalMediaEnd(), SafeRational(300));
    EXPECT_EQ(blip->mediaForTrackNumber(0)->duration(), 1); // shorter than a tick: one, played slower
}

TEST_F(SourceCommandTest, AnUndoneEditFindsTheStreamAtThePresentRate) {
    const SourcePtr a = project->loadSource("a.mov");
    const auto clip = VMFile::create(a, 0, 0);
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, clip, 0)));
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, clip, 30)));
    project->setEditRate(boost::rational<unsigned long>(60));
    project->undo();
    EXPECT_EQ(clip->duration(), 150); // the clip's own timing comes back exactly
    EXPECT_EQ(clip->maxRationalMediaEnd(), SafeRational(300));
    project->undo();
    project->redo();
    EXPECT_EQ(clip->maxRationalMediaEnd(), SafeRational(300));
}

TEST_F(SourceCommandTest, NoObserverRunsUnderTheWriteLock) {
    const SourcePtr a = project->loadSource("a.mov"), b = project->loadSource("b.mov");
    loader->set("longer.mov",
                {stream(TrackType::Video, 0, 6000, 600), stream(TrackType::Audio, 0, 48000, 48000, 2)});
    const ReadWriteMutex& lock = project->token().lock()->mutex();
    int calls = 0, underLock = 0;
    LambdaObserverWithoutNotifyDelay watcher([&](Observable*) {
        ++calls;
        underLock += lock.hasWriter();
    });
    for (const SourcePtr& source : {a, b}) {
        source->mediaForTrackNumber(0)->attachWithoutNotifyDelay(&watcher);
        source->stats()->attachWithoutNotifyDelay(&watcher);
    }
    project->sourceBin()->attachWithoutNotifyDelay(&watcher);
    project->setEditRate(boost::rational<unsigned long>(60));
    project->changeSourcesFile(a, "longer.mov");
    project->renameSourcesFile(a, "moved.mov");
    ASSERT_TRUE(project->execute(UnloadSourceCmd::create(b)));
    project->setEditRate(boost::rational<unsigned long>(30));
    project->undo(); // b comes back and takes the rate
    for (const SourcePtr& source : {a, b}) {
        source->mediaForTrackNumber(0)->detach(&watcher);
        source->stats()->detach(&watcher);
    }
    project->sourceBin()->detach(&watcher);
    EXPECT_GE(calls, 8);
    EXPECT_EQ(underLock, 0);
}

TEST_F(SourceCommandTest, ClipsRefuseSourcesOfAnotherProjectAndSwapsCheckEveryClipFirst) {
    loader->set("mute.mov", {stream(TrackType::Video, 0, 3000, 600)});
    const SourcePtr a = project->loadSource("a.mov"), mute = project->loadSource("mute.mov");
    const auto picture = VMFile::create(a, 0, 0);
    const auto sound = AMFile::create(a, 1, 0);
    track->addMedia(picture, 0);
    track->addMedia(sound, 500);
    EXPECT_THROW(project->timeline()->swapSourceForTimelineMedias(a, mute), IndexException);
    EXPECT_EQ(picture->source(), a); // the picture could have played it, but the sound cannot
    const ProjectPtr other = Project::create(30, 1);
    EXPECT_THROW(picture->setSource(other->loadSource("a.mov")), AddRemoveException);
    EXPECT_THROW(project->sourceBin()->insertSource(other->loadSource("b.mov"), -1), AddRemoveException);
    EXPECT_EQ(picture->source(), a);
}

TEST_F(SourceCommandTest, RateChangesReachSourcesInTheBinInTheHistoryAndOnTheTimeline) {
    const SourcePtr a = project->loadSource("a.mov"), b = project->loadSource("b.mov");
    const auto clip = VMFile::create(a, 0, 0);
    track->addMedia(clip, 0);
    ASSERT_TRUE(project->execute(UnloadSourceCmd::create(b)));
    project->setEditRate(boost::rational<unsigned long>(60));
    EXPECT_EQ(clip->maxRationalMediaEnd(), SafeRational(300));
    project->undo(); // b comes back at the present rate
    EXPECT_EQ(b->editRate(), boost::rational<unsigned long>(60));
    EXPECT_EQ(b->mediaForTrackNumber(0)->duration(), 300);

    EXPECT_THROW(project->setEditRate(boost::rational<unsigned long>(0)), VelaMediaLibException);
    EXPECT_THROW(Project::create(30, 1)->setEditRate(boost::rational<unsigned long>(0)),
                 VelaMediaLibException);
    EXPECT_EQ(project->editRate(), boost::rational<unsigned long>(60));
    EXPECT_EQ(a->editRate(), boost::rational<unsigned long>(60));
    EXPECT_EQ(b->mediaForTrackNumber(0)->duration(), 300);
}

TEST_F(SourceCommandTest, RedoFindsItsPlaceAfterTheBinShrankOutsideTheHistory) {
    const SourcePtr a = load("a.mov"), b = load("b.mov"), c = load("c.mov");
    project->undo();          // c out
    project->unloadSource(a); // directly, no step
    project->redo();
    EXPECT_EQ(sources(), (SourceBin::Sources{b, c}));
}

TEST_F(SourceCommandTest, AChangeMadeWhileAnotherIsToldLeavesNoStaleClip) {
    const SourcePtr a = project->loadSource("a.mov");
    loader->set("longer.mov",
                {stream(TrackType::Video, 0, 6000, 600), stream(TrackType::Audio, 0, 96000, 48000, 2)});
    bool once = false;
    LambdaObserverWithoutNotifyDelay watcher([&](Observable*) {
        if (once) return;
        once = true;
        project->setEditRate(boost::rational<unsigned long>(60));
    });
    a->mediaForTrackNumber(0)->attachWithoutNotifyDelay(&watcher);
    project->changeSourcesFile(a, "longer.mov");
    a->mediaForTrackNumber(0)->detach(&watcher);
    EXPECT_EQ(a->mediaForTrackNumber(0)->duration(), 600); // 10 s at 60
    EXPECT_EQ(a->mediaForTrackNumber(1)->duration(), 120); // 2 s at 60
}

TEST_F(SourceCommandTest, ASentryMayChangeASourcesFileWhileTheProjectDelivers) {
    const SourcePtr a = project->loadSource("a.mov");
    loader->set("longer.mov",
                {stream(TrackType::Video, 0, 6000, 600), stream(TrackType::Audio, 0, 96000, 48000, 2)});
    bool once = false;
    LambdaObserverWithoutNotifyDelay changer([&](Observable*) {
        if (once) return;
        once = true;
        project->changeSourcesFile(a, "longer.mov");
    });
    project->addSourceBinSentry(&changer); // held back: told while the history delivers
    ASSERT_TRUE(project->execute(LoadSourceCmd::create("b.mov")));
    project->sourceBin()->detach(&changer);
    EXPECT_EQ(a->filename(), "longer.mov");
}

TEST_F(SourceCommandTest, UndoIsExactForAClipThatOutlivedItsLongerFile) {
    loader->set("short.mov",
                {stream(TrackType::Video, 0, 1500, 600), stream(TrackType::Audio, 0, 48000, 48000, 2)});
    const SourcePtr a = project->loadSource("a.mov");
    const auto clip = VMFile::create(a, 0, 0);
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, clip, 0)));
    project->changeSourcesFile(a, "short.mov"); // 75 ticks: the clip keeps its 150
    const MediaState whole = clip->state();
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, clip, 100)));
    EXPECT_EQ(clip->maxRationalMediaEnd(), SafeRational(75)); // no room left beyond the file
    const MediaState trimmed = clip->state();
    ASSERT_TRUE(project->execute(MoveCmd::create(track, clip, 10)));
    project->undo();
    EXPECT_EQ(clip->state(), trimmed);
    project->undo();
    EXPECT_EQ(clip->state(), whole);
}

TEST_F(SourceCommandTest, AClipPutBackByAnUndoCannotReachPastItsFile) {
    project->setEditRate(boost::rational<unsigned long>(60));
    const SourcePtr a = project->loadSource("a.mov");
    const auto clip = VMFile::create(a, 0, 0);
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, clip, 0)));
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, clip, 200)));
    ASSERT_TRUE(project->execute(RemoveMediaCmd::create(track, clip)));
    project->setEditRate(boost::rational<unsigned long>(30));
    project->undo();
    EXPECT_EQ(clip->maxRationalMediaEnd(), SafeRational(150));
    EXPECT_THROW(clip->trimEnd(-150), InvalidTrimRangeException);
}

TEST_F(SourceCommandTest, ClipsInsideCompositesCountAsInstancesOfTheirSource) {
    const SourcePtr a = project->loadSource("a.mov"), b = project->loadSource("b.mov");
    const auto unified = UnifiedMedia::create(VMFile::create(a, 0, 0), AMFile::create(a, 1, 0));
    track->addMedia(unified, 0);
    const auto stitched = StitchedMedia::create({VMFile::create(b, 0, 0, SafeRational(0), SafeRational(30)),
                                                 VMFile::create(b, 0, 0, SafeRational(60), SafeRational(30))},
                                                0);
    track->addMedia(stitched, 1000);
    EXPECT_EQ(project->timeline()->instancesOf(a).size(), 2u);
    EXPECT_EQ(project->timeline()->allSources().size(), 2u);
    EXPECT_THROW(project->unloadSource(a), VelaMediaLibException);
    EXPECT_THROW(project->unloadSource(b), VelaMediaLibException);

    // At a tick inside the second part, the stitched clip answers that part and the time inside it.
    bool found = false;
    for (const Track::MediaAtTime& at : project->timeline()->allMediasAndTimesAtTime(1040))
        if (at.media == stitched->medias().back()) found = at.parametricTime == SafeRational(10);
    EXPECT_TRUE(found);
}

} // namespace

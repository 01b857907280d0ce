// The project's source operations and the commands that load and unload sources.
#include "../model/SourceTestSupport.h"

#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/commands/edits/LoadSourceCmd.h>
#include <VelaMediaLib/commands/edits/UnloadSourceCmd.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/time/sync/LambdaObserverWithoutNotifyDelay.h>

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

} // namespace

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/framework/BatchCmd.h>
#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>
#include <VelaMediaLib/commands/framework/LambdaMultiCommand.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/commands/edits/LockData.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/time/parameters/SymbolTable.h>
#include <VelaMediaLib/time/sync/NotifyDelay.h>

#include <algorithm>
#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

using namespace VelaMediaLib;

namespace {

class ProjectTest : public ::testing::Test {
protected:
    ProjectPtr project = Project::create(30, 1);
    boost::shared_ptr<GenericMixer> mixer = project->newMixer("main");
    boost::shared_ptr<GenericTrack> track = newTrack();

    boost::shared_ptr<GenericTrack> newTrack() {
        const auto made = project->timeline()->newTrack();
        project->timeline()->addTrack(mixer, made);
        return made;
    }
    MediaPtr clip(VelaTime duration) {
        return PlaceholderMedia::create(project->token(), project->editRateToken(), 0, duration);
    }
    MediaPtr place(VelaTime start, VelaTime duration) {
        const MediaPtr media = clip(duration);
        EXPECT_TRUE(project->execute(AddMediaCmd::create(track, media, start)));
        return media;
    }
    std::vector<VelaTime> starts() const {
        std::vector<VelaTime> result;
        for (const MediaPtr& media : track->medias()) result.push_back(media->startTime());
        return result;
    }
};

} // namespace

TEST(ProjectCreation, RatesAndDefaults) {
    struct Case {
        unsigned long numerator, denominator;
        int frameRate, sampleRate;
    };
    for (const Case& c : {Case{30, 1, 30, 44100}, Case{25, 1, 25, 44100}, Case{24, 1, 30, 44100},
                          Case{48000, 1, 30, 48000}, Case{30000, 1001, 30, 44100}}) {
        const ProjectPtr project = Project::create(c.numerator, c.denominator);
        EXPECT_EQ(project->videoFormatFrameRateAttribute()->value(), c.frameRate) << c.numerator;
        EXPECT_EQ(project->audioFormatSampleRateAttribute()->value(), c.sampleRate) << c.numerator;
    }
    EXPECT_EQ(Project::create(60, 2)->editRate(), boost::rational<unsigned long>(30, 1));
    EXPECT_THROW(Project::create(30, 0), boost::bad_rational);
    const ProjectPtr project = Project::create(30, 1);
    EXPECT_EQ(project->targetLoudnessAttribute()->value(), -18.0);
    EXPECT_FALSE(project->shouldApplyLoudnessNormalizationAttribute()->value());
    EXPECT_TRUE(project->allowSubFrameEditingAttribute()->value());
    EXPECT_EQ(project->authorAttribute()->value(), "");
    EXPECT_EQ(project->sourceBin()->size(), 0u);
    EXPECT_EQ(project->commandHistory()->undoLimit(), -1);
    project->setUndoLimit(5);
    EXPECT_EQ(project->commandHistory()->undoLimit(), 5);
    project->setAuthorVersionInfo(VersionInfo{"6.0", "Pelorus", "2.1", "linux"});
    EXPECT_EQ(project->metaDataValue("authoringClientName:name"), "Pelorus");
    EXPECT_EQ(project->metaDataValue("authoringClientName:platform"), "linux");
    EXPECT_EQ(project->metaDataValue("authoringClientName:version"), "2.1");
}

TEST(ProjectCreation, ObjectsFindTheProjectLockAndOutliveIt) {
    boost::weak_ptr<const ThreadSafe> token;
    MediaPtr survivor;
    {
        const ProjectPtr project = Project::create(30, 1);
        token = project->token();
        survivor = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10);
        EXPECT_FALSE(token.expired());
    }
    EXPECT_TRUE(token.expired());
    survivor->trimEnd(5); // no project: no lock, still works
    EXPECT_EQ(survivor->duration(), 5);
}

TEST(SymbolTable, AnIdentifierAnswersOnlyForKindsItIs) {
    const ProjectPtr project = Project::create(30, 1);
    SymbolTable symbols;
    const MediaPtr media = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10);
    symbols.addSymbol(7, project->timeline());
    symbols.addSymbol(8, media);
    EXPECT_FALSE(symbols.symbolForIdent<Media>(7));
    EXPECT_EQ(symbols.symbolForIdent<Timeline>(7), project->timeline());
    EXPECT_EQ(symbols.symbolForIdent<Media>(8), media);
    EXPECT_TRUE(symbols.symbolForIdent<Parametric>(8));
    EXPECT_TRUE(symbols.symbolForIdent<PlaceholderMedia>(8));
    EXPECT_FALSE(symbols.symbolForIdent<Media>(9));
    EXPECT_FALSE(symbols.hasSymbolForIdent(9));
}

TEST_F(ProjectTest, AtomicCommandsAndTheirUndo) {
    const MediaPtr a = place(0, 10), b = place(20, 10);
    EXPECT_FALSE(
        project->execute(AddMediaCmd::create(track, clip(10), 5))); // collides: refused, not recorded
    EXPECT_EQ(project->commandHistory()->undoStack().size(), 2u);
    EXPECT_TRUE(project->execute(MoveCmd::create(track, b, 5)));
    EXPECT_FALSE(project->execute(MoveCmd::create(track, b, -20))); // onto a
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 25}));
    EXPECT_TRUE(project->execute(RemoveMediaCmd::create(track, a)));
    EXPECT_EQ(track->numMedias(), 1u);
    project->undo();
    project->undo();
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 20}));
    project->redo();
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 25}));
    project->execute(MoveCmd::create(track, b, 5));
    project->combineLastCommands();
    project->undo();
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 20})); // both moves undone as one
}

TEST_F(ProjectTest, ACompositeWhoseThirdStepThrowsLeavesTheProjectAsItWas) {
    const MediaPtr a = place(0, 10), b = place(20, 10);
    const CommandHistoryState before = project->commandState();
    const auto composite = LambdaMultiCommand::create([&](MultiCommand* self) {
        self->execute(MoveCmd::create(track, a, 100));
        self->execute(MoveCmd::create(track, b, 100));
        self->execute(CloseGapsOnTrackCmd::create(TrackPtr())); // throws
    });
    EXPECT_THROW(project->execute(composite), VelaMediaLibException);
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 20}));
    EXPECT_EQ(project->commandState().undoStack, before.undoStack);
}

TEST_F(ProjectTest, AMagneticTrackClosesItsGapsAsAnUndoStepOfItsOwn) {
    track->magneticAttribute()->setValue(true);
    const MediaPtr media = place(5, 10);
    EXPECT_EQ(media->startTime(), 0);
    ASSERT_EQ(project->commandHistory()->undoStack().size(), 2u);
    EXPECT_EQ(project->commandHistory()->undoStack().back()->name(), "Close Gaps");
    project->undo();
    EXPECT_EQ(media->startTime(), 5);
    project->redo();
    EXPECT_EQ(media->startTime(), 0);

    const MediaPtr second = place(10, 10), third = place(20, 10);
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 10, 20}));
    project->execute(RemoveMediaCmd::create(track, second));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 10})); // the gap closed
    EXPECT_EQ(third->startTime(), 10);
    project->undo(); // the closing
    EXPECT_EQ(third->startTime(), 20);
    project->undo(); // the removal
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 10, 20}));

    const auto plain = newTrack();
    const MediaPtr loose = clip(10);
    project->execute(AddMediaCmd::create(plain, loose, 50));
    EXPECT_EQ(loose->startTime(), 50); // not magnetic: stays
}

TEST_F(ProjectTest, TheMagnetizerQueuesItsClosingInsteadOfEditingFromANotification) {
    struct Watcher : CommandHistoryObserver {
        ProjectPtr project;
        std::vector<bool> insideDelivery;
        void commandWillExecute(const CommandPtr& command, uint32_t) override {
            if (command->name() == "Close Gaps")
                insideDelivery.push_back(
                    NotifyDelay::isNotifying(boost::shared_ptr<const ThreadSafe>(project->token())));
        }
        void commandDidExecute(const CommandPtr&, uint32_t, bool) override {}
    };
    const auto watcher = boost::make_shared<Watcher>();
    watcher->project = project;
    project->commandHistory()->setObserver(watcher);
    track->magneticAttribute()->setValue(true);
    place(5, 10);
    ASSERT_FALSE(watcher->insideDelivery.empty());
    EXPECT_EQ(std::count(watcher->insideDelivery.begin(), watcher->insideDelivery.end(), true), 0);
    watcher->project.reset();
}

TEST_F(ProjectTest, CombineNextFoldsTheCommandItWasMeantForNotTheClosingItCauses) {
    track->magneticAttribute()->setValue(true);
    place(0, 10);
    const MediaPtr second = place(10, 10);
    place(20, 10);
    ASSERT_EQ(project->commandHistory()->undoStack().size(), 3u); // no gap: nothing closed
    project->combineNextCommand();
    project->execute(RemoveMediaCmd::create(track, second));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 10}));
    ASSERT_EQ(project->commandHistory()->undoStack().size(), 4u);
    EXPECT_EQ(project->commandHistory()->undoStack().back()->name(), "Close Gaps");
    project->undo(); // the closing
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 20}));
    project->undo(); // the third clip's addition and the removal, as one step
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 10}));
}

TEST_F(ProjectTest, AMagneticTrackStartsAtZeroWhateverTheClipsStarts) {
    track->magneticAttribute()->setValue(true);
    const MediaPtr early = place(-39, 10);
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0}));
    const MediaPtr late = place(10, 10);
    project->execute(MoveCmd::create(track, late, -40)); // to [-30, -20), before the first
    EXPECT_EQ(late->startTime(), 0);
    EXPECT_EQ(early->startTime(), 10);
    project->undo();
    EXPECT_EQ(late->startTime(), -30);
    EXPECT_EQ(early->startTime(), 0);
    project->undo();
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 10}));
    EXPECT_EQ(late->startTime(), 10);
}

TEST_F(ProjectTest, AnUndoTheModelRefusesLeavesTheStacks) {
    const MediaPtr media = place(20, 10);
    project->execute(MoveCmd::create(track, media, 30));
    track->addMedia(clip(10), 20); // edited directly into the place the clip left
    const CommandHistoryState before = project->commandState();
    EXPECT_FALSE(project->undo());
    EXPECT_EQ(media->startTime(), 50);
    EXPECT_EQ(project->commandState().undoStack, before.undoStack);
    EXPECT_TRUE(project->commandState().redoStack.empty());
}

TEST_F(ProjectTest, OneCommandNotifiesEachChangedObjectOnce) {
    const MediaPtr media = place(0, 10);
    struct Counter : Observer {
        int count = 0;
        void update(Observable*) override { ++count; }
    } counter;
    media->attach(&counter);
    project->execute(BatchCmd::create(
        std::vector<CommandPtr>{MoveCmd::create(track, media, 5), MoveCmd::create(track, media, 5)}));
    EXPECT_EQ(media->startTime(), 10);
    EXPECT_EQ(counter.count, 1);
    project->undo();
    EXPECT_EQ(counter.count, 2);
    media->detach(&counter);
}

TEST_F(ProjectTest, LockHideAndSoloAreUndoable) {
    project->execute(LockData::GetChangeIsLockedCommand(track, true));
    project->execute(LockData::GetChangeIsHiddenCommand(track, true));
    project->execute(LockData::GetChangeIsSoloCommand(track, true));
    EXPECT_TRUE(LockData::IsTrackLocked(*track));
    EXPECT_TRUE(LockData::IsTrackHidden(*track));
    EXPECT_TRUE(track->attributeValue("solo", false));
    project->commandHistory()->undoAll();
    EXPECT_FALSE(LockData::IsTrackLocked(*track));
    EXPECT_FALSE(LockData::IsTrackHidden(*track));
    EXPECT_FALSE(track->attributeValue("solo", false));
    EXPECT_FALSE(track->hasMetaData(Track::isLockedMetaDataKey())); // none before, none after

    const auto other = newTrack();
    other->addMetaData(Track::isLockedMetaDataKey(), "false");
    project->execute(LockData::GetChangeIsLockedCommand(other, true));
    project->undo();
    EXPECT_EQ(other->metaDataValue(Track::isLockedMetaDataKey()), "false");
}

TEST_F(ProjectTest, AutoCombiningFoldsEverythingAfterTheFirst) {
    const MediaPtr media = place(0, 10);
    project->beginAutoCommandCombining();
    for (int i = 0; i < 3; ++i) project->execute(MoveCmd::create(track, media, 10));
    project->endAutoCommandCombining();
    EXPECT_EQ(project->commandHistory()->undoStack().size(), 2u);
    project->undo();
    EXPECT_EQ(media->startTime(), 0);
    project->combineNextCommand();
    project->execute(MoveCmd::create(track, media, 1));
    EXPECT_EQ(project->commandHistory()->undoStack().size(), 1u);
}

TEST(TrackMagnetizerAutoAttacher, FollowsTracksAndMixersAsTheyComeAndGo) {
    const ProjectPtr project = Project::create(30, 1);
    const TimelinePtr timeline = Timeline::create(project->token());
    CommandHistory history(dynamic_cast<CommandHandler*>(project.get()), project->token());
    const auto first = timeline->newMixer("a");
    const auto early = timeline->newTrack();
    timeline->addTrack(first, early);
    TrackMagnetizerAutoAttacher attacher(timeline, history);
    EXPECT_TRUE(attacher.hasMagnetizer(early)); // tracks already there
    const auto late = timeline->newTrack();
    timeline->addTrack(first, late);
    EXPECT_TRUE(attacher.hasMagnetizer(late));
    timeline->removeTrack(first, late);
    EXPECT_FALSE(attacher.hasMagnetizer(late));
    const auto second = GenericMixer::create(project->token());
    const auto inSecond = timeline->newTrack();
    second->addTrack(inSecond);
    timeline->addMixer("b", second);
    EXPECT_TRUE(attacher.hasMagnetizer(inSecond));
    timeline->removeMixer(second);
    EXPECT_FALSE(attacher.hasMagnetizer(inSecond));

    // The magnetizer of a track made magnetic closes its gap through the history.
    const MediaPtr clip = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10);
    early->addMedia(clip, 7);
    early->magneticAttribute()->setValue(true); // edited directly: the request waits
    EXPECT_EQ(clip->startTime(), 7);
    history.runFollowUps();
    EXPECT_EQ(clip->startTime(), 0);
    EXPECT_EQ(history.undoStack().size(), 1u);
}

// A host editing a magnetic track directly queues the closing; it runs before
// the next command, as a step of its own, so that undo still undoes that command.
TEST_F(ProjectTest, ADirectEditOnAMagneticTrackClosesBeforeTheNextCommand) {
    track->magneticAttribute()->setValue(true);
    const auto other = newTrack();
    const MediaPtr a = clip(10), b = clip(10);
    track->addMedia(a, 7); // directly: the closing waits
    other->addMedia(b, 0);
    ASSERT_TRUE(project->execute(MoveCmd::create(other, b, 5)));
    EXPECT_EQ(a->startTime(), 0);
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(b->startTime(), 0); // the move, not the closing
    EXPECT_EQ(a->startTime(), 0);
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(a->startTime(), 7); // then the closing
}

TEST_F(ProjectTest, AWaitingClosingIsDroppedWhenItsTrackLeavesTheProject) {
    const auto second = project->newMixer("second");
    const auto leaving = project->timeline()->newTrack();
    project->timeline()->addTrack(second, leaving);
    leaving->magneticAttribute()->setValue(true);
    const MediaPtr a = clip(10);
    leaving->addMedia(a, 7); // directly: the closing waits
    project->removeMixer(second);
    const MediaPtr b = place(0, 10);
    EXPECT_EQ(a->startTime(), 7);
    EXPECT_EQ(project->commandHistory()->undoStack().size(), 1u);
    EXPECT_EQ(project->commandHistory()->numFollowUps(), 0u);
    EXPECT_EQ(b->startTime(), 0);
}

// Add observers run after the clip is placed: what they throw is theirs, and
// neither refuses the edit (half done) nor keeps the other observers from hearing.
TEST_F(ProjectTest, AnAddObserverThatThrowsNeitherRefusesTheEditNorSilencesTheOthers) {
    struct Thrower : TrackAddObserver {
        void onTrackAddMedia(Track&, const MediaPtr&) override {
            throw AddRemoveException("observer failed");
        }
        void onTrackRemoveMedia(Track&, const MediaPtr&) override {
            throw ValueException<double>("observer failed", 0);
        }
    } thrower;
    struct Counter : TrackAddObserver {
        int added = 0, removed = 0;
        void onTrackAddMedia(Track&, const MediaPtr&) override { ++added; }
        void onTrackRemoveMedia(Track&, const MediaPtr&) override { ++removed; }
    } counter;
    track->attachAddObserver(&thrower);
    track->attachAddObserver(&counter);
    const MediaPtr media = clip(10);
    EXPECT_TRUE(project->execute(AddMediaCmd::create(track, media, 0)));
    EXPECT_TRUE(track->hasMedia(media));
    EXPECT_TRUE(project->execute(RemoveMediaCmd::create(track, media)));
    EXPECT_FALSE(track->hasMedia(media));
    EXPECT_EQ(project->commandHistory()->undoStack().size(), 2u);
    EXPECT_EQ(counter.added, 1);
    EXPECT_EQ(counter.removed, 1);
    project->commandHistory()->undoAll();
    EXPECT_FALSE(track->hasMedia(media));
    EXPECT_EQ(counter.added, 2);
    track->detachAddObserver(&thrower);
    track->detachAddObserver(&counter);
}

// The same for an observer told at once of a clip's change: the move has
// happened, so the command succeeds and is recorded.
TEST_F(ProjectTest, AnImmediateObserverThatThrowsDoesNotTurnAnEditIntoARefusal) {
    struct Thrower : Observer {
        int told = 0;
        void update(Observable*) override {
            ++told;
            throw InvalidTrimRangeException("observer failed", 0, Range<VelaTime>(0, 1));
        }
    } thrower;
    const MediaPtr media = clip(10);
    ASSERT_TRUE(project->execute(AddMediaCmd::create(track, media, 0)));
    media->attachWithoutNotifyDelay(&thrower);
    EXPECT_TRUE(project->execute(MoveCmd::create(track, media, 5)));
    EXPECT_EQ(media->startTime(), 5);
    EXPECT_GE(thrower.told, 1);
    EXPECT_EQ(project->commandHistory()->undoStack().size(), 2u);
    media->detach(&thrower);
}

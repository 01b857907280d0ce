#include "../JsonTestSupport.h"
#include "../time/TimeTestSupport.h"
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>
#include <VelaMediaLib/commands/edits/LockData.h>
#include <VelaMediaLib/commands/framework/BatchCmd.h>
#include <VelaMediaLib/time/parameters/SymbolTable.h>
#include <VelaMediaLib/time/sync/NotifyDelay.h>

#include <boost/make_shared.hpp>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

using ProjectTest = EditTest;

const char* const kClosing = "Close Gaps";
std::string lastStepName(const ProjectPtr& project) {
    return project->commandHistory()->undoStack().back()->name();
}

} // namespace

// Every edit rate follows one rule: a zero numerator gives 0/1 (with the frame
// and sample rates of a rate that is not one of theirs), a zero denominator
// makes no project.
TEST(ProjectCreation, RatesDefaultsAndTheEditRate) {
    struct Case {
        unsigned long numerator, denominator;
        int frameRate, sampleRate;
    };
    for (const Case& c : {Case{30, 1, 30, 44100}, Case{25, 1, 25, 44100}, Case{24, 1, 30, 44100},
                          Case{48000, 1, 30, 48000}, Case{30000, 1001, 30, 44100}, Case{0, 7, 30, 44100}}) {
        const ProjectPtr project = Project::create(c.numerator, c.denominator);
        EXPECT_EQ(project->videoFormatFrameRateAttribute()->value(), c.frameRate) << c.numerator;
        EXPECT_EQ(project->audioFormatSampleRateAttribute()->value(), c.sampleRate) << c.numerator;
    }
    EXPECT_EQ(Project::create(0, 7)->editRate(), Rate(0, 1));
    EXPECT_EQ(Project::create(60, 2)->editRate(), Rate(30));
    EXPECT_THROW(Project::create(30, 0), boost::bad_rational);
    const ProjectPtr project = Project::create(Rate(25));
    EXPECT_EQ(project->targetLoudnessAttribute()->value(), -18.0);
    EXPECT_FALSE(project->voxaneMetaDataAttribute()->value());
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

    // Clips hold the rate through the project's edit-rate token.
    const boost::shared_ptr<ProjectEditRate> held = project->editRateToken().lock();
    ASSERT_TRUE(held);
    project->setEditRate(Rate(30000, 1001));
    EXPECT_EQ(held->editRate(), Rate(30000, 1001));
    held->setEditRate(Rate(24));
    EXPECT_EQ(project->editRate(), Rate(24));
    RateReader reader;
    reader.rate = held.get();
    project->attachEditRateObserver(&reader);
    project->setEditRate(Rate(25));
    EXPECT_EQ(reader.seen, std::vector<Rate>{Rate(25)});
    project->detachEditRateObserver(&reader);
}

// Kept past the project, the history refuses instead of reaching into it
// (AddressSanitizer finds any such read), a composite's inner history holds no
// handler between runs, and a clip works on without a lock.
TEST_F(ProjectTest, WhatTheHostKeepsPastTheProjectRefusesOrWorksAlone) {
    const MediaPtr media = place(0, 10);
    ASSERT_TRUE(project->execute(MoveCmd::create(track, media, 5)));
    const auto batch = BatchCmd::create(MoveCmd::create(track, media, 5));
    ASSERT_TRUE(project->execute(batch));
    const auto history = project->commandHistory();
    const CommandHistoryState before = history->state();
    const boost::weak_ptr<const ThreadSafe> token = project->token();
    project.reset();
    EXPECT_TRUE(token.expired());
    const std::string gone = "the project of this command history has gone";
    EXPECT_EQ(thrown<VelaMediaLibException>([&] { history->undo(); }), gone);
    EXPECT_EQ(thrown<VelaMediaLibException>([&] { history->redo(); }), gone);
    EXPECT_EQ(thrown<VelaMediaLibException>([&] { history->undoAll(); }), gone);
    EXPECT_EQ(thrown<VelaMediaLibException>([&] { history->execute(MoveCmd::create(track, media, 1)); }),
              gone);
    EXPECT_EQ(history->undoStack(), before.undoStack);
    EXPECT_TRUE(history->redoStack().empty());
    EXPECT_EQ(batch->commandHistory().handler(), nullptr);
    EXPECT_EQ(thrown<VelaMediaLibException>([&] { batch->commandHistory().undo(); }), "no command handler");
    EXPECT_EQ(media->startTime(), 10);
    media->trimEnd(5);
    EXPECT_EQ(media->duration(), 5);
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

// A magnetic track starts at zero without gaps; its closing is an undo step of
// its own, after the command that made the gap, even one combined with the last.
TEST_F(ProjectTest, AMagneticTrackClosesItsGapsAsAStepOfItsOwn) {
    track->magneticAttribute()->setValue(true);
    const MediaPtr early = place(-39, 10);
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0}));
    ASSERT_EQ(steps(), 2u);
    EXPECT_EQ(lastStepName(project), kClosing);
    project->undo();
    EXPECT_EQ(early->startTime(), -39);
    EXPECT_TRUE(project->redo());
    EXPECT_EQ(early->startTime(), 0);
    const MediaPtr second = place(10, 10);
    place(20, 10);
    EXPECT_EQ(steps(), 4u); // no gap: nothing closed
    project->combineNextCommand();
    project->execute(RemoveMediaCmd::create(track, second));
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 10}));
    ASSERT_EQ(steps(), 5u);
    EXPECT_EQ(lastStepName(project), kClosing);
    project->undo(); // the closing
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 20}));
    project->undo(); // the third clip's addition and the removal, as one step
    EXPECT_EQ(starts(), (std::vector<VelaTime>{0, 10}));

    project->execute(MoveCmd::create(track, second, -40)); // to [-30, -20), before the first
    EXPECT_EQ(second->startTime(), 0);
    EXPECT_EQ(early->startTime(), 10);
    project->undo();
    EXPECT_EQ(second->startTime(), -30);
    EXPECT_EQ(early->startTime(), 0);
    project->undo();
    EXPECT_EQ(second->startTime(), 10);
}

TEST_F(ProjectTest, TheMagnetizerQueuesItsClosingInsteadOfEditingFromANotification) {
    struct Watcher : CommandHistoryObserver {
        boost::weak_ptr<const ThreadSafe> token;
        int closings = 0, insideDelivery = 0;
        void commandWillExecute(const CommandPtr& command, uint32_t) override {
            if (command->name() != kClosing) return;
            ++closings;
            insideDelivery += NotifyDelay::isNotifying(token.lock());
        }
        void commandDidExecute(const CommandPtr&, uint32_t, bool) override {}
    };
    const auto watcher = boost::make_shared<Watcher>();
    watcher->token = project->token();
    project->commandHistory()->setObserver(watcher);
    track->magneticAttribute()->setValue(true);
    place(5, 10);
    EXPECT_GT(watcher->closings, 0);
    EXPECT_EQ(watcher->insideDelivery, 0);
}

// A host editing a magnetic track directly queues the closing; it runs before
// the next command, as a step of its own, so that undo still undoes that
// command, unless the track has left the project by then.
TEST_F(ProjectTest, ADirectEditOnAMagneticTrackClosesBeforeTheNextCommand) {
    const auto second = project->newMixer("second");
    const auto leaving = project->timeline()->newTrack();
    project->timeline()->addTrack(second, leaving);
    for (const auto& magnetic : {track, leaving}) magnetic->magneticAttribute()->setValue(true);
    const auto other = newTrack();
    const MediaPtr a = clip(10), b = clip(10), left = clip(10);
    leaving->addMedia(left, 7); // directly: the closing waits
    project->removeMixer(second);
    track->addMedia(a, 7);
    other->addMedia(b, 0);
    ASSERT_TRUE(project->execute(MoveCmd::create(other, b, 5)));
    EXPECT_EQ(a->startTime(), 0);
    EXPECT_EQ(left->startTime(), 7);
    EXPECT_EQ(steps(), 2u);
    EXPECT_EQ(project->commandHistory()->numFollowUps(), 0u);
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(b->startTime(), 0); // the move, not the closing
    EXPECT_EQ(a->startTime(), 0);
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(a->startTime(), 7); // then the closing
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

// Observers run after the clip is placed or moved: what they throw is theirs,
// and neither refuses the edit (half done) nor keeps the other observers from hearing.
TEST_F(ProjectTest, AnObserverThatThrowsNeitherRefusesTheEditNorSilencesTheOthers) {
    struct Thrower : TrackAddObserver, Observer {
        int told = 0;
        void onTrackAddMedia(Track&, const MediaPtr&) override {
            throw AddRemoveException("observer failed");
        }
        void onTrackRemoveMedia(Track&, const MediaPtr&) override {
            throw ValueException<double>("observer failed", 0);
        }
        void update(Observable*) override {
            ++told;
            throw InvalidTrimRangeException("observer failed", 0, Range<VelaTime>(0, 1));
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
    media->attachWithoutNotifyDelay(&thrower);
    EXPECT_TRUE(project->execute(MoveCmd::create(track, media, 5)));
    EXPECT_EQ(media->startTime(), 5);
    EXPECT_GE(thrower.told, 1);
    media->detach(&thrower);
    EXPECT_TRUE(project->execute(RemoveMediaCmd::create(track, media)));
    EXPECT_FALSE(track->hasMedia(media));
    EXPECT_EQ(steps(), 3u);
    EXPECT_EQ(counter.added, 1);
    EXPECT_EQ(counter.removed, 1);
    project->commandHistory()->undoAll();
    EXPECT_FALSE(track->hasMedia(media));
    EXPECT_EQ(counter.added, 2);
    track->detachAddObserver(&thrower);
    track->detachAddObserver(&counter);
}

// A clip placed where a moved clip stood makes the move's undo collide: the
// history keeps both stacks and the model stays as it is.
TEST_F(ProjectTest, AnUndoTheModelRefusesLeavesTheStacks) {
    const MediaPtr media = place(20, 10);
    ASSERT_TRUE(project->execute(MoveCmd::create(track, media, 30)));
    track->addMedia(clip(10), 20);
    const Snapshot before = snapshot();
    const size_t undoable = steps();
    EXPECT_FALSE(project->undo());
    EXPECT_EQ(snapshot(), before);
    EXPECT_EQ(media->startTime(), 50);
    EXPECT_EQ(steps(), undoable);
    EXPECT_TRUE(project->commandHistory()->redoStack().empty());
}

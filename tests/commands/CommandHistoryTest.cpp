#include "../JsonTestSupport.h"
#include "../ThreadTestSupport.h"

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/commands/framework/BatchCmd.h>
#include <VelaMediaLib/commands/framework/CommandHistory.h>
#include <VelaMediaLib/commands/framework/CommandPair.h>
#include <VelaMediaLib/commands/framework/LambdaMultiCommand.h>
#include <VelaMediaLib/commands/framework/NullCmd.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <stdexcept>
#include <thread>

using namespace VelaMediaLib;
using VelaMediaLib::testing::thrown;

namespace {

// Adds its amount to a counter; refuses when told to, on any step.
struct CountCmd : Command {
    CountCmd(int& into, int by, bool ok) : counter(into), amount(by), succeeds(ok) {}
    bool execute(CommandHandler*) override { return succeeds && (counter += amount, true); }
    bool unexecute(CommandHandler*) override {
        if (throwOnUndo) throw std::runtime_error("undo failed on purpose");
        return !refuseUndo && (counter -= amount, true);
    }
    bool reexecute(CommandHandler* handler) override { return !refuseRedo && execute(handler); }
    int& counter;
    int amount;
    bool succeeds, refuseUndo = false, refuseRedo = false, throwOnUndo = false;
};

// Counts, and queues a follow-up as an observer of its change would.
struct QueueingCmd : Command {
    QueueingCmd(CommandExecutor& to, int& into, CommandPtr then)
        : executor(to), counter(into), followUp(then) {}
    bool execute(CommandHandler*) override {
        ++counter;
        executor.queueFollowUp(followUp);
        seenBeforeFollowUp = counter;
        return true;
    }
    bool unexecute(CommandHandler*) override {
        --counter;
        executor.queueFollowUp(followUp); // heard during a replay: dropped
        return true;
    }
    CommandExecutor& executor;
    int& counter;
    CommandPtr followUp;
    int seenBeforeFollowUp = 0;
};

struct ThrowCmd : Command {
    bool execute(CommandHandler*) override { throw VelaMediaLibException("refused on purpose"); }
    bool unexecute(CommandHandler*) override { return true; }
};

// Records what the history tells its observer.
struct Recorder : CommandHistoryObserver {
    std::vector<uint32_t> before, after;
    std::vector<bool> results;
    void commandWillExecute(const CommandPtr&, uint32_t n) override { before.push_back(n); }
    void commandDidExecute(const CommandPtr&, uint32_t n, bool result) override {
        after.push_back(n);
        results.push_back(result);
    }
};

class History : public ::testing::Test {
protected:
    int counter = 0;
    CommandHistory history{nullptr};

    boost::shared_ptr<CountCmd> add(int amount, bool succeeds = true) {
        return boost::make_shared<CountCmd>(counter, amount, succeeds);
    }
    boost::shared_ptr<CountCmd> refused(int amount) { return add(amount, false); }
    std::string message(bool (CommandHistory::*step)()) {
        return thrown<VelaMediaLibException>([&] { (history.*step)(); });
    }
};

// History tests that hear edits on other threads, which ThreadSanitizer also runs.
using HistoryConcurrency = History;

} // namespace

TEST_F(History, UndoRedoLimitsAndANewCommandClearingRedo) {
    EXPECT_EQ(message(&CommandHistory::undo), "no commands to undo");
    EXPECT_EQ(message(&CommandHistory::redo), "no commands to redo");
    history.execute(add(1));
    history.execute(add(10));
    EXPECT_EQ((history.undo(), counter), 1);
    EXPECT_EQ((history.redo(), counter), 11);
    history.undo();
    history.execute(add(100));
    EXPECT_EQ(message(&CommandHistory::redo), "no commands to redo");
    EXPECT_EQ((history.undoAll(), counter), 0);
    EXPECT_EQ((history.redoAll(), counter), 101);

    history.setUndoLimit(2);
    const CommandPtr first = add(1), second = add(2), third = add(4);
    for (const CommandPtr& c : {first, second, third}) history.execute(c);
    EXPECT_EQ(history.undoStack(), (std::list<CommandPtr>{second, third}));
    history.setUndoLimit(0);
    EXPECT_TRUE(history.undoStack().empty());
    EXPECT_EQ(counter, 108);  // dropping commands undoes nothing
    history.setUndoLimit(-5); // stored as given: any negative limit is no cap
    EXPECT_EQ(history.undoLimit(), -5);
    for (int i = 0; i < 50; ++i) history.execute(add(1));
    EXPECT_EQ(history.undoStack().size(), 50u);
}

TEST_F(History, TransactionNumbersCountEveryStepAndFalseLeavesTheStacks) {
    const auto observer = boost::make_shared<Recorder>();
    history.setObserver(observer);
    EXPECT_EQ(history.transactionNumber(), 1u);
    history.execute(add(1));
    EXPECT_FALSE(history.execute(refused(5)));
    EXPECT_EQ(history.undoStack().size(), 1u);
    history.undo();
    history.redo();
    EXPECT_EQ(history.transactionNumber(), 5u);
    EXPECT_EQ(observer->before, (std::vector<uint32_t>{2, 3}));
    EXPECT_EQ(observer->after, (std::vector<uint32_t>{2, 3}));
    EXPECT_THROW(history.execute(boost::make_shared<ThrowCmd>()), VelaMediaLibException);
    EXPECT_EQ(history.undoStack().size(), 1u);
}

// A request to combine the next command waits past a refused one, and folds
// that command, not its follow-ups; an auto-combined gesture, follow-ups
// included, is one step.
TEST_F(History, CombiningFoldsTheCommandsItWasMeantFor) {
    history.execute(add(1));
    history.combineLastCommands(); // one command: nothing to fold
    EXPECT_EQ(history.undoStack().size(), 1u);
    history.execute(add(2));
    history.execute(add(4));
    history.combineLastCommands();
    ASSERT_EQ(history.undoStack().size(), 2u);
    EXPECT_EQ((history.undo(), counter), 1); // both folded commands undone at once
    ThrowCmd loose;
    EXPECT_THROW(loose.combine(add(1)), boost::bad_weak_ptr);

    history.combineNextCommand();
    EXPECT_FALSE(history.execute(refused(7)));
    history.execute(boost::make_shared<QueueingCmd>(history, counter, add(10)));
    ASSERT_EQ(history.undoStack().size(), 2u); // [1 + queueing], [follow-up]
    EXPECT_EQ((history.undo(), counter), 2);
    EXPECT_EQ((history.undo(), counter), 0);

    history.execute(add(1000)); // a step before the gesture, which it must not swallow
    history.beginAutoCommandCombining();
    history.execute(boost::make_shared<QueueingCmd>(history, counter, add(10)));
    history.execute(add(100));
    history.endAutoCommandCombining();
    history.execute(add(5)); // after the gesture: a step of its own
    EXPECT_EQ(history.undoStack().size(), 3u);
    EXPECT_EQ((history.undo(), history.undo(), counter), 1000);
}

TEST_F(History, ACompositeThatThrowsUndoesWhatItDid) {
    const auto composite = LambdaMultiCommand::create([&](MultiCommand* self) {
        self->execute(add(1));
        self->execute(add(2));
        self->execute(boost::make_shared<ThrowCmd>());
        self->execute(add(4));
    });
    EXPECT_THROW(history.execute(composite), VelaMediaLibException);
    EXPECT_EQ(counter, 0);
    EXPECT_TRUE(history.undoStack().empty());

    const auto withExecutor = LambdaMultiCommand::create([&](const MultiCommand::ExecuteFunc& run) {
        run(add(1));
        run(refused(50)); // not recorded
        run(add(2));
    });
    history.execute(withExecutor);
    EXPECT_EQ(counter, 3);
    EXPECT_EQ(withExecutor->numUndoCommands(), 2u);
    EXPECT_EQ((history.undo(), counter), 0);
    EXPECT_EQ((history.redo(), counter), 3);

    // When even the rollback fails, the original exception goes on.
    const auto unrollable = add(1);
    unrollable->throwOnUndo = true;
    const auto failing = LambdaMultiCommand::create([&](MultiCommand* self) {
        self->execute(unrollable);
        throw VelaMediaLibException("the first failure");
    });
    EXPECT_EQ(thrown<VelaMediaLibException>([&] { history.execute(failing); }), "the first failure");
    EXPECT_EQ(history.undoStack().size(), 1u);
}

TEST_F(History, BatchesPairsAndNothing) {
    const auto batch = BatchCmd::create(std::vector<CommandPtr>{add(1), add(2), add(4)});
    std::vector<double> progress;
    const auto callback = boost::make_shared<BatchCmd::ProgressCallback>([&](double f) {
        progress.push_back(f);
        return true;
    });
    batch->addProgressCallbackForExecuteCommands(callback); // held weakly
    history.execute(batch);
    EXPECT_EQ(counter, 7);
    EXPECT_EQ(progress, (std::vector<double>{1.0 / 3, 2.0 / 3, 1.0, 1.0}));
    EXPECT_EQ(batch->commandCount(), 3u);
    EXPECT_TRUE(batch->removeCommand(batch->commandHistory().undoStack().front()));
    EXPECT_EQ(batch->commandCount(), 2u);
    const CommandPtr single = add(8);
    EXPECT_NE(BatchCmd::combineCommands(single, add(1)), single);
    history.execute(CommandPair::create(add(10), add(20)));
    EXPECT_EQ(counter, 37);
    EXPECT_EQ((history.undo(), counter), 7);
    EXPECT_TRUE(history.execute(NullCmd::create()));
}

// A refused step leaves both stacks and says so; a composite, batch or pair
// refuses as a whole and puts back what ran.
TEST_F(History, ARefusalLeavesTheStacksAndPutsBackWhatRan) {
    const auto command = add(1);
    history.execute(add(10));
    history.execute(command);
    const CommandHistoryState before = history.state();
    command->refuseUndo = true;
    EXPECT_FALSE(history.undo());
    EXPECT_EQ(history.undoStack(), before.undoStack);
    EXPECT_TRUE(history.redoStack().empty());
    EXPECT_FALSE(history.undoAll()); // stops at the refusal
    EXPECT_EQ(counter, 11);
    command->refuseUndo = false;
    command->refuseRedo = true;
    EXPECT_TRUE(history.undo());
    EXPECT_FALSE(history.redo());
    EXPECT_EQ(history.undoStack().size(), 1u);
    EXPECT_EQ(history.redoStack().size(), 1u);
    EXPECT_EQ((history.undo(), counter), 0);

    EXPECT_FALSE(history.execute(BatchCmd::create(std::vector<CommandPtr>{add(1), add(2), refused(4)})));
    EXPECT_FALSE(history.execute(CommandPair::create(add(10), refused(1))));
    EXPECT_THROW(history.execute(CommandPair::create(add(10), boost::make_shared<ThrowCmd>())),
                 VelaMediaLibException);
    EXPECT_EQ(counter, 0);
    EXPECT_TRUE(history.undoStack().empty());

    const auto first = add(10);
    history.execute(CommandPair::create(first, add(20)));
    first->refuseUndo = true;
    EXPECT_FALSE(history.undo());
    EXPECT_EQ(counter, 30); // the second redone after the first refused

    const auto stubborn = add(2);
    const auto composite = LambdaMultiCommand::create([&](MultiCommand* self) {
        self->execute(add(1));
        self->execute(stubborn);
        self->execute(add(4));
    });
    history.execute(composite);
    stubborn->refuseUndo = true;
    EXPECT_FALSE(history.undo());
    EXPECT_EQ(counter, 37); // the 4 undone and redone again
    EXPECT_EQ(composite->numUndoCommands(), 3u);
    stubborn->refuseUndo = false;
    EXPECT_EQ((history.undo(), counter), 30);
    stubborn->refuseRedo = true;
    EXPECT_FALSE(history.redo());
    EXPECT_EQ(counter, 30);
    EXPECT_EQ(history.redoStack().size(), 1u);
}

TEST_F(History, FollowUpsRunAfterTheCommandAsStepsOfTheirOwn) {
    const auto command = boost::make_shared<QueueingCmd>(history, counter, add(10));
    EXPECT_TRUE(history.execute(command));
    EXPECT_EQ(command->seenBeforeFollowUp, 1); // not run from inside the command
    EXPECT_EQ(counter, 11);
    ASSERT_EQ(history.undoStack().size(), 2u);
    EXPECT_EQ((history.undo(), counter), 1); // the follow-up alone
    history.undo();                          // queues again while replaying: dropped
    EXPECT_EQ(history.numFollowUps(), 0u);
    EXPECT_EQ((history.redo(), counter), 1);
    EXPECT_EQ(history.numFollowUps(), 0u);
    EXPECT_EQ(history.redoStack().size(), 1u);
}

TEST_F(History, ARefusedOrThrowingFollowUpLeavesTheStacksAndTheOthersRun) {
    const auto observer = boost::make_shared<Recorder>();
    history.setObserver(observer);
    const auto composite = LambdaMultiCommand::create([&](MultiCommand* self) {
        self->queueFollowUp(refused(100));
        self->queueFollowUp(LambdaMultiCommand::create([&](MultiCommand* inner) {
            inner->execute(add(1000));
            throw VelaMediaLibException("the follow-up failed");
        }));
        self->queueFollowUp(add(10));
        self->execute(add(1));
    });
    EXPECT_TRUE(history.execute(composite));
    EXPECT_EQ(counter, 11);
    EXPECT_EQ(history.undoStack().size(), 2u); // the composite, then the one follow-up that took effect
    EXPECT_EQ(observer->results, (std::vector<bool>{true, false, false, true}));
}

// Queued while idle (a host editing directly), a follow-up runs before the
// next command, as a step of its own, so that undo undoes that command. A
// refused command drops only what it queued on its own thread: a host edit
// heard on another thread meanwhile still gets its follow-up.
TEST_F(HistoryConcurrency, FollowUpsOfARefusedCommandAreDroppedAndIdleOnesRunBeforeTheNext) {
    VelaMediaLib::testing::Deadline deadline;
    int other = 0;
    history.queueFollowUp(add(5));
    EXPECT_EQ(counter, 0);
    const auto refusing = LambdaMultiCommand::create([&](MultiCommand* self) {
        self->queueFollowUp(add(100));
        std::thread([&] { history.queueFollowUp(boost::make_shared<CountCmd>(other, 1, true)); }).join();
        self->executeFunc()(refused(1));
        throw VelaMediaLibException("refused");
    });
    EXPECT_THROW(history.execute(refusing), VelaMediaLibException);
    EXPECT_EQ(counter, 5); // the idle one ran first; the refused command's was dropped
    EXPECT_EQ(history.numFollowUps(), 1u);
    history.queueFollowUp(add(20));
    history.execute(add(1));
    EXPECT_EQ(other, 1);
    EXPECT_EQ(counter, 26);
    EXPECT_EQ(history.undoStack().size(), 4u);
    EXPECT_EQ((history.undo(), counter), 25); // the command, not the follow-ups before it
    history.queueFollowUp(add(40));
    history.runFollowUps();
    EXPECT_EQ(counter, 65);

    const auto loose = LambdaMultiCommand::create([&](MultiCommand* self) { self->queueFollowUp(add(1)); });
    EXPECT_THROW(loose->execute(static_cast<CommandHandler*>(nullptr)),
                 VelaMediaLibException); // no history runs it
}

// Threads that keep editing keep queueing; a drain takes only what was
// queued before it began (and what its own steps queue), so it ends.
TEST_F(HistoryConcurrency, ADrainRunsWhatWasQueuedBeforeItBegan) {
    VelaMediaLib::testing::Deadline deadline;
    struct Relay : Command {
        Relay(CommandHistory& into, int& counted) : history(into), runs(counted) {}
        bool execute(CommandHandler*) override {
            if (++runs < 50) // heard on another thread, which queues again
                std::thread([this] {
                    history.queueFollowUp(boost::make_shared<Relay>(history, runs));
                }).join();
            return true;
        }
        bool unexecute(CommandHandler*) override { return true; }
        CommandHistory& history;
        int& runs;
    };
    int runs = 0;
    history.queueFollowUp(boost::make_shared<Relay>(history, runs));
    history.runFollowUps();
    EXPECT_EQ(runs, 1);
    EXPECT_EQ(history.numFollowUps(), 1u);
    history.runFollowUps();
    EXPECT_EQ(runs, 2);
}

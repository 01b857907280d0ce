#include <VelaMediaLib/commands/framework/BatchCmd.h>
#include <VelaMediaLib/commands/framework/CommandHistory.h>
#include <VelaMediaLib/commands/framework/CommandPair.h>
#include <VelaMediaLib/commands/framework/LambdaMultiCommand.h>
#include <VelaMediaLib/commands/framework/NullCmd.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <stdexcept>
#include <thread>

using namespace VelaMediaLib;

namespace {

// Adds its amount to a counter; reports false when told to, on any step.
class CountCmd : public Command {
public:
    static boost::shared_ptr<CountCmd> create(int& counter, int amount, bool succeeds = true) {
        return boost::shared_ptr<CountCmd>(new CountCmd(counter, amount, succeeds));
    }
    bool execute(CommandHandler*) override {
        if (!succeeds_) return false;
        counter_ += amount_;
        return true;
    }
    bool unexecute(CommandHandler*) override {
        if (throwOnUndo) throw std::runtime_error("undo failed on purpose");
        if (refuseUndo) return false;
        counter_ -= amount_;
        return true;
    }
    bool reexecute(CommandHandler* handler) override { return !refuseRedo && execute(handler); }

    bool refuseUndo = false, refuseRedo = false, throwOnUndo = false;

private:
    CountCmd(int& counter, int amount, bool succeeds)
        : counter_(counter), amount_(amount), succeeds_(succeeds) {}
    int& counter_;
    int amount_;
    bool succeeds_;
};

// Counts, and queues a follow-up as an observer of its change would.
class QueueingCmd : public Command {
public:
    QueueingCmd(CommandExecutor& executor, int& counter, CommandPtr followUp)
        : executor_(executor), counter_(counter), followUp_(followUp) {}
    bool execute(CommandHandler*) override {
        ++counter_;
        executor_.queueFollowUp(followUp_);
        seenBeforeFollowUp = counter_;
        return true;
    }
    bool unexecute(CommandHandler*) override {
        --counter_;
        executor_.queueFollowUp(followUp_); // heard during a replay: dropped
        return true;
    }
    int seenBeforeFollowUp = 0;

private:
    CommandExecutor& executor_;
    int& counter_;
    CommandPtr followUp_;
};

struct ThrowCmd : Command {
    bool execute(CommandHandler*) override { throw VelaMediaLibException("refused on purpose"); }
    bool unexecute(CommandHandler*) override { return true; }
};

std::string messageOf(bool (CommandHistory::*step)(), CommandHistory& history) {
    try {
        (history.*step)();
    } catch (const VelaMediaLibException& e) {
        return e.what();
    }
    return "no exception";
}

class History : public ::testing::Test {
protected:
    int counter = 0;
    CommandHistory history{nullptr};
    CommandPtr add(int amount) { return CountCmd::create(counter, amount); }
};

} // namespace

TEST_F(History, UndoLimitsKeepTheNewestCommands) {
    history.setUndoLimit(2);
    const CommandPtr first = add(1), second = add(2), third = add(4);
    for (const CommandPtr& c : {first, second, third}) history.execute(c);
    EXPECT_EQ(history.undoStack(), (std::list<CommandPtr>{second, third}));
    history.setUndoLimit(0);
    EXPECT_TRUE(history.undoStack().empty());
    EXPECT_EQ(counter, 7);    // dropping commands undoes nothing
    history.setUndoLimit(-5); // stored as given: any negative limit is no cap
    EXPECT_EQ(history.undoLimit(), -5);
    for (int i = 0; i < 50; ++i) history.execute(add(1));
    EXPECT_EQ(history.undoStack().size(), 50u);
}

TEST_F(History, UndoRedoAndANewCommandClearingRedo) {
    EXPECT_EQ(messageOf(&CommandHistory::undo, history), "no commands to undo");
    EXPECT_EQ(messageOf(&CommandHistory::redo, history), "no commands to redo");
    history.execute(add(1));
    history.execute(add(10));
    history.undo();
    EXPECT_EQ(counter, 1);
    history.redo();
    EXPECT_EQ(counter, 11);
    history.undo();
    history.execute(add(100));
    EXPECT_EQ(messageOf(&CommandHistory::redo, history), "no commands to redo");
    history.undoAll();
    EXPECT_EQ(counter, 0);
    history.redoAll();
    EXPECT_EQ(counter, 101);
}

TEST_F(History, TransactionNumbersCountEveryStepAndFalseLeavesTheStacks) {
    struct Observer : CommandHistoryObserver {
        std::vector<uint32_t> before, after;
        void commandWillExecute(const CommandPtr&, uint32_t n) override { before.push_back(n); }
        void commandDidExecute(const CommandPtr&, uint32_t n, bool) override { after.push_back(n); }
    };
    const auto observer = boost::make_shared<Observer>();
    history.setObserver(observer);
    EXPECT_EQ(history.transactionNumber(), 1u);
    history.execute(add(1));
    EXPECT_FALSE(history.execute(CountCmd::create(counter, 5, false)));
    EXPECT_EQ(history.undoStack().size(), 1u);
    history.undo();
    history.redo();
    EXPECT_EQ(history.transactionNumber(), 5u);
    EXPECT_EQ(observer->before, (std::vector<uint32_t>{2, 3}));
    EXPECT_EQ(observer->after, (std::vector<uint32_t>{2, 3}));
    EXPECT_THROW(history.execute(boost::make_shared<ThrowCmd>()), VelaMediaLibException);
    EXPECT_EQ(history.undoStack().size(), 1u);
}

TEST_F(History, CombiningFoldsTheNewestTwo) {
    history.execute(add(1));
    history.combineLastCommands(); // one command: nothing to fold
    EXPECT_EQ(history.undoStack().size(), 1u);
    history.execute(add(2));
    history.execute(add(4));
    history.combineLastCommands();
    ASSERT_EQ(history.undoStack().size(), 2u);
    history.undo();
    EXPECT_EQ(counter, 1); // both folded commands undone at once
    ThrowCmd loose;
    EXPECT_THROW(loose.combine(add(1)), boost::bad_weak_ptr);
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
        run(CountCmd::create(counter, 50, false)); // refused: not recorded
        run(add(2));
    });
    history.execute(withExecutor);
    EXPECT_EQ(counter, 3);
    EXPECT_EQ(withExecutor->numUndoCommands(), 2u);
    history.undo();
    EXPECT_EQ(counter, 0);
    history.redo();
    EXPECT_EQ(counter, 3);
}

TEST_F(History, BatchesPairsAndNothing) {
    const auto batch = BatchCmd::create(std::vector<CommandPtr>{add(1), add(2), add(4)});
    std::vector<double> progress;
    const auto callback = boost::make_shared<BatchCmd::ProgressCallback>([&](double f) {
        progress.push_back(f);
        return true;
    });
    batch->addProgressCallbackForExecuteCommands(callback);
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
    history.undo();
    EXPECT_EQ(counter, 7);
    EXPECT_FALSE(history.execute(CommandPair::create(add(10), CountCmd::create(counter, 1, false))));
    EXPECT_EQ(counter, 7); // the first undone again when the second refuses
    EXPECT_TRUE(history.execute(NullCmd::create()));
}

TEST_F(History, ARefusedUndoOrRedoLeavesBothStacksAndSaysSo) {
    const auto command = CountCmd::create(counter, 1);
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
    EXPECT_EQ(counter, 10);
}

TEST_F(History, ACompositeReplaysBackWhenASubCommandRefusesToUndoOrRedo) {
    const auto stubborn = CountCmd::create(counter, 2);
    const auto composite = LambdaMultiCommand::create([&](MultiCommand* self) {
        self->execute(add(1));
        self->execute(stubborn);
        self->execute(add(4));
    });
    history.execute(composite);
    stubborn->refuseUndo = true;
    EXPECT_FALSE(history.undo());
    EXPECT_EQ(counter, 7); // the 4 undone and redone again
    EXPECT_EQ(composite->numUndoCommands(), 3u);
    stubborn->refuseUndo = false;
    EXPECT_TRUE(history.undo());
    EXPECT_EQ(counter, 0);
    stubborn->refuseRedo = true;
    EXPECT_FALSE(history.redo());
    EXPECT_EQ(counter, 0);
    EXPECT_EQ(history.redoStack().size(), 1u);
}

TEST_F(History, ABatchOrPairRefusesAsAWholeAndPutsBackWhatRan) {
    const auto batch =
        BatchCmd::create(std::vector<CommandPtr>{add(1), add(2), CountCmd::create(counter, 4, false)});
    EXPECT_FALSE(history.execute(batch));
    EXPECT_EQ(counter, 0);
    EXPECT_TRUE(history.undoStack().empty());

    EXPECT_THROW(history.execute(CommandPair::create(add(10), boost::make_shared<ThrowCmd>())),
                 VelaMediaLibException);
    EXPECT_EQ(counter, 0); // the first put back when the second threw
    const auto second = CountCmd::create(counter, 20);
    history.execute(CommandPair::create(add(10), second));
    const auto first = boost::dynamic_pointer_cast<CountCmd>(
        boost::dynamic_pointer_cast<CommandPair>(history.lastUndoCommand())->command1());
    first->refuseUndo = true;
    EXPECT_FALSE(history.undo());
    EXPECT_EQ(counter, 30); // the second redone after the first refused
}

TEST_F(History, ACompositeRethrowsTheOriginalExceptionWhenItsRollbackFails) {
    const auto unrollable = CountCmd::create(counter, 1);
    unrollable->throwOnUndo = true;
    const auto composite = LambdaMultiCommand::create([&](MultiCommand* self) {
        self->execute(unrollable);
        throw VelaMediaLibException("the first failure");
    });
    try {
        history.execute(composite);
        FAIL() << "no exception";
    } catch (const VelaMediaLibException& e) {
        EXPECT_STREQ(e.what(), "the first failure");
    }
    EXPECT_TRUE(history.undoStack().empty());
}

TEST_F(History, FollowUpsRunAfterTheCommandAsStepsOfTheirOwn) {
    const auto command = boost::make_shared<QueueingCmd>(history, counter, add(10));
    EXPECT_TRUE(history.execute(command));
    EXPECT_EQ(command->seenBeforeFollowUp, 1); // not run from inside the command
    EXPECT_EQ(counter, 11);
    ASSERT_EQ(history.undoStack().size(), 2u);
    history.undo(); // the follow-up alone
    EXPECT_EQ(counter, 1);
    history.undo(); // queues again while replaying: dropped
    EXPECT_EQ(history.numFollowUps(), 0u);
    history.redo();
    EXPECT_EQ(counter, 1);
    EXPECT_EQ(history.numFollowUps(), 0u);
    EXPECT_EQ(history.redoStack().size(), 1u);
}

TEST_F(History, ARefusedOrThrowingFollowUpLeavesTheStacksAndTheOthersRun) {
    struct Observer : CommandHistoryObserver {
        std::vector<bool> results;
        void commandWillExecute(const CommandPtr&, uint32_t) override {}
        void commandDidExecute(const CommandPtr&, uint32_t, bool result) override {
            results.push_back(result);
        }
    };
    const auto observer = boost::make_shared<Observer>();
    history.setObserver(observer);
    const auto composite = LambdaMultiCommand::create([&](MultiCommand* self) {
        self->queueFollowUp(CountCmd::create(counter, 100, false));
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
// next command, as a step of its own, so that undo undoes that command.
TEST_F(History, FollowUpsOfARefusedCommandAreDroppedAndIdleOnesRunBeforeTheNext) {
    history.queueFollowUp(add(5));
    EXPECT_EQ(counter, 0);
    const auto refused = LambdaMultiCommand::create([&](MultiCommand* self) {
        self->queueFollowUp(add(100));
        self->executeFunc()(CountCmd::create(counter, 1, false));
        throw VelaMediaLibException("refused");
    });
    EXPECT_THROW(history.execute(refused), VelaMediaLibException);
    EXPECT_EQ(counter, 5); // the idle one ran first; the refused command's was dropped
    EXPECT_EQ(history.numFollowUps(), 0u);
    history.queueFollowUp(add(20));
    history.execute(add(1));
    EXPECT_EQ(counter, 26);
    EXPECT_EQ(history.undoStack().size(), 3u);
    history.undo(); // the command, not the follow-up before it
    EXPECT_EQ(counter, 25);
    history.queueFollowUp(add(40));
    history.runFollowUps();
    EXPECT_EQ(counter, 65);

    const auto loose = LambdaMultiCommand::create([&](MultiCommand* self) { self->queueFollowUp(add(1)); });
    EXPECT_THROW(loose->execute(static_cast<CommandHandler*>(nullptr)),
                 VelaMediaLibException); // no history runs it
}

// Only what the refused step queued on its own thread answered it; a host
// edit heard on another thread meanwhile still gets its follow-up.
TEST_F(History, ARefusedCommandDropsOnlyTheFollowUpsItQueued) {
    int other = 0;
    const auto refused = LambdaMultiCommand::create([&](MultiCommand* self) {
        self->queueFollowUp(add(100));
        std::thread elsewhere([&] { history.queueFollowUp(CountCmd::create(other, 1)); });
        elsewhere.join();
        self->executeFunc()(CountCmd::create(counter, 1, false));
        throw VelaMediaLibException("refused");
    });
    EXPECT_THROW(history.execute(refused), VelaMediaLibException);
    EXPECT_EQ(history.numFollowUps(), 1u);
    history.execute(add(1));
    EXPECT_EQ(other, 1);
    EXPECT_EQ(counter, 1);
}

// Threads that keep editing keep queueing; a drain takes only what was
// queued before it began (and what its own steps queue), so it ends.
TEST_F(History, ADrainRunsWhatWasQueuedBeforeItBegan) {
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

TEST_F(History, CombiningFoldsTheCommandItWasMeantForNotItsFollowUps) {
    history.execute(add(1));
    history.combineNextCommand();
    EXPECT_FALSE(history.execute(CountCmd::create(counter, 7, false))); // refused: the request waits
    history.execute(boost::make_shared<QueueingCmd>(history, counter, add(10)));
    ASSERT_EQ(history.undoStack().size(), 2u); // [1 + queueing], [follow-up]
    history.undo();
    EXPECT_EQ(counter, 2);
    history.undo();
    EXPECT_EQ(counter, 0);

    history.beginAutoCommandCombining();
    history.execute(boost::make_shared<QueueingCmd>(history, counter, add(10)));
    history.execute(add(100));
    history.endAutoCommandCombining();
    EXPECT_EQ(history.undoStack().size(), 1u); // the gesture, follow-ups included, is one step
    history.undo();
    EXPECT_EQ(counter, 0);
}

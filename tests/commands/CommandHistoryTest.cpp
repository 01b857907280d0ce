#include <VelaMediaLib/commands/BatchCmd.h>
#include <VelaMediaLib/commands/CommandHistory.h>
#include <VelaMediaLib/commands/CommandPair.h>
#include <VelaMediaLib/commands/LambdaMultiCommand.h>
#include <VelaMediaLib/commands/NullCmd.h>
#include <VelaMediaLib/time/VelaMediaLibException.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

using namespace VelaMediaLib;

namespace {

// Adds its amount to a counter; reports false when told to.
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
        counter_ -= amount_;
        return true;
    }

private:
    CountCmd(int& counter, int amount, bool succeeds)
        : counter_(counter), amount_(amount), succeeds_(succeeds) {}
    int& counter_;
    int amount_;
    bool succeeds_;
};

struct ThrowCmd : Command {
    bool execute(CommandHandler*) override { throw VelaMediaLibException("refused on purpose"); }
    bool unexecute(CommandHandler*) override { return true; }
};

std::string messageOf(void (CommandHistory::*step)(), CommandHistory& history) {
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
    EXPECT_EQ(counter, 7); // dropping commands undoes nothing
    history.setUndoLimit(-1);
    for (int i = 0; i < 50; ++i) history.execute(add(1));
    EXPECT_EQ(history.undoStack().size(), 50u);
    EXPECT_EQ(history.undoLimit(), -1);
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

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/CommandHistory.h>

#include <boost/function.hpp>

namespace VelaMediaLib {

/// A command made of sub-commands, recorded on an inner history as they are
/// executed: undoing it undoes them in reverse order, redoing it redoes them.
/// A composite is never left half-applied: if issuing the sub-commands
/// throws, every finished one is undone and the original exception goes on;
/// if a sub-command it cannot do without refuses (executeRequired), the
/// finished ones are undone and execute reports false; if one of them refuses
/// to undo or redo, those already replayed are replayed back and unexecute or
/// reexecute reports false. When even that fails the model cannot be put
/// back: VelaMediaLibFatalException. The inner history has the handler only
/// while the composite runs (none between runs: a composite kept in a stack
/// holds no pointer to a handler that may have gone).
class VELAMEDIALIB_API MultiCommand : public Command, public CommandExecutor {
public:
    typedef boost::function<bool(const CommandPtr&)> ExecuteFunc;

    MultiCommand();

    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    bool reexecute(CommandHandler* handler) override;
    /// Records a sub-command: executes it through the inner history.
    bool execute(const CommandPtr& command) override;
    /// Passed on to the history running this composite (a follow-up runs
    /// after the outermost command); throws VelaMediaLibException when none runs it.
    void queueFollowUp(const CommandPtr& command) override { history_.queueFollowUp(command); }
    bool isReplaying() const override { return history_.isReplaying(); }
    size_t numUndoCommands() const { return history_.undoStack().size(); }
    CommandHistory& commandHistory() { return history_; }
    /// This composite's execute, as a function handed to lambdas.
    ExecuteFunc executeFunc();

protected:
    /// Issues the sub-commands through this composite's execute.
    virtual void executeCommands(const CommandHandler* handler) = 0;
    /// Executes a sub-command the composite cannot do without: when it
    /// refuses, the whole composite is refused (execute rolls back and reports
    /// false), and the caller should issue nothing more.
    bool executeRequired(const CommandPtr& command);
    CommandHandler* handler() const { return history_.handler(); }

private:
    void rollBack();
    /// Replays every sub-command one way; on a refusal or an exception the
    /// ones replayed so far go back the other way.
    bool replayAll(bool backwards);
    void replayBack(size_t count, bool backwards);

    CommandHistory history_;
    bool refused_ = false;
};

} // namespace VelaMediaLib

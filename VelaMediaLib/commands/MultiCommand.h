#pragma once

#include <VelaMediaLib/commands/CommandHistory.h>

#include <boost/function.hpp>

namespace VelaMediaLib {

/// A command made of sub-commands, recorded on an inner history as they are
/// executed: undoing it undoes them in reverse order, redoing it redoes them.
/// If issuing the sub-commands throws, every finished one is undone before
/// the exception goes on, so a composite is never left half-applied.
class MultiCommand : public Command, public CommandExecutor {
public:
    typedef boost::function<bool(const CommandPtr&)> ExecuteFunc;

    MultiCommand() : history_(nullptr) {}

    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    bool reexecute(CommandHandler* handler) override;
    /// Records a sub-command: executes it through the inner history.
    bool execute(const CommandPtr& command) override;
    size_t numUndoCommands() const { return history_.undoStack().size(); }
    CommandHistory& commandHistory() { return history_; }
    /// This composite's execute, as a function handed to lambdas.
    ExecuteFunc executeFunc();

protected:
    /// Issues the sub-commands through this composite's execute.
    virtual void executeCommands(const CommandHandler* handler) = 0;
    CommandHandler* handler() const { return history_.handler(); }

private:
    CommandHistory history_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/commands/CommandExecutor.h>
#include <VelaMediaLib/model/Cloneable.h>
#include <VelaMediaLib/time/SubjectWithMutex.h>

#include <cstdint>
#include <list>

namespace VelaMediaLib {

/// Told before and after each command the history executes.
class CommandHistoryObserver {
public:
    virtual ~CommandHistoryObserver() = default;
    virtual void commandWillExecute(const CommandPtr& command, uint32_t transactionNumber) = 0;
    virtual void commandDidExecute(const CommandPtr& command, uint32_t transactionNumber, bool result) = 0;
};

/// Both stacks, as a history had them.
struct CommandHistoryState {
    std::list<CommandPtr> undoStack;
    std::list<CommandPtr> redoStack;
};

/// The undo and redo stacks. Its observers hear after every change of the
/// stacks. When given the project's token, each execute, undo and redo runs
/// under a notify delay, so every object it changed notifies once at the end.
class CommandHistory : public VelaObject, public Cloneable, public SubjectWithMutex, public CommandExecutor {
public:
    explicit CommandHistory(CommandHandler* handler, const boost::weak_ptr<const ThreadSafe>& token =
                                                         boost::weak_ptr<const ThreadSafe>());

    bool execute(const CommandPtr& command) override;
    /// Throws VelaMediaLibException "no commands to undo".
    void undo();
    /// Throws VelaMediaLibException "no commands to redo".
    void redo();
    void undoAll();
    void redoAll();
    /// Folds the newest two commands into one with combine; fewer than two: nothing.
    void combineLastCommands();
    /// -1: no limit; 0 or more: the most commands the undo stack keeps.
    void setUndoLimit(int limit);
    int undoLimit() const { return undoLimit_; }
    const std::list<CommandPtr>& undoStack() const { return state_.undoStack; }
    const std::list<CommandPtr>& redoStack() const { return state_.redoStack; }
    CommandPtr lastUndoCommand() const;
    uint32_t transactionNumber() const { return transactionNumber_; }
    CommandHistoryState state() const { return state_; }
    /// Puts both stacks back as they were; commands in neither are released.
    void restoreState(const CommandHistoryState& state);
    void setObserver(const boost::shared_ptr<CommandHistoryObserver>& observer) { observer_ = observer; }
    void setHandler(CommandHandler* handler) { handler_ = handler; }
    CommandHandler* handler() const { return handler_; }
    bool isReplaying() const override { return replaying_ > 0; }
    /// A history with the same handler, limit and stacks (sharing the commands).
    boost::shared_ptr<CommandHistory> clone() const;

private:
    /// Runs one step under the project's notify delay, unless one is being delivered.
    template <typename Step>
    void delayedNotifications(Step step);
    void trimToLimit();
    template <typename Replay>
    void replay(std::list<CommandPtr>& from, std::list<CommandPtr>& to, const char* emptyMessage,
                Replay step);

    CommandHandler* handler_;
    boost::weak_ptr<const ThreadSafe> token_;
    CommandHistoryState state_;
    int undoLimit_ = -1;
    uint32_t transactionNumber_ = 1;
    int replaying_ = 0;
    boost::weak_ptr<CommandHistoryObserver> observer_;
};

} // namespace VelaMediaLib

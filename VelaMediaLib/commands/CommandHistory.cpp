#include <VelaMediaLib/commands/CommandHistory.h>

#include <VelaMediaLib/time/NotifyDelay.h>
#include <VelaMediaLib/time/VelaMediaLibException.h>

#include <memory>

namespace VelaMediaLib {

CommandHistory::CommandHistory(CommandHandler* handler, const boost::weak_ptr<const ThreadSafe>& token)
    : handler_(handler), token_(token) {}

template <typename Step>
void CommandHistory::delayedNotifications(Step step) {
    std::unique_ptr<NotifyDelay> delay;
    if (const boost::shared_ptr<const ThreadSafe> project = token_.lock())
        if (!NotifyDelay::isNotifying(project)) delay.reset(new NotifyDelay(project));
    step();
}

void CommandHistory::trimToLimit() {
    if (undoLimit_ < 0) return;
    while (state_.undoStack.size() > size_t(undoLimit_)) state_.undoStack.pop_front();
}

bool CommandHistory::execute(const CommandPtr& command) {
    if (!command) throw VelaMediaLibException("no command to execute");
    const uint32_t transaction = ++transactionNumber_;
    const boost::shared_ptr<CommandHistoryObserver> observer = observer_.lock();
    if (observer) observer->commandWillExecute(command, transaction);
    bool done = false;
    delayedNotifications([&] {
        done = command->execute(handler_);
        if (!done) return;
        state_.undoStack.push_back(command);
        state_.redoStack.clear();
        trimToLimit();
    });
    if (done) notify();
    if (observer) observer->commandDidExecute(command, transaction, done);
    return done;
}

// Undo and redo: the newest command of one stack replays (counted as
// replaying, under the notify delay) and moves to the other stack; a command
// whose replay throws stays where it was.
template <typename Replay>
void CommandHistory::replay(std::list<CommandPtr>& from, std::list<CommandPtr>& to, const char* emptyMessage,
                            Replay step) {
    if (from.empty()) throw VelaMediaLibException(emptyMessage);
    ++transactionNumber_;
    const CommandPtr command = from.back();
    ++replaying_;
    try {
        delayedNotifications([&] { step(*command); });
    } catch (...) {
        --replaying_;
        throw;
    }
    --replaying_;
    from.pop_back();
    to.push_back(command);
    notify();
}

void CommandHistory::undo() {
    replay(state_.undoStack, state_.redoStack, "no commands to undo",
           [&](Command& c) { c.unexecute(handler_); });
}

void CommandHistory::redo() {
    replay(state_.redoStack, state_.undoStack, "no commands to redo",
           [&](Command& c) { c.reexecute(handler_); });
}

void CommandHistory::undoAll() {
    while (!state_.undoStack.empty()) undo();
}

void CommandHistory::redoAll() {
    while (!state_.redoStack.empty()) redo();
}

void CommandHistory::combineLastCommands() {
    if (state_.undoStack.size() < 2) return;
    const CommandPtr later = state_.undoStack.back();
    const CommandPtr earlier = *std::prev(state_.undoStack.end(), 2);
    const CommandPtr combined = earlier->combine(later); // may throw: the stack is still whole
    state_.undoStack.pop_back();
    state_.undoStack.pop_back();
    state_.undoStack.push_back(combined);
    notify();
}

void CommandHistory::setUndoLimit(int limit) {
    undoLimit_ = limit < 0 ? -1 : limit;
    trimToLimit();
    notify();
}

CommandPtr CommandHistory::lastUndoCommand() const {
    return state_.undoStack.empty() ? CommandPtr() : state_.undoStack.back();
}

void CommandHistory::restoreState(const CommandHistoryState& state) {
    state_ = state;
    notify();
}

boost::shared_ptr<CommandHistory> CommandHistory::clone() const {
    const boost::shared_ptr<CommandHistory> copy(new CommandHistory(handler_, token_));
    copy->state_ = state_;
    copy->undoLimit_ = undoLimit_;
    copy->transactionNumber_ = transactionNumber_;
    return copy;
}

} // namespace VelaMediaLib

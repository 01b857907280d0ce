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

void CommandHistory::undo() {
    if (state_.undoStack.empty()) throw VelaMediaLibException("no commands to undo");
    ++transactionNumber_;
    const CommandPtr command = state_.undoStack.back();
    ++replaying_;
    try {
        delayedNotifications([&] { command->unexecute(handler_); });
    } catch (...) {
        --replaying_;
        throw;
    }
    --replaying_;
    state_.undoStack.pop_back();
    state_.redoStack.push_back(command);
    notify();
}

void CommandHistory::redo() {
    if (state_.redoStack.empty()) throw VelaMediaLibException("no commands to redo");
    ++transactionNumber_;
    const CommandPtr command = state_.redoStack.back();
    ++replaying_;
    try {
        delayedNotifications([&] { command->reexecute(handler_); });
    } catch (...) {
        --replaying_;
        throw;
    }
    --replaying_;
    state_.redoStack.pop_back();
    state_.undoStack.push_back(command);
    notify();
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

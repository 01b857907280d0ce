#include <VelaMediaLib/commands/framework/MultiCommand.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <exception>

namespace VelaMediaLib {
namespace {

// The inner history has the handler only while the composite runs: a
// composite kept in a stack must not keep a handler that may go meanwhile.
class HandlerFor {
public:
    HandlerFor(CommandHistory& history, CommandHandler* handler) : history_(history) {
        history_.setHandler(handler);
    }
    ~HandlerFor() { history_.setHandler(nullptr); }
    HandlerFor(const HandlerFor&) = delete;
    HandlerFor& operator=(const HandlerFor&) = delete;

private:
    CommandHistory& history_;
};

} // namespace

MultiCommand::MultiCommand() : history_(nullptr) { history_.inner_ = true; }

void MultiCommand::rollBack() {
    if (!history_.undoAll())
        throw VelaMediaLibFatalException("a composite could not undo its finished sub-commands");
    history_.restoreState(CommandHistoryState());
}

bool MultiCommand::execute(CommandHandler* handler) {
    const HandlerFor running(history_, handler);
    refused_ = false;
    try {
        executeCommands(handler);
    } catch (...) {
        const std::exception_ptr original = std::current_exception();
        try {
            rollBack();
        } catch (...) {
            // The rollback's own failure must not hide what went wrong first.
        }
        std::rethrow_exception(original);
    }
    if (!refused_) return true;
    rollBack();
    return false;
}

bool MultiCommand::executeRequired(const CommandPtr& command) {
    if (execute(command)) return true;
    refused_ = true;
    return false;
}

void MultiCommand::replayBack(size_t count, bool backwards) {
    for (size_t i = 0; i < count; ++i)
        if (!(backwards ? history_.redo() : history_.undo()))
            throw VelaMediaLibFatalException("a composite could not put back its replayed sub-commands");
}

bool MultiCommand::replayAll(bool backwards) {
    const std::list<CommandPtr>& from = backwards ? history_.undoStack() : history_.redoStack();
    size_t replayed = 0;
    try {
        while (!from.empty() && (backwards ? history_.undo() : history_.redo())) ++replayed;
    } catch (...) {
        const std::exception_ptr original = std::current_exception();
        try {
            replayBack(replayed, backwards);
        } catch (...) {}
        std::rethrow_exception(original);
    }
    if (from.empty()) return true;
    replayBack(replayed, backwards);
    return false;
}

bool MultiCommand::unexecute(CommandHandler* handler) {
    const HandlerFor running(history_, handler);
    return replayAll(true);
}

bool MultiCommand::reexecute(CommandHandler* handler) {
    const HandlerFor running(history_, handler);
    return replayAll(false);
}

bool MultiCommand::execute(const CommandPtr& command) { return history_.execute(command); }

MultiCommand::ExecuteFunc MultiCommand::executeFunc() {
    return [this](const CommandPtr& command) { return execute(command); };
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/CommandHistory.h>

#include <VelaMediaLib/time/NotifyDelay.h>
#include <VelaMediaLib/time/VelaMediaLibException.h>

#include <memory>

namespace VelaMediaLib {
namespace {

// The top-level history running a step on this thread; composites pass the
// follow-ups queued on them to it.
thread_local CommandHistory* tRunning = nullptr;

// Counts a step in for as long as it lives, whichever way the step ends.
class Counted {
public:
    explicit Counted(int& count) : count_(count) { ++count_; }
    ~Counted() { --count_; }
    Counted(const Counted&) = delete;
    Counted& operator=(const Counted&) = delete;

private:
    int& count_;
};

} // namespace

class CommandHistory::Running {
public:
    explicit Running(CommandHistory& history) : previous_(tRunning), claimed_(!history.inner_) {
        if (claimed_) tRunning = &history;
    }
    ~Running() {
        if (claimed_) tRunning = previous_;
    }
    Running(const Running&) = delete;
    Running& operator=(const Running&) = delete;

private:
    CommandHistory* previous_;
    bool claimed_;
};

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

bool CommandHistory::record(const CommandPtr& command) {
    const uint32_t transaction = ++transactionNumber_;
    const boost::shared_ptr<CommandHistoryObserver> observer = observer_.lock();
    if (observer) observer->commandWillExecute(command, transaction);
    bool done = false;
    {
        const Running running(*this);
        const Counted counted(depth_);
        delayedNotifications([&] {
            done = command->execute(handler_);
            if (!done) return;
            state_.undoStack.push_back(command);
            state_.redoStack.clear();
            trimToLimit();
        });
    }
    if (done) notify();
    if (observer) observer->commandDidExecute(command, transaction, done);
    return done;
}

// The command has been recorded; it has already taken effect, so a fold that
// fails leaves it as a step of its own rather than failing the command.
void CommandHistory::fold(bool followUp) {
    const bool next = combineNext_ && !followUp;
    if (next) combineNext_ = false;
    const bool automatic = autoCombining_ && autoCombinedFirst_;
    if (autoCombining_) autoCombinedFirst_ = true;
    if (!next && !automatic) return;
    try {
        combineLastCommands();
    } catch (...) {}
}

bool CommandHistory::execute(const CommandPtr& command) {
    if (!command) throw VelaMediaLibException("no command to execute");
    if (depth_ > 0 || draining_) return record(command); // a nested step: the outer one folds and drains
    const size_t queued = followUps_.size();
    bool done = false;
    try {
        done = record(command);
    } catch (...) {
        followUps_.resize(queued); // they answered changes that were rolled back
        throw;
    }
    if (!done) {
        followUps_.resize(queued);
        return false;
    }
    fold(false);
    runFollowUps();
    return true;
}

void CommandHistory::queueFollowUp(const CommandPtr& command) {
    if (!command) throw VelaMediaLibException("no follow-up to queue");
    if (inner_) {
        if (!tRunning) throw VelaMediaLibException("no command history runs this composite's follow-up");
        tRunning->queueFollowUp(command);
        return;
    }
    if (replaying_ > 0) return; // the replay brings back the follow-ups recorded then
    followUps_.push_back(command);
}

// Like a host command's, the follow-ups queued by a follow-up that refused or
// threw answered changes that were rolled back, and are dropped.
void CommandHistory::runFollowUps() {
    if (inner_ || draining_ || depth_ > 0 || replaying_ > 0) return;
    const Counted draining(draining_);
    while (!followUps_.empty()) {
        const CommandPtr next = followUps_.front();
        followUps_.pop_front();
        const size_t queued = followUps_.size();
        bool done = false, threw = false;
        try {
            done = record(next);
        } catch (...) {
            threw = true; // it has rolled itself back; the edit it answered stands
        }
        if (done) {
            fold(true);
            continue;
        }
        followUps_.resize(queued);
        if (threw)
            if (const boost::shared_ptr<CommandHistoryObserver> observer = observer_.lock())
                observer->commandDidExecute(next, transactionNumber_, false);
    }
}

// Undo and redo: the newest command of one stack replays (counted as
// replaying, under the notify delay) and moves to the other stack; a command
// whose replay throws or refuses stays where it was.
template <typename Replay>
bool CommandHistory::replay(std::list<CommandPtr>& from, std::list<CommandPtr>& to, const char* emptyMessage,
                            Replay step) {
    if (from.empty()) throw VelaMediaLibException(emptyMessage);
    ++transactionNumber_;
    const CommandPtr command = from.back();
    bool done = false;
    {
        const Running running(*this);
        const Counted counted(replaying_);
        delayedNotifications([&] { done = step(*command); });
    }
    if (!done) return false;
    from.pop_back();
    to.push_back(command);
    trimToLimit();
    notify();
    return true;
}

bool CommandHistory::undo() {
    return replay(state_.undoStack, state_.redoStack, "no commands to undo",
                  [&](Command& c) { return c.unexecute(handler_); });
}

bool CommandHistory::redo() {
    return replay(state_.redoStack, state_.undoStack, "no commands to redo",
                  [&](Command& c) { return c.reexecute(handler_); });
}

bool CommandHistory::undoAll() {
    while (!state_.undoStack.empty())
        if (!undo()) return false;
    return true;
}

bool CommandHistory::redoAll() {
    while (!state_.redoStack.empty())
        if (!redo()) return false;
    return true;
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

void CommandHistory::beginAutoCommandCombining() {
    autoCombining_ = true;
    autoCombinedFirst_ = false;
}

void CommandHistory::setUndoLimit(int limit) {
    undoLimit_ = limit;
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

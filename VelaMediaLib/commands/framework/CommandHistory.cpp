#include <VelaMediaLib/commands/framework/CommandHistory.h>

#include <VelaMediaLib/time/sync/NotifyDelay.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <algorithm>
#include <memory>

namespace VelaMediaLib {
namespace {

// The steps of histories running on this thread, innermost first: composites
// pass their follow-ups to the innermost top-level history, and observers ask
// whether what they hear is a replay.
struct Frame {
    CommandHistory* history;
    bool replaying;
    bool topLevel;
    const Frame* outer;
};
thread_local const Frame* tFrames = nullptr;

CommandHistory* topLevelRunningHere() {
    for (const Frame* frame = tFrames; frame; frame = frame->outer)
        if (frame->topLevel) return frame->history;
    return nullptr;
}

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

bool isEmpty(const boost::weak_ptr<const ThreadSafe>& token) {
    const boost::weak_ptr<const ThreadSafe> none;
    return !token.owner_before(none) && !none.owner_before(token);
}

} // namespace

class CommandHistory::Running {
public:
    Running(CommandHistory& history, bool replaying) : frame_{&history, replaying, !history.inner_, tFrames} {
        tFrames = &frame_;
    }
    ~Running() { tFrames = frame_.outer; }
    Running(const Running&) = delete;
    Running& operator=(const Running&) = delete;

private:
    Frame frame_;
};

CommandHistory::CommandHistory(CommandHandler* handler, const boost::weak_ptr<const ThreadSafe>& token)
    : handler_(handler), token_(token), bound_(!isEmpty(token)) {}

CommandHistory::ProjectHold CommandHistory::holdProject() const {
    if (!bound_) return ProjectHold();
    ProjectHold project = token_.lock();
    if (!project) throw VelaMediaLibException("the project of this command history has gone");
    return project;
}

template <typename Step>
void CommandHistory::delayedNotifications(const ProjectHold& project, Step step) {
    std::unique_ptr<NotifyDelay> delay;
    if (project && !NotifyDelay::isNotifying(project)) delay.reset(new NotifyDelay(project));
    step();
}

bool CommandHistory::runsHere() const {
    for (const Frame* frame = tFrames; frame; frame = frame->outer)
        if (frame->history == this) return true;
    return false;
}

bool CommandHistory::isReplaying() const {
    for (const Frame* frame = tFrames; frame; frame = frame->outer)
        if (frame->history == this && frame->replaying) return true;
    return false;
}

void CommandHistory::trimToLimit() {
    if (undoLimit_ < 0) return;
    while (state_.undoStack.size() > size_t(undoLimit_)) state_.undoStack.pop_front();
}

bool CommandHistory::record(const CommandPtr& command, const ProjectHold& project) {
    const uint32_t transaction = ++transactionNumber_;
    const boost::shared_ptr<CommandHistoryObserver> observer = observer_.lock();
    if (observer) observer->commandWillExecute(command, transaction);
    bool done = false;
    {
        const Running running(*this, false);
        const Counted counted(depth_);
        delayedNotifications(project, [&] {
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
    const ProjectHold project = holdProject();
    if (depth_ > 0 || draining_) return record(command, project); // nested: the outer step folds and drains
    if (inner_) { // a composite's: its follow-ups went to the history running it, which drains them
        if (!record(command, project)) return false;
        fold(false);
        return true;
    }
    drain(project); // what idle time queued answers earlier changes: it goes first
    const uint64_t mark = queueMark();
    bool done = false;
    try {
        done = record(command, project);
    } catch (...) {
        dropAnswersSince(mark);
        throw;
    }
    if (!done) {
        dropAnswersSince(mark);
        return false;
    }
    fold(false);
    drain(project);
    return true;
}

// A replay brings back the follow-ups recorded then; only the thread running
// a step can know that what it queues answers that step.
void CommandHistory::queueFollowUp(const CommandPtr& command) {
    if (!command) throw VelaMediaLibException("no follow-up to queue");
    if (inner_) {
        CommandHistory* const running = topLevelRunningHere();
        if (!running) throw VelaMediaLibException("no command history runs this composite's follow-up");
        running->queueFollowUp(command);
        return;
    }
    if (isReplaying()) return;
    const bool answersStep = runsHere();
    const std::lock_guard<std::mutex> lock(followUpMutex_);
    followUps_.push_back(FollowUp{command, followUpCount_++, answersStep});
}

size_t CommandHistory::numFollowUps() const {
    const std::lock_guard<std::mutex> lock(followUpMutex_);
    return followUps_.size();
}

uint64_t CommandHistory::queueMark() const {
    const std::lock_guard<std::mutex> lock(followUpMutex_);
    return followUpCount_;
}

void CommandHistory::dropAnswersSince(uint64_t mark) {
    const std::lock_guard<std::mutex> lock(followUpMutex_);
    followUps_.erase(std::remove_if(followUps_.begin(), followUps_.end(),
                                    [&](const FollowUp& f) { return f.answersStep && f.number >= mark; }),
                     followUps_.end());
}

CommandPtr CommandHistory::nextFollowUp(uint64_t limit) {
    const std::lock_guard<std::mutex> lock(followUpMutex_);
    const auto next = std::find_if(followUps_.begin(), followUps_.end(),
                                   [&](const FollowUp& f) { return f.number < limit || f.answersStep; });
    if (next == followUps_.end()) return CommandPtr();
    const CommandPtr command = next->command;
    followUps_.erase(next);
    return command;
}

void CommandHistory::runFollowUps() {
    if (inner_ || draining_ || depth_ > 0 || isReplaying()) return;
    drain(holdProject());
}

// Each follow-up is a step of its own; one that refused or threw has rolled
// itself back (the edit it answered stands), and what it queued is dropped.
// What other threads queue once the drain has begun waits for the next one,
// so that threads editing without pause cannot keep it running.
void CommandHistory::drain(const ProjectHold& project) {
    const Counted draining(draining_);
    const uint64_t limit = queueMark();
    while (const CommandPtr next = nextFollowUp(limit)) {
        const uint64_t mark = queueMark();
        bool done = false, threw = false;
        try {
            done = record(next, project);
        } catch (...) {
            threw = true;
        }
        if (done) {
            fold(true);
            continue;
        }
        dropAnswersSince(mark);
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
    const ProjectHold project = holdProject();
    if (from.empty()) throw VelaMediaLibException(emptyMessage);
    ++transactionNumber_;
    const CommandPtr command = from.back();
    bool done = false;
    {
        const Running running(*this, true);
        delayedNotifications(project, [&] { done = step(*command); });
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

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/CommandExecutor.h>
#include <VelaMediaLib/base/Cloneable.h>
#include <VelaMediaLib/time/sync/SubjectWithMutex.h>

#include <cstdint>
#include <deque>
#include <list>
#include <mutex>

namespace VelaMediaLib {

class MultiCommand;

/// Told before and after each command the history executes, follow-ups included.
class VELAMEDIALIB_API CommandHistoryObserver {
public:
    virtual ~CommandHistoryObserver() = default;
    virtual void commandWillExecute(const CommandPtr& command, uint32_t transactionNumber) = 0;
    virtual void commandDidExecute(const CommandPtr& command, uint32_t transactionNumber, bool result) = 0;
};

/// Both stacks, as a history had them.
struct VELAMEDIALIB_API CommandHistoryState {
    std::list<CommandPtr> undoStack;
    std::list<CommandPtr> redoStack;
};

/// The undo and redo stacks. Its observers hear after every change of the
/// stacks. When given the project's token, each execute, undo and redo runs
/// under a notify delay, so every object it changed notifies once at the end.
///
/// The handler is not owned. A history given the project's token holds the
/// project alive through it for every step, and once the project has gone
/// refuses every step (execute, undo, redo, runFollowUps) with
/// VelaMediaLibException "the project of this command history has gone",
/// both stacks unchanged: its handler, usually the project, went with it.
///
/// Follow-ups queued while a command runs (by observers hearing its changes)
/// run after it, once its delay has ended, each recorded as a step of its
/// own; a refused one is not recorded, one that throws leaves the stacks
/// alone and the rest still run. Follow-ups queued while the history is idle
/// (a host editing the model directly, here or on another thread) run before
/// the next command, as steps of their own, or when the host calls
/// runFollowUps. Undo and redo replay recorded steps only: follow-ups queued
/// by the replay are dropped. Queueing is safe from any thread; everything
/// else belongs to one editing thread at a time.
class VELAMEDIALIB_API CommandHistory : public VelaObject,
                                        public Cloneable,
                                        public SubjectWithMutex,
                                        public CommandExecutor {
public:
    explicit CommandHistory(CommandHandler* handler, const boost::weak_ptr<const ThreadSafe>& token =
                                                         boost::weak_ptr<const ThreadSafe>());

    /// Runs the follow-ups waiting from idle time, then executes and records
    /// the command, folds it as asked (combineNextCommand, auto-combining),
    /// then runs the follow-ups it caused.
    bool execute(const CommandPtr& command) override;
    /// Safe from any thread. Queued by a step running on this thread, it
    /// answers that step (and is dropped if the step refuses or throws);
    /// queued otherwise, it waits for the next execute or runFollowUps.
    void queueFollowUp(const CommandPtr& command) override;
    /// Runs every waiting follow-up now (nothing while a step of this history
    /// runs on this thread: that step's end runs them).
    void runFollowUps();
    size_t numFollowUps() const;
    /// False when the command refused to undo: both stacks stay as they were.
    /// Throws VelaMediaLibException "no commands to undo".
    bool undo();
    /// False when the command refused to redo. Throws "no commands to redo".
    bool redo();
    /// Stop at the first refusal and report false.
    bool undoAll();
    bool redoAll();
    /// Folds the newest two commands into one with combine; fewer than two: nothing.
    void combineLastCommands();
    /// The next command executed here that takes effect is folded into the
    /// step before it; the follow-ups it causes stay steps of their own.
    void combineNextCommand() { combineNext_ = true; }
    /// Until the end, every step after the first (follow-ups included) is
    /// folded into one, so the whole gesture undoes at once.
    void beginAutoCommandCombining();
    void endAutoCommandCombining() { autoCombining_ = false; }
    bool isAutoCommandCombining() const { return autoCombining_; }
    /// Below 0: no limit; 0 or more: the most commands the undo stack keeps.
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
    /// Not owned: the host keeps a handler of its own alive while the history runs steps.
    void setHandler(CommandHandler* handler) { handler_ = handler; }
    CommandHandler* handler() const { return handler_; }
    /// Whether this thread is undoing or redoing a step of this history.
    bool isReplaying() const override;
    /// A history with the same handler, token, limit and stacks (sharing the commands).
    boost::shared_ptr<CommandHistory> clone() const;

private:
    friend class MultiCommand;
    class Running;
    typedef boost::shared_ptr<const ThreadSafe> ProjectHold;
    struct FollowUp {
        CommandPtr command;
        uint64_t number;
        bool answersStep; // queued by a step running on the thread that runs it
    };

    /// The project, held for a step; throws when it has gone.
    ProjectHold holdProject() const;
    /// Runs one step under the project's notify delay, unless one is being delivered.
    template <typename Step>
    void delayedNotifications(const ProjectHold& project, Step step);
    void trimToLimit();
    /// Executes the command as one step and records it when it took effect.
    bool record(const CommandPtr& command, const ProjectHold& project);
    void fold(bool followUp);
    void drain(const ProjectHold& project);
    bool runsHere() const;
    uint64_t queueMark() const;
    /// Drops the follow-ups queued since the mark that answered the step
    /// that refused or threw: the changes they answered were rolled back.
    void dropAnswersSince(uint64_t mark);
    /// The first follow-up queued before the limit or answering a step here.
    CommandPtr nextFollowUp(uint64_t limit);
    template <typename Replay>
    bool replay(std::list<CommandPtr>& from, std::list<CommandPtr>& to, const char* emptyMessage,
                Replay step);

    CommandHandler* handler_;
    // The history's one token. Its subject base is given none: the history's
    // observers hear at once, never held back by the delays its own steps open.
    boost::weak_ptr<const ThreadSafe> token_;
    bool bound_; // given a token: the steps need its project
    CommandHistoryState state_;
    mutable std::mutex followUpMutex_; // guards the two below
    std::deque<FollowUp> followUps_;
    uint64_t followUpCount_ = 0;
    int undoLimit_ = -1;
    uint32_t transactionNumber_ = 1;
    int depth_ = 0;      // commands of this history running
    int draining_ = 0;   // follow-ups running
    bool inner_ = false; // a composite's: follow-ups go to the history running it
    bool combineNext_ = false;
    bool autoCombining_ = false;
    bool autoCombinedFirst_ = false;
    boost::weak_ptr<CommandHistoryObserver> observer_;
};

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/framework/BatchCmd.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <algorithm>
#include <stdexcept>

namespace VelaMediaLib {

boost::shared_ptr<BatchCmd> BatchCmd::create() { return boost::shared_ptr<BatchCmd>(new BatchCmd); }

boost::shared_ptr<BatchCmd> BatchCmd::create(const CommandPtr& command) {
    const boost::shared_ptr<BatchCmd> batch = create();
    batch->addCommand(command);
    return batch;
}

boost::shared_ptr<BatchCmd> BatchCmd::create(const std::vector<CommandPtr>& commands) {
    const boost::shared_ptr<BatchCmd> batch = create();
    for (const CommandPtr& command : commands) batch->addCommand(command);
    return batch;
}

void BatchCmd::addCommand(const CommandPtr& command) {
    if (!command) throw VelaMediaLibException("no command to add to a batch");
    if (commands_.size() >= commands_.max_size()) throw std::length_error("list too long");
    commands_.push_back(command);
}

bool BatchCmd::removeCommand(const CommandPtr& command) {
    const auto found = std::find(commands_.begin(), commands_.end(), command);
    if (found == commands_.end()) return false;
    commands_.erase(found);
    return true;
}

void BatchCmd::reverseOrder() { std::reverse(commands_.begin(), commands_.end()); }

void BatchCmd::addProgressCallbackForExecuteCommands(const boost::weak_ptr<ProgressCallback>& callback) {
    progress_.push_back(callback);
}

std::string BatchCmd::name() const {
    const std::string own = Command::name();
    if (!own.empty() || commands_.empty()) return own;
    return commands_.front()->name();
}

void BatchCmd::reportProgress(double fraction) {
    for (const boost::weak_ptr<ProgressCallback>& held : progress_)
        if (const boost::shared_ptr<ProgressCallback> callback = held.lock())
            if (*callback) (*callback)(fraction);
}

// Every command of a batch is needed: one that refuses refuses the batch.
void BatchCmd::executeCommands(const CommandHandler*) {
    const double count = double(commands_.size());
    for (size_t i = 0; i < commands_.size(); ++i) {
        if (!executeRequired(commands_[i])) return;
        reportProgress(double(i + 1) / count);
    }
    reportProgress(1.0);
}

// Combining folds commands that have run: they go on the batch's inner
// history as done, so that undoing the batch undoes them.
void BatchCmd::appendExecuted(const CommandPtr& command) {
    addCommand(command);
    CommandHistoryState state = commandHistory().state();
    state.undoStack.push_back(command);
    commandHistory().restoreState(state);
}

CommandPtr BatchCmd::combineCommands(const CommandPtr& a, const CommandPtr& b) {
    boost::shared_ptr<BatchCmd> batch = boost::dynamic_pointer_cast<BatchCmd>(a);
    if (!batch) {
        batch = create();
        batch->appendExecuted(a);
    }
    batch->appendExecuted(b);
    return batch;
}

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>

#include <vector>

namespace VelaMediaLib {

/// Ready-made commands executed one after another as one undo step, telling
/// progress callbacks the fraction done after each. A command that refuses
/// refuses the batch: the ones before it are undone and execute reports false.
class VELAMEDIALIB_API BatchCmd : public MultiCommand {
public:
    typedef boost::function<bool(double)> ProgressCallback;

    static boost::shared_ptr<BatchCmd> create();
    static boost::shared_ptr<BatchCmd> create(const CommandPtr& command);
    static boost::shared_ptr<BatchCmd> create(const std::vector<CommandPtr>& commands);

    /// Throws std::length_error "list too long" past the list's largest size.
    void addCommand(const CommandPtr& command);
    bool removeCommand(const CommandPtr& command);
    void reverseOrder();
    size_t commandCount() const { return commands_.size(); }
    void addProgressCallbackForExecuteCommands(const boost::weak_ptr<ProgressCallback>& callback);
    std::string name() const override;

    /// Folds two commands that have run into one undo step: b appended to a when
    /// a is a batch already, otherwise a new batch of both.
    static CommandPtr combineCommands(const CommandPtr& a, const CommandPtr& b);

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    BatchCmd() = default;
    void reportProgress(double fraction);
    void appendExecuted(const CommandPtr& command);

    std::vector<CommandPtr> commands_;
    std::vector<boost::weak_ptr<ProgressCallback>> progress_;
};

} // namespace VelaMediaLib

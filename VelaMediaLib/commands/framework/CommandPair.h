#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>

namespace VelaMediaLib {

/// Two commands executed as one: the second only when the first took effect,
/// and undone in reverse order. Like every composite it is never left half
/// done: when the second refuses or throws, the first is put back (and the
/// second's exception goes on); the same holds for undo and redo. When the
/// first cannot be put back: VelaMediaLibFatalException.
class VELAMEDIALIB_API CommandPair : public Command {
public:
    static boost::shared_ptr<CommandPair> create(const CommandPtr& first, const CommandPtr& second);

    const CommandPtr& command1() const { return first_; }
    const CommandPtr& command2() const { return second_; }

    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    bool reexecute(CommandHandler* handler) override;

private:
    CommandPair(const CommandPtr& first, const CommandPtr& second) : first_(first), second_(second) {}
    CommandPtr first_, second_;
};

} // namespace VelaMediaLib

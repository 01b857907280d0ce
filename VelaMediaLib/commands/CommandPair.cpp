#include <VelaMediaLib/commands/CommandPair.h>

#include <VelaMediaLib/time/VelaMediaLibException.h>

namespace VelaMediaLib {

boost::shared_ptr<CommandPair> CommandPair::create(const CommandPtr& first, const CommandPtr& second) {
    if (!first || !second) throw VelaMediaLibException("a command pair needs two commands");
    return boost::shared_ptr<CommandPair>(new CommandPair(first, second));
}

bool CommandPair::execute(CommandHandler* handler) {
    if (!first_->execute(handler)) return false;
    if (second_->execute(handler)) return true;
    first_->unexecute(handler);
    return false;
}

bool CommandPair::unexecute(CommandHandler* handler) {
    second_->unexecute(handler);
    return first_->unexecute(handler);
}

bool CommandPair::reexecute(CommandHandler* handler) {
    first_->reexecute(handler);
    return second_->reexecute(handler);
}

} // namespace VelaMediaLib

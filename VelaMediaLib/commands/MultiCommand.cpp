#include <VelaMediaLib/commands/MultiCommand.h>

namespace VelaMediaLib {

bool MultiCommand::execute(CommandHandler* handler) {
    history_.setHandler(handler);
    try {
        executeCommands(handler);
    } catch (...) {
        history_.undoAll();
        throw;
    }
    return true;
}

bool MultiCommand::unexecute(CommandHandler* handler) {
    history_.setHandler(handler);
    history_.undoAll();
    return true;
}

bool MultiCommand::reexecute(CommandHandler* handler) {
    history_.setHandler(handler);
    history_.redoAll();
    return true;
}

bool MultiCommand::execute(const CommandPtr& command) { return history_.execute(command); }

MultiCommand::ExecuteFunc MultiCommand::executeFunc() {
    return [this](const CommandPtr& command) { return execute(command); };
}

} // namespace VelaMediaLib

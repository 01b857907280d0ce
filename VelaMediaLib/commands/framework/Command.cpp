#include <VelaMediaLib/commands/framework/Command.h>

#include <VelaMediaLib/commands/framework/BatchCmd.h>

namespace VelaMediaLib {

CommandPtr Command::combine(const CommandPtr& later) { return groupCommands(shared_from_this(), later); }

CommandPtr Command::groupCommands(const CommandPtr& first, const CommandPtr& second) {
    return BatchCmd::combineCommands(first, second);
}

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>

#include <type_traits>

namespace VelaMediaLib {

/// A composite whose sub-commands are issued by a stored function, given
/// either the composite itself or its execute function.
class VELAMEDIALIB_API LambdaMultiCommand : public MultiCommand {
public:
    typedef boost::function<void(MultiCommand*)> Function;

    /// From a function of the composite (MultiCommand*) or of the execute
    /// function (taking a command, returning bool).
    template <typename F>
    static boost::shared_ptr<LambdaMultiCommand> create(F function, const std::string& name = std::string()) {
        boost::shared_ptr<LambdaMultiCommand> command(new LambdaMultiCommand);
        // Asked in this order because boost::function converts from anything.
        if constexpr (std::is_invocable<F, MultiCommand::ExecuteFunc>::value) {
            command->function_ = [function](MultiCommand* composite) { function(composite->executeFunc()); };
        } else {
            command->function_ = function;
        }
        command->setName(name);
        return command;
    }

protected:
    void executeCommands(const CommandHandler*) override {
        if (function_) function_(this);
    }

private:
    LambdaMultiCommand() = default;
    Function function_;
};

} // namespace VelaMediaLib

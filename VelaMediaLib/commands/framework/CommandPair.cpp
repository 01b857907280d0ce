#include <VelaMediaLib/commands/framework/CommandPair.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <exception>

namespace VelaMediaLib {
namespace {

// Runs `then` after `done` has taken effect; when `then` refuses or throws,
// `back` puts `done` back and the pair reports false or rethrows.
template <typename Then, typename Back>
bool secondOrBack(Then then, Back back) {
    bool result = false;
    try {
        result = then();
    } catch (...) {
        const std::exception_ptr original = std::current_exception();
        try {
            back();
        } catch (...) {}
        std::rethrow_exception(original);
    }
    if (!result && !back())
        throw VelaMediaLibFatalException("a command pair could not put its first command back");
    return result;
}

} // namespace

boost::shared_ptr<CommandPair> CommandPair::create(const CommandPtr& first, const CommandPtr& second) {
    if (!first || !second) throw VelaMediaLibException("a command pair needs two commands");
    return boost::shared_ptr<CommandPair>(new CommandPair(first, second));
}

bool CommandPair::execute(CommandHandler* handler) {
    if (!first_->execute(handler)) return false;
    return secondOrBack([&] { return second_->execute(handler); },
                        [&] { return first_->unexecute(handler); });
}

bool CommandPair::unexecute(CommandHandler* handler) {
    if (!second_->unexecute(handler)) return false;
    return secondOrBack([&] { return first_->unexecute(handler); },
                        [&] { return second_->reexecute(handler); });
}

bool CommandPair::reexecute(CommandHandler* handler) {
    if (!first_->reexecute(handler)) return false;
    return secondOrBack([&] { return second_->reexecute(handler); },
                        [&] { return first_->unexecute(handler); });
}

} // namespace VelaMediaLib

#include "Arguments.h"

#include "UsageError.h"

namespace VelaTool {

namespace {

bool isHelp(const std::string& word) { return word == "--help" || word == "-h"; }

// A negative number ("vela at DOC -5") is an operand, not an option.
bool looksLikeOption(const std::string& word) {
    return word.size() > 1 && word[0] == '-' && !(word[1] >= '0' && word[1] <= '9');
}

} // namespace

Arguments Arguments::parse(const std::vector<std::string>& words, const AcceptedArguments& accepted) {
    Arguments arguments;
    for (const std::string& word : words)
        if (isHelp(word)) {
            arguments.help_ = true;
            return arguments;
        }
    arguments.take(words, accepted);
    if (arguments.operands_.size() != accepted.operands)
        throw UsageError("expected " + std::to_string(accepted.operands) + " operand" +
                         (accepted.operands == 1 ? "" : "s") + ", got " +
                         std::to_string(arguments.operands_.size()));
    return arguments;
}

void Arguments::take(const std::vector<std::string>& words, const AcceptedArguments& accepted) {
    bool optionsEnded = false;
    for (size_t i = 0; i < words.size(); ++i) {
        const std::string& word = words[i];
        if (optionsEnded || !looksLikeOption(word)) {
            operands_.push_back(word);
        } else if (word == "--") {
            optionsEnded = true;
        } else if (accepted.flags.count(word)) {
            flags_.insert(word);
        } else if (accepted.options.count(word)) {
            if (i + 1 == words.size()) throw UsageError("option " + word + " needs a value");
            options_[word] = words[++i];
        } else {
            throw UsageError("unknown option " + word);
        }
    }
}

std::string Arguments::value(const std::string& option, const std::string& fallback) const {
    const auto found = options_.find(option);
    return found == options_.end() ? fallback : found->second;
}

} // namespace VelaTool

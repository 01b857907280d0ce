#pragma once

#include <map>
#include <set>
#include <string>
#include <vector>

namespace VelaTool {

/// What a subcommand accepts: flags without a value, options with one, and
/// how many operands (a lone "-" is an operand: standard input).
struct AcceptedArguments {
    std::set<std::string> flags;
    std::set<std::string> options;
    size_t operands = 0;
};

/// One subcommand's command line, checked against what it accepts. "--help" (or
/// "-h") anywhere asks for the usage and skips the other checks.
class Arguments {
public:
    /// Throws UsageError for an unknown option, a missing value or a wrong
    /// number of operands.
    static Arguments parse(const std::vector<std::string>& words, const AcceptedArguments& accepted);

    bool wantsHelp() const { return help_; }
    bool has(const std::string& flag) const { return flags_.count(flag) != 0; }
    /// The option's value, or the fallback when it was not given.
    std::string value(const std::string& option, const std::string& fallback = "") const;
    const std::string& operand(size_t index) const { return operands_.at(index); }

private:
    void take(const std::vector<std::string>& words, const AcceptedArguments& accepted);

    bool help_ = false;
    std::set<std::string> flags_;
    std::map<std::string, std::string> options_;
    std::vector<std::string> operands_;
};

} // namespace VelaTool

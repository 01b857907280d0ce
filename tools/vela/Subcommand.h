#pragma once

#include "Arguments.h"
#include "Console.h"

#include <string>
#include <utility>

namespace VelaTool {

/// One of the tool's subcommands: its name, a line for the tool's help, its
/// usage and the arguments it accepts. The tool checks the command line
/// against accepted(), prints usage() for "--help", and calls run with the
/// result; run returns the exit status and reports failures by throwing.
class Subcommand {
public:
    struct Description {
        const char* name;
        const char* summary;
        std::string usage;
        AcceptedArguments accepted;
    };

    explicit Subcommand(Description description) : description_(std::move(description)) {}
    virtual ~Subcommand() = default;
    const char* name() const { return description_.name; }
    /// One line for the tool's own help.
    const char* summary() const { return description_.summary; }
    /// The synopsis and what the options do.
    const std::string& usage() const { return description_.usage; }
    const AcceptedArguments& accepted() const { return description_.accepted; }
    virtual int run(const Arguments& arguments, Console& console) const = 0;

private:
    Description description_;
};

} // namespace VelaTool

#pragma once

#include "Arguments.h"
#include "Console.h"

#include <string>

namespace VelaTool {

/// One of the tool's subcommands. The tool checks the command line against
/// spec(), prints usage() for "--help", and calls run with the result;
/// run returns the exit status and reports failures by throwing.
class Subcommand {
public:
    virtual ~Subcommand() = default;
    virtual const char* name() const = 0;
    /// One line for the tool's own help.
    virtual const char* summary() const = 0;
    /// The synopsis and what the options do.
    virtual std::string usage() const = 0;
    virtual ArgumentSpec spec() const = 0;
    virtual int run(const Arguments& arguments, Console& console) const = 0;
};

} // namespace VelaTool

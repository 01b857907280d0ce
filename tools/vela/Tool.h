#pragma once

#include "Console.h"
#include "Subcommand.h"

#include <memory>
#include <string>
#include <vector>

namespace VelaTool {

/// The `vela` program: picks the subcommand named by the first word, checks
/// its command line and runs it. Exit status: the subcommand's (0 success,
/// 1 a refused document or a failed check), 2 for a command line it cannot
/// follow. Failures are reported on the error stream, never thrown.
class Tool {
public:
    Tool();
    /// The words after the program's name.
    int run(const std::vector<std::string>& words, Console& console) const;

private:
    const Subcommand* find(const std::string& name) const;
    void printHelp(std::ostream& out) const;
    int runSubcommand(const Subcommand& subcommand, const std::vector<std::string>& words,
                      Console& console) const;

    std::vector<std::unique_ptr<Subcommand>> subcommands_;
};

} // namespace VelaTool

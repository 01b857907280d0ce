#include "Tool.h"

#include "AtCommand.h"
#include "FmtCommand.h"
#include "InfoCommand.h"
#include "RoundtripCommand.h"
#include "UsageError.h"
#include "ValidateCommand.h"

#include <iomanip>
#include <ostream>

namespace VelaTool {

Tool::Tool() {
    subcommands_.emplace_back(new InfoCommand);
    subcommands_.emplace_back(new ValidateCommand);
    subcommands_.emplace_back(new AtCommand);
    subcommands_.emplace_back(new RoundtripCommand);
    subcommands_.emplace_back(new FmtCommand);
}

const Subcommand* Tool::find(const std::string& name) const {
    for (const auto& subcommand : subcommands_)
        if (name == subcommand->name()) return subcommand.get();
    return nullptr;
}

void Tool::printHelp(std::ostream& out) const {
    out << "usage: vela COMMAND [ARGS]  (vela COMMAND --help for its own)\n"
           "Reads VelaMediaLib project documents; - as DOC reads standard input.\n\n";
    for (const auto& subcommand : subcommands_)
        out << "  " << std::left << std::setw(11) << subcommand->name() << subcommand->summary() << "\n";
}

int Tool::run(const std::vector<std::string>& words, Console& console) const {
    if (words.empty()) {
        printHelp(console.err);
        return 2;
    }
    if (words[0] == "--help" || words[0] == "-h" || words[0] == "help") {
        printHelp(console.out);
        return 0;
    }
    const Subcommand* subcommand = find(words[0]);
    if (!subcommand) {
        console.err << "vela: unknown command \"" << words[0] << "\"\n";
        printHelp(console.err);
        return 2;
    }
    return runSubcommand(*subcommand, std::vector<std::string>(words.begin() + 1, words.end()), console);
}

int Tool::runSubcommand(const Subcommand& subcommand, const std::vector<std::string>& words,
                        Console& console) const {
    const std::string who = std::string("vela ") + subcommand.name() + ": ";
    try {
        const Arguments arguments = Arguments::parse(words, subcommand.accepted());
        if (arguments.wantsHelp()) {
            console.out << subcommand.usage();
            return 0;
        }
        return subcommand.run(arguments, console);
    } catch (const UsageError& wrong) {
        console.err << who << wrong.what() << "\n" << subcommand.usage();
        return 2;
    } catch (const std::exception& failure) {
        console.err << who << failure.what() << "\n";
        return 1;
    }
}

} // namespace VelaTool

#include "ValidateCommand.h"

#include "DocumentLoader.h"

#include <ostream>
#include <stdexcept>

namespace VelaTool {

ValidateCommand::ValidateCommand()
    : Subcommand({"validate", "exit 0 when the document reads, else its fault and exit 1",
                  "usage: vela validate DOC\n"
                  "  Reads the document as the library does. Prints \"DOC: valid\" and exits 0,\n"
                  "  or prints the reader's message on standard error and exits 1.\n"
                  "  DOC is a project document, or - for standard input.\n",
                  AcceptedArguments{{}, {}, 1}}) {}

int ValidateCommand::run(const Arguments& arguments, Console& console) const {
    const std::string& document = arguments.operand(0);
    try {
        DocumentLoader(console).load(document);
    } catch (const std::exception& refused) {
        console.err << document << ": " << refused.what() << "\n";
        return 1;
    }
    console.out << document << ": valid\n";
    return 0;
}

} // namespace VelaTool

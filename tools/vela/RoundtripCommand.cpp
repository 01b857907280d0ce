#include "RoundtripCommand.h"

#include "DocumentLoader.h"
#include "DocumentText.h"
#include "TextDifference.h"

#include <ostream>

namespace VelaTool {

RoundtripCommand::RoundtripCommand()
    : Subcommand({"roundtrip", "read, write and compare; exit 1 on the first difference",
                  "usage: vela roundtrip DOC\n"
                  "  Reads the document, writes the project again in the document's own form\n"
                  "  (indented, or compact when the document is) and compares the two texts.\n"
                  "  Exits 0 when they are equal byte for byte; otherwise shows the first\n"
                  "  difference and exits 1. A document `vela fmt` wrote always round-trips.\n"
                  "  DOC is a project document, or - for standard input.\n",
                  AcceptedArguments{{}, {}, 1}}) {}

int RoundtripCommand::run(const Arguments& arguments, Console& console) const {
    const LoadedDocument document = DocumentLoader(console).load(arguments.operand(0));
    const std::string rewrite = documentText(*document.project, isCompactText(document.text));
    const TextDifference difference(document.text, rewrite);
    if (!difference.equal()) {
        difference.print(console.out, "document", "rewrite ");
        return 1;
    }
    console.out << "equal: " << rewrite.size() << " bytes read and written\n";
    return 0;
}

} // namespace VelaTool

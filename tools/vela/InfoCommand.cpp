#include "InfoCommand.h"

#include "DocumentLoader.h"
#include "ProjectSummary.h"

#include <ostream>

namespace VelaTool {

InfoCommand::InfoCommand()
    : Subcommand(
          {"info", "edit rate, canvas, duration, tracks, clips by kind, sources",
           "usage: vela info DOC [--json]\n"
           "  Prints the project's edit rate, canvas size, duration, number of tracks,\n"
           "  clips by kind (at any depth) and sources with their offline status.\n"
           "  DOC is a project document, or - for standard input.\n"
           "  --json  the same as one JSON object: \"editRate\" (\"n/d\"), \"width\", \"height\",\n"
           "          \"duration\" (ticks), \"tracks\", \"clips\" (counts by \"_type\"), \"sources\"\n",
           AcceptedArguments{{"--json"}, {}, 1}}) {}

int InfoCommand::run(const Arguments& arguments, Console& console) const {
    const LoadedDocument document = DocumentLoader(console).load(arguments.operand(0));
    const ProjectSummary summary(*document.project);
    if (arguments.has("--json"))
        summary.printJSON(console.out);
    else
        summary.printText(console.out);
    return 0;
}

} // namespace VelaTool

#include "FmtCommand.h"

#include "DocumentLoader.h"
#include "DocumentText.h"

#include <cerrno>
#include <cstring>
#include <fstream>
#include <stdexcept>

namespace VelaTool {

namespace {

void writeFile(const std::string& path, const std::string& text) {
    std::ofstream file(path, std::ios::binary | std::ios::trunc);
    if (!file) throw std::runtime_error("cannot write " + path + ": " + std::strerror(errno));
    file << text;
    file.close();
    if (!file) throw std::runtime_error("cannot write " + path);
}

} // namespace

FmtCommand::FmtCommand()
    : Subcommand({"fmt", "the document rewritten in the library's form",
                  "usage: vela fmt DOC [-o OUT] [--compact]\n"
                  "  Reads the document and writes it again as the library writes projects:\n"
                  "  its member order, fresh ids counted from 1, two-blank indentation.\n"
                  "  DOC is a project document, or - for standard input.\n"
                  "  -o OUT     write to OUT (only once the document has been read) instead of\n"
                  "             standard output\n"
                  "  --compact  no line breaks and no indentation\n",
                  AcceptedArguments{{"--compact"}, {"-o"}, 1}}) {}

int FmtCommand::run(const Arguments& arguments, Console& console) const {
    const LoadedDocument document = DocumentLoader(console).load(arguments.operand(0));
    const std::string text = documentText(*document.project, arguments.has("--compact"));
    const std::string out = arguments.value("-o");
    if (out.empty() || out == "-")
        console.out << text;
    else
        writeFile(out, text);
    return 0;
}

} // namespace VelaTool

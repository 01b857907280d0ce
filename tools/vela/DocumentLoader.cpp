#include "DocumentLoader.h"

#include "ProgressLine.h"

#include <VelaMediaLib/document/RemixParser.h>

#include <cerrno>
#include <cstring>
#include <fstream>
#include <istream>
#include <stdexcept>
#include <streambuf>

namespace VelaTool {

namespace {

const size_t kChunk = 4 * 1024 * 1024;

/// Lets the parser read a text in memory without a copy of it.
class TextBuffer : public std::streambuf {
public:
    explicit TextBuffer(const std::string& text) {
        char* begin = const_cast<char*>(text.data()); // read only: the get area is never written
        setg(begin, begin, begin + text.size());
    }
};

/// Appends the stream to the text chunk by chunk, so that the progress line
/// starts as soon as the document turns out large.
void readAll(std::istream& in, std::string& text, ProgressLine& progress) {
    std::string chunk(kChunk, '\0');
    while (in) {
        in.read(&chunk[0], std::streamsize(chunk.size()));
        text.append(chunk, 0, size_t(in.gcount()));
        progress.sizeKnown(text.size());
    }
}

std::string readFile(const std::string& path, ProgressLine& progress) {
    std::ifstream file(path, std::ios::binary | std::ios::ate);
    if (!file) throw std::runtime_error("cannot open " + path + ": " + std::strerror(errno));
    const std::streamoff size = file.tellg();
    file.seekg(0);
    std::string text;
    if (size > 0) {
        text.reserve(size_t(size));
        progress.sizeKnown(size_t(size));
    }
    progress.stage("reading");
    readAll(file, text, progress);
    if (file.bad()) throw std::runtime_error("cannot read " + path);
    return text;
}

} // namespace

LoadedDocument DocumentLoader::load(const std::string& document) const {
    const bool standardInput = document == "-";
    ProgressLine progress(console_.err, standardInput ? "standard input" : document);
    LoadedDocument loaded;
    try {
        if (standardInput) {
            progress.stage("reading");
            readAll(console_.in, loaded.text, progress);
        } else {
            loaded.text = readFile(document, progress);
        }
        progress.stage("parsing");
        loaded.project = parse(loaded.text);
    } catch (...) {
        progress.finish("failed");
        throw;
    }
    progress.finish();
    return loaded;
}

VelaMediaLib::ProjectPtr DocumentLoader::parse(const std::string& text) {
    TextBuffer buffer(text);
    std::istream in(&buffer);
    VelaMediaLib::RemixParser parser;
    if (!parser.parse(in) || !parser.project()) throw std::runtime_error("the document could not be read");
    return parser.project();
}

} // namespace VelaTool

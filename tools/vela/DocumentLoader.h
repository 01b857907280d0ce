#pragma once

#include "Console.h"

#include <VelaMediaLib/model/project/Project.h>

#include <string>

namespace VelaTool {

/// A document as read: its text, byte for byte, and the project built from it.
struct LoadedDocument {
    std::string text;
    VelaMediaLib::ProjectPtr project;
};

/// Reads a document named on the command line ("-": standard input) and
/// builds its project with the library's parser, telling on the error
/// stream how a large one goes.
class DocumentLoader {
public:
    explicit DocumentLoader(Console& console) : console_(console) {}

    /// Throws std::runtime_error when the file cannot be read, and what the
    /// parser throws when the document is refused.
    LoadedDocument load(const std::string& document) const;

    /// The project of a text already in memory; throws as the parser does.
    static VelaMediaLib::ProjectPtr parse(const std::string& text);

private:
    Console& console_;
};

} // namespace VelaTool

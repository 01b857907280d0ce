#pragma once

#include <VelaMediaLib/model/project/Project.h>

#include <string>

namespace VelaTool {

/// The project as the library writes it, ending with one line break as a
/// text file does: what `vela fmt` prints and `vela roundtrip` compares.
std::string documentText(const VelaMediaLib::Project& project, bool compact);

/// Whether a document is in the compact form (no line break after the
/// opening brace), so that a rewrite keeps the form it came in.
bool isCompactText(const std::string& text);

} // namespace VelaTool

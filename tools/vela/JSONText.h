#pragma once

#include <string>

namespace VelaTool {

/// The string as a JSON string literal, quotes included.
std::string quotedJSON(const std::string& text);

} // namespace VelaTool

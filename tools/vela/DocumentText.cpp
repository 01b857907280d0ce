#include "DocumentText.h"

#include <VelaMediaLib/document/ProjectDocument.h>

namespace VelaTool {

std::string documentText(const VelaMediaLib::Project& project, bool compact) {
    std::string text = VelaMediaLib::projectToJSONString(project, compact);
    if (text.empty() || text.back() != '\n') text += '\n';
    return text;
}

bool isCompactText(const std::string& text) {
    const size_t brace = text.find_first_not_of(" \t\r\n");
    return brace != std::string::npos && text.compare(brace, 2, "{\"") == 0;
}

} // namespace VelaTool

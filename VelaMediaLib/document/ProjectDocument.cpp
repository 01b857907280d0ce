#include <VelaMediaLib/document/ProjectDocument.h>
#include <VelaMediaLib/document/RemixParser.h>
#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/model/project/Project.h>

#include <sstream>

namespace VelaMediaLib {

std::string projectToJSONString(const Project& project, bool compact) {
    std::ostringstream out;
    XMLOptions options(out, compact ? 0 : 2);
    project.toJSON(options);
    return out.str();
}

boost::shared_ptr<Project> projectFromJSONString(const std::string& text) {
    std::istringstream in(text);
    RemixParser parser;
    parser.parse(in);
    return parser.project();
}

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/shared_ptr.hpp>
#include <string>

namespace VelaMediaLib {

class Project;

/// The project's document; compact writes no line breaks or indentation.
VELAMEDIALIB_API std::string projectToJSONString(const Project& project, bool compact = false);
/// A new project read from the document text; throws as RemixParser::parse.
VELAMEDIALIB_API boost::shared_ptr<Project> projectFromJSONString(const std::string& text);

} // namespace VelaMediaLib

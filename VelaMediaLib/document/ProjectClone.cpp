// Temporary: the readers define InternalProject::clone (a write read back)
// and replace this file.
#include <VelaMediaLib/commands/edits/InternalProject.h>

namespace VelaMediaLib {

boost::shared_ptr<Project> InternalProject::clone() const { throw VelaMediaLibException("not yet"); }

} // namespace VelaMediaLib

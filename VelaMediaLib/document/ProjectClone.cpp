#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/document/ProjectDocument.h>
#include <VelaMediaLib/document/RemixParser.h>
#include <VelaMediaLib/model/source/Source.h>

#include <sstream>

namespace VelaMediaLib {

// The document written and read back. The copy asks the same file system
// as the sources and keeps their online state: nothing is asked of the
// files or of the host while copying.
boost::shared_ptr<Project> InternalProject::clone() const {
    const SourceBin::Sources sources = sourceBin_->sources();
    std::istringstream in(projectToJSONString(*this, true));
    RemixParser parser;
    parser.setCheckFiles(false);
    if (!sources.empty()) parser.setFileSystem(sources.front()->fileSystem());
    parser.parse(in);
    const boost::shared_ptr<Project> copy = parser.project();
    const SourceBin::Sources copied = copy->sourceBin()->sources();
    for (size_t i = 0; i < copied.size() && i < sources.size(); ++i)
        copied[i]->setOnline(sources[i]->isOnline());
    return copy;
}

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/commands/edits/CommandHandler.h>
#include <VelaMediaLib/model/project/Project.h>

namespace VelaMediaLib {

/// The project a source command acts on. Throws VelaMediaLibException
/// "loading a source needs a project" when the handler has none.
inline boost::shared_ptr<Project> projectForSourceCommand(CommandHandler* handler) {
    const boost::shared_ptr<Project> project = handler ? handler->project() : boost::shared_ptr<Project>();
    if (!project) throw VelaMediaLibException("loading a source needs a project");
    return project;
}

} // namespace VelaMediaLib

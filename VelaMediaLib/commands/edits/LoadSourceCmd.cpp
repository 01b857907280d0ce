#include <VelaMediaLib/commands/edits/LoadSourceCmd.h>

#include <VelaMediaLib/commands/edits/detail/SourceCommandSupport.h>
#include <VelaMediaLib/model/source/Source.h>

namespace VelaMediaLib {

boost::shared_ptr<LoadSourceCmd> LoadSourceCmd::create(const boost::shared_ptr<Source>& source) {
    if (!source) throw VelaMediaLibException("no source to load");
    const boost::shared_ptr<LoadSourceCmd> command(new LoadSourceCmd(source, source->filename(), -1));
    command->setName("Import Media");
    return command;
}

boost::shared_ptr<LoadSourceCmd> LoadSourceCmd::create(const std::string& path, int index) {
    const boost::shared_ptr<LoadSourceCmd> command(new LoadSourceCmd(SourcePtr(), path, index));
    command->setName("Import Media");
    return command;
}

bool LoadSourceCmd::execute(CommandHandler* handler) {
    const boost::shared_ptr<Project> project = projectForSourceCommand(handler);
    const boost::shared_ptr<SourceBin> bin = project->sourceBin();
    if (bin->isFileLoaded(path_)) return false; // nothing to load, nothing to undo
    if (source_) {
        bin->insertSource(source_, index_);
    } else {
        bool added = false;
        const SourcePtr source = bin->loadFileAtIndex(path_, index_, &added);
        if (!added) return false; // another thread loaded the file meanwhile
        source_ = source;
    }
    index_ = bin->indexOfSource(source_);
    return true;
}

bool LoadSourceCmd::unexecute(CommandHandler* handler) {
    index_ = projectForSourceCommand(handler)->unloadSource(source_); // redo puts it back there
    return true;
}

bool LoadSourceCmd::reexecute(CommandHandler* handler) {
    projectForSourceCommand(handler)->sourceBin()->insertSource(source_, index_);
    return true;
}

} // namespace VelaMediaLib

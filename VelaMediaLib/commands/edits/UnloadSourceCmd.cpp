#include <VelaMediaLib/commands/edits/UnloadSourceCmd.h>

#include <VelaMediaLib/commands/edits/detail/SourceCommandSupport.h>
#include <VelaMediaLib/model/source/Source.h>

namespace VelaMediaLib {

boost::shared_ptr<UnloadSourceCmd> UnloadSourceCmd::create(const boost::shared_ptr<Source>& source) {
    if (!source) throw VelaMediaLibException("no source to unload");
    const boost::shared_ptr<UnloadSourceCmd> command(new UnloadSourceCmd(source));
    command->setName("Remove Media");
    return command;
}

bool UnloadSourceCmd::execute(CommandHandler* handler) {
    index_ = projectForSourceCommand(handler)->unloadSource(source_);
    return true;
}

bool UnloadSourceCmd::unexecute(CommandHandler* handler) {
    projectForSourceCommand(handler)->sourceBin()->insertSource(source_, index_);
    return true;
}

} // namespace VelaMediaLib

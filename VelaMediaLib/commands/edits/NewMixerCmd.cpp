#include <VelaMediaLib/commands/edits/NewMixerCmd.h>

#include <VelaMediaLib/commands/edits/CommandHandler.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

namespace VelaMediaLib {
namespace {

TimelinePtr timelineOf(CommandHandler* handler) {
    const boost::shared_ptr<Project> project = handler ? handler->project() : boost::shared_ptr<Project>();
    if (!project) throw VelaMediaLibException("the command needs a project");
    return project->timeline();
}

} // namespace

boost::shared_ptr<NewMixerCmd> NewMixerCmd::create(const std::string& name) {
    if (name.empty()) throw ValueException<int>("a mixer needs a name", 0);
    const boost::shared_ptr<NewMixerCmd> command(new NewMixerCmd(name));
    command->setName("New Mixer");
    return command;
}

// The first run makes the mixer; later runs (redo) put the same one back.
bool NewMixerCmd::execute(CommandHandler* handler) {
    const TimelinePtr timeline = timelineOf(handler);
    if (!mixer_) {
        mixer_ = timeline->newMixer(mixerName_);
        return true;
    }
    timeline->addMixer(mixerName_, mixer_);
    return true;
}

bool NewMixerCmd::unexecute(CommandHandler* handler) {
    timelineOf(handler)->removeMixer(mixer_);
    return true;
}

} // namespace VelaMediaLib

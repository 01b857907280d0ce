#include <VelaMediaLib/commands/edits/ChangeProjectEditRateCmd.h>

#include <VelaMediaLib/commands/edits/CommandHandler.h>
#include <VelaMediaLib/commands/edits/ScaleMixerEditRateCmd.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/timeline/ClipBoard.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

namespace VelaMediaLib {
namespace {

boost::shared_ptr<Project> projectOf(CommandHandler* handler) {
    const boost::shared_ptr<Project> project = handler ? handler->project() : boost::shared_ptr<Project>();
    if (!project) throw VelaMediaLibException("the command needs a project");
    return project;
}

void requireRate(const boost::rational<unsigned long>& rate) {
    if (rate.numerator() == 0) throw VelaMediaLibException("an edit rate must be greater than 0");
}

/// The keyframes of the timeline's own parameters, exactly scaled; undo
/// gives each parameter back the copy saved before.
class ScaleTimelineKeyframesStep : public Command {
public:
    ScaleTimelineKeyframesStep(const TimelinePtr& timeline, const EditRateScale& scale)
        : timeline_(timeline), scale_(scale) {}

    bool execute(CommandHandler*) override {
        saved_.clear();
        try {
            for (const std::string& name : timeline_->parameterNames()) {
                if (!timeline_->hasMadeParameter(name)) continue;
                const boost::shared_ptr<ParameterInterface> parameter = timeline_->parameter(name);
                if (!parameter || parameter->numKeyFrames() == 0) continue;
                saved_.emplace_back(parameter, parameter->cloneParameter());
                scale_.scaleKeyframes(*parameter);
            }
        } catch (...) {
            unexecute(nullptr);
            throw;
        }
        return true;
    }
    bool unexecute(CommandHandler*) override {
        for (auto p = saved_.rbegin(); p != saved_.rend(); ++p) {
            p->first->takeStateOf(*p->second);
            p->first->notify();
        }
        return true;
    }

private:
    TimelinePtr timeline_;
    EditRateScale scale_;
    std::vector<std::pair<boost::shared_ptr<ParameterInterface>, boost::shared_ptr<ParameterInterface>>>
        saved_;
};

} // namespace

boost::shared_ptr<SetEditRateCmd> SetEditRateCmd::create(const boost::rational<unsigned long>& rate) {
    requireRate(rate);
    const boost::shared_ptr<SetEditRateCmd> command(new SetEditRateCmd(rate));
    command->setName("Set Edit Rate");
    return command;
}

bool SetEditRateCmd::execute(CommandHandler* handler) {
    const boost::shared_ptr<Project> project = projectOf(handler);
    saved_ = project->editRate();
    if (saved_ == rate_) return false;
    project->setEditRate(rate_);
    return true;
}

bool SetEditRateCmd::unexecute(CommandHandler* handler) {
    projectOf(handler)->setEditRate(saved_);
    return true;
}

boost::shared_ptr<ChangeProjectEditRateCmd>
ChangeProjectEditRateCmd::create(const boost::rational<unsigned long>& rate) {
    requireRate(rate);
    const boost::shared_ptr<ChangeProjectEditRateCmd> command(new ChangeProjectEditRateCmd(rate));
    command->setName("Change Project Edit Rate");
    return command;
}

boost::shared_ptr<ChangeProjectEditRateCmd> ChangeProjectEditRateCmd::create(unsigned long numerator,
                                                                             unsigned long denominator) {
    return create(boost::rational<unsigned long>(numerator, denominator));
}

bool ChangeProjectEditRateCmd::execute(CommandHandler* handler) {
    if (projectOf(handler)->editRate() == rate_) return false;
    return MultiCommand::execute(handler);
}

// The clips first, at the old rate; the rate last, when the project's
// sources and the clips' limits follow it.
void ChangeProjectEditRateCmd::executeCommands(const CommandHandler*) {
    const boost::shared_ptr<Project> project = projectOf(handler());
    const EditRateScale scale = EditRateScale::between(project->editRate(), rate_);
    const TimelinePtr timeline = project->timeline();
    // One fit for every mixer, once all are scaled: a transition's clips
    // may stand in two of them.
    std::vector<TrackPtr> tracks;
    for (const MixerPtr& mixer : timeline->mixers())
        for (const TrackPtr& track : mixer->tracks()) tracks.push_back(track);
    const CommandPtr fit = fitTransitionsStep(tracks);
    for (const MixerPtr& mixer : timeline->mixers()) {
        const auto scaling = ScaleMixerEditRateCmd::create(mixer, scale.factor());
        scaling->withoutFits();
        if (!executeRequired(scaling)) return;
    }
    execute(fit);
    for (const MixerPtr& clipping : project->clipBoard()->clippings())
        if (!executeRequired(ScaleMixerEditRateCmd::create(clipping, scale.factor()))) return;
    execute(CommandPtr(new ScaleTimelineKeyframesStep(timeline, scale)));
    executeRequired(SetEditRateCmd::create(rate_));
}

} // namespace VelaMediaLib

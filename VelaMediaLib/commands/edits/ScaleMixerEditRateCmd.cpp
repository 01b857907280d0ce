#include <VelaMediaLib/commands/edits/ScaleMixerEditRateCmd.h>

#include <VelaMediaLib/commands/edits/ScaleMediaEditRateCmd.h>
#include <VelaMediaLib/model/media/Transition.h>

namespace VelaMediaLib {
namespace {

/// The lengths of a track's transitions, each once, to the nearest tick.
class ScaleTransitionsStep : public Command {
public:
    ScaleTransitionsStep(const TrackPtr& track, const EditRateScale& scale) : track_(track), scale_(scale) {}

    bool execute(CommandHandler*) override {
        saved_.clear();
        ScopedWriteLock lock(track_->projectMutex());
        for (const TransitionPtr& transition : track_->transitions()) {
            saved_.emplace_back(transition, transition->duration());
            transition->setDuration(scale_.tick(transition->duration()));
        }
        return true;
    }
    bool unexecute(CommandHandler*) override {
        ScopedWriteLock lock(track_->projectMutex());
        for (const auto& entry : saved_) entry.first->setDuration(entry.second);
        return true;
    }

private:
    TrackPtr track_;
    EditRateScale scale_;
    std::vector<std::pair<TransitionPtr, VelaTime>> saved_;
};

} // namespace

void scaleTrackEditRate(MultiCommand& into, const TrackPtr& track, const EditRateScale& scale) {
    if (!track || scale.isIdentity()) return;
    const std::vector<MediaPtr> clips = track->medias();
    const std::vector<MediaState> states = scale.trackStates(clips);
    std::vector<bool> later;
    for (size_t i = 0; i < clips.size(); ++i) later.push_back(states[i].start > clips[i]->startTime());
    into.execute(CommandPtr(new ScaleTransitionsStep(track, scale)));
    const auto scaleClip = [&](size_t i) {
        if (!into.execute(ScaleMediaEditRateCmd::create(track, clips[i], scale.factor(), states[i].start)))
            throw VelaMediaLibException("a clip refused the edit rate change");
    };
    for (size_t i = clips.size(); i-- > 0;)
        if (later[i]) scaleClip(i);
    for (size_t i = 0; i < clips.size(); ++i)
        if (!later[i]) scaleClip(i);
}

boost::shared_ptr<ScaleMixerEditRateCmd> ScaleMixerEditRateCmd::create(const MixerPtr& mixer,
                                                                       const SafeRational& factor) {
    if (!mixer) throw AddRemoveException("no mixer to scale");
    const boost::shared_ptr<ScaleMixerEditRateCmd> command(
        new ScaleMixerEditRateCmd(mixer, EditRateScale(factor)));
    command->setName("Scale Mixer Edit Rate");
    return command;
}

boost::shared_ptr<ScaleMixerEditRateCmd>
ScaleMixerEditRateCmd::create(const MixerPtr& mixer, const boost::rational<unsigned long>& from,
                              const boost::rational<unsigned long>& to) {
    return create(mixer, EditRateScale::between(from, to).factor());
}

void ScaleMixerEditRateCmd::executeCommands(const CommandHandler*) {
    for (const TrackPtr& track : mixer_->tracks()) scaleTrackEditRate(*this, track, scale_);
}

} // namespace VelaMediaLib

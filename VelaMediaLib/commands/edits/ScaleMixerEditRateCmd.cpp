#include <VelaMediaLib/commands/edits/ScaleMixerEditRateCmd.h>

#include <VelaMediaLib/commands/edits/ScaleMediaEditRateCmd.h>
#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/media/Transition.h>

#include <algorithm>

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
            if (!scaledHere(*transition)) continue;
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
    // A transition whose clips were pulled onto two tracks is held on both:
    // the track of its left clip scales it, so that it is scaled once.
    bool scaledHere(const Transition& transition) const {
        const MediaPtr left = transition.leftMedia();
        const boost::shared_ptr<SubTimeline> parent =
            left ? left->parent() : boost::shared_ptr<SubTimeline>();
        return !parent || parent.get() == static_cast<const SubTimeline*>(track_.get());
    }

    TrackPtr track_;
    EditRateScale scale_;
    std::vector<std::pair<TransitionPtr, VelaTime>> saved_;
};

/// After the clips and their transitions were rounded to ticks each on their
/// own, a clip that had room for its transitions may be a tick short of it:
/// the longer one gives up the ticks missing. Going to the finer rate and back
/// rounds the shortened transition to its old length again (one tick is less
/// than half of the two a tick becomes there). A clip that had no room before
/// (as a document may give it) is left as it is.
class FitTransitionsStep : public Command {
public:
    /// Made before the change, to know which clips have room: those of the
    /// tracks and of the groups and stitched clips on them, at any depth.
    explicit FitTransitionsStep(const std::vector<TrackPtr>& tracks) {
        if (!tracks.empty()) token_ = tracks.front()->projectMutex();
        for (const TrackPtr& track : tracks) take(*track);
    }

    bool execute(CommandHandler*) override {
        saved_.clear();
        ScopedWriteLock lock(token_);
        for (const MediaPtr& clip : roomy_) fit(*clip);
        return true;
    }
    bool unexecute(CommandHandler*) override {
        ScopedWriteLock lock(token_);
        for (auto entry = saved_.rbegin(); entry != saved_.rend(); ++entry)
            entry->first->setDuration(entry->second);
        return true;
    }

private:
    void take(const Track& track) {
        for (const MediaPtr& clip : track.medias()) {
            if (Transition::keepsRoom(*clip, clip->duration())) roomy_.push_back(clip);
            if (const Group* group = Group::asGroup(clip.get()))
                for (const TrackPtr& inner : group->mixer()->tracks()) take(*inner);
            if (const auto* stitched = dynamic_cast<const StitchedMedia*>(clip.get()))
                take(*stitched->track());
        }
    }
    void fit(const Media& clip) {
        for (VelaTime missing = Transition::minimumTrackDuration(clip) - clip.duration(); missing > 0;) {
            const TransitionPtr left = clip.leftTransition(), right = clip.rightTransition();
            const TransitionPtr longer =
                !right || (left && left->duration() >= right->duration()) ? left : right;
            const VelaTime taken = std::min(missing, longer->duration());
            if (taken <= 0) return; // nothing left to give (one transition in both slots)
            saved_.emplace_back(longer, longer->duration());
            longer->setDuration(longer->duration() - taken);
            missing -= taken;
        }
    }

    boost::weak_ptr<const ThreadSafe> token_; // the tracks' project
    std::vector<MediaPtr> roomy_;
    std::vector<std::pair<TransitionPtr, VelaTime>> saved_;
};

// The track's transitions (each once) and clips, without fitting them.
void scaleTrackContents(MultiCommand& into, const TrackPtr& track, const EditRateScale& scale) {
    const std::vector<MediaPtr> clips = track->medias();
    const std::vector<MediaState> states = scale.trackStates(clips);
    std::vector<bool> later;
    for (size_t i = 0; i < clips.size(); ++i) later.push_back(states[i].start > clips[i]->startTime());
    into.execute(CommandPtr(new ScaleTransitionsStep(track, scale)));
    const auto scaleClip = [&](size_t i) {
        const auto step = ScaleMediaEditRateCmd::create(track, clips[i], scale.factor(), states[i].start);
        step->partOfTrackChange();
        if (!into.execute(step)) throw VelaMediaLibException("a clip refused the edit rate change");
    };
    for (size_t i = clips.size(); i-- > 0;)
        if (later[i]) scaleClip(i);
    for (size_t i = 0; i < clips.size(); ++i)
        if (!later[i]) scaleClip(i);
}

} // namespace

CommandPtr fitTransitionsStep(const std::vector<TrackPtr>& tracks) {
    return CommandPtr(new FitTransitionsStep(tracks));
}

void scaleTrackEditRate(MultiCommand& into, const TrackPtr& track, const EditRateScale& scale, bool fit) {
    if (!track || scale.isIdentity()) return;
    const CommandPtr fitting = fit ? fitTransitionsStep({track}) : CommandPtr();
    scaleTrackContents(into, track, scale);
    if (fitting) into.execute(fitting);
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

// Which clips have room is seen before anything is scaled, and the fit
// comes after every track's transitions are: one on two tracks is scaled
// with its left clip's track.
void ScaleMixerEditRateCmd::executeCommands(const CommandHandler*) {
    if (scale_.isIdentity()) return;
    const CommandPtr fit = fits_ ? fitTransitionsStep(mixer_->tracks()) : CommandPtr();
    for (const TrackPtr& track : mixer_->tracks()) scaleTrackContents(*this, track, scale_);
    if (fit) execute(fit);
}

} // namespace VelaMediaLib

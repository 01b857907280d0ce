#include <VelaMediaLib/commands/edits/SeparateVideoAudioCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>
#include <VelaMediaLib/model/timeline/GenericMixer.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>

namespace VelaMediaLib {
namespace {

/// Puts a new track in a mixer at an index; undone by taking it out again.
class AddTrackStep : public Command {
public:
    AddTrackStep(const boost::shared_ptr<GenericMixer>& mixer, const TrackPtr& track, int index)
        : mixer_(mixer), track_(track), index_(index) {}
    bool execute(CommandHandler*) override {
        mixer_->addTrack(track_, index_);
        return true;
    }
    bool unexecute(CommandHandler*) override { return mixer_->removeTrack(track_); }

private:
    boost::shared_ptr<GenericMixer> mixer_;
    TrackPtr track_;
    int index_;
};

} // namespace

boost::shared_ptr<ReleaseInternalsCmd>
ReleaseInternalsCmd::create(const boost::shared_ptr<UnifiedMedia>& unified) {
    if (!unified) throw VelaMediaLibException("no unified media to take apart");
    const boost::shared_ptr<ReleaseInternalsCmd> command(new ReleaseInternalsCmd(unified));
    command->setName("Release Unified Parts");
    return command;
}

// Moving a transition from one clip to another rewrites its links, so they
// are taken first and put back last on undo.
bool ReleaseInternalsCmd::execute(CommandHandler*) {
    if (unified_->parent() || !unified_->holdsInternals()) return false; // still placed, or apart already
    const MediaPtr visual = unified_->internalVisualMedia();
    unifiedLeft_ = unified_->leftTransition();
    unifiedRight_ = unified_->rightTransition();
    visualLeft_ = visual->leftTransition();
    visualRight_ = visual->rightTransition();
    links_.clear();
    for (const TransitionPtr& each : {unifiedLeft_, unifiedRight_, visualLeft_, visualRight_})
        if (each) links_.push_back(Link{each, each->leftMedia(), each->rightMedia()});
    unified_->releaseInternals();
    unified_->setLeftTransition(TransitionPtr());
    unified_->setRightTransition(TransitionPtr());
    visual->setLeftTransition(unifiedLeft_);
    visual->setRightTransition(unifiedRight_);
    return true;
}

bool ReleaseInternalsCmd::unexecute(CommandHandler*) {
    const MediaPtr visual = unified_->internalVisualMedia();
    visual->setLeftTransition(visualLeft_);
    visual->setRightTransition(visualRight_);
    unified_->setLeftTransition(unifiedLeft_);
    unified_->setRightTransition(unifiedRight_);
    {
        ScopedWriteLock lock(unified_->projectMutex());
        for (const Link& link : links_) {
            link.transition->setLeftMedia(link.left);
            link.transition->setRightMedia(link.right);
        }
    }
    unified_->adoptInternals();
    return true;
}

boost::shared_ptr<UnifiedMedia> SeparateVideoAudioCmd::unifiedOf(const TrackPtr& track,
                                                                 const MediaPtr& media) {
    if (!track) throw VelaMediaLibException("no track to take a unified media apart on");
    const boost::shared_ptr<UnifiedMedia> unified = boost::dynamic_pointer_cast<UnifiedMedia>(media);
    if (!unified) throw TypeException("only a unified media can be taken apart");
    return unified;
}

boost::shared_ptr<SeparateVideoAudioCmd>
SeparateVideoAudioCmd::create(const TrackPtr& track, const MediaPtr& media, const TrackPtr& audioTrack) {
    const boost::shared_ptr<UnifiedMedia> unified = unifiedOf(track, media);
    if (audioTrack == track)
        throw AddRemoveException("the audio of a unified media needs a track other than the clip's");
    const boost::shared_ptr<SeparateVideoAudioCmd> command(
        new SeparateVideoAudioCmd(track, unified, audioTrack));
    command->setName("Separate Video and Audio");
    return command;
}

// Made once: redo puts the same track back.
TrackPtr SeparateVideoAudioCmd::newAudioTrack() {
    const boost::shared_ptr<GenericMixer> mixer =
        boost::dynamic_pointer_cast<GenericMixer>(track_->parentMixer());
    if (!mixer) throw VelaMediaLibException("the clip's track lies in no mixer to add an audio track to");
    const TrackPtr made = GenericTrack::create(track_->projectMutex());
    execute(CommandPtr(new AddTrackStep(mixer, made, mixer->indexForTrack(track_) + 1)));
    return made;
}

void SeparateVideoAudioCmd::executeCommands(const CommandHandler*) {
    const VelaTime start = unified_->startTime();
    if (!executeRequired(RemoveMediaCmd::create(track_, unified_))) return;
    const TrackPtr audioTrack = audioTrack_ ? audioTrack_ : newAudioTrack();
    if (!executeRequired(ReleaseInternalsCmd::create(unified_))) return;
    if (!executeRequired(AddMediaCmd::create(track_, unified_->internalVisualMedia(), start))) return;
    if (!executeRequired(AddMediaCmd::create(audioTrack, unified_->internalAudioMedia(), start))) return;
    audioTrack_ = audioTrack;
}

} // namespace VelaMediaLib

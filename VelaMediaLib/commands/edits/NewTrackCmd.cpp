#include <VelaMediaLib/commands/edits/NewTrackCmd.h>

#include <VelaMediaLib/model/timeline/GenericTrack.h>

namespace VelaMediaLib {
namespace {

boost::shared_ptr<GenericMixer> genericOf(const MixerPtr& mixer) {
    const boost::shared_ptr<GenericMixer> generic = boost::dynamic_pointer_cast<GenericMixer>(mixer);
    if (!generic) throw TypeException("tracks are added to and removed from a GenericMixer");
    return generic;
}

void requireTrack(const Mixer& mixer, const TrackPtr& track) {
    if (!track || !mixer.hasTrack(track)) throw AddRemoveException("the track is not in this mixer");
}

} // namespace

boost::shared_ptr<NewTrackCmd> NewTrackCmd::create(const MixerPtr& mixer, int index) {
    const boost::shared_ptr<NewTrackCmd> command(new NewTrackCmd(genericOf(mixer), index));
    command->setName("New Track");
    return command;
}

// The mixer checks the index before it changes anything.
bool NewTrackCmd::execute(CommandHandler*) {
    if (!track_) track_ = GenericTrack::create(mixer_->projectMutex());
    mixer_->addTrack(track_, index_);
    return true;
}

bool NewTrackCmd::unexecute(CommandHandler*) { return mixer_->removeTrack(track_); }

boost::shared_ptr<RemoveTrackCmd> RemoveTrackCmd::create(const MixerPtr& mixer, const TrackPtr& track) {
    const boost::shared_ptr<GenericMixer> generic = genericOf(mixer);
    requireTrack(*generic, track);
    const boost::shared_ptr<RemoveTrackCmd> command(new RemoveTrackCmd(generic, track));
    command->setName("Remove Track");
    return command;
}

bool RemoveTrackCmd::execute(CommandHandler*) {
    if (!mixer_->hasTrack(track_)) return false;
    info_ = mixer_->removeTrackImpl(track_);
    return true;
}

bool RemoveTrackCmd::unexecute(CommandHandler*) {
    mixer_->putBack(info_);
    return true;
}

boost::shared_ptr<SwapTrackOrderCmd> SwapTrackOrderCmd::create(const MixerPtr& mixer, const TrackPtr& first,
                                                               const TrackPtr& second) {
    if (!mixer) throw AddRemoveException("the track is not in this mixer");
    requireTrack(*mixer, first);
    requireTrack(*mixer, second);
    if (first == second)
        throw ValueException<int>("cannot swap a track with itself", mixer->indexForTrack(first));
    const boost::shared_ptr<SwapTrackOrderCmd> command(new SwapTrackOrderCmd(mixer, first, second));
    command->setName("Swap Track Order");
    return command;
}

bool SwapTrackOrderCmd::execute(CommandHandler*) { return mixer_->swapTrackOrder(first_, second_); }

} // namespace VelaMediaLib

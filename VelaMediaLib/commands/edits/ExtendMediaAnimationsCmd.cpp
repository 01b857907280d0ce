#include <VelaMediaLib/commands/edits/ExtendMediaAnimationsCmd.h>

namespace VelaMediaLib {

AnimationTimeCmd::AnimationTimeCmd(const MediaPtr& media, VelaTime time, VelaTime amount, bool extend)
    : ClipTimeCmd(media, time, amount, extend, "move animations of", "animation") {}

MediaImpl::AnimationTracks AnimationTimeCmd::moved(const MediaImpl::AnimationTracks& tracks) const {
    const VelaTime from = extend_ ? time_ : time_ + amount_;
    const VelaTime offset = extend_ ? amount_ : -amount_;
    MediaImpl::AnimationTracks changed;
    for (const auto& entry : tracks) {
        std::vector<AnimationTrack::Animation> animations = entry.second.animations();
        bool moves = false;
        for (AnimationTrack::Animation& animation : animations) {
            if (!extend_ && animation.endTime >= time_ && animation.endTime < from)
                throw VelaMediaLibException("an animation ends in the time being removed");
            if (animation.endTime < from) continue;
            animation.range = Range<long long>(animation.range.start() + offset, animation.range.duration());
            animation.endTime += offset;
            moves = true;
        }
        if (moves) changed[entry.first] = AnimationTrack(entry.second.name(), animations);
    }
    return changed;
}

void AnimationTimeCmd::apply(const MediaImpl::AnimationTracks& tracks) const {
    MediaImpl& impl = dynamic_cast<MediaImpl&>(*media_);
    for (const auto& entry : tracks) impl.setAnimationTrack(entry.first, entry.second);
}

bool AnimationTimeCmd::execute(CommandHandler*) {
    before_.clear();
    after_.clear();
    MediaImpl* const impl = dynamic_cast<MediaImpl*>(media_.get());
    if (!impl || amount_ == 0) return false;
    const MediaImpl::AnimationTracks all = impl->animationTracks();
    MediaImpl::AnimationTracks changed = moved(all);
    if (changed.empty()) return false;
    for (const auto& entry : changed) before_[entry.first] = all.at(entry.first);
    after_.swap(changed);
    apply(after_);
    return true;
}

bool AnimationTimeCmd::unexecute(CommandHandler*) {
    apply(before_);
    return true;
}

bool AnimationTimeCmd::reexecute(CommandHandler*) {
    apply(after_);
    return true;
}

boost::shared_ptr<ExtendMediaAnimationsCmd> ExtendMediaAnimationsCmd::create(const MediaPtr& media,
                                                                             VelaTime time, VelaTime amount) {
    const boost::shared_ptr<ExtendMediaAnimationsCmd> command(
        new ExtendMediaAnimationsCmd(media, time, amount));
    command->setName("Extend Media Animations");
    return command;
}

boost::shared_ptr<ReduceMediaAnimationsCmd> ReduceMediaAnimationsCmd::create(const MediaPtr& media,
                                                                             VelaTime time, VelaTime amount) {
    const boost::shared_ptr<ReduceMediaAnimationsCmd> command(
        new ReduceMediaAnimationsCmd(media, time, amount));
    command->setName("Reduce Media Animations");
    return command;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/TrackCleanupCmd.h>

#include <VelaMediaLib/commands/edits/AddTransitionCmd.h>
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/timeline/Mixer.h>

namespace VelaMediaLib {

namespace {

/// Takes a transition out of one slot of a clip; undone by giving the slots
/// and links around the clip back as they were.
class ReleaseTransitionCmd : public TransitionEditCmd {
public:
    ReleaseTransitionCmd(const TrackPtr& track, const MediaPtr& media, Side side)
        : TransitionEditCmd(track), media_(media), side_(side) {
        setName("Release Transition");
    }
    bool execute(CommandHandler*) override {
        if (!onTrack({media_})) return false;
        saveSlots({media_});
        if (side_ == Left)
            media_->setLeftTransition(TransitionPtr());
        else
            media_->setRightTransition(TransitionPtr());
        return done();
    }

private:
    MediaPtr media_;
    TransitionEditCmd::Side side_;
};

bool isEmptyGroup(const Media& media) {
    const Group* group = Group::asGroup(&media);
    if (!group || !group->mixer()) return false;
    for (const TrackPtr& inner : group->mixer()->tracks())
        if (inner->numMedias() > 0) return false;
    return true;
}

// Whether the clip's slot holds a transition whose other side names a clip
// that is not the touching neighbour there holding it too.
bool holdsStray(const MediaPtr& media, TransitionEditCmd::Side side) {
    const bool left = side == TransitionEditCmd::Left;
    const TransitionPtr transition = left ? media->leftTransition() : media->rightTransition();
    if (!transition) return false;
    const MediaPtr other = left ? transition->leftMedia() : transition->rightMedia();
    if (!other) return false;
    const MediaPtr touching =
        left ? Track::getTouchingMediaToLeftOfMedia(media) : Track::getTouchingMediaToRightOfMedia(media);
    const TransitionPtr facing = !touching ? TransitionPtr()
                                 : left    ? touching->rightTransition()
                                           : touching->leftTransition();
    return other != touching || facing != transition;
}

} // namespace

boost::shared_ptr<TrackCleanupCmd> TrackCleanupCmd::create(const TrackPtr& track) {
    if (!track) throw VelaMediaLibException("no track to clean up");
    const boost::shared_ptr<TrackCleanupCmd> command(new TrackCleanupCmd(track));
    command->setName("Track Cleanup");
    return command;
}

bool TrackCleanupCmd::execute(CommandHandler* handler) {
    return MultiCommand::execute(handler) && numUndoCommands() > 0;
}

void TrackCleanupCmd::executeCommands(const CommandHandler*) {
    if (removeEmptyGroups()) releaseStrayTransitions();
}

bool TrackCleanupCmd::removeEmptyGroups() {
    for (const MediaPtr& media : track_->medias())
        if (isEmptyGroup(*media) && !executeRequired(RemoveMediaCmd::create(track_, media))) return false;
    return true;
}

// Found first, released after: releasing one side changes no other slot.
bool TrackCleanupCmd::releaseStrayTransitions() {
    std::vector<std::pair<MediaPtr, TransitionEditCmd::Side>> strays;
    for (const MediaPtr& media : track_->medias())
        for (const TransitionEditCmd::Side side : {TransitionEditCmd::Left, TransitionEditCmd::Right})
            if (holdsStray(media, side)) strays.emplace_back(media, side);
    for (const auto& stray : strays)
        if (!executeRequired(CommandPtr(new ReleaseTransitionCmd(track_, stray.first, stray.second))))
            return false;
    return true;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/CreateGroupCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/model/project/Project.h>

#include <algorithm>
#include <set>

namespace VelaMediaLib {
namespace {

// The clips of one track, and where the track stands in the mixer.
struct Origin {
    TrackPtr track;
    int index;
    std::vector<MediaPtr> clips;
};

TrackPtr trackOf(const MediaPtr& media) { return boost::dynamic_pointer_cast<Track>(media->parent()); }

void checkSelection(const std::vector<MediaPtr>& clips) {
    const std::set<MediaPtr> distinct(clips.begin(), clips.end());
    if (clips.empty() || distinct.size() != clips.size() || distinct.count(MediaPtr()))
        throw VelaMediaLibException("no clips to group");
    for (const MediaPtr& media : clips)
        if (!trackOf(media)) throw VelaMediaLibException("a clip to group lies on no track");
    for (const MediaPtr& media : clips) {
        const auto group = boost::dynamic_pointer_cast<Group>(media);
        for (const MediaPtr& other : clips)
            if (group && group->recursivelyContainsMedia(other))
                throw VelaMediaLibException("a clip cannot be grouped with a group that holds it");
    }
    const MixerPtr mixer = trackOf(clips.front())->parentMixer();
    for (const MediaPtr& media : clips)
        if (!mixer || trackOf(media)->parentMixer() != mixer)
            throw VelaMediaLibException("the clips to group lie on tracks of more than one mixer");
}

// The clips by track, in the mixer's order of their tracks.
std::vector<Origin> originsOf(const std::vector<MediaPtr>& clips) {
    std::vector<Origin> origins;
    for (const MediaPtr& media : clips) {
        const TrackPtr track = trackOf(media);
        auto found =
            std::find_if(origins.begin(), origins.end(), [&](const Origin& o) { return o.track == track; });
        if (found == origins.end())
            found =
                origins.insert(origins.end(), Origin{track, track->parentMixer()->indexForTrack(track), {}});
        found->clips.push_back(media);
    }
    std::sort(origins.begin(), origins.end(),
              [](const Origin& a, const Origin& b) { return a.index < b.index; });
    return origins;
}

bool selected(const std::vector<MediaPtr>& clips, const MediaPtr& media) {
    return std::find(clips.begin(), clips.end(), media) != clips.end();
}

// Parts the grouped clips from the transitions they share with clips left
// outside: such a transition belongs at the group's edge, where placing the
// group joins it, not inside with a clip that no longer touches the other
// side. Undone, every slot and link is back as it was.
class DetachOutsideTransitionsCmd : public Command {
public:
    explicit DetachOutsideTransitionsCmd(const std::vector<MediaPtr>& clips) : clips_(clips) {}

    bool execute(CommandHandler*) override {
        taken_.assign(clips_.size(), TransitionSlots());
        for (size_t i = 0; i < clips_.size(); ++i)
            taken_[i].takeAround(*trackOf(clips_[i]), clips_[i], clips_[i]->trackRange());
        for (const MediaPtr& media : clips_) {
            const TransitionPtr left = media->leftTransition(), right = media->rightTransition();
            if (left && left->leftMedia() && !selected(clips_, left->leftMedia()))
                media->setLeftTransition(TransitionPtr());
            if (right && right->rightMedia() && !selected(clips_, right->rightMedia()))
                media->setRightTransition(TransitionPtr());
        }
        return true;
    }
    bool unexecute(CommandHandler*) override {
        for (auto slots = taken_.rbegin(); slots != taken_.rend(); ++slots) slots->restore();
        return true;
    }

private:
    std::vector<MediaPtr> clips_;
    std::vector<TransitionSlots> taken_;
};

} // namespace

boost::shared_ptr<CreateGroupCmd> CreateGroupCmd::create(const std::vector<MediaPtr>& clips) {
    checkSelection(clips);
    const boost::shared_ptr<CreateGroupCmd> command(new CreateGroupCmd(clips));
    command->setName("Create Group");
    return command;
}

bool CreateGroupCmd::execute(CommandHandler* handler) {
    const boost::shared_ptr<Project> project = handler ? handler->project() : boost::shared_ptr<Project>();
    for (const MediaPtr& media : clips_)
        if (project && media->projectMutex().lock() != project->token().lock())
            throw VelaMediaLibException("the clips to group belong to another project");
    return MultiCommand::execute(handler);
}

// The clips leave their tracks first, so that each goes onto the group's
// track for it; the group is made once they stand there, from their extent.
void CreateGroupCmd::executeCommands(const CommandHandler*) {
    checkSelection(clips_);
    const std::vector<Origin> origins = originsOf(clips_);
    VelaTime start = clips_.front()->startTime();
    for (const MediaPtr& media : clips_) start = std::min(start, media->startTime());
    const auto mixer = GenericMixer::create(clips_.front()->projectMutex());
    std::vector<boost::shared_ptr<GenericTrack>> inner;
    for (const Origin& origin : origins) {
        inner.push_back(boost::dynamic_pointer_cast<GenericTrack>(origin.track->cloneEmpty()));
        mixer->addTrack(inner.back());
    }
    if (!executeRequired(CommandPtr(new DetachOutsideTransitionsCmd(clips_)))) return;
    for (const Origin& origin : origins)
        for (const MediaPtr& media : origin.clips)
            if (!executeRequired(RemoveMediaCmd::create(origin.track, media))) return;
    for (size_t i = 0; i < origins.size(); ++i)
        for (const MediaPtr& media : origins[i].clips)
            if (!executeRequired(AddMediaCmd::create(inner[i], media, media->startTime() - start))) return;
    group_ = Group::create(clips_.front()->projectMutex(), clips_.front()->projectEditRate(), mixer, start);
    if (!executeRequired(AddMediaCmd::create(origins.front().track, group_, start))) group_.reset();
}

} // namespace VelaMediaLib

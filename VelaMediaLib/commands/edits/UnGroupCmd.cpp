#include <VelaMediaLib/commands/edits/UnGroupCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/model/project/Project.h>

#include <algorithm>
#include <set>

namespace VelaMediaLib {
namespace {

// A track added to a mixer, taken off again on undo.
class AddTrackToMixerCmd : public Command {
public:
    AddTrackToMixerCmd(const boost::shared_ptr<GenericMixer>& mixer, const TrackPtr& track)
        : mixer_(mixer), track_(track) {}
    bool execute(CommandHandler*) override {
        mixer_->addTrack(track_);
        return true;
    }
    bool unexecute(CommandHandler*) override { return mixer_->removeTrack(track_); }

private:
    boost::shared_ptr<GenericMixer> mixer_;
    TrackPtr track_;
};

// A clip of the group, what its trims take off and where it goes.
struct Release {
    MediaPtr media;
    VelaTime trimStart, trimEnd;
    Range<VelaTime> placed;
};

// The clips of the track the group shows, cut to its window [first, end)
// of whole ticks and moved by the offset from inner to global time.
std::vector<Release> releasesOf(const Track& track, VelaTime first, VelaTime end, VelaTime offset) {
    std::vector<Release> releases;
    for (const MediaPtr& media : track.medias()) {
        const Range<VelaTime> range = media->trackRange();
        const VelaTime from = std::max(range.start(), first), to = std::min(range.end(), end);
        if (from >= to) continue;
        releases.push_back(Release{media, from - range.start(), range.end() - to,
                                   Range<VelaTime>(from + offset, to - from)});
    }
    return releases;
}

bool fits(const Track& track, const std::vector<Release>& releases) {
    return std::all_of(releases.begin(), releases.end(),
                       [&](const Release& r) { return track.mediasIntersectingRange(r.placed).empty(); });
}

} // namespace

boost::shared_ptr<UnGroupCmd> UnGroupCmd::create(const GroupPtr& group) {
    if (!group) throw VelaMediaLibException("no group to ungroup");
    const boost::shared_ptr<UnGroupCmd> command(new UnGroupCmd(group));
    command->setName("Ungroup");
    return command;
}

bool UnGroupCmd::execute(CommandHandler* handler) {
    const boost::shared_ptr<Project> project = handler ? handler->project() : boost::shared_ptr<Project>();
    if (project && group_->projectMutex().lock() != project->token().lock())
        throw VelaMediaLibException("the group belongs to another project");
    return MultiCommand::execute(handler);
}

// The group leaves first, so that its own track is free where it stood.
void UnGroupCmd::executeCommands(const CommandHandler*) {
    const TrackPtr home = boost::dynamic_pointer_cast<Track>(group_->parent());
    const auto mixer = boost::dynamic_pointer_cast<GenericMixer>(home ? home->parentMixer() : MixerPtr());
    if (!mixer) throw VelaMediaLibException("the group to ungroup lies on no track");
    const MediaState state = group_->state();
    if (state.scalar != 1 || state.mediaStart.denominator() != 1)
        throw VelaMediaLibException("only a group playing whole ticks at normal speed can be ungrouped");
    const VelaTime first = state.mediaStart.asVelaTime(), offset = state.start - first;
    const Mixer::Tracks inner = group_->mixer()->tracks();
    if (!executeRequired(RemoveMediaCmd::create(home, group_))) return;
    std::set<TrackPtr> taken;
    for (const TrackPtr& track : inner) {
        const std::vector<Release> releases = releasesOf(*track, first, first + state.duration, offset);
        if (releases.empty()) continue;
        const Mixer::Tracks candidates = mixer->tracks();
        auto target = std::find_if(candidates.begin() + mixer->indexForTrack(home), candidates.end(),
                                   [&](const TrackPtr& t) { return !taken.count(t) && fits(*t, releases); });
        TrackPtr destination = target == candidates.end() ? TrackPtr() : *target;
        if (!destination) {
            destination = GenericTrack::create(mixer->projectMutex());
            if (!executeRequired(CommandPtr(new AddTrackToMixerCmd(mixer, destination)))) return;
        }
        taken.insert(destination);
        for (const Release& r : releases) {
            if (r.trimStart && !executeRequired(TrimStartCmd::create(track, r.media, r.trimStart))) return;
            if (r.trimEnd && !executeRequired(TrimEndCmd::create(track, r.media, r.trimEnd))) return;
            if (!executeRequired(RemoveMediaCmd::create(track, r.media))) return;
            if (!executeRequired(AddMediaCmd::create(destination, r.media, r.placed.start()))) return;
        }
    }
}

} // namespace VelaMediaLib

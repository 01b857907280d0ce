#include <VelaMediaLib/commands/edits/DuplicateMediaCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/CloneAddMediasCmd.h>

#include <algorithm>
#include <numeric>
#include <set>

namespace VelaMediaLib {
namespace {

TrackPtr trackOf(const MediaPtr& media) { return boost::dynamic_pointer_cast<Track>(media->parent()); }

} // namespace

boost::shared_ptr<DuplicateMediaCmd> DuplicateMediaCmd::create(const std::vector<MediaPtr>& medias) {
    if (medias.empty()) throw VelaMediaLibException("no clips to duplicate");
    std::set<MediaPtr> seen;
    for (const MediaPtr& media : medias) {
        if (!media) throw VelaMediaLibException("no clip to duplicate");
        if (!seen.insert(media).second) throw VelaMediaLibException("a clip to duplicate is given twice");
    }
    const boost::shared_ptr<DuplicateMediaCmd> command(new DuplicateMediaCmd(medias));
    command->setName("Duplicate Media");
    return command;
}

// The clips are in start order and never overlap: the first gap after `from`
// as long as the duration, or the end of the last clip.
VelaTime DuplicateMediaCmd::firstFreeStart(const Track& track, VelaTime from, VelaTime duration) {
    ScopedReadLock lock(track.projectLock());
    VelaTime candidate = from;
    for (auto at = track.mediaBegin(); at != track.mediaEnd(); ++at) {
        const Range<VelaTime> range = at->second->lockedTrackRange();
        if (range.end() <= candidate) continue;
        if (range.start() >= candidate + duration) break;
        candidate = range.end();
    }
    return candidate;
}

// A clip on no track (or inside another clip) has no place for a copy.
bool DuplicateMediaCmd::execute(CommandHandler* handler) {
    created_.assign(medias_.size(), MediaPtr());
    for (const MediaPtr& media : medias_)
        if (!trackOf(media)) return false;
    if (MultiCommand::execute(handler)) return true;
    created_.assign(medias_.size(), MediaPtr());
    return false;
}

void DuplicateMediaCmd::executeCommands(const CommandHandler*) {
    std::vector<size_t> order(medias_.size());
    std::iota(order.begin(), order.end(), 0);
    std::stable_sort(order.begin(), order.end(),
                     [&](size_t a, size_t b) { return medias_[a]->startTime() < medias_[b]->startTime(); });
    for (const size_t index : order) {
        const MediaPtr& media = medias_[index];
        const TrackPtr track = trackOf(media);
        const MediaPtr copy = CloneAddMediasCmd::placeableClone(*media);
        const VelaTime start = firstFreeStart(*track, media->endTime(), copy->duration());
        if (!executeRequired(AddMediaCmd::create(track, copy, start))) return;
        created_[index] = copy;
    }
}

} // namespace VelaMediaLib

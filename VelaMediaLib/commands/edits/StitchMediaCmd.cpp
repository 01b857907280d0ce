#include <VelaMediaLib/commands/edits/StitchMediaCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/detail/StitchSupport.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>

#include <algorithm>

namespace VelaMediaLib {

StitchMediaCmd::StitchMediaCmd(const TrackPtr& track, const std::vector<MediaPtr>& clips)
    : track_(track), clips_(clips) {
    clips_ = checkedClips();
    const MediaPtr& first = clips_.front();
    stitched_ = StitchedMedia::create(first->projectMutex(), first->projectEditRate(),
                                      MediaState::unbounded(first->startTime(), 1));
    setName("Stitch");
}

boost::shared_ptr<StitchMediaCmd> StitchMediaCmd::create(const TrackPtr& track,
                                                         const std::vector<MediaPtr>& clips) {
    return boost::shared_ptr<StitchMediaCmd>(new StitchMediaCmd(track, clips));
}

std::vector<MediaPtr> StitchMediaCmd::checkedClips() const {
    if (!track_) throw AddRemoveException("no track to stitch clips on");
    if (clips_.size() < 2) throw AddRemoveException("stitching needs at least two clips");
    std::vector<MediaPtr> ordered = clips_;
    for (const MediaPtr& clip : ordered)
        if (!clip || !track_->hasMedia(clip))
            throw AddRemoveException("a clip to stitch is not on the track");
    std::sort(ordered.begin(), ordered.end(),
              [](const MediaPtr& a, const MediaPtr& b) { return a->startTime() < b->startTime(); });
    if (std::adjacent_find(ordered.begin(), ordered.end()) != ordered.end())
        throw AddRemoveException("a clip to stitch is given twice");
    for (size_t i = 1; i < ordered.size(); ++i) {
        if (ordered[i - 1]->endTime() != ordered[i]->startTime())
            throw VelaMediaLibException("only touching clips can be stitched");
        if (StitchedMedia::sourceOf(ordered[i]) != StitchedMedia::sourceOf(ordered.front()))
            throw VelaMediaLibException("cannot stitch clips of different sources");
    }
    return ordered;
}

void StitchMediaCmd::executeCommands(const CommandHandler*) {
    const std::vector<MediaPtr> clips = checkedClips();
    const VelaTime start = clips.front()->startTime();
    for (const MediaPtr& clip : clips)
        if (!executeRequired(RemoveMediaCmd::create(track_, clip))) return;
    if (!executeRequired(CommandPtr(new detail::StitchPartsCmd(stitched_, clips)))) return;
    executeRequired(AddMediaCmd::create(track_, stitched_, start));
}

} // namespace VelaMediaLib

#include <VelaMediaLib/commands/edits/RippleDeleteRangeAndCreateDeletionPointCmd.h>

#include <VelaMediaLib/document/format/XMLOptions.h>

#include <sstream>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/RippleMoveCmd.h>

#include <algorithm>

namespace VelaMediaLib {

boost::shared_ptr<SetDeletionPointsCmd>
SetDeletionPointsCmd::create(const TrackPtr& track, const std::vector<DeletionPointPtr>& points) {
    if (!track) throw VelaMediaLibException("no track for deletion points");
    const boost::shared_ptr<SetDeletionPointsCmd> command(new SetDeletionPointsCmd(track, points));
    command->setName("Set Deletion Points");
    return command;
}

boost::shared_ptr<DeletionPointList> SetDeletionPointsCmd::listOf(const TrackPtr& track) {
    const TimelinePtr timeline = track ? track->parentTimeline() : TimelinePtr();
    if (!timeline) throw VelaMediaLibException("a deletion point needs a track on a timeline");
    return timeline->deletionPoints();
}

bool SetDeletionPointsCmd::execute(CommandHandler*) {
    const boost::shared_ptr<DeletionPointList> list = listOf(track_);
    saved_ = list->pointsOn(*track_);
    list->setPointsOn(*track_, points_);
    return true;
}

// The track may have left the timeline since: its points stay with the list they were in.
bool SetDeletionPointsCmd::unexecute(CommandHandler*) {
    const TimelinePtr timeline = track_->parentTimeline();
    if (!timeline) return false;
    timeline->deletionPoints()->setPointsOn(*track_, saved_);
    return true;
}

boost::shared_ptr<RippleDeleteRangeAndCreateDeletionPointCmd>
RippleDeleteRangeAndCreateDeletionPointCmd::create(const Range<VelaTime>& range) {
    if (range.duration() <= 0) throw VelaMediaLibException("a deleted range must be longer than zero");
    const boost::shared_ptr<RippleDeleteRangeAndCreateDeletionPointCmd> command(
        new RippleDeleteRangeAndCreateDeletionPointCmd(std::vector<Range<VelaTime>>{range}));
    command->setName("Ripple Delete");
    return command;
}

void RippleDeleteRangeAndCreateDeletionPointCmd::addTrack(const TrackPtr& track) {
    if (!track) throw VelaMediaLibException("no track to ripple delete on");
    if (std::find(tracks_.begin(), tracks_.end(), track) == tracks_.end()) tracks_.push_back(track);
}

bool RippleDeleteRangeAndCreateDeletionPointCmd::execute(CommandHandler* handler) {
    created_.clear();
    if (MultiCommand::execute(handler) && numUndoCommands() > 0) return true;
    created_.clear();
    return false;
}

void RippleDeleteRangeAndCreateDeletionPointCmd::executeCommands(const CommandHandler*) {
    if (tracks_.empty()) throw VelaMediaLibException("can't ripple delete without tracks");
    for (const TrackPtr& track : tracks_) SetDeletionPointsCmd::listOf(track); // all on a timeline
    for (const Range<VelaTime>& range : ranges_)
        for (const TrackPtr& track : tracks_)
            if (!deleteRange(track, range)) return;
}

std::string DeletionCuts::textOf(const Media& media) {
    std::ostringstream out;
    XMLOptions options(out);
    media.toJSON(options, 0);
    return out.str();
}

bool RippleDeleteRangeAndCreateDeletionPointCmd::cutAt(const TrackPtr& track, VelaTime time,
                                                       DeletionCuts& cuts) {
    const MediaPtr left = SplitCmd::mediaToSplit(*track, time);
    if (!left) return true;
    const boost::shared_ptr<SplitCmd> split = SplitCmd::create(track, time);
    if (!executeRequired(split)) return false;
    const MediaPtr right = split->getCreatedMedias().front();
    DeletionCuts::Cut cut{
        split, left, right, DeletionCuts::textOf(*left), DeletionCuts::textOf(*right), TransitionSlots()};
    cut.slots.takeAround(*track, left,
                         Range<VelaTime>(left->startTime(), right->endTime() - left->startTime()), true);
    cuts.cuts.push_back(cut);
    return true;
}

namespace {

// The track's points after the range went: those inside it (ends included)
// go into the new point, later ones move left with the content.
std::vector<DeletionPointPtr> pointsAfterDeletion(const std::vector<DeletionPointPtr>& points,
                                                  const Range<VelaTime>& range,
                                                  std::vector<DeletionPoint::InnerPoint>& inner) {
    std::vector<DeletionPointPtr> kept;
    for (const DeletionPointPtr& point : points) {
        if (point->time() < range.start())
            kept.push_back(point);
        else if (point->time() <= range.end())
            inner.push_back(DeletionPoint::InnerPoint{point, point->time() - range.start()});
        else
            kept.push_back(point->movedTo(point->time() - range.duration()));
    }
    return kept;
}

} // namespace

bool RippleDeleteRangeAndCreateDeletionPointCmd::deleteRange(const TrackPtr& track,
                                                             const Range<VelaTime>& range) {
    const boost::shared_ptr<DeletionCuts> cuts(new DeletionCuts);
    if (!cutAt(track, range.start(), *cuts) || !cutAt(track, range.end(), *cuts)) return false;
    std::vector<DeletionPoint::RemovedClip> removed;
    for (const MediaPtr& media : track->mediasIntersectingRange(range)) {
        removed.push_back(DeletionPoint::RemovedClip{media, media->startTime() - range.start()});
        if (!executeRequired(RemoveMediaCmd::create(track, media))) return false;
    }
    MediaPtr after;
    {
        ScopedReadLock lock(track->projectLock());
        const auto at = track->lower_bound(range.end());
        if (at != track->mediaEnd()) after = at->second;
    }
    if (after && !executeRequired(RippleMoveCmd::create(track, after, -range.duration()))) return false;
    if (removed.empty() && !after) return true; // nothing here to remember
    std::vector<DeletionPoint::InnerPoint> inner;
    std::vector<DeletionPointPtr> points =
        pointsAfterDeletion(SetDeletionPointsCmd::listOf(track)->pointsOn(*track), range, inner);
    const DeletionPointPtr point(
        new DeletionPoint(track, range.start(), range.duration(), removed, inner, cuts));
    points.push_back(point);
    if (!executeRequired(SetDeletionPointsCmd::create(track, points))) return false;
    created_.push_back(point);
    return true;
}

} // namespace VelaMediaLib

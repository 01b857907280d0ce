#include <VelaMediaLib/commands/edits/RestoreDeletionPointAtTimeCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/RippleDeleteRangeAndCreateDeletionPointCmd.h>

#include <algorithm>

namespace VelaMediaLib {

namespace {

/// Joins a cut again by undoing the split that made it; undone by redoing
/// the split. The split's own sub-edits give both pieces back exactly.
class JoinCutCmd : public Command {
public:
    explicit JoinCutCmd(const boost::shared_ptr<SplitCmd>& split) : split_(split) { setName("Join Cut"); }
    bool execute(CommandHandler* handler) override { return split_->unexecute(handler); }
    bool unexecute(CommandHandler* handler) override { return split_->reexecute(handler); }
    bool reexecute(CommandHandler* handler) override { return split_->unexecute(handler); }

private:
    boost::shared_ptr<SplitCmd> split_;
};

// Both pieces on the track, touching, and as the split left them, all they
// hold and every transition slot and link around them: undoing the split
// puts back what it saw, so joining after an effect, a keyframe or a
// transition was changed since would drop the change, and the join's undo
// could not give it back.
bool standsAsCut(const Track& track, const DeletionCuts::Cut& cut) {
    ScopedReadLock lock(track.projectLock());
    return track.hasMedia(cut.left) && track.hasMedia(cut.right) &&
           DeletionCuts::textOf(*cut.left) == cut.leftText &&
           DeletionCuts::textOf(*cut.right) == cut.rightText && cut.slots.standsAsTaken();
}

// The track's points once the point is restored: the later ones move right,
// the ones it held come back where they stood.
std::vector<DeletionPointPtr> pointsAfterRestore(const std::vector<DeletionPointPtr>& points,
                                                 const DeletionPointPtr& restored) {
    std::vector<DeletionPointPtr> kept;
    for (const DeletionPointPtr& point : points) {
        if (point == restored) continue;
        kept.push_back(point->time() > restored->time() ? point->movedTo(point->time() + restored->length())
                                                        : point);
    }
    for (const DeletionPoint::InnerPoint& inner : restored->innerPoints())
        kept.push_back(inner.point->movedTo(restored->time() + inner.offset));
    return kept;
}

} // namespace

boost::shared_ptr<RestoreDeletionPointAtTimeCmd> RestoreDeletionPointAtTimeCmd::create(VelaTime time) {
    const boost::shared_ptr<RestoreDeletionPointAtTimeCmd> command(new RestoreDeletionPointAtTimeCmd(time));
    command->setName("Restore Deletion Point");
    return command;
}

void RestoreDeletionPointAtTimeCmd::addTrack(const TrackPtr& track) {
    if (!track) throw VelaMediaLibException("no track to restore a deletion point on");
    if (std::find(tracks_.begin(), tracks_.end(), track) == tracks_.end()) tracks_.push_back(track);
}

bool RestoreDeletionPointAtTimeCmd::hasDeletionPointAt(const TrackPtr& track, VelaTime time) {
    const TimelinePtr timeline = track ? track->parentTimeline() : TimelinePtr();
    return timeline && timeline->deletionPoints()->pointAt(*track, time);
}

void RestoreDeletionPointAtTimeCmd::executeCommands(const CommandHandler*) {
    if (tracks_.empty()) throw VelaMediaLibException("can't restore a deletion point without tracks");
    std::vector<DeletionPointPtr> points;
    for (const TrackPtr& track : tracks_)
        points.push_back(SetDeletionPointsCmd::listOf(track)->pointAt(*track, time_));
    for (size_t i = 0; i < tracks_.size(); ++i)
        if (points[i] && !restore(tracks_[i], points[i])) return;
}

bool RestoreDeletionPointAtTimeCmd::restore(const TrackPtr& track, const DeletionPointPtr& point) {
    if (!splitAndRipple(track, point->time(), point->length())) return false;
    for (const DeletionPoint::RemovedClip& clip : point->clips())
        if (!executeRequired(AddMediaCmd::create(track, clip.media, point->time() + clip.offset)))
            return false;
    if (!joinCuts(track, *point)) return false;
    const std::vector<DeletionPointPtr> points =
        pointsAfterRestore(SetDeletionPointsCmd::listOf(track)->pointsOn(*track), point);
    return executeRequired(SetDeletionPointsCmd::create(track, points));
}

// The last cut first: a later cut may have split a piece of an earlier one.
bool RestoreDeletionPointAtTimeCmd::joinCuts(const TrackPtr& track, const DeletionPoint& point) {
    const auto cuts = boost::dynamic_pointer_cast<const DeletionCuts>(point.joins());
    if (!cuts) return true;
    for (auto cut = cuts->cuts.rbegin(); cut != cuts->cuts.rend(); ++cut)
        if (standsAsCut(*track, *cut) && !executeRequired(CommandPtr(new JoinCutCmd(cut->split))))
            return false;
    return true;
}

} // namespace VelaMediaLib

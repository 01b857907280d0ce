#include <VelaMediaLib/document/CopyRangeClippingCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/MagneticEffects.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>
#include <VelaMediaLib/commands/edits/detail/SourceCommandSupport.h>
#include <VelaMediaLib/document/ClippingWriter.h>
#include <VelaMediaLib/model/timeline/GenericMixer.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>

#include <algorithm>
#include <map>

namespace VelaMediaLib {
namespace {

typedef std::map<MediaPtr, MediaPtr> Copies;

// The clip's part inside the range, standing where the range starts or later.
MediaPtr cutCopy(const Media& media, const Range<VelaTime>& range) {
    const Range<VelaTime> at = media.trackRange();
    const MediaPtr copy = at.start() < range.start()
                              ? SplitCmd::rightHandCopy(media, range.start() - at.start())
                              : media.clone();
    if (copy->endTime() > range.end()) {
        // As a split's left part: the effects that follow the end edge end with the copy.
        const Range<VelaTime> before = copy->trackRange();
        const EdgeEffects followers = magneticEffectsForMedia(copy);
        copy->trimEnd(copy->endTime() - range.end());
        if (const auto moved =
                effectsFollowingEdge(copy->allEffects(), followers, before, copy->trackRange(), false))
            copy->replaceAllEffects(*moved);
        // The fades out stay with the part after the range, as a cut's split leaves them.
        copy->setRightEdgeModificationsUnnotified(EdgeModifiable::EdgeModifications());
    }
    return copy;
}

// A transition edge's far side is kept when there is none, when it came
// along, or when it is off the track (the track's document shows the
// transition one-sided then too).
bool farSideKept(const MediaPtr& other, const Track& track, const Copies& copies) {
    return !other || copies.count(other) || !track.hasMedia(other);
}

struct Carried {
    MediaPtr copy;
    bool left;
    TransitionPtr transition;
};

// The transitions that come along, cloned once each, shared where they join two copies.
std::vector<Carried> carriedTransitions(const Track& track, const Range<VelaTime>& range,
                                        const Copies& copies) {
    std::map<TransitionPtr, TransitionPtr> clones;
    const auto cloneOf = [&](const TransitionPtr& original) {
        TransitionPtr& clone = clones[original];
        if (!clone) clone = original->clone();
        return clone;
    };
    std::vector<Carried> carried;
    for (const auto& entry : copies) {
        const Range<VelaTime> at = entry.first->trackRange();
        const TransitionPtr left = entry.first->leftTransition();
        if (left && at.start() >= range.start() && farSideKept(left->leftMedia(), track, copies))
            carried.push_back(Carried{entry.second, true, cloneOf(left)});
        const TransitionPtr right = entry.first->rightTransition();
        if (right && at.end() <= range.end() && farSideKept(right->rightMedia(), track, copies))
            carried.push_back(Carried{entry.second, false, cloneOf(right)});
    }
    return carried;
}

// A clip may not be shorter than its transitions together: those of a copy
// cut too short stay behind, on both their sides.
void dropTooLong(std::vector<Carried>& carried) {
    std::map<MediaPtr, VelaTime> lengths;
    for (const Carried& each : carried) lengths[each.copy] += each.transition->duration();
    std::vector<TransitionPtr> dropped;
    for (const Carried& each : carried)
        if (lengths[each.copy] > each.copy->duration()) dropped.push_back(each.transition);
    for (const TransitionPtr& transition : dropped)
        carried.erase(std::remove_if(carried.begin(), carried.end(),
                                     [&](const Carried& each) { return each.transition == transition; }),
                      carried.end());
}

TrackPtr portionOf(const Track& track, const Range<VelaTime>& range) {
    const boost::shared_ptr<GenericTrack> portion = GenericTrack::create(track.projectMutex());
    Copies copies;
    for (const MediaPtr& media : track.mediasIntersectingRange(range)) copies[media] = cutCopy(*media, range);
    std::vector<Carried> carried = carriedTransitions(track, range, copies);
    dropTooLong(carried);
    for (const Carried& each : carried)
        each.left ? each.copy->setLeftTransition(each.transition)
                  : each.copy->setRightTransition(each.transition);
    for (const auto& entry : copies)
        portion->addMedia(entry.second, entry.second->startTime() - range.start());
    return portion;
}

} // namespace

void CopyRangeClippingCmd::checkArguments(const std::vector<TrackPtr>& tracks, const Range<VelaTime>& range) {
    if (tracks.empty()) throw VelaMediaLibException("a clipping needs tracks to copy from");
    for (const TrackPtr& track : tracks)
        if (!track) throw VelaMediaLibException("a clipping needs tracks to copy from");
    if (range.duration() <= 0) throw VelaMediaLibException("a clipping needs a range of at least one tick");
}

void CopyRangeClippingCmd::checkTracksOf(const Project& project, const std::vector<TrackPtr>& tracks) {
    const ThreadSafe* own = &project;
    for (const TrackPtr& track : tracks)
        if (track->projectMutex().lock().get() != own)
            throw VelaMediaLibException("the tracks are not of the project edited");
}

boost::shared_ptr<CopyRangeClippingCmd> CopyRangeClippingCmd::create(const std::vector<TrackPtr>& tracks,
                                                                     const Range<VelaTime>& range) {
    checkArguments(tracks, range);
    const boost::shared_ptr<CopyRangeClippingCmd> command(new CopyRangeClippingCmd(tracks, range));
    command->setName("Copy");
    return command;
}

MixerPtr CopyRangeClippingCmd::clippingOf(const std::vector<TrackPtr>& tracks, const Range<VelaTime>& range) {
    checkArguments(tracks, range);
    const boost::shared_ptr<GenericMixer> clipping = GenericMixer::create(tracks.front()->projectMutex());
    for (const TrackPtr& track : tracks) clipping->addTrack(portionOf(*track, range));
    return clipping;
}

std::string CopyRangeClippingCmd::clippingDocument(const Project& project,
                                                   const std::vector<TrackPtr>& tracks,
                                                   const Range<VelaTime>& range) {
    checkArguments(tracks, range);
    checkTracksOf(project, tracks);
    return clippingToJSONString(project, *clippingOf(tracks, range));
}

bool CopyRangeClippingCmd::execute(CommandHandler* handler) {
    const ProjectPtr project = projectForSourceCommand(handler);
    checkTracksOf(*project, tracks_);
    const MixerPtr clipping = clippingOf(tracks_, range_);
    text_ = clippingToJSONString(*project, *clipping);
    clipping_ = clipping;
    return false; // nothing changed: no undo step
}

boost::shared_ptr<CutRangeClippingCmd> CutRangeClippingCmd::create(const std::vector<TrackPtr>& tracks,
                                                                   const Range<VelaTime>& range) {
    CopyRangeClippingCmd::checkArguments(tracks, range);
    const boost::shared_ptr<CutRangeClippingCmd> command(new CutRangeClippingCmd(tracks, range));
    command->setName("Cut");
    return command;
}

bool CutRangeClippingCmd::execute(CommandHandler* handler) {
    text_.clear();
    bool done = false;
    try {
        done = MultiCommand::execute(handler);
    } catch (...) {
        text_.clear(); // rolled back: nothing was cut
        throw;
    }
    if (!done) text_.clear();
    return done && numUndoCommands() > 0; // a range holding nothing keeps its (empty) clipping's text
}

bool CutRangeClippingCmd::splitAt(const TrackPtr& track, VelaTime time) {
    return !SplitCmd::mediaToSplit(*track, time) || executeRequired(SplitCmd::create(track, time));
}

void CutRangeClippingCmd::executeCommands(const CommandHandler*) {
    const ProjectPtr project = projectForSourceCommand(handler());
    text_ = CopyRangeClippingCmd::clippingDocument(*project, tracks_, range_);
    for (const TrackPtr& track : tracks_) {
        if (!splitAt(track, range_.start()) || !splitAt(track, range_.end())) return;
        for (const MediaPtr& media : track->mediasIntersectingRange(range_))
            if (!executeRequired(RemoveMediaCmd::create(track, media))) return;
    }
}

} // namespace VelaMediaLib

// Edit makers for the command families beyond the core edits: placement,
// time structure, deletion points, tracks and mixers, edit rates, edge
// modifications, animations and keyframes, and the clipboard. As the core
// makers do, each picks its arguments from what stands on the tracks and now
// and then makes them wrong, so that refusals come as often as edits.
//
// Not here: ExtendFrameCmd and StitchingExtendFrameCmd need a clip of a file
// source with an image stream, and the soak's project holds placeholders only.
#include "SoakDriver.h"

#include <VelaMediaLib/commands/edits/AddAnimationCmd.h>
#include <VelaMediaLib/commands/edits/AddEdgeModCmd.h>
#include <VelaMediaLib/commands/edits/AddParameterKeyFrameInterfaceCmd.h>
#include <VelaMediaLib/commands/edits/ApplySerializedParameterValuesToMediaCmd.h>
#include <VelaMediaLib/commands/edits/ChangeProjectEditRateCmd.h>
#include <VelaMediaLib/commands/edits/CloneAddMediasCmd.h>
#include <VelaMediaLib/commands/edits/DisplaceMediaOnUnifiedMixerCmd.h>
#include <VelaMediaLib/commands/edits/DuplicateMediaCmd.h>
#include <VelaMediaLib/commands/edits/EdgeModCloneCmd.h>
#include <VelaMediaLib/commands/edits/ExtendEffectsCmd.h>
#include <VelaMediaLib/commands/edits/ExtendMediaAnimationsCmd.h>
#include <VelaMediaLib/commands/edits/ExtendFrameCmd.h>
#include <VelaMediaLib/commands/edits/ExtendMediaCmd.h>
#include <VelaMediaLib/commands/edits/StitchingExtendFrameCmd.h>
#include <VelaMediaLib/commands/edits/ExtendParametersCmd.h>
#include <VelaMediaLib/commands/edits/ExtendTracksCmd.h>
#include <VelaMediaLib/commands/edits/MergeAnimationsCmd.h>
#include <VelaMediaLib/commands/edits/MoveAnimationCmd.h>
#include <VelaMediaLib/commands/edits/MoveEdgeModCmd.h>
#include <VelaMediaLib/commands/edits/MoveParameterKeyFrameCmd.h>
#include <VelaMediaLib/commands/edits/NewMixerCmd.h>
#include <VelaMediaLib/commands/edits/NewTrackCmd.h>
#include <VelaMediaLib/commands/edits/RemoveAnimationCmd.h>
#include <VelaMediaLib/commands/edits/RemoveEdgeModCmd.h>
#include <VelaMediaLib/commands/edits/RemoveLastMediaCmd.h>
#include <VelaMediaLib/commands/edits/RemoveParameterKeyFrameCmd.h>
#include <VelaMediaLib/commands/edits/RemoveRangeMediaCmd.h>
#include <VelaMediaLib/commands/edits/RepeatMediaToFillRangeCmd.h>
#include <VelaMediaLib/commands/edits/ReplaceMediaWithMediasCmd.h>
#include <VelaMediaLib/commands/edits/RestoreDeletionPointAtTimeCmd.h>
#include <VelaMediaLib/commands/edits/RippleDeleteMultipleRangesAndCreateDeletionPointCmd.h>
#include <VelaMediaLib/commands/edits/RippleDeleteRangeAndCreateDeletionPointCmd.h>
#include <VelaMediaLib/commands/edits/RippleReplaceMediaWithMediasCmd.h>
#include <VelaMediaLib/commands/edits/ScaleMediaEditRateCmd.h>
#include <VelaMediaLib/commands/edits/SetAnimationInterpolaterCmd.h>
#include <VelaMediaLib/commands/edits/SetDoubleParameterValueInRangeCmd.h>
#include <VelaMediaLib/commands/edits/SetMediaStateCmd.h>
#include <VelaMediaLib/commands/edits/SplitAnimationCmd.h>
#include <VelaMediaLib/commands/edits/TrackCleanupCmd.h>
#include <VelaMediaLib/commands/edits/TrimAnimationCmd.h>
#include <VelaMediaLib/commands/edits/TrimMediasToFrameCmd.h>
#include <VelaMediaLib/document/CopyRangeClippingCmd.h>
#include <VelaMediaLib/document/PasteClippingCmd.h>
#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/VisualMediaImpl.h>
#include <VelaMediaLib/model/timeline/DeletionPoint.h>
#include <VelaMediaLib/time/parameters/KeyFrame.h>
#include <VelaMediaLib/time/parameters/Parameter.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <algorithm>
#include <limits>
#include <sstream>

namespace VelaMediaLib {
namespace soak {

namespace {

// Names clips, tracks and times by their place in the run's pools.
struct Described {
    explicit Described(const SoakState& soak) : state(soak) {}
    Described& clip(const MediaPtr& media) {
        const auto found = std::find(state.clips.begin(), state.clips.end(), media);
        out << " clip "
            << (!media                       ? "-"
                : found == state.clips.end() ? "?"
                                             : std::to_string(found - state.clips.begin()));
        return *this;
    }
    Described& track(const TrackPtr& track) {
        const std::vector<TrackPtr> tracks = state.tracks(), inner = state.groupTracks();
        const auto main = std::find(tracks.begin(), tracks.end(), track);
        const auto in = std::find(inner.begin(), inner.end(), track);
        out << " track "
            << (!track                 ? std::string("-")
                : main != tracks.end() ? std::to_string(main - tracks.begin())
                : in != inner.end()    ? "(inner " + std::to_string(in - inner.begin()) + ")"
                                       : std::string("?"));
        return *this;
    }
    template <typename T>
    Described& operator<<(const T& value) {
        out << " " << value;
        return *this;
    }
    const SoakState& state;
    std::ostringstream out;
};

Edit edit(const CommandPtr& command, const Described& what) {
    Edit e;
    e.command = command;
    e.what = what.out.str();
    return e;
}

VelaTime trackEnd(const TrackPtr& track) { return track ? track->endTime() : 0; }

VelaTime mixerEnd(const SoakState& state) {
    VelaTime end = 0;
    for (const TrackPtr& track : state.tracks()) end = std::max(end, track->endTime());
    return end;
}

// A clip on a track of the mixer and that track; now and then a clip from
// anywhere in the pool (loose, inside a group, in a deletion point).
struct Target {
    MediaPtr clip;
    TrackPtr track;
};
Target target(Random& random, const SoakState& state) {
    Target t;
    t.clip = chance(random, 90) ? state.randomPlaced(random, &t.track) : state.randomKnown(random);
    if (!t.clip) t.clip = state.randomKnown(random);
    if (!t.track) t.track = SoakState::trackOf(t.clip);
    if (!t.track || chance(random, 5)) t.track = state.randomTrack(random);
    return t;
}

// A range of ticks: mostly a short one where clips stand, sometimes none long.
Range<VelaTime> someRange(Random& random, const SoakState& state, VelaTime longest = 60) {
    const VelaTime start = between(random, -10, mixerEnd(state) + 10);
    return Range<VelaTime>(start, chance(random, 97) ? between(random, 1, longest) : between(random, -5, 0));
}

// Some of the mixer's tracks (now and then a group's track too), each named;
// now and then none.
std::vector<TrackPtr> someTracks(Random& random, const SoakState& state, Described& what) {
    std::vector<TrackPtr> chosen;
    for (const TrackPtr& track : state.tracks())
        if (chance(random, 50)) chosen.push_back(track);
    if (chance(random, 8)) {
        const TrackPtr inner = oneOf(random, state.groupTracks());
        if (inner) chosen.push_back(inner);
    }
    if (chosen.empty() && chance(random, 90)) chosen.push_back(oneOf(random, state.tracks()));
    for (const TrackPtr& track : chosen) what.track(track);
    return chosen;
}

// A fresh loose clip; now and then with a hotspot (the edit rate commands scale it).
MediaPtr freshClip(Random& random, SoakState& state) {
    const MediaPtr clip = state.newClip(random);
    if (chance(random, 30))
        if (const auto visual = boost::dynamic_pointer_cast<VisualMediaImpl>(clip)) {
            HotspotInfo hotspot;
            hotspot.action = "jump";
            hotspot.gotoTime = between(random, 0, 300);
            hotspot.markerTime = between(random, 0, 60);
            visual->setHotspot(hotspot);
        }
    return clip;
}

void learnAll(SoakState& state, const std::vector<MediaPtr>& clips) {
    for (const MediaPtr& clip : clips) state.remember(clip);
}

// ---- Media placement ----

Edit makeRemoveRange(Random& random, SoakState& state) {
    Described what(state);
    const Range<VelaTime> range = someRange(random, state);
    what << "from" << range.start() << "for" << range.duration();
    const auto command = RemoveRangeMediaCmd::create(range); // no length: throws
    if (chance(random, 15)) {
        command->addTracksOf(state.mixer);
        what << "on every track";
    } else {
        for (const TrackPtr& track : someTracks(random, state, what)) command->addTrack(track);
    }
    Edit e = edit(command, what);
    e.learn = [command](SoakState& s) { learnAll(s, command->removedMedias()); };
    return e;
}

Edit makeRemoveLast(Random& random, SoakState& state) {
    const TrackPtr track = chance(random, 25) ? TrackPtr() : state.randomTrack(random); // none: throws
    return edit(RemoveLastMediaCmd::create(track), Described(state).track(track));
}

Edit makeDuplicate(Random& random, SoakState& state) {
    std::vector<MediaPtr> chosen;
    if (!chance(random, 2)) // an empty list throws
        for (long long i = between(random, 1, 3); i > 0; --i) chosen.push_back(state.randomPlaced(random));
    if (chance(random, 20)) chosen.push_back(state.randomKnown(random));        // loose or inside: refused
    if (chance(random, 3) && !chosen.empty()) chosen.push_back(chosen.front()); // twice: throws
    Described what(state);
    for (const MediaPtr& clip : chosen) what.clip(clip);
    return edit(DuplicateMediaCmd::create(chosen), what);
}

Edit makeCloneAdd(Random& random, SoakState& state) {
    std::vector<CloneAddMediasCmd::Placement> placements;
    Described what(state);
    for (long long i = between(random, 1, 2); i > 0; --i) {
        CloneAddMediasCmd::Placement placement;
        placement.media = chance(random, 70) ? state.randomPlaced(random) : state.randomKnown(random);
        placement.track = state.randomTrack(random);
        // Mostly where it fits, after the track's end; sometimes onto its clips.
        placement.time = chance(random, 60) ? trackEnd(placement.track) + between(random, 0, 30)
                                            : between(random, -5, trackEnd(placement.track));
        what.clip(placement.media).track(placement.track) << "at" << placement.time;
        placements.push_back(placement);
    }
    return edit(CloneAddMediasCmd::create(placements), what);
}

Edit makeRepeat(Random& random, SoakState& state) {
    const TrackPtr track = state.randomTrack(random);
    const MediaPtr pattern = chance(random, 80) ? state.randomPlaced(random) : state.randomKnown(random);
    const VelaTime most =
        std::max<VelaTime>(1, std::min<VelaTime>(200, (pattern ? pattern->duration() : 1) * 4));
    const bool after = chance(random, 60);
    const VelaTime start =
        after ? trackEnd(track) + between(random, 0, 20) : between(random, -5, trackEnd(track));
    const VelaTime length = after ? between(random, 1, most) : between(random, -2, most); // no length: throws
    const Range<VelaTime> range(start, length);
    return edit(RepeatMediaToFillRangeCmd::create(track, pattern, range),
                Described(state).track(track).clip(pattern)
                    << "over" << range.start() << "for" << range.duration());
}

EditMaker makeReplace(bool ripple) {
    return [ripple](Random& random, SoakState& state) {
        const Target t = target(random, state);
        std::vector<MediaPtr> list;
        for (long long i = chance(random, 60) ? 1 : between(random, 2, 3); i > 0; --i)
            list.push_back(freshClip(random, state));
        if (chance(random, 25)) list.push_back(state.randomPlaced(random)); // on a track: refused
        if (chance(random, 3)) list.push_back(t.clip);                      // itself: throws
        if (chance(random, 3)) list.push_back(list.front());                // twice: throws
        Described what(state);
        what.clip(t.clip).track(t.track) << "by";
        for (const MediaPtr& clip : list) what.clip(clip);
        if (ripple) return edit(RippleReplaceMediaWithMediasCmd::create(t.track, t.clip, list), what);
        return edit(ReplaceMediaWithMediasCmd::create(t.track, t.clip, list), what);
    };
}

Edit makeDisplace(Random& random, SoakState& state) {
    const TrackPtr track = chance(random, 15) ? TrackPtr() : state.randomTrack(random); // none: throws
    const long long kind = between(random, 0, 9);
    const MediaPtr clip = kind < 6   ? freshClip(random, state)
                          : kind < 9 ? state.randomPlaced(random) // dragged from where it stands
                                     : state.randomKnown(random);
    const VelaTime time = between(random, -3, trackEnd(track) + 20);
    return edit(DisplaceMediaOnUnifiedMixerCmd::create(track, clip, time),
                Described(state).clip(clip).track(track) << "at" << time);
}

// ---- Time structure ----

Edit makeTrimToFrame(Random& random, SoakState& state) {
    if (chance(random, 30)) {
        const MixerPtr mixer = state.mixer;
        const VelaTime time = between(random, -5, mixerEnd(state) + 5);
        return edit(TrimMediasToFrameCmd::create(mixer, time), Described(state) << "the mixer at" << time);
    }
    const Target t = target(random, state);
    const Range<VelaTime> range = t.clip->trackRange();
    const VelaTime time = chance(random, 85) ? between(random, range.start() + 1, range.end())
                                             : between(random, range.start() - 5, range.end() + 5);
    return edit(TrimMediasToFrameCmd::create(t.clip, time), Described(state).clip(t.clip) << "at" << time);
}

// A frame held for a while, inserted or over what follows, or held and
// stitched into one clip. Only clips of the source give a still (groups of
// them too); the others throw, which counts as a refusal.
Edit makeExtendFrame(Random& random, SoakState& state) {
    const Target t = target(random, state);
    const Range<VelaTime> range = t.clip->trackRange();
    const VelaTime time = chance(random, 90) ? between(random, range.start(), range.end() - 1)
                                             : between(random, range.start() - 3, range.end() + 3);
    const VelaTime duration = chance(random, 95) ? between(random, 1, 20) : between(random, -2, 0);
    Described what(state);
    what.clip(t.clip) << "at" << time << "for" << duration;
    if (chance(random, 30)) {
        const VelaTime trim = between(random, 0, 10);
        const SafeRational scalar =
            chance(random, 70) ? SafeRational(1) : SafeRational(between(random, 1, 3), 2);
        const bool others = chance(random, 30);
        what << "stitched, trim" << trim << "scalar" << scalar << (others ? "on every track" : "");
        return edit(
            StitchingExtendFrameCmd::create(t.clip, "Hold Frame", time, duration, trim, scalar, others),
            what);
    }
    const bool ripple = chance(random, 60), others = ripple && chance(random, 30);
    what << (ripple ? "inserting" : "overwriting") << (others ? "on every track" : "");
    return edit(ExtendFrameCmd::create(t.clip, time, duration, ripple, others), what);
}

Edit makeMediaLength(Random& random, SoakState& state) {
    const Target t = target(random, state);
    const VelaTime before = chance(random, 40) ? 0 : between(random, chance(random, 4) ? -3 : 0, 15);
    const VelaTime after = chance(random, 40) ? 0 : between(random, 0, 15);
    const bool ripple = chance(random, 50), extend = chance(random, 50);
    MultiTrackEditOptions options;
    Described what(state);
    what.clip(t.clip) << (extend ? "extend" : "reduce") << before << after << (ripple ? "rippling" : "");
    if ((ripple && chance(random, 40)) || chance(random, 4)) { // without ripple: throws
        const TrackPtr own = SoakState::trackOf(t.clip);
        for (const TrackPtr& track : state.tracks())
            if ((track != own || chance(random, 5)) && chance(random, 50)) { // its own: throws
                options.tracks.push_back(track);
                what.track(track);
            }
    }
    const CommandPtr command =
        extend ? CommandPtr(ExtendMediaCmd::create(t.clip, before, after, options, ripple))
               : CommandPtr(ReduceMediaCmd::create(t.clip, before, after, options, ripple));
    return edit(command, what);
}

// Mostly a stretch of a gap of one track, which a reduction can take out.
bool gapOf(Random& random, const TrackPtr& track, VelaTime& time, VelaTime& amount) {
    std::vector<std::pair<VelaTime, VelaTime>> gaps;
    VelaTime end = 0;
    for (const MediaPtr& clip : track->medias()) {
        if (clip->startTime() > end) gaps.emplace_back(end, clip->startTime() - end);
        end = clip->trackRange().end();
    }
    if (gaps.empty()) return false;
    const auto gap = oneOf(random, gaps);
    const VelaTime offset = between(random, 0, gap.second - 1);
    time = gap.first + offset;
    amount = between(random, 1, gap.second - offset);
    return true;
}

Edit makeTrackTime(Random& random, SoakState& state) {
    const bool extend = chance(random, 50);
    VelaTime time = between(random, -5, mixerEnd(state) + 5);
    VelaTime amount = chance(random, 97) ? between(random, 0, 40) : -1; // negative: throws
    Described what(state);
    std::vector<TrackPtr> tracks;
    const TrackPtr one = state.randomTrack(random);
    if (!extend && chance(random, 50) && gapOf(random, one, time, amount)) {
        tracks.push_back(one);
        what.track(one);
    } else {
        tracks = someTracks(random, state, what);
    }
    what << (extend ? "extend at" : "reduce at") << time << "by" << amount;
    if (extend) {
        const auto command = ExtendTracksCmd::create(time, amount);
        for (const TrackPtr& track : tracks) command->addTrack(track);
        return edit(command, what);
    }
    const auto command = ReduceTracksCmd::create(time, amount);
    for (const TrackPtr& track : tracks) command->addTrack(track);
    return edit(command, what);
}

Edit makeContentTime(Random& random, SoakState& state) {
    const Target t = target(random, state);
    const VelaTime duration = t.clip->duration();
    VelaTime time = between(random, -5, duration + 5);
    const VelaTime amount = chance(random, 97) ? between(random, 0, 20) : -2; // negative: throws
    const bool extend = chance(random, 50);
    Described what(state);
    what.clip(t.clip);
    CommandPtr command;
    switch (between(random, 0, 2)) {
    case 0:
        what << "effects";
        command = extend ? CommandPtr(ExtendEffectsCmd::create(t.clip, time, amount))
                         : CommandPtr(ReduceEffectsCmd::create(t.clip, time, amount));
        break;
    case 1:
        what << "animations";
        command = extend ? CommandPtr(ExtendMediaAnimationsCmd::create(t.clip, time, amount))
                         : CommandPtr(ReduceMediaAnimationsCmd::create(t.clip, time, amount));
        break;
    default:
        if (extend && chance(random, 10)) time = KeyframeTimeCmd::earliestTime();
        what << "keyframes";
        command = extend ? CommandPtr(ExtendParametersCmd::create(t.clip, time, amount))
                         : CommandPtr(ReduceParametersCmd::create(t.clip, time, amount));
    }
    return edit(command, what << (extend ? "extend at" : "reduce at") << time << "by" << amount);
}

Edit makeCleanup(Random& random, SoakState& state) {
    const TrackPtr track = chance(random, 4) ? TrackPtr() : state.randomTrack(random); // none: throws
    return edit(TrackCleanupCmd::create(track), Described(state).track(track));
}

void learnPoints(SoakState& state, const std::vector<DeletionPointPtr>& points) {
    for (const DeletionPointPtr& point : points)
        for (const DeletionPoint::RemovedClip& removed : point->clips()) state.remember(removed.media);
}

Edit makeRippleDelete(Random& random, SoakState& state) {
    Described what(state);
    boost::shared_ptr<RippleDeleteRangeAndCreateDeletionPointCmd> command;
    if (chance(random, 30)) {
        std::vector<Range<VelaTime>> ranges;
        for (long long i = between(random, chance(random, 3) ? 0 : 1, 3); i > 0; --i) {
            ranges.push_back(someRange(random, state, 30)); // overlapping or touching: throws
            what << "[" << ranges.back().start() << "+" << ranges.back().duration() << "]";
        }
        command = RippleDeleteMultipleRangesAndCreateDeletionPointCmd::create(ranges);
    } else {
        const Range<VelaTime> range = someRange(random, state);
        what << "from" << range.start() << "for" << range.duration();
        command = RippleDeleteRangeAndCreateDeletionPointCmd::create(range);
    }
    for (const TrackPtr& track : someTracks(random, state, what)) command->addTrack(track);
    Edit e = edit(command, what);
    e.learn = [command](SoakState& s) { learnPoints(s, command->createdDeletionPoints()); };
    return e;
}

Edit makeRestore(Random& random, SoakState& state) {
    std::vector<DeletionPointPtr> points;
    for (const TrackPtr& track : state.tracks()) {
        const std::vector<DeletionPointPtr> on = SetDeletionPointsCmd::listOf(track)->pointsOn(*track);
        points.insert(points.end(), on.begin(), on.end());
    }
    const DeletionPointPtr point = oneOf(random, points);
    const VelaTime time = point && chance(random, 85) ? point->time() : between(random, -5, mixerEnd(state));
    const auto command = RestoreDeletionPointAtTimeCmd::create(time);
    Described what(state);
    what << "at" << time;
    if (point && point->track() && chance(random, 85)) {
        command->addTrack(point->track());
        what.track(point->track());
    }
    if (chance(random, 30) || command->tracks().empty())
        for (const TrackPtr& track : someTracks(random, state, what))
            command->addTrack(track); // none: throws
    return edit(command, what);
}

// ---- Tracks and mixers ----

boost::shared_ptr<GenericMixer> someGroupMixer(Random& random, const SoakState& state) {
    std::vector<boost::shared_ptr<GenericMixer>> mixers;
    for (const MediaPtr& clip : state.clips)
        if (const Group* group = Group::asGroup(clip.get()))
            if (clip->parent()) mixers.push_back(group->mixer());
    return oneOf(random, mixers);
}

// The mixer keeps four tracks at least and eight at most, so that the other
// makers always find tracks; a track added to a group is rare.
Edit makeNewTrack(Random& random, SoakState& state) {
    boost::shared_ptr<GenericMixer> mixer = state.mixer;
    if (chance(random, 10))
        if (const auto inner = someGroupMixer(random, state)) mixer = inner;
    const int count = int(mixer->tracks().size());
    int index = int(between(random, -1, count));
    if (chance(random, 35) || (mixer == state.mixer && count >= 8))
        index = chance(random, 50) ? count + 1 : -2; // throws
    return edit(NewTrackCmd::create(mixer, index), Described(state) << "at" << index << "of" << count);
}

Edit makeRemoveTrack(Random& random, SoakState& state) {
    boost::shared_ptr<GenericMixer> mixer = state.mixer;
    std::vector<TrackPtr> removable;
    for (const TrackPtr& track : state.tracks())
        if (!track->magneticAttribute()->value() || chance(random, 20)) removable.push_back(track);
    if (state.tracks().size() <= 4) removable.clear();
    if (chance(random, 10))
        if (const auto inner = someGroupMixer(random, state)) {
            mixer = inner;
            removable = inner->tracks().size() > 1 ? inner->tracks() : std::vector<TrackPtr>();
        }
    TrackPtr track = oneOf(random, removable);
    Described what(state);
    if (!track || chance(random, 10)) { // a track of no mixer or a group's: throws
        track = oneOf(random, state.groupTracks());
        mixer = state.mixer;
        what << "not in the mixer";
    }
    return edit(RemoveTrackCmd::create(mixer, track), what.track(track));
}

Edit makeSwapTracks(Random& random, SoakState& state) {
    const TrackPtr first = oneOf(random, state.tracks());
    const TrackPtr second = chance(random, 90) ? oneOf(random, state.tracks()) // the same: throws
                                               : oneOf(random, state.groupTracks());
    return edit(SwapTrackOrderCmd::create(state.mixer, first, second),
                Described(state).track(first).track(second));
}

Edit makeNewMixer(Random& random, SoakState& state) {
    static const char* const names[] = {"extra 1", "extra 2", "main", ""}; // taken or empty: throws
    const std::string name = names[chance(random, 85) ? between(random, 0, 1) : between(random, 2, 3)];
    return edit(NewMixerCmd::create(name), Described(state) << "named" << name);
}

// ---- Edit rate ----

SafeRational rateFactor(Random& random) {
    const SafeRational factors[] = {SafeRational(2000, 1001), SafeRational(1001, 2000), SafeRational(2),
                                    SafeRational(1, 2),       SafeRational(4, 5),       SafeRational(0)};
    return factors[chance(random, 97) ? between(random, 0, 4) : 5]; // 0: throws
}

Edit makeMediaState(Random& random, SoakState& state) {
    const Target t = target(random, state);
    MediaState s = t.clip->state();
    Described what(state);
    what.clip(t.clip);
    const auto keepRule = [&s] {
        s.duration = RationalUtil::toVelaTime(RationalUtil::Round(s.mediaDuration * s.scalar));
    };
    switch (between(random, 0, 4)) {
    case 0:
        s.start += between(random, -40, 40);
        what << "start" << s.start;
        break;
    case 1:
        s.mediaStart += SafeRational(between(random, -10, 10));
        what << "media start" << s.mediaStart;
        break;
    case 2: {
        const SafeRational scalars[] = {1, SafeRational(1, 2), 2, SafeRational(3, 2)};
        s.scalar = scalars[between(random, 0, 3)];
        keepRule();
        what << "scalar" << s.scalar;
        break;
    }
    case 3:
        s.mediaDuration -= SafeRational(between(random, -5, 10));
        keepRule();
        what << "media duration" << s.mediaDuration;
        break;
    default:
        s.duration += between(random, -3, 3); // against the duration rule: refused
        what << "duration" << s.duration;
    }
    if (chance(random, 20)) return edit(SetMediaStateCmd::create(t.clip, s), what);
    return edit(SetMediaStateCmd::create(t.track, t.clip, s), what.track(t.track));
}

Edit makeProjectRate(Random& random, SoakState& state) {
    typedef boost::rational<unsigned long> Rate;
    const Rate now = state.project->editRate();
    Rate rate = now == Rate(30) ? Rate(60000, 1001) : Rate(30);
    if (chance(random, 25)) rate = chance(random, 50) ? Rate(0) : now; // throws; nothing to do
    Described what(state);
    what << "from" << now << "to" << rate;
    if (chance(random, 10)) // the rate alone, ticks keeping their count
        return edit(SetEditRateCmd::create(rate), what << "(SetEditRateCmd)");
    return edit(ChangeProjectEditRateCmd::create(rate), what);
}

Edit makeScaleMedia(Random& random, SoakState& state) {
    const Target t = target(random, state);
    const SafeRational factor = rateFactor(random);
    Described what(state);
    what.clip(t.clip).track(t.track) << "by" << factor;
    if (chance(random, 30)) {
        const VelaTime start = between(random, 0, trackEnd(t.track) + 10);
        return edit(ScaleMediaEditRateCmd::create(t.track, t.clip, factor, start), what << "to" << start);
    }
    return edit(ScaleMediaEditRateCmd::create(t.track, t.clip, factor), what);
}

Edit makeScaleHotspot(Random& random, SoakState& state) {
    std::vector<MediaPtr> withHotspot;
    for (const MediaPtr& clip : state.clips)
        if (const auto visual = boost::dynamic_pointer_cast<VisualMediaImpl>(clip))
            if (visual->hotspot() && (clip->parent() || chance(random, 20))) withHotspot.push_back(clip);
    const MediaPtr clip =
        chance(random, 50) && !withHotspot.empty() ? oneOf(random, withHotspot) : state.randomKnown(random);
    const SafeRational factor = rateFactor(random);
    return edit(ScaleHotspotEditRateCmd::create(clip, factor), Described(state).clip(clip) << "by" << factor);
}

// ---- Edge modifications ----

struct OnClip {
    MediaPtr clip;
    EdgeModificationPtr modification;
    bool left;
};

std::vector<OnClip> edgeModifications(const SoakState& state) {
    std::vector<OnClip> all;
    for (const MediaPtr& clip : state.clips) {
        for (const EdgeModificationPtr& m : clip->leftEdgeModifications()) all.push_back({clip, m, true});
        for (const EdgeModificationPtr& m : clip->rightEdgeModifications()) all.push_back({clip, m, false});
    }
    return all;
}

EdgeModificationPtr newModification(Random& random, const MediaPtr& clip) {
    const VelaTime most = clip ? clip->duration() : 10;
    const VelaTime duration = chance(random, 92) ? between(random, 0, most) : most + between(random, 1, 5);
    const char* kind = chance(random, 70) ? "fade" : "duck";
    const double level = double(between(random, 0, 4)) / 4;
    return EdgeModificationPtr(new EdgeModification(duration, kind, level));
}

Edit makeEdgeMod(Random& random, SoakState& state) {
    const std::vector<OnClip> all = edgeModifications(state);
    OnClip known = oneOf(random, all);
    const Target t = target(random, state);
    Described what(state);
    const long long kind = between(random, 0, 9);
    if (kind >= 4 && !known.clip) { // nothing to work on yet: add one
        return edit(AddEdgeModCmd::create(t.clip, newModification(random, t.clip), EdgeModificationPtr()),
                    what.clip(t.clip) << "add a left one");
    }
    // Mostly the modification's own clip; sometimes another (throws).
    const MediaPtr on = chance(random, 92) ? known.clip : t.clip;
    const bool left = chance(random, 92) ? known.left : !known.left;
    switch (kind) {
    case 0:
    case 1: {
        const bool side = chance(random, 50);
        const EdgeModificationPtr m =
            chance(random, 92) ? newModification(random, t.clip) : known.modification;
        what.clip(t.clip) << "add" << (side ? "left" : "right") << (m ? m->duration() : 0);
        return edit(side ? CommandPtr(AddLeftEdgeModCmd::create(t.clip, m))
                         : CommandPtr(AddRightEdgeModCmd::create(t.clip, m)),
                    what);
    }
    case 2: {
        const EdgeModificationPtr l =
            chance(random, 80) ? newModification(random, t.clip) : EdgeModificationPtr();
        const EdgeModificationPtr r =
            chance(random, 80) ? newModification(random, t.clip) : EdgeModificationPtr();
        return edit(AddEdgeModCmd::create(t.clip, l, r), what.clip(t.clip) << "add both"); // neither: throws
    }
    case 3:
    case 4: {
        const MediaPtr to = chance(random, 95) ? t.clip : known.clip; // onto itself: throws
        const std::string group = chance(random, 50) ? std::string() : chance(random, 70) ? "fade" : "duck";
        return edit(EdgeModCloneCmd::create(known.clip ? known.clip : t.clip, to, group),
                    what.clip(known.clip).clip(to) << "clone" << group);
    }
    case 5:
    case 6:
        what.clip(on) << "remove" << (left ? "left" : "right");
        return edit(left ? CommandPtr(RemoveLeftEdgeModCmd::create(on, known.modification))
                         : CommandPtr(RemoveRightEdgeModCmd::create(on, known.modification)),
                    what);
    default: {
        const VelaTime d = chance(random, 90) ? between(random, -10, 10) : between(random, -200, 200);
        const VelaTime d2 = between(random, -8, 8);
        what.clip(on) << "move" << (left ? "left" : "right") << "by" << d;
        const auto make = [&](VelaTime delta) {
            return left ? CommandPtr(MoveLeftEdgeModCmd::create(on, known.modification, delta))
                        : CommandPtr(MoveRightEdgeModCmd::create(on, known.modification, delta));
        };
        Edit e = edit(make(d), what);
        if (chance(random, 30)) { // two drags folded into one step
            e.second = make(d2);
            e.combine = true;
            e.what += " and " + std::to_string(d2);
        }
        return e;
    }
    }
}

// ---- Animations and keyframes ----

std::string animatedName(Random& random) {
    const long long pick = between(random, 1, 100);
    return pick <= 85 ? "opacity" : pick <= 97 ? "scale" : "loudness"; // none such: throws
}

std::string someCode(Random& random) {
    static const char* const codes[] = {"linr", "esIn", "esOt", "bnce",
                                        "",     "linr", "nope"}; // unknown: throws
    return codes[chance(random, 97) ? between(random, 0, 5) : 6];
}

Edit makeAnimation(Random& random, SoakState& state) {
    const Target t = target(random, state);
    const std::string name = animatedName(random);
    std::vector<VelaTime> starts;
    VelaTime lastEnd = 0;
    AnimationTracksEditCmd::AnimationLists lists = AnimationTracksEditCmd::animationsOf(t.clip);
    for (const auto& animation : lists[name]) {
        starts.push_back(animation.range.start());
        lastEnd = animation.range.end();
    }
    const VelaTime duration = t.clip->duration();
    const auto anyStart = [&] {
        return chance(random, 85) && !starts.empty() ? oneOf(random, starts) : between(random, -3, duration);
    };
    const VelaTime start = anyStart();
    Described what(state);
    what.clip(t.clip) << name << "at" << start;
    switch (between(random, 0, 11)) {
    case 0: {
        const VelaTime at =
            chance(random, 60) ? lastEnd + between(random, 0, 10) : between(random, -2, duration);
        const Range<VelaTime> range(at, between(random, chance(random, 3) ? -2 : 1, 25));
        return edit(AddAnimationCmd::create(t.clip, name, range, someCode(random)),
                    what << "add" << range.start() << range.duration());
    }
    case 1: {
        AnimationTrack::Animation preset;
        const VelaTime at = lastEnd + between(random, 0, 10), length = between(random, 1, 20);
        preset.range = Range<long long>(at, length);
        preset.endTime = chance(random, 95) ? at + length : at; // another end: throws
        preset.duration = between(random, 0, length);
        preset.interp = someCode(random);
        return edit(AddAnimationWithDescriptionCmd::create(t.clip, name, preset),
                    what << "add a preset" << at);
    }
    case 2:
        return edit(RemoveAnimationCmd::create(t.clip, name, start), what << "remove");
    case 3:
        return edit(RemoveAllAnimationsCmd::create(t.clip, chance(random, 70) ? name : std::string()),
                    what << "remove all");
    case 4: {
        const VelaTime d = between(random, -20, 20);
        return edit(MoveAnimationCmd::create(t.clip, name, start, d), what << "move by" << d);
    }
    case 5: {
        std::vector<VelaTime> moved;
        for (const VelaTime s : starts)
            if (chance(random, 60)) moved.push_back(s);
        if (chance(random, 10)) moved.push_back(anyStart());
        const VelaTime d = between(random, -20, 20);
        return edit(MoveAnimationsCmd::create(t.clip, name, moved, d), what << moved.size() << "by" << d);
    }
    case 6: {
        const VelaTime at = start + between(random, -2, 15);
        return edit(SplitAnimationCmd::create(t.clip, name, start, at), what << "split at" << at);
    }
    case 7:
    case 8: {
        const VelaTime d = between(random, -10, 10);
        const bool atStart = chance(random, 50);
        what << (atStart ? "trim start by" : "trim end by") << d;
        return edit(atStart ? CommandPtr(TrimAnimationStartCmd::create(t.clip, name, start, d))
                            : CommandPtr(TrimAnimationEndCmd::create(t.clip, name, start, d)),
                    what);
    }
    case 9: {
        const auto next = std::upper_bound(starts.begin(), starts.end(), start);
        const VelaTime second = next != starts.end() && chance(random, 85) ? *next : anyStart();
        return edit(MergeAnimationsCmd::create(t.clip, name, start, second), what << "merge with" << second);
    }
    case 10: {
        const std::string code = someCode(random);
        return edit(SetAnimationInterpolaterCmd::create(t.clip, name, start, code), what << "code" << code);
    }
    default: {
        const bool automatic = chance(random, 50);
        const std::string fixed = chance(random, 95) ? "esOt" : "";
        return edit(SetAnimationAutoInterpolationCmd::create(t.clip, name, automatic, fixed),
                    what << "automatic" << automatic);
    }
    }
}

boost::shared_ptr<KeyFrameInterface> keyframe(Random& random, VelaTime time) {
    const VelaTime leadIn = chance(random, 80) ? 0 : between(random, -1, 10);
    return boost::shared_ptr<KeyFrame<double>>(
        new KeyFrame<double>(boost::weak_ptr<const ThreadSafe>(), RationalTime(time),
                             double(between(random, 0, 8)) / 8, RationalTime(leadIn)));
}

Edit makeKeyframes(Random& random, SoakState& state) {
    const Target t = target(random, state);
    const VelaTime duration = t.clip->duration();
    Described what(state);
    what.clip(t.clip);
    // Asking a clip for a parameter it has not made makes it: only made ones are asked for.
    const auto opacity = t.clip->hasMadeParameter("opacity") ? t.clip->typedParameter<double>("opacity")
                                                             : boost::shared_ptr<Parameter<double>>();
    std::vector<RationalTime> times;
    if (opacity) times = *opacity->keyframeTimes();
    const RationalTime known = chance(random, 85) && !times.empty()
                                   ? oneOf(random, times)
                                   : RationalTime(between(random, -2, duration));
    const long long kind = opacity ? between(random, 0, 9) : between(random, 7, 9);
    switch (kind) {
    case 0:
    case 1: {
        const VelaTime time = between(random, -2, duration + 2);
        return edit(AddParameterKeyFrameInterfaceCmd::create(opacity, keyframe(random, time)),
                    what << "add at" << time);
    }
    case 2:
        return edit(RemoveParameterKeyFrameCmd::create(opacity, known), what << "remove at" << known);
    case 3:
        return edit(RemoveAllKeyFramesCmd::create(opacity, RationalTime(between(random, 0, duration))),
                    what << "remove all");
    case 4: {
        const RationalTime to(between(random, -2, duration + 2));
        return edit(MoveParameterKeyFrameCmd::create(opacity, known, to),
                    what << "move" << known << "to" << to);
    }
    case 5:
    case 6: {
        const long long from = between(random, 0, duration);
        const Range<RationalTime> range(RationalTime(from),
                                        RationalTime(between(random, chance(random, 3) ? -1 : 1, 20)));
        const double value = chance(random, 98) ? double(between(random, 0, 4)) / 4
                                                : std::numeric_limits<double>::quiet_NaN(); // throws
        return edit(SetDoubleParameterValueInRangeCmd::create(opacity, range, value),
                    what << "hold" << value << "from" << range.start());
    }
    case 7: { // placeholders have no volume: throws
        const VelaTime from = between(random, 0, duration);
        const Range<VelaTime> range(from, between(random, 1, 20));
        return edit(SetVolumeInRangeCmd::create(t.clip, range, 0.5), what << "volume");
    }
    default: {
        static const char* const texts[] = {
            "{\"opacity\": 0.5}",
            "{\"opacity\": 0.75}",
            ("{\"scale\": {\"type\": \"point\", \"keyframes\": [{\"time\": 0, \"endTime\": 0, "
             "\"value\": [2.0, 2.0, 1.0], \"duration\": 0}]}}"), // one text over two lines
            "{\"opacity\": 0.25, \"rotation\": \"sideways\"}",   // of the wrong type: throws as it runs
            "{\"loudness\": 1}",                                 // none such: throws
            "[1]"};                                              // no object: throws
        const long long text = chance(random, 85) ? between(random, 0, 2) : between(random, 3, 5);
        return edit(ApplySerializedParameterValuesToMediaCmd::create(t.clip, texts[text]),
                    what << "apply text" << text);
    }
    }
}

// ---- Clipboard ----

Edit makeCut(Random& random, SoakState& state) {
    Described what(state);
    const Range<VelaTime> range = someRange(random, state);
    what << "from" << range.start() << "for" << range.duration();
    std::vector<TrackPtr> tracks = someTracks(random, state, what); // none: throws
    if (chance(random, 2)) tracks.push_back(TrackPtr());            // throws
    return edit(CutRangeClippingCmd::create(tracks, range), what);
}

// The clipping of a range of some tracks, copied as a host copies (no step).
std::string copied(Random& random, const SoakState& state, Described& what, size_t& count) {
    const std::vector<TrackPtr> all = state.tracks();
    const size_t first = size_t(between(random, 0, (long long)all.size() - 1));
    const size_t last = std::min(all.size() - 1, first + size_t(between(random, 0, 2)));
    const std::vector<TrackPtr> from(all.begin() + first, all.begin() + last + 1);
    const VelaTime at = between(random, 0, mixerEnd(state));
    const Range<VelaTime> range(at, between(random, 1, 80));
    what << "copy of" << from.size() << "tracks from" << range.start() << "for" << range.duration();
    count = from.size();
    return CopyRangeClippingCmd::clippingDocument(*state.project, from, range);
}

Edit makePaste(Random& random, SoakState& state) {
    Described what(state);
    size_t count = 0;
    std::string text = copied(random, state, what, count);
    if (chance(random, 4)) { // another edit rate, or no document at all: throws
        const size_t at = text.find("\"editRate\""), colon = text.find(':', at), comma = text.find(',', at);
        text = chance(random, 50) && comma != std::string::npos
                   ? text.substr(0, colon + 1) + "7" + text.substr(comma)
                   : std::string("{\"tracks\": [");
    }
    // Mostly as many tracks as were copied; fewer throw when the rest hold clips.
    const std::vector<TrackPtr> all = state.tracks();
    const long long room =
        chance(random, 90) ? (long long)all.size() - (long long)count : (long long)all.size() - 1;
    const size_t first = size_t(between(random, 0, std::max(0LL, room)));
    std::vector<TrackPtr> targets(all.begin() + first, all.end());
    if (targets.size() > count) targets.resize(count);
    VelaTime end = 0;
    for (const TrackPtr& track : targets) end = std::max(end, track->endTime());
    const VelaTime time = chance(random, 60) ? end + between(random, 0, 20) : between(random, -3, end);
    what << "onto";
    for (const TrackPtr& track : targets) what.track(track);
    return edit(PasteClippingCmd::create(text, targets, time), what << "at" << time); // negative: throws
}

Edit makeCopyAndPaste(Random& random, SoakState& state) {
    Described what(state);
    std::vector<TrackPtr> tracks = someTracks(random, state, what);
    const VelaTime from = between(random, 0, mixerEnd(state));
    const Range<VelaTime> range(from, between(random, chance(random, 3) ? 0 : 1, 60));
    VelaTime end = 0;
    for (const TrackPtr& track : tracks) end = std::max(end, track->endTime());
    const VelaTime time = chance(random, 60) ? end + between(random, 0, 20) : between(random, -3, end);
    std::vector<TrackPtr> targets;
    if (chance(random, 30))
        for (const TrackPtr& track : state.tracks())
            if (targets.size() < tracks.size() && chance(random, 60)) targets.push_back(track);
    what << "from" << range.start() << "for" << range.duration() << "to" << time << "onto" << targets.size();
    return edit(CopyRangeAndPasteCmd::create(tracks, range, time, targets), what);
}

} // namespace

void addFamilyMakers(EditMakerRegistry& registry) {
    registry.add("RemoveRangeMediaCmd", 3, makeRemoveRange);
    registry.add("RemoveLastMediaCmd", 2, makeRemoveLast);
    registry.add("DuplicateMediaCmd", 2, makeDuplicate);
    registry.add("CloneAddMediasCmd", 2, makeCloneAdd);
    registry.add("RepeatMediaToFillRangeCmd", 2, makeRepeat);
    registry.add("ReplaceMediaWithMediasCmd", 2, makeReplace(false));
    registry.add("RippleReplaceMediaWithMediasCmd", 2, makeReplace(true));
    registry.add("DisplaceMediaOnUnifiedMixerCmd", 3, makeDisplace);
    registry.add("TrimMediasToFrameCmd", 2, makeTrimToFrame);
    registry.add("ExtendMediaCmd/ReduceMediaCmd", 4, makeMediaLength);
    registry.add("ExtendFrameCmd/StitchingExtendFrameCmd", 3, makeExtendFrame);
    registry.add("ExtendTracksCmd/ReduceTracksCmd", 3, makeTrackTime);
    registry.add("Extend/Reduce{Effects,MediaAnimations,Parameters}Cmd", 3, makeContentTime);
    registry.add("TrackCleanupCmd", 2, makeCleanup);
    registry.add("RippleDelete(Multiple)Range(s)AndCreateDeletionPointCmd", 3, makeRippleDelete);
    registry.add("RestoreDeletionPointAtTimeCmd", 3, makeRestore);
    registry.add("NewTrackCmd", 2, makeNewTrack);
    registry.add("RemoveTrackCmd", 1, makeRemoveTrack);
    registry.add("SwapTrackOrderCmd", 1, makeSwapTracks);
    registry.add("NewMixerCmd", 1, makeNewMixer);
    registry.add("SetMediaStateCmd", 2, makeMediaState);
    registry.add("ChangeProjectEditRateCmd/SetEditRateCmd", 1, makeProjectRate);
    registry.add("ScaleMediaEditRateCmd", 2, makeScaleMedia);
    registry.add("ScaleHotspotEditRateCmd", 1, makeScaleHotspot);
    registry.add("edge modifications", 5, makeEdgeMod);
    registry.add("animations", 5, makeAnimation);
    registry.add("keyframes", 4, makeKeyframes);
    registry.add("CutRangeClippingCmd", 2, makeCut);
    registry.add("PasteClippingCmd", 2, makePaste);
    registry.add("CopyRangeAndPasteCmd", 2, makeCopyAndPaste);
}

} // namespace soak
} // namespace VelaMediaLib

// Edit makers for the timeline edits of today: each picks its arguments at
// random from what stands on the tracks, and now and then makes them wrong
// (a clip not on the track, a delta that collides or overshoots, a time with
// nothing to split), so that refusals are exercised as often as edits.
#include "SoakDriver.h"

#include <VelaMediaLib/commands/edits/AddTransitionCmd.h>
#include <VelaMediaLib/commands/edits/ChangeTrackFlagCmd.h>
#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>
#include <VelaMediaLib/commands/edits/CreateGroupCmd.h>
#include <VelaMediaLib/commands/edits/GroupCmd.h>
#include <VelaMediaLib/commands/edits/InsertTimeCmd.h>
#include <VelaMediaLib/commands/edits/RemoveTransitionCmd.h>
#include <VelaMediaLib/commands/edits/RippleMoveCmd.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>
#include <VelaMediaLib/commands/edits/StitchMediaCmd.h>
#include <VelaMediaLib/commands/edits/StretchCmd.h>
#include <VelaMediaLib/commands/edits/StretchTrimCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/commands/edits/UnGroupCmd.h>
#include <VelaMediaLib/commands/edits/UnstitchAllCmd.h>
#include <VelaMediaLib/commands/edits/UnstitchMediaCmd.h>
#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>

#include <sstream>

namespace VelaMediaLib {
namespace soak {

namespace {

// Names a clip, track or transition by its place in the run's pools.
template <typename T>
std::string nameIn(const std::vector<T>& all, const T& one) {
    const auto found = std::find(all.begin(), all.end(), one);
    return !one ? "-" : found == all.end() ? "?" : std::to_string(found - all.begin());
}

struct Described {
    explicit Described(const SoakState& soak) : state(soak) {}
    Described& clip(const MediaPtr& media) { return out << " clip " << nameIn(state.clips, media), *this; }
    Described& track(const TrackPtr& track) {
        const std::vector<TrackPtr> tracks = state.tracks();
        out << " track " << nameIn(tracks, track);
        if (std::find(tracks.begin(), tracks.end(), track) == tracks.end())
            out << "(inner " << nameIn(state.groupTracks(), track) << ")";
        return *this;
    }
    Described& transition(const TransitionPtr& t) {
        return out << " transition " << nameIn(state.transitions, t), *this;
    }
    template <typename T>
    Described& operator<<(const T& value) {
        out << " " << value;
        return *this;
    }
    std::string str() const { return out.str(); }
    const SoakState& state;
    std::ostringstream out;
};

// A clip on a track and the track to edit it on: mostly its own, sometimes
// another (an invalid edit), sometimes a clip from anywhere in the pool.
struct Target {
    MediaPtr clip;
    TrackPtr track;
};
Target target(Random& random, const SoakState& state) {
    Target t;
    t.clip = chance(random, 90) ? state.randomPlaced(random, &t.track) : state.randomKnown(random);
    if (!t.clip) t.clip = state.randomKnown(random);
    if (!t.track || chance(random, 8)) t.track = state.randomTrack(random);
    if (chance(random, 10)) { // a clip inside a group, on its own inner track
        const std::vector<TrackPtr> inner = state.groupTracks();
        const TrackPtr on = oneOf(random, inner);
        if (on && on->numMedias() > 0) {
            t.track = on;
            t.clip = oneOf(random, on->medias());
        }
    }
    return t;
}

// A delta: mostly small, sometimes far (mostly collisions or overshoots).
VelaTime delta(Random& random, VelaTime small) {
    return chance(random, 85) ? between(random, -small, small) : between(random, -400, 400);
}

VelaTime trackEnd(const TrackPtr& track) { return track ? track->endTime() : 0; }

Edit edit(const CommandPtr& command, const Described& what) {
    Edit e;
    e.command = command;
    e.what = what.str();
    return e;
}

// Placement: add, remove, move.
Edit makeAdd(Random& random, SoakState& state) {
    std::vector<MediaPtr> loose;
    for (const MediaPtr& media : state.clips)
        if (!media->parent()) loose.push_back(media);
    MediaPtr clip = chance(random, 85) ? oneOf(random, loose) : state.randomKnown(random); // placed: refused
    if (!clip || chance(random, 10)) clip = state.newClip(random);
    const TrackPtr track = state.randomTrack(random);
    const VelaTime start = between(random, -30, trackEnd(track) + 60);
    return edit(AddMediaCmd::create(track, clip, start), Described(state).clip(clip).track(track)
                                                             << "at" << start);
}

Edit makeRemove(Random& random, SoakState& state) {
    const Target t = target(random, state);
    return edit(RemoveMediaCmd::create(t.track, t.clip), Described(state).clip(t.clip).track(t.track));
}

Edit makeMove(Random& random, SoakState& state) {
    const Target t = target(random, state);
    const VelaTime d = delta(random, 60);
    return edit(MoveCmd::create(t.track, t.clip, d), Described(state).clip(t.clip).track(t.track)
                                                         << "by" << d);
}

// Time structure: trims, stretches, stretch trims, split, closing gaps.
Edit makeTrim(Random& random, SoakState& state) {
    const Target t = target(random, state);
    const VelaTime d = delta(random, 25);
    const bool start = chance(random, 50);
    const CommandPtr command = start ? CommandPtr(TrimStartCmd::create(t.track, t.clip, d))
                                     : CommandPtr(TrimEndCmd::create(t.track, t.clip, d));
    return edit(command, Described(state).clip(t.clip).track(t.track)
                             << (start ? "start" : "end") << "by" << d);
}

Edit makeStretch(Random& random, SoakState& state) {
    const Target t = target(random, state);
    const SafeRational scalars[] = {
        1, SafeRational(1, 3),  SafeRational(1, 2), SafeRational(2, 3), SafeRational(3, 2), 2,
        3, SafeRational(1, 200)};
    const SafeRational scalar = scalars[between(random, 0, 7)];
    if (chance(random, 20)) {
        const double factor = double(between(random, 1, 40)) / 10.0;
        return edit(StretchCmd::create(t.clip, factor), Described(state).clip(t.clip) << "to" << factor);
    }
    return edit(StretchCmd::create(t.clip, scalar), Described(state).clip(t.clip) << "to" << scalar);
}

Edit makeStretchTrim(Random& random, SoakState& state) {
    const Target t = target(random, state);
    const VelaTime d = delta(random, 20);
    const bool start = chance(random, 50);
    const CommandPtr command = start ? CommandPtr(StretchTrimStartCmd::create(t.clip, d))
                                     : CommandPtr(StretchTrimEndCmd::create(t.clip, d));
    return edit(command, Described(state).clip(t.clip) << (start ? "start" : "end") << "by" << d);
}

Edit makeSplit(Random& random, SoakState& state) {
    const Target t = target(random, state);
    // Mostly inside the clip; sometimes anywhere on the track (a start, a gap, past the end).
    const Range<VelaTime> range = t.clip->trackRange();
    const VelaTime time = chance(random, 75) ? between(random, range.start(), range.end())
                                             : between(random, -5, trackEnd(t.track) + 5);
    const auto split = SplitCmd::create(t.track, time);
    Edit e = edit(split, Described(state).track(t.track) << "at" << time);
    e.learn = [split](SoakState& s) {
        for (const MediaPtr& made : split->getCreatedMedias()) s.remember(made);
    };
    return e;
}

Edit makeCloseGaps(Random& random, SoakState& state) {
    const TrackPtr track = state.randomTrack(random);
    return edit(CloseGapsOnTrackCmd::create(track), Described(state).track(track));
}

// Ripple edits: ripple move, inserted time, splitting ripple move.
Edit makeRippleMove(Random& random, SoakState& state) {
    const Target t = target(random, state);
    const VelaTime d = delta(random, 60);
    return edit(RippleMoveCmd::create(t.track, t.clip, d), Described(state).clip(t.clip).track(t.track)
                                                               << "by" << d);
}

Edit makeInsertTime(Random& random, SoakState& state) {
    const std::vector<TrackPtr> tracks = state.tracks();
    const VelaTime start = between(random, -10, 400),
                   length = chance(random, 97) ? between(random, 1, 60) : 0;
    Described what(state);
    what << "at" << start << "for" << length;
    const auto insert = InsertTimeCmd::create(Range<VelaTime>(start, length)); // throws for no length
    for (const TrackPtr& track : tracks)
        if (chance(random, 60)) {
            insert->addTrack(track);
            what.track(track);
        }
    return edit(insert, what); // without a track: throws as it runs
}

Edit makeSplittingRippleMove(Random& random, SoakState& state) {
    const VelaTime time = between(random, -10, 400), d = delta(random, 40);
    Described what(state);
    what << "at" << time << "by" << d;
    if (chance(random, 3)) // no mixer and no track: throws as it runs
        return edit(SplittingRippleMoveCmd::create(MixerPtr(), time, d), what << "without tracks");
    if (chance(random, 70))
        return edit(SplittingRippleMoveCmd::create(state.mixer, time, d), what << "on the mixer");
    const auto move = SplittingRippleMoveCmd::create(MixerPtr(), time, d);
    const TrackPtr track = state.randomTrack(random);
    move->addTrack(track);
    return edit(move, what.track(track));
}

// Transitions.
TransitionPtr knownOrNew(Random& random, SoakState& state) {
    return chance(random, 70) && !state.transitions.empty() ? oneOf(random, state.transitions)
                                                            : state.newTransition(between(random, 0, 20));
}

Edit makeTransitionEdit(Random& random, SoakState& state) {
    const Target t = target(random, state);
    Described what(state);
    switch (between(random, 0, 5)) {
    case 0: {
        const TransitionPtr transition =
            state.newTransition(chance(random, 90) ? between(random, 0, 30) : -3);
        const auto side = chance(random, 50) ? TransitionEditCmd::Left : TransitionEditCmd::Right;
        if (chance(random, 10)) { // one already on a clip
            const auto command = AddTransitionCmd::create(t.track, t.clip, knownOrNew(random, state), side);
            return edit(command, what << "add a known" << side);
        }
        return edit(AddTransitionCmd::create(t.track, t.clip, transition, side),
                    what.clip(t.clip).track(t.track).transition(transition) << "add" << side);
    }
    case 1: {
        std::vector<MediaPtr> clips = t.track->medias();
        std::vector<MediaPtr> chosen;
        for (const MediaPtr& clip : clips)
            if (chance(random, 40)) chosen.push_back(clip);
        if (chance(random, 10)) chosen.push_back(state.randomKnown(random));
        const TransitionPtr transition = state.newTransition(between(random, 0, 15));
        what.track(t.track).transition(transition) << "on" << chosen.size() << "clips";
        return edit(AddTransitionToMediasCmd::create(t.track, chosen, transition), what);
    }
    case 2: {
        const TransitionPtr transition = knownOrNew(random, state);
        return edit(RemoveTransitionCmd::create(t.track, transition),
                    what.track(t.track).transition(transition) << "remove");
    }
    case 3: {
        const TransitionPtr transition = knownOrNew(random, state);
        const TransitionPtr replacement =
            chance(random, 85) ? state.newTransition(between(random, 0, 25)) : knownOrNew(random, state);
        what.track(t.track).transition(transition) << "replace by";
        return edit(ReplaceTransitionCmd::create(t.track, transition, replacement),
                    what.transition(replacement));
    }
    case 4: {
        const TransitionPtr transition = knownOrNew(random, state);
        return edit(SplitTransitionCmd::create(t.track, transition),
                    what.track(t.track).transition(transition) << "split");
    }
    default: {
        const TransitionPtr transition = knownOrNew(random, state);
        const VelaTime length = between(random, -3, 40);
        what.track(t.track).transition(transition) << "trim to" << length;
        return edit(TrimTransitionCmd::create(t.track, transition, length), what);
    }
    }
}

// Composites: group, ungroup, stitch, unstitch.
Edit makeGroup(Random& random, SoakState& state) {
    std::vector<MediaPtr> chosen;
    const long long count = between(random, 1, 3);
    for (long long i = 0; i < count; ++i) chosen.push_back(state.randomPlaced(random));
    if (chance(random, 5)) chosen.push_back(state.randomKnown(random)); // loose or inside: throws
    Described what(state);
    for (const MediaPtr& clip : chosen) what.clip(clip);
    if (chance(random, 50)) {
        const auto group = GroupCmd::create(chosen);
        Edit e = edit(group, what << "(GroupCmd)");
        e.learn = [group](SoakState& s) { s.remember(group->createdGroup()); };
        return e;
    }
    const auto group = CreateGroupCmd::create(chosen); // throws for a bad selection
    Edit e = edit(group, what << "(CreateGroupCmd)");
    e.learn = [group](SoakState& s) { s.remember(group->createdGroup()); };
    return e;
}

Edit makeUngroup(Random& random, SoakState& state) {
    std::vector<MediaPtr> groups;
    for (const MediaPtr& media : state.clips)
        if (Group::asGroup(media.get()) && (media->parent() || chance(random, 5))) groups.push_back(media);
    const MediaPtr group = oneOf(random, groups);
    const auto command = UnGroupCmd::create(boost::dynamic_pointer_cast<Group>(group)); // none: throws
    return edit(command, Described(state).clip(group));
}

Edit makeStitch(Random& random, SoakState& state) {
    const TrackPtr track = state.randomTrack(random);
    const std::vector<MediaPtr> clips = track->medias();
    std::vector<MediaPtr> chosen;
    if (!clips.empty()) {
        size_t first = size_t(between(random, 0, (long long)clips.size() - 1));
        chosen.push_back(clips[first]);
        // Mostly a run of touching clips; sometimes any next clip (throws when they do not touch).
        for (size_t i = first + 1; i < clips.size() && chosen.size() < 3; ++i) {
            if (clips[i]->startTime() != chosen.back()->trackRange().end() && chance(random, 90)) break;
            chosen.push_back(clips[i]);
        }
    }
    Described what(state);
    what.track(track);
    for (const MediaPtr& clip : chosen) what.clip(clip);
    const auto stitch = StitchMediaCmd::create(track, chosen); // fewer than two: throws
    Edit e = edit(stitch, what);
    e.learn = [stitch](SoakState& s) { s.remember(stitch->stitchedMedia()); };
    return e;
}

Edit makeUnstitch(Random& random, SoakState& state) {
    const TrackPtr track = state.randomTrack(random);
    if (chance(random, 25))
        return edit(UnstitchAllCmd::create(track), Described(state).track(track) << "all");
    std::vector<MediaPtr> stitched;
    for (const MediaPtr& media : track->medias())
        if (dynamic_cast<const StitchedMedia*>(media.get())) stitched.push_back(media);
    const MediaPtr media = chance(random, 85) ? oneOf(random, stitched) : state.randomKnown(random);
    // A plain clip throws; a stitched media elsewhere is refused.
    return edit(UnstitchMediaCmd::create(track, media), Described(state).clip(media).track(track));
}

Edit makeTrackFlag(Random& random, SoakState& state) {
    const TrackPtr track = chance(random, 15) ? TrackPtr() : state.randomTrack(random); // none: throws
    const auto flag = ChangeTrackFlagCmd::Flag(between(random, 0, 2));
    const bool value = chance(random, 50);
    return edit(ChangeTrackFlagCmd::create(track, flag, value), Described(state).track(track)
                                                                    << flag << value);
}

// Two moves or two trims of the same edge of one clip, folded into one undo step.
Edit makeFolded(Random& random, SoakState& state) {
    const Target t = target(random, state);
    const VelaTime a = delta(random, 20), b = delta(random, 20);
    Edit e;
    switch (between(random, 0, 2)) {
    case 0:
        e = edit(MoveCmd::create(t.track, t.clip, a), Described(state).clip(t.clip).track(t.track)
                                                          << "move by" << a << b);
        e.second = MoveCmd::create(t.track, t.clip, b);
        break;
    case 1:
        e = edit(TrimStartCmd::create(t.track, t.clip, a), Described(state).clip(t.clip).track(t.track)
                                                               << "trim start by" << a << b);
        e.second = TrimStartCmd::create(t.track, t.clip, b);
        break;
    default:
        e = edit(TrimEndCmd::create(t.track, t.clip, a), Described(state).clip(t.clip).track(t.track)
                                                             << "trim end by" << a << b);
        e.second = TrimEndCmd::create(t.track, t.clip, b);
    }
    e.combine = true;
    return e;
}

} // namespace

void addCoreMakers(EditMakerRegistry& registry) {
    registry.add("AddMediaCmd", 6, makeAdd);
    registry.add("RemoveMediaCmd", 4, makeRemove);
    registry.add("MoveCmd", 10, makeMove);
    registry.add("TrimStartCmd/TrimEndCmd", 10, makeTrim);
    registry.add("StretchCmd", 4, makeStretch);
    registry.add("StretchTrimStartCmd/EndCmd", 4, makeStretchTrim);
    registry.add("SplitCmd", 8, makeSplit);
    registry.add("CloseGapsOnTrackCmd", 2, makeCloseGaps);
    registry.add("RippleMoveCmd", 5, makeRippleMove);
    registry.add("InsertTimeCmd", 3, makeInsertTime);
    registry.add("SplittingRippleMoveCmd", 3, makeSplittingRippleMove);
    registry.add("transitions", 10, makeTransitionEdit);
    registry.add("GroupCmd/CreateGroupCmd", 2, makeGroup);
    registry.add("UnGroupCmd", 2, makeUngroup);
    registry.add("StitchMediaCmd", 3, makeStitch);
    registry.add("UnstitchMediaCmd/UnstitchAllCmd", 2, makeUnstitch);
    registry.add("ChangeTrackFlagCmd", 2, makeTrackFlag);
    registry.add("combineLastCommands", 4, makeFolded);
}

} // namespace soak
} // namespace VelaMediaLib

#pragma once
// The random-edit soak: a seeded run of random edits, valid and invalid, on a
// project with several tracks (one magnetic), groups, stitched media,
// transitions, keyframes, effects and animations. After every step the model
// must hold its invariants and a refused edit must leave the written document
// byte-identical; every undo must give back the document its step began
// from, and redo the one it ended with.
//
// Edits come from makers, one function per family of commands, kept in a
// registry: a family is added by registering one more maker.

#include <VelaMediaLib/commands/framework/Command.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/timeline/GenericMixer.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>

#include <cstdint>
#include <functional>
#include <map>
#include <ostream>
#include <random>
#include <set>
#include <string>
#include <unordered_set>
#include <vector>

namespace VelaMediaLib {
namespace soak {

typedef std::mt19937_64 Random;

/// A whole number from low to high, both included (low when high is below it).
/// The same seed gives the same numbers under every standard library; keep
/// it so by never passing two draws as arguments of one call (the compiler
/// picks their order): draw each into a variable of its own.
long long between(Random& random, long long low, long long high);
/// True with the chance percent / 100.
bool chance(Random& random, int percent);
/// One of the items (a default value when there are none).
template <typename T>
T oneOf(Random& random, const std::vector<T>& items) {
    return items.empty() ? T() : items[size_t(between(random, 0, (long long)items.size() - 1))];
}

/// The project a run edits and what the run knows of it. The model is asked
/// what stands where at each step; the pools only remember every clip and
/// transition seen, so that makers can also name ones that are elsewhere.
struct SoakState {
    ProjectPtr project;
    boost::shared_ptr<GenericMixer> mixer;
    std::vector<MediaPtr> clips;            // every clip seen: placed, loose, inside composites
    std::vector<TransitionPtr> transitions; // every transition made
    std::unordered_set<const Media*> known; // the clips of the pool
    boost::shared_ptr<const Source> source; // a video with a still beside it, for held frames
    boost::shared_ptr<void> sourceStats;    // answers for that file while the run lasts

    /// The mixer's tracks, in order.
    std::vector<TrackPtr> tracks() const;
    /// The tracks of the groups on the mixer's tracks, at any depth.
    std::vector<TrackPtr> groupTracks() const;
    /// Mostly a track of the mixer; now and then one inside a group.
    TrackPtr randomTrack(Random& random) const;
    /// A clip standing on a track of the mixer (or null), and that track.
    MediaPtr randomPlaced(Random& random, TrackPtr* on = nullptr) const;
    /// A clip of the pool, wherever it is.
    MediaPtr randomKnown(Random& random) const { return oneOf(random, clips); }
    /// A fresh clip (with keyframes, effects and an animation), in the pool:
    /// mostly a placeholder, now and then (unless `placeholder`) a slice of
    /// the source's video.
    MediaPtr newClip(Random& random, bool placeholder = false);
    TransitionPtr newTransition(VelaTime duration);
    /// Adds the clip to the pool unless it is there.
    void remember(const MediaPtr& media);
    /// Remembers every clip on the mixer's tracks and the groups' tracks.
    void rememberPlaced();
    /// The track the clip stands on, or null.
    static TrackPtr trackOf(const MediaPtr& media);
};

/// One random edit. `second`, when set, is executed after the first took
/// effect, and with `combine` the two are then folded into one undo step.
struct Edit {
    CommandPtr command;
    std::string what;
    CommandPtr second;
    bool combine = false;
    /// Run after the edit took effect: to learn the clips it made that are
    /// not on a track (every clip on one is learnt anyway).
    std::function<void(SoakState&)> learn;
};

/// Makes one random edit of its family. It may throw as a command's create
/// does for bad arguments: that counts as a refusal.
typedef std::function<Edit(Random&, SoakState&)> EditMaker;

class EditMakerRegistry {
public:
    struct Entry {
        std::string family;
        int weight;
        EditMaker make;
    };
    void add(const std::string& family, int weight, const EditMaker& make);
    /// A maker chosen by weight.
    const Entry& pick(Random& random) const;
    const std::vector<Entry>& entries() const { return entries_; }

private:
    std::vector<Entry> entries_;
    int total_ = 0;
};

/// The families the timeline edit commands of today give: placement, time
/// structure, ripple edits, transitions, composites, track flags and folding.
void addCoreMakers(EditMakerRegistry& registry);
/// Every other family of edit commands (FamilyMakers.cpp).
void addFamilyMakers(EditMakerRegistry& registry);

/// The project every run starts from: four tracks (the first magnetic), clips
/// with keyframes, effects (a magnetized "CursorPath" among them) and
/// animations, transitions, a group and a stitched media, and loose clips.
/// Its history is empty.
SoakState buildSoakProject(Random& random);

/// Empty when the model holds every invariant, else what broke: on every
/// track (the mixer's and the groups', at any depth) clips in start order,
/// not overlapping, each with the track as its parent, the time queries
/// agreeing with the clips; every transition slot and its transition's link
/// naming each other; a clip at least as long as its transitions together
/// less the one tick a trim may take;
/// every clip's media inside its limits. With `packed`, a magnetic track of
/// the mixer has no gap (after an edit; an undo of one step may leave one).
std::string invariantViolations(const SoakState& state, bool packed);

/// The kind of a broken invariant, by what the checker says: "room" (a clip
/// too short for its transitions), "link" (a transition slot and its
/// transition's link naming different clips), or "" for every other rule.
std::string kindOf(const std::string& broken);

struct Violation {
    uint64_t seed;
    long long step;
    std::string what;
    std::string kind; // kindOf; "" also for refusals that changed something and inexact undos
};

struct SoakOptions {
    uint64_t seed = 1;
    long long edits = 2000;
    /// A run of random undos (and mostly redos) after about one edit in this many; 0: none.
    int undoRunEvery = 40;
    /// Give up a run after this many violations of no named kind (the state
    /// may be beyond telling more); the named kinds are each reported as they
    /// appear and do not end it.
    size_t maxViolations = 20;
    /// Where to write a line for each edit, if anywhere.
    std::ostream* trace = nullptr;
};

struct SoakResult {
    long long edits = 0, applied = 0, refused = 0, thrown = 0, undone = 0;
    std::map<std::string, long long> appliedByFamily, refusedByFamily;
    std::vector<Violation> violations;
};

/// Runs the edits from a fresh project, then undoes everything and redoes it.
SoakResult runSoak(const SoakOptions& options, const EditMakerRegistry& registry);

} // namespace soak
} // namespace VelaMediaLib

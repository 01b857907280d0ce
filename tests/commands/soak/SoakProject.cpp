// The soak's project and what a run knows of it.
#include "SoakDriver.h"

#include "../../model/SourceTestSupport.h"

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/GroupCmd.h>
#include <VelaMediaLib/commands/edits/StitchMediaCmd.h>
#include <VelaMediaLib/commands/framework/CommandHistory.h>
#include <VelaMediaLib/effects/StoredEffect.h>
#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/MediaImpl.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/project/SourceBin.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

#include <algorithm>
#include <cstdint>
#include <limits>
#include <stdexcept>

namespace VelaMediaLib {
namespace soak {

// Drawn from the engine's raw output with rejection rather than through a
// standard distribution, whose draws differ between standard libraries: a
// seed names the same edits under every compiler.
long long between(Random& random, long long low, long long high) {
    if (high < low) high = low; // a track may end before 0
    const uint64_t span = uint64_t(high) - uint64_t(low) + 1;
    const uint64_t most = std::numeric_limits<uint64_t>::max();
    if (span == 0) return (long long)random(); // the whole range
    const uint64_t limit = most - most % span; // a multiple of span: every value as likely
    uint64_t draw = random();
    while (draw >= limit) draw = random();
    return (long long)(uint64_t(low) + draw % span);
}

bool chance(Random& random, int percent) { return between(random, 1, 100) <= percent; }

std::vector<TrackPtr> SoakState::tracks() const { return mixer->tracks(); }

namespace {

void collectGroupTracks(const std::vector<TrackPtr>& tracks, std::vector<TrackPtr>& out) {
    for (const TrackPtr& track : tracks)
        for (const MediaPtr& media : track->medias())
            if (const Group* group = Group::asGroup(media.get())) {
                const std::vector<TrackPtr> inner = group->mixer()->tracks();
                out.insert(out.end(), inner.begin(), inner.end());
                collectGroupTracks(inner, out);
            }
}

StoredEffectPtr effect(const std::string& name, VelaTime start, VelaTime duration) {
    StoredEffect::Fields fields;
    fields.effectName = name;
    fields.start = start;
    fields.duration = duration;
    return StoredEffect::create(fields);
}

} // namespace

std::vector<TrackPtr> SoakState::groupTracks() const {
    std::vector<TrackPtr> out;
    collectGroupTracks(tracks(), out);
    return out;
}

TrackPtr SoakState::randomTrack(Random& random) const {
    if (chance(random, 10)) {
        const std::vector<TrackPtr> inner = groupTracks();
        if (!inner.empty()) return oneOf(random, inner);
    }
    return oneOf(random, tracks());
}

MediaPtr SoakState::randomPlaced(Random& random, TrackPtr* on) const {
    std::vector<std::pair<TrackPtr, MediaPtr>> placed;
    for (const TrackPtr& track : tracks())
        for (const MediaPtr& media : track->medias()) placed.emplace_back(track, media);
    const auto chosen = oneOf(random, placed);
    if (on) *on = chosen.first;
    return chosen.second;
}

TrackPtr SoakState::trackOf(const MediaPtr& media) {
    return media ? boost::dynamic_pointer_cast<Track>(media->parent()) : TrackPtr();
}

void SoakState::remember(const MediaPtr& media) {
    if (media && known.insert(media.get()).second) clips.push_back(media);
}

void SoakState::rememberPlaced() {
    std::vector<TrackPtr> all = tracks();
    const std::vector<TrackPtr> inner = groupTracks();
    all.insert(all.end(), inner.begin(), inner.end());
    for (const TrackPtr& track : all)
        for (const MediaPtr& media : track->medias()) remember(media);
}

TransitionPtr SoakState::newTransition(VelaTime duration) {
    transitions.emplace_back(new Transition("t" + std::to_string(transitions.size()), duration));
    return transitions.back();
}

MediaPtr SoakState::newClip(Random& random, bool placeholder) {
    const SafeRational scalars[] = {1, 1, SafeRational(3, 2), SafeRational(2, 3), SafeRational(1, 3), 2};
    const SafeRational scalar = scalars[between(random, 0, 5)];
    const SafeRational mediaStart = between(random, 0, 40), mediaDuration = between(random, 20, 90);
    const boost::shared_ptr<VisualMediaImpl> clip =
        source && !placeholder && chance(random, 20)
            ? boost::shared_ptr<VisualMediaImpl>(
                  VMFile::create(source, 0, 0, mediaStart, mediaDuration, scalar))
            : PlaceholderMedia::createFromMediaRange(project->token(), project->editRateToken(), 0,
                                                     mediaStart, mediaDuration, scalar);
    const VelaTime duration = clip->duration();
    clip->opacity()->addKeyFrame(RationalTime(between(random, 0, 10)), 0.25, RationalTime(0));
    clip->opacity()->addKeyFrame(RationalTime(between(random, 11, 30)), 1.0, RationalTime(0));
    clip->addEffect(effect("CursorPath", 0, duration)); // follows both edges
    if (chance(random, 50)) clip->addEffect(effect("Blur", duration / 4, duration / 2));
    if (chance(random, 50)) {
        AnimationTrack::Animation animation;
        animation.range = Range<long long>(duration / 5, duration / 2);
        animation.endTime = animation.range.end();
        animation.duration = animation.range.duration();
        clip->setAnimationTrack(AnimationTrack("opacity", {animation}));
    }
    clip->addMetaData("note", "clip " + std::to_string(clips.size()));
    remember(clip);
    return clip;
}

namespace {

// Placed directly, before the history starts: the track joins transitions
// set on touching edges.
void lineUp(SoakState& state, Random& random, GenericTrack& track, int count, bool gaps, bool placeholders) {
    VelaTime end = 0;
    for (int i = 0; i < count; ++i) {
        const MediaPtr clip = state.newClip(random, placeholders);
        // Only where they fit: the project starts as the edits keep it.
        const TransitionPtr right = chance(random, 30) ? state.newTransition(between(random, 0, 8)) : nullptr;
        if (right && Transition::roomFor(*clip, right, nullptr)) clip->setRightTransition(right);
        const TransitionPtr left = chance(random, 20) ? state.newTransition(between(random, 0, 8)) : nullptr;
        if (left && Transition::roomFor(*clip, left, nullptr)) clip->setLeftTransition(left);
        if (gaps && chance(random, 40)) end += between(random, 1, 30);
        track.addMedia(clip, end);
        end += clip->duration();
    }
}

// The file's stats come from a table registered for the run, ahead of the
// loaders that would look for it on disk.
void loadSource(SoakState& state) {
    const char* path = "/soak/screen.mov";
    const auto loader = boost::make_shared<testing::RegisteredTableLoader>();
    (*loader)->set(
        path, {testing::stream(TrackType::Video, 0, 6000, 30), testing::stream(TrackType::Image, 0, 1, 30)});
    const auto files = boost::make_shared<testing::FakeFileSystem>();
    files->present.insert(path);
    state.project->sourceBin()->setFileSystem(files);
    state.source = state.project->sourceBin()->loadFile(path);
    state.sourceStats = loader;
}

void must(bool done, const char* what) {
    if (!done) throw std::runtime_error(std::string("the soak project could not be built: ") + what);
}

} // namespace

SoakState buildSoakProject(Random& random) {
    SoakState state;
    state.project = Project::create(30, 1);
    loadSource(state);
    state.mixer = state.project->newMixer("main");
    for (int t = 0; t < 4; ++t) {
        const auto track = state.project->timeline()->newTrack();
        state.project->timeline()->addTrack(state.mixer, track);
        lineUp(state, random, *track, 6, t > 0, t == 3); // the last track's are stitched below
    }
    const std::vector<TrackPtr> tracks = state.tracks();
    tracks[0]->magneticAttribute()->setValue(true);
    for (int i = 0; i < 3; ++i) state.newClip(random); // loose, for adds

    // The last track's first two clips touch: stitch them; group the second
    // track's last clip with a clip of the third after it.
    const auto fourth = boost::dynamic_pointer_cast<GenericTrack>(tracks[3]);
    const std::vector<MediaPtr> last = fourth->medias();
    fourth->removeMedia(last[1]);
    fourth->addMedia(last[1], last[0]->trackRange().end());
    const auto stitch = StitchMediaCmd::create(tracks[3], {last[0], last[1]});
    must(state.project->execute(stitch), "stitch");
    state.remember(stitch->stitchedMedia());
    const MediaPtr below = state.newClip(random);
    boost::dynamic_pointer_cast<GenericTrack>(tracks[2])->addMedia(
        below, std::max(tracks[1]->endTime(), tracks[2]->endTime()));
    const auto group = GroupCmd::create({tracks[1]->medias().back(), below});
    must(state.project->execute(group), "group");
    state.remember(group->createdGroup());
    state.project->commandHistory()->runFollowUps();
    state.project->commandHistory()->restoreState(CommandHistoryState());
    state.rememberPlaced();
    return state;
}

} // namespace soak
} // namespace VelaMediaLib

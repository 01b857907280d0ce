// An embedder's first program: a project, a track, a clip placed by a
// command, a query, an undo. It also catches an exception thrown inside the
// library and casts a clip down, which only work when the library exports the
// classes' type information.
#include <VelaMediaLib/VelaMediaLib.h>

#include <iostream>

using namespace VelaMediaLib;

namespace {

// Taking off a clip the track does not hold throws AddRemoveException.
bool refusesRemovingAnAbsentClip(const TrackPtr& track, const MediaPtr& clip) {
    try {
        track->removeMedia(clip);
    } catch (const VelaMediaLibException& refused) {
        return dynamic_cast<const AddRemoveException*>(&refused) != nullptr;
    }
    return false;
}

} // namespace

int main() {
    const ProjectPtr project = Project::create(30, 1);
    const auto track = project->timeline()->newTrack();
    project->timeline()->addTrack(project->newMixer("main"), track);
    const auto clip = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 90);
    if (!project->execute(AddMediaCmd::create(track, clip, 30))) return 1;
    const MediaPtr found = track->mediaAtTime(45).first;
    const bool placeholder = boost::dynamic_pointer_cast<PlaceholderMedia>(found) == clip;
    project->undo();
    const bool refused = refusesRemovingAnAbsentClip(track, clip);
    const SafeRational frame(1001, 30000);
    std::cout << "installed VelaMediaLib: clip found " << placeholder << ", 30 NTSC frames last "
              << frame * 30 << " s, track empty after undo " << (track->numMedias() == 0)
              << ", absent clip refused " << refused << "\n";
    return placeholder && refused && track->numMedias() == 0 ? 0 : 1;
}

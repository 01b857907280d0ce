// An embedder's first program: a project, a track, a clip placed by a
// command, a query, an undo.
#include <VelaMediaLib/VelaMediaLib.h>

#include <iostream>

using namespace VelaMediaLib;

int main() {
    const ProjectPtr project = Project::create(30, 1);
    const auto track = project->timeline()->newTrack();
    project->timeline()->addTrack(project->newMixer("main"), track);
    const auto clip = PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 90);
    if (!project->execute(AddMediaCmd::create(track, clip, 30))) return 1;
    const bool found = track->mediaAtTime(45).first == clip;
    project->undo();
    const SafeRational frame(1001, 30000);
    std::cout << "installed VelaMediaLib: clip found " << found << ", 30 NTSC frames last " << frame * 30
              << " s, track empty after undo " << (track->numMedias() == 0) << "\n";
    return found && track->numMedias() == 0 ? 0 : 1;
}

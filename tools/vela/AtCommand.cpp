#include "AtCommand.h"

#include "DocumentLoader.h"
#include "UsageError.h"

#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <ostream>
#include <sstream>

using namespace VelaMediaLib;

namespace VelaTool {

namespace {

VelaTime tickOf(const std::string& text) {
    size_t used = 0;
    long long tick = 0;
    try {
        tick = std::stoll(text, &used);
    } catch (const std::exception&) {
        used = 0;
    }
    if (used == 0 || used != text.size()) throw UsageError("TICK must be an integer, not \"" + text + "\"");
    return tick;
}

std::string timeText(const SafeRational& time) {
    std::ostringstream out;
    if (time.denominator() == 1)
        out << time.numerator();
    else
        out << time;
    return out.str();
}

/// How many clips hold the clip: its indentation under the track's own clip.
int depthOf(const Media& media) {
    int depth = 0;
    for (MediaPtr outer = Track::enclosingClipOf(media); outer; outer = Track::enclosingClipOf(*outer))
        ++depth;
    return depth;
}

void printClip(std::ostream& out, const Track::MediaAtTime& found, int baseDepth) {
    const Media& media = *found.media;
    const Range<VelaTime> range = media.trackRange();
    const SafeRational mediaTime =
        media.rationalMediaRange().start() + found.parametricTime / media.rationalScalar();
    out << std::string(size_t(2 * (depthOf(media) - baseDepth + 1)), ' ')
        << MediaTypeFromMediaDispatcher::typeOf(media) << " \"" << media.identifier() << "\" ["
        << range.start() << ", " << range.end() << ") media time " << timeText(mediaTime) << "\n";
}

void printTrack(std::ostream& out, const std::string& label, const Track& track, VelaTime tick) {
    std::vector<Track::MediaAtTime> found;
    track.recursivelyCollectMediasAtTime(SafeRational(tick), found);
    out << label << " \"" << track.identifier() << "\":" << (found.empty() ? " nothing" : "") << "\n";
    if (found.empty()) return;
    const int baseDepth = depthOf(*found.front().media);
    for (const Track::MediaAtTime& clip : found) printClip(out, clip, baseDepth);
}

} // namespace

AtCommand::AtCommand()
    : Subcommand({"at", "the clips active at a tick, per track, with their media time",
                  "usage: vela at DOC TICK\n"
                  "  Prints, track by track, the clips active at TICK (ticks of the project's\n"
                  "  edit rate): kind, name, range [start, end) on its track (a clip inside a\n"
                  "  group, stitched or unified clip: in its container's time, indented under\n"
                  "  it) and the clip's media time there. At a cut both touching clips are listed.\n"
                  "  DOC is a project document, or - for standard input.\n",
                  AcceptedArguments{{}, {}, 2}}) {}

int AtCommand::run(const Arguments& arguments, Console& console) const {
    const VelaTime tick = tickOf(arguments.operand(1));
    const LoadedDocument document = DocumentLoader(console).load(arguments.operand(0));
    const TimelinePtr timeline = document.project->timeline();
    const std::vector<std::string> names = timeline->mixerNames();
    for (const std::string& name : names) {
        const Mixer::Tracks tracks = timeline->mixer(name)->tracks();
        const std::string prefix = names.size() > 1 ? name + " " : "";
        for (size_t index = 0; index < tracks.size(); ++index)
            printTrack(console.out, prefix + "track " + std::to_string(index), *tracks[index], tick);
    }
    return 0;
}

} // namespace VelaTool

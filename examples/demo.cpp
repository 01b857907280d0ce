// A tour of what VelaMediaLib answers, printed readably. It grows with the library.
#include "HeaderStatsLoader.h"

#include <VelaMediaLib/VelaMediaLib.h>
#include <VelaMediaLib/document/ProjectDocument.h>

#include <boost/filesystem.hpp>
#include <boost/make_shared.hpp>

#include <fstream>
#include <iomanip>
#include <iostream>
#include <sstream>
#include <vector>

using namespace VelaMediaLib;

namespace {

typedef boost::rational<unsigned long> Rate;

std::string text(const SafeRational& value) {
    std::ostringstream out;
    out << value;
    return out.str();
}

std::string rateName(const Rate& rate) {
    std::ostringstream out;
    out << rate.numerator();
    if (rate.denominator() != 1) out << "/" << rate.denominator();
    return out.str();
}

void frameRates() {
    std::cout << "Frame rates: one frame, and the frame that starts just before one minute\n\n";
    std::cout << std::left << std::setw(12) << "rate" << std::setw(14) << "frame (s)" << std::setw(14)
              << "frame flicks" << std::setw(10) << "frame" << std::setw(22) << "starts at (s)"
              << "in 30 fps ticks (truncated / rounded)\n";
    const Rate rates[] = {Rate(24), Rate(25), Rate(30000, 1001), Rate(60000, 1001), Rate(44100)};
    for (const Rate& rate : rates) {
        const SafeRational frame = SafeRational((long long)rate.denominator(), (long long)rate.numerator());
        const long long lastFrame = TimeUtil::fromSecondsToVelaTimeTruncated(60.0, rate) - 1;
        const SafeRational start = frame * lastFrame;
        const long long frameFlicks = RationalUtil::toVelaTime(frame * ScaledTime::kFlickScale);
        std::cout << std::setw(12) << rateName(rate) << std::setw(14) << text(frame) << std::setw(14)
                  << frameFlicks << std::setw(10) << lastFrame << std::setw(22) << std::setprecision(12)
                  << start.asDouble() << RationalUtil::toVelaTime(start * 30) << " / "
                  << RationalUtil::toVelaTime(RationalUtil::Round(start * 30)) << "\n";
    }
}

void seconds() {
    const Rate ntsc(30000, 1001);
    std::cout << std::right << "\nSeconds to ticks at 30000/1001 ticks per second\n";
    for (double s : {1.0, 1.5, -1.5, 10.01}) {
        std::cout << "  " << std::setw(6) << s << " s -> rounded " << std::setw(4)
                  << TimeUtil::fromSecondsToVelaTimeRounded(s, ntsc) << ", truncated " << std::setw(4)
                  << TimeUtil::fromSecondsToVelaTimeTruncated(s, ntsc) << " ticks\n";
    }
    std::cout << "  tick 30 starts at " << std::setprecision(17) << TimeUtil::fromVelaTimeToSeconds(30, ntsc)
              << " s\n";
}

void grid() {
    std::cout << "\nFlick times moved onto the 30 fps grid (one frame = 23520000 flicks)\n";
    for (long long t : {23520001LL, 35280000LL, -23520001LL}) {
        const ScaledTime time(ScaledTime::kFlickScale, t);
        std::cout << "  " << std::setw(10) << t << ": floor " << std::setw(9)
                  << time.alignedFloored(30).time() << "  ceil " << std::setw(9)
                  << time.alignedCeiled(30).time() << "  round " << std::setw(9)
                  << time.alignedRounded(30).time() << "\n";
    }
}

void rounding() {
    std::cout << "\nExact rounding (halves away from zero)\n";
    for (const SafeRational& x :
         {SafeRational(5, 2), SafeRational(-5, 2), SafeRational(1, 3), SafeRational(-1, 2)})
        std::cout << "  " << std::setw(5) << text(x) << ": floor " << std::setw(3)
                  << RationalUtil::Floor(x).asVelaTime() << "  ceil " << std::setw(3)
                  << RationalUtil::Ceil(x).asVelaTime() << "  round " << std::setw(3)
                  << RationalUtil::Round(x).asVelaTime() << "\n";
    std::cout << "  1/3 + 1/6 = " << SafeRational(1, 3) + SafeRational(1, 6) << "\n";
    const SafeRational a(1000000007, 3037000500), b(3037000507, 3037000501);
    std::cout << "  " << a << " * " << b << " overflows 64 bits;\n    the guard answers " << a * b
              << " (\"%f\" of " << std::setprecision(15) << a.asDouble() * b.asDouble() << ")\n";
}

void parameters() {
    std::cout
        << "\nKeyframed opacity: 0 at tick 0, 1 at tick 30, back to 0 at tick 60 with a 10-tick lead-in\n";
    const boost::shared_ptr<ThreadSafe> project(new ThreadSafe);
    const char* kinds[] = {"linr", "esIn", "esOt", "eios", "bnce", "sprg"};
    std::cout << "  tick";
    for (const char* kind : kinds) std::cout << std::setw(8) << kind;
    std::cout << "\n";
    std::vector<boost::shared_ptr<InterpolatingParam<double>>> curves;
    for (const char* kind : kinds) {
        auto opacity = InterpolatingParam<double>::create(project, "opacity", 0.0,
                                                          InterpolaterFactory<double>::byName(kind));
        opacity->addKeyFrame(RationalTime(30), 1.0, RationalTime(0));
        opacity->addKeyFrame(RationalTime(60), 0.0, RationalTime(10));
        curves.push_back(opacity);
    }
    for (long long tick : {0LL, 10LL, 15LL, 20LL, 30LL, 45LL, 50LL, 55LL, 60LL}) {
        std::cout << "  " << std::setw(4) << tick << std::fixed << std::setprecision(3);
        for (const auto& curve : curves) std::cout << std::setw(8) << curve->valueAtTime(RationalTime(tick));
        std::cout << std::defaultfloat << "\n";
    }
    std::cout << "\nThe linear curve as the project document holds it:\n  ";
    XMLOptions options(std::cout);
    curves.front()->toJSON(options, 1, "opacity");
    std::cout << "\n";
}

void printClip(const char* what, const Media& clip) {
    const Range<VelaTime> track = clip.trackRange();
    const Range<SafeRational> media = clip.rationalMediaRange();
    std::cout << "  " << std::left << std::setw(30) << what << std::right << " track [" << std::setw(4)
              << track.start() << ", " << std::setw(4) << track.end() << ")  media start " << std::setw(5)
              << text(media.start()) << "  media length " << std::setw(6) << text(media.duration())
              << "  scalar " << text(clip.state().scalar) << "\n";
}

void clips() {
    std::cout << "\nA placeholder clip playing 90 ticks of media 1.5 times as fast (scalar 2/3)\n";
    const boost::shared_ptr<ThreadSafe> project(new ThreadSafe);
    const boost::shared_ptr<ProjectEditRate> rate(
        new SimpleProjectEditRate(boost::rational<unsigned long>(30)));
    const auto clip = PlaceholderMedia::createFromMediaRange(project, rate, 0, 0, 90, SafeRational(2, 3));
    printClip("as made", *clip);
    clip->trimStart(1);
    printClip("trimStart(1)", *clip);
    clip->trimEnd(2);
    printClip("trimEnd(2)", *clip);
    clip->rationalStretch(SafeRational(3, 2));
    printClip("rationalStretch(3/2)", *clip);
    try {
        clip->trimEnd(-10);
    } catch (const InvalidTrimRangeException& e) {
        std::cout << "  trimEnd(-10) is refused: \"" << e.what() << "\" (limit " << clip->trimEndLimit()
                  << ")\n";
    }
    printClip("unchanged", *clip);
}

std::string activeAt(const Timeline& timeline, VelaTime tick) {
    std::string names;
    for (const MediaPtr& media : timeline.allMediasAtTime(tick))
        names += (names.empty() ? "" : "+") + media->identifier();
    return names.empty() ? "-" : names;
}

void printTracks(const char* step, const Project& project, const std::vector<TrackPtr>& tracks) {
    std::cout << "  " << std::left << std::setw(34) << step << std::right;
    for (const TrackPtr& track : tracks) {
        std::cout << " " << track->identifier() << ":";
        for (const MediaPtr& media : track->medias())
            std::cout << " " << media->identifier() << "[" << media->startTime() << "," << media->endTime()
                      << ")";
    }
    std::cout << "\n  " << std::setw(34) << ""
              << " active at";
    for (VelaTime tick : {0, 15, 25, 45})
        std::cout << "  " << tick << ":" << activeAt(*project.timeline(), tick);
    std::cout << "   (undo steps " << project.commandHistory()->undoStack().size() << ")\n";
}

ProjectPtr project() {
    std::cout << "\nA project: clips on a magnetic and a plain track, edited through the history\n";
    const ProjectPtr project = Project::create(30, 1);
    const auto mixer = project->newMixer("main");
    std::vector<TrackPtr> tracks;
    for (const char* name : {"magnetic", "plain"}) {
        const auto track = project->timeline()->newTrack();
        track->setIdentifier(name);
        project->timeline()->addTrack(mixer, track);
        tracks.push_back(track);
    }
    tracks[0]->magneticAttribute()->setValue(true);
    std::vector<MediaPtr> clips;
    for (int i = 0; i < 6; ++i) {
        clips.push_back(PlaceholderMedia::create(project->token(), project->editRateToken(), 0, 10));
        clips.back()->setIdentifier(std::string(1, char('A' + i)));
        project->execute(AddMediaCmd::create(tracks[size_t(i / 3)], clips.back(), (i % 3) * 20));
    }
    printTracks("placed at 0, 20, 40 (magnet closes up)", *project, tracks);
    project->execute(RemoveMediaCmd::create(tracks[0], clips[1]));
    printTracks("removed B (the gap closes)", *project, tracks);
    project->execute(RemoveMediaCmd::create(tracks[1], clips[4]));
    printTracks("removed E (the gap stays)", *project, tracks);
    project->undo();
    printTracks("undo: E back", *project, tracks);
    project->undo();
    printTracks("undo: the gap opens again", *project, tracks);
    project->undo();
    printTracks("undo: B back", *project, tracks);
    project->redo();
    project->redo();
    printTracks("redo twice: B gone, gaps closed", *project, tracks);
    const auto split = SplitCmd::create(tracks[1], 25);
    project->execute(split);
    split->getCreatedMedias().front()->setIdentifier("E2");
    printTracks("split E at 25", *project, tracks);
    const auto insert = InsertTimeCmd::create(Range<VelaTime>(5, 10));
    insert->addTrack(tracks[1]);
    project->execute(insert);
    printTracks("10 ticks inserted at 5 (D split)", *project, tracks);
    project->execute(RippleMoveCmd::create(tracks[1], clips[5], -5));
    printTracks("F rippled 5 left", *project, tracks);
    for (int step = 0; step < 3; ++step) project->undo();
    printTracks("undo three times: E whole again", *project, tracks);
    return project;
}

/// The project as its document, for `vela info` and the other tools.
void writeDocument(const Project& project, const std::string& path) {
    const std::string text = projectToJSONString(project);
    std::ofstream file(path, std::ios::binary);
    file << text;
    std::cout << "\nThe project written to " << path << " (" << text.size() << " bytes)"
              << (file ? "" : ": FAILED") << "\n";
}

} // namespace

void printSources(const char* step, const Project& project) {
    std::cout << "  " << step << ":";
    for (const SourcePtr& source : project.sourceBin()->sources())
        std::cout << " " << boost::filesystem::path(source->filename()).filename().string();
    std::cout << " (" << project.sourceBin()->numSources() << " in the bin)\n";
}

/// Files written by the demo itself, imported through the example loader.
void sources() {
    std::cout << "\nImporting files: the host's stats loader reads WAV and PNG headers\n";
    namespace fs = boost::filesystem;
    const fs::path folder = fs::temp_directory_path() / fs::unique_path("vela-demo-%%%%%%%%");
    fs::create_directories(folder);
    const std::string voice = (folder / "voice.wav").string(), logo = (folder / "logo.png").string();
    VelaExamples::writeTestWav(voice, 48000, 2, 1.5);
    VelaExamples::writeTestPng(logo, 320, 200);
    const auto loader = boost::make_shared<VelaExamples::HeaderStatsLoader>();
    MediaFileStats::addStatsLoader(loader, 1);

    const ProjectPtr project = Project::create(30, 1);
    const auto track = project->timeline()->newTrack();
    project->timeline()->addTrack(project->newMixer("main"), track);
    for (const std::string& path : {voice, logo, voice}) project->execute(LoadSourceCmd::create(path));
    printSources("voice, logo and voice again imported", *project);
    for (const SourcePtr& source : project->sourceBin()->sources()) {
        const auto stats = source->stats();
        const Range<VelaTime> ticks = source->timeRangeForTrack(0);
        std::cout << "    " << fs::path(source->filename()).filename().string() << ": "
                  << trackTypeName(stats->trackType(0)) << " stream, ";
        if (stats->trackType(0) == TrackType::Audio)
            std::cout << stats->numChannels(0) << " channels at "
                      << RationalUtil::toVelaTime(stats->sampleRate(0)) << " Hz";
        else
            std::cout << stats->trackRect(0).width << "x" << stats->trackRect(0).height << " pixels";
        std::cout << ", " << ticks.duration() << " ticks of the project\n";
    }
    const SourcePtr sound = project->sourceBin()->sourceForFile(voice);
    const SourcePtr picture = project->sourceBin()->sourceForFile(logo);
    project->execute(AddMediaCmd::create(track, AMFile::create(sound, 0, 0), 0));
    project->execute(AddMediaCmd::create(track, IMFile::create(picture, 0, 0, 60), 45));
    for (const MediaPtr& clip : track->medias())
        printClip(MediaTypeFromMediaDispatcher::typeOf(*clip).c_str(), *clip);
    try {
        project->unloadSource(sound);
    } catch (const VelaMediaLibException& refused) {
        std::cout << "  unloading voice.wav: " << refused.what() << "\n";
    }

    fs::remove(logo);
    project->dropSourceOffline(picture);
    std::cout << "  logo.png deleted: offline status " << static_cast<int>(picture->offlineStatus())
              << " (1: the file is gone)\n";
    for (int step = 0; step < 4; ++step) project->undo(); // the two clips, then the two imports
    printSources("undo four times", *project);
    project->redo();
    printSources("redo: the same voice source back", *project);
    std::cout << "  the bin's voice is the one the clips played: " << std::boolalpha
              << (project->sourceBin()->sourceForFile(voice) == sound) << "\n";

    MediaFileStats::removeStatsLoader(loader);
    fs::remove_all(folder);
}

/// With a path, the demo's project is also written there as its document.
int main(int argc, char** argv) {
    std::cout << "VelaMediaLib: exact time at work\n\n";
    frameRates();
    seconds();
    grid();
    rounding();
    parameters();
    clips();
    const ProjectPtr edited = project();
    sources();
    if (argc > 1) writeDocument(*edited, argv[1]);
    return 0;
}

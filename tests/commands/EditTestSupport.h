#pragma once
// A project for edit tests that keeps every clip, transition and track it
// makes, so that a test can ask that undo and redo give back exact states.

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/document/ProjectDocument.h>
#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/effects/StoredEffect.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>

#include <algorithm>
#include <gtest/gtest.h>
#include <sstream>

namespace VelaMediaLib {
namespace testing {

template <typename T>
std::string indexIn(const std::vector<T>& all, const T& one) {
    const auto found = std::find(all.begin(), all.end(), one);
    return !one ? "-" : found == all.end() ? "?" : std::to_string(found - all.begin());
}

inline boost::shared_ptr<GenericTrack> parentOf(const MediaPtr& clip) {
    boost::shared_ptr<GenericTrack> parent;
    clip->parentVisitor([&](const boost::shared_ptr<SubTimeline>& p) {
        parent = boost::dynamic_pointer_cast<GenericTrack>(p);
    });
    return parent;
}

// An effect kept whole, standing on the clip's ticks [start, start + duration).
inline StoredEffectPtr storedEffect(const std::string& name, VelaTime start, VelaTime duration) {
    StoredEffect::Fields fields;
    fields.effectName = name;
    fields.start = start;
    fields.duration = duration;
    return StoredEffect::create(fields);
}

inline boost::shared_ptr<Parameter<double>> opacityOf(const MediaPtr& clip) {
    return boost::dynamic_pointer_cast<VisualMedia>(clip)->opacity();
}

// All an edit may change: each clip's timing state, and a line per clip,
// transition and track (which a failure prints).
struct Snapshot {
    std::vector<MediaState> states;
    std::vector<std::string> lines;
    bool operator==(const Snapshot& o) const { return states == o.states && lines == o.lines; }
};
inline void PrintTo(const Snapshot& s, std::ostream* out) {
    for (const std::string& line : s.lines) *out << "\n    " << line;
}

class EditTest : public ::testing::Test {
protected:
    ProjectPtr project = Project::create(30, 1);
    boost::shared_ptr<GenericMixer> mixer = project->newMixer("main");
    std::vector<boost::shared_ptr<GenericTrack>> tracks;
    boost::shared_ptr<GenericTrack> track = newTrack();
    std::vector<MediaPtr> clips;
    std::vector<TransitionPtr> transitions;

    boost::shared_ptr<GenericTrack> newTrack() {
        tracks.push_back(project->timeline()->newTrack());
        project->timeline()->addTrack(mixer, tracks.back());
        return tracks.back();
    }
    MediaPtr clip(VelaTime duration) {
        clips.push_back(PlaceholderMedia::create(project->token(), project->editRateToken(), 0, duration));
        return clips.back();
    }
    MediaPtr slice(const SafeRational& mediaStart, const SafeRational& mediaDuration,
                   const SafeRational& scalar = 1) {
        clips.push_back(PlaceholderMedia::createFromMediaRange(project->token(), project->editRateToken(), 0,
                                                               mediaStart, mediaDuration, scalar));
        return clips.back();
    }
    TransitionPtr transition() {
        transitions.emplace_back(new Transition("t" + std::to_string(transitions.size()), 2));
        return transitions.back();
    }
    MediaPtr place(VelaTime start, VelaTime duration) {
        const MediaPtr media = clip(duration);
        EXPECT_TRUE(project->execute(AddMediaCmd::create(track, media, start)));
        return media;
    }
    std::vector<VelaTime> starts() const {
        std::vector<VelaTime> result;
        for (const MediaPtr& media : track->medias()) result.push_back(media->startTime());
        return result;
    }
    size_t steps() const { return project->commandHistory()->undoStack().size(); }

    Snapshot snapshot() const {
        Snapshot shot;
        std::vector<std::string>& lines = shot.lines;
        for (const MediaPtr& media : clips) {
            const MediaState s = media->state();
            shot.states.push_back(s);
            std::ostringstream out, curve;
            XMLOptions options(curve);
            opacityOf(media)->toJSON(options, 0, "opacity");
            out << "[" << s.start << ", +" << s.duration << ") media " << s.mediaStart << "+"
                << s.mediaDuration << " x" << s.scalar << " in " << s.minMediaStart << ".." << s.maxMediaEnd
                << " offset " << s.hasStartOffset << s.startOffset << " track "
                << indexIn(tracks, parentOf(media)) << " transitions "
                << indexIn(transitions, media->leftTransition()) << "|"
                << indexIn(transitions, media->rightTransition()) << " metadata";
            for (const auto& entry : media->metaDataCopy()) out << " " << entry.first << "=" << entry.second;
            lines.push_back(out.str() + " " + curve.str());
        }
        for (const TransitionPtr& t : transitions)
            lines.push_back(indexIn(clips, t->leftMedia()) + ">" + indexIn(clips, t->rightMedia()));
        for (const auto& each : tracks) {
            std::ostringstream out;
            for (const MediaPtr& media : each->medias()) out << indexIn(clips, media) << " ";
            for (const auto& entry : each->metaDataCopy()) out << entry.first << "=" << entry.second << " ";
            out << each->attributeValue("videoHidden", false) << each->attributeValue("solo", false);
            lines.push_back(out.str());
        }
        return shot;
    }

    // Runs the command, then asks that undo gives back the state before it and redo the state after.
    void expectExactUndo(const CommandPtr& command) {
        const Snapshot before = snapshot();
        ASSERT_TRUE(project->execute(command)) << command->name();
        const Snapshot after = snapshot();
        ASSERT_TRUE(project->undo()) << command->name();
        EXPECT_EQ(snapshot(), before) << command->name();
        ASSERT_TRUE(project->redo()) << command->name();
        EXPECT_EQ(snapshot(), after) << command->name();
    }
    // The whole project as written: what undo must give back byte for byte.
    std::string document() const { return projectToJSONString(*project, true); }
    // As expectExactUndo, on the written project.
    void expectExactDocumentUndo(const CommandPtr& command) {
        const std::string before = document();
        ASSERT_TRUE(project->execute(command)) << command->name();
        const std::string after = document();
        EXPECT_NE(after, before) << command->name();
        ASSERT_TRUE(project->undo()) << command->name();
        EXPECT_EQ(document(), before) << command->name();
        ASSERT_TRUE(project->redo()) << command->name();
        EXPECT_EQ(document(), after) << command->name();
    }
    // The command is refused: the written project and the history stay as they were.
    void expectRefusedDocument(const CommandPtr& command) {
        const std::string before = document();
        const size_t stepsBefore = steps();
        EXPECT_FALSE(project->execute(command)) << command->name();
        EXPECT_EQ(document(), before) << command->name();
        EXPECT_EQ(steps(), stepsBefore) << command->name();
    }
    // The command is refused, changes nothing and leaves no step.
    void expectRefused(const CommandPtr& command) {
        const Snapshot before = snapshot();
        const size_t stepsBefore = steps();
        EXPECT_FALSE(project->execute(command)) << command->name();
        EXPECT_EQ(snapshot(), before) << command->name();
        EXPECT_EQ(steps(), stepsBefore) << command->name();
    }
};

} // namespace testing
} // namespace VelaMediaLib

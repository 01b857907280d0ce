// A seeded run of random edits through the project, valid and invalid, on
// three tracks of which one is magnetic. Some clips carry transitions, so
// adds, removes and moves join and part them; every clip has metadata and a
// keyframed parameter, edited too. After every step the model must hold its
// invariants, a refused edit must have changed nothing, and at the end
// undoing everything and redoing everything must give back the exact states.
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/ChangeTrackFlagCmd.h>
#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>
#include <VelaMediaLib/commands/edits/StretchCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <algorithm>
#include <gtest/gtest.h>
#include <limits>
#include <map>
#include <random>
#include <sstream>

using namespace VelaMediaLib;

namespace {

const char* const kNote = "comment";

// Sets (or removes) a clip's "comment" metadata; undo puts back the entry as it was.
class SetNoteCmd : public Command {
public:
    SetNoteCmd(const MediaPtr& clip, const std::string& text, bool remove)
        : clip_(clip), text_(text), remove_(remove) {}
    bool execute(CommandHandler*) override {
        had_ = clip_->hasMetaData(kNote);
        old_ = clip_->metaDataValue(kNote);
        if (remove_) return clip_->removeMetaData(kNote);
        clip_->addMetaData(kNote, text_);
        return true;
    }
    bool unexecute(CommandHandler*) override {
        if (had_)
            clip_->addMetaData(kNote, old_);
        else
            clip_->removeMetaData(kNote);
        return true;
    }

private:
    MediaPtr clip_;
    std::string text_;
    bool remove_;
    bool had_ = false;
    std::string old_;
};

// Sets a clip's opacity at a keyframe time, adding the keyframe if there is
// none; undo changes it back or removes it.
class SetOpacityCmd : public Command {
public:
    SetOpacityCmd(const MediaPtr& clip, int time, double value)
        : clip_(clip), time_(RationalTime(time)), value_(value) {}
    bool execute(CommandHandler*) override {
        const auto opacity = parameter();
        had_ = opacity->hasKeyFrameAtTime(time_);
        if (had_)
            old_ = opacity->changeKeyFrame(time_, value_);
        else
            opacity->addKeyFrame(time_, value_, RationalTime(0));
        return true;
    }
    bool unexecute(CommandHandler*) override {
        if (had_)
            parameter()->changeKeyFrame(time_, old_);
        else
            parameter()->removeKeyFrame(time_);
        return true;
    }

private:
    boost::shared_ptr<Parameter<double>> parameter() const {
        return boost::dynamic_pointer_cast<VisualMedia>(clip_)->opacity();
    }
    MediaPtr clip_;
    RationalTime time_;
    double value_;
    bool had_ = false;
    double old_ = 0;
};

// Everything an edit may change: each clip's timing, track, transitions,
// metadata and opacity curve, each transition's clips, each track's clips in
// order and its flags.
struct Snapshot {
    std::vector<MediaState> states;
    std::vector<const Track*> parents;
    std::vector<std::string> clipParts;
    std::vector<std::string> transitionLinks;
    std::vector<std::vector<const Media*>> trackClips;
    std::vector<std::map<std::string, std::string>> trackMetaData;
    std::vector<std::pair<bool, bool>> hiddenAndSolo;

    bool operator==(const Snapshot& o) const { return difference(o).empty(); }

    // What differs from another snapshot, for the failure message.
    std::string difference(const Snapshot& o) const {
        std::ostringstream out;
        for (size_t c = 0; c < states.size(); ++c) {
            if (states[c] != o.states[c])
                out << "clip " << c << " at [" << states[c].start << ", +" << states[c].duration << ") media "
                    << states[c].mediaStart.asDouble() << "+" << states[c].mediaDuration.asDouble() << " x"
                    << states[c].scalar.asDouble() << " vs [" << o.states[c].start << ", +"
                    << o.states[c].duration << ") media " << o.states[c].mediaStart.asDouble() << "+"
                    << o.states[c].mediaDuration.asDouble() << " x" << o.states[c].scalar.asDouble() << "; ";
            if (parents[c] != o.parents[c]) out << "clip " << c << " changed track; ";
            if (clipParts[c] != o.clipParts[c])
                out << "clip " << c << ": " << clipParts[c] << " vs " << o.clipParts[c] << "; ";
        }
        for (size_t t = 0; t < transitionLinks.size(); ++t)
            if (transitionLinks[t] != o.transitionLinks[t])
                out << "transition " << t << " links " << transitionLinks[t] << " vs " << o.transitionLinks[t]
                    << "; ";
        for (size_t t = 0; t < trackClips.size(); ++t) {
            if (trackClips[t] != o.trackClips[t]) out << "track " << t << " holds other clips; ";
            if (trackMetaData[t] != o.trackMetaData[t]) out << "track " << t << " metadata differs; ";
            if (hiddenAndSolo[t] != o.hiddenAndSolo[t]) out << "track " << t << " flags differ; ";
        }
        return out.str();
    }
};

class RandomEdits {
public:
    RandomEdits() : random_(2000) {
        const auto mixer = project_->newMixer("main");
        for (int i = 0; i < 3; ++i) {
            tracks_.push_back(project_->timeline()->newTrack());
            project_->timeline()->addTrack(mixer, tracks_.back());
        }
        const SafeRational scalars[] = {SafeRational(1), SafeRational(3, 2), SafeRational(2, 3),
                                        SafeRational(1, 3)};
        const long long mediaDurations[] = {10, 17, 30, 41};
        for (int i = 0; i < 14; ++i)
            clips_.push_back(PlaceholderMedia::createFromMediaRange(
                project_->token(), project_->editRateToken(), 0, SafeRational(i % 3), mediaDurations[i % 4],
                scalars[(i / 4) % 4]));
        for (int i = 0; i < 14; ++i) {
            clips_[i]->addMetaData(kNote, "clip " + std::to_string(i));
            opacityOf(clips_[i])->addKeyFrame(RationalTime(5), 0.5, RationalTime(0));
            // Set before placing, so that placing joins them with touching neighbours.
            if (i % 3 == 0) clips_[i]->setRightTransition(newTransition());
            if (i % 4 == 1) clips_[i]->setLeftTransition(newTransition());
        }
        VelaTime packed = 0; // the magnetic track starts without gaps
        for (int i = 0; i < 4; ++i) {
            tracks_[0]->addMedia(clips_[i], packed);
            packed += clips_[i]->duration();
        }
        VelaTime ends[2] = {0, 0}; // the others touch, but for a gap before the last
        for (int i = 4; i < 10; ++i) {
            VelaTime& end = ends[i % 2];
            if (i >= 8) end += 10;
            tracks_[1 + i % 2]->addMedia(clips_[i], end);
            end += clips_[i]->duration();
        }
        tracks_[0]->magneticAttribute()->setValue(true);
        project_->commandHistory()->runFollowUps();
    }

    Snapshot snapshot() const {
        Snapshot s;
        for (const MediaPtr& clip : clips_) {
            s.states.push_back(clip->state());
            const Track* parent = nullptr;
            clip->parentVisitor([&](const boost::shared_ptr<SubTimeline>& p) {
                parent = dynamic_cast<const Track*>(p.get());
            });
            s.parents.push_back(parent);
            s.clipParts.push_back(partsOf(clip));
        }
        for (const TransitionPtr& transition : transitions_)
            s.transitionLinks.push_back(indexOf(transition->leftMedia()) + ">" +
                                        indexOf(transition->rightMedia()));
        for (const auto& track : tracks_) {
            std::vector<const Media*> onTrack;
            for (const MediaPtr& clip : track->medias()) onTrack.push_back(clip.get());
            s.trackClips.push_back(onTrack);
            s.trackMetaData.push_back(track->metaDataCopy());
            s.hiddenAndSolo.emplace_back(track->attributeValue("videoHidden", false),
                                         track->attributeValue("solo", false));
        }
        return s;
    }

    // Empty when every invariant holds, else what broke.
    std::string violation() const {
        std::ostringstream out;
        for (size_t t = 0; t < tracks_.size(); ++t) {
            VelaTime expected = 0, end = std::numeric_limits<VelaTime>::min();
            for (const MediaPtr& clip : tracks_[t]->medias()) {
                const Range<VelaTime> range = clip->trackRange();
                if (range.start() < end)
                    out << "track " << t << ": clips overlap at " << range.start() << "; ";
                if (t == 0 && range.start() != expected)
                    out << "magnetic track: clip at " << range.start() << " where " << expected
                        << " was due; ";
                expected = end = range.end();
            }
        }
        for (size_t c = 0; c < clips_.size(); ++c) {
            const MediaState s = clips_[c]->state();
            const VelaTime rule = RationalUtil::toVelaTime(RationalUtil::Round(s.mediaDuration * s.scalar));
            if (s.mediaStart < s.minMediaStart || s.mediaEnd() > s.maxMediaEnd)
                out << "clip " << c << ": media " << s.mediaStart.asDouble() << " to "
                    << s.mediaEnd().asDouble() << " outside its limits " << s.minMediaStart.asDouble()
                    << " to " << s.maxMediaEnd.asDouble() << "; ";
            if (s.duration != rule)
                out << "clip " << c << ": duration " << s.duration << " but media "
                    << s.mediaDuration.asDouble() << " x scalar " << s.scalar.asDouble() << " rounds to "
                    << rule << "; ";
        }
        return out.str();
    }

    // One random edit, valid or not; returns what it was and whether it took effect.
    std::string step(bool& done) {
        std::ostringstream what;
        const CommandPtr command = randomCommand(what);
        done = project_->execute(command);
        return what.str();
    }

    ProjectPtr project() const { return project_; }

private:
    static boost::shared_ptr<Parameter<double>> opacityOf(const MediaPtr& clip) {
        return boost::dynamic_pointer_cast<VisualMedia>(clip)->opacity();
    }

    TransitionPtr newTransition() {
        transitions_.emplace_back(new Transition("t" + std::to_string(transitions_.size()), 2));
        return transitions_.back();
    }

    template <typename T>
    static std::string indexIn(const std::vector<boost::shared_ptr<T>>& all,
                               const boost::shared_ptr<T>& one) {
        if (!one) return "-";
        const auto found = std::find(all.begin(), all.end(), one);
        return found == all.end() ? "?" : std::to_string(found - all.begin());
    }
    std::string indexOf(const MediaPtr& clip) const { return indexIn(clips_, clip); }

    // A clip's transitions, metadata and opacity curve (as its document has it).
    std::string partsOf(const MediaPtr& clip) const {
        std::ostringstream out;
        out << "transitions " << indexIn(transitions_, clip->leftTransition()) << "|"
            << indexIn(transitions_, clip->rightTransition()) << ", note '" << clip->metaDataValue(kNote)
            << "' " << clip->hasMetaData(kNote) << ", opacity ";
        std::ostringstream curve;
        XMLOptions options(curve);
        opacityOf(clip)->toJSON(options, 0, "opacity");
        for (const char c : curve.str())
            if (c != '\n' && c != ' ') out << c;
        return out.str();
    }

    int pick(int below) { return std::uniform_int_distribution<int>(0, below - 1)(random_); }
    VelaTime delta(int reach) { return std::uniform_int_distribution<VelaTime>(-reach, reach)(random_); }

    // Mostly the clip's own track; sometimes another one (an invalid edit).
    TrackPtr trackFor(const MediaPtr& clip) {
        TrackPtr own;
        clip->parentVisitor(
            [&](const boost::shared_ptr<SubTimeline>& p) { own = boost::dynamic_pointer_cast<Track>(p); });
        return own && pick(8) != 0 ? own : tracks_[pick(3)];
    }

    CommandPtr randomCommand(std::ostringstream& what) {
        const int c = pick(int(clips_.size()));
        const MediaPtr clip = clips_[c];
        const TrackPtr track = trackFor(clip);
        const int t = int(std::find(tracks_.begin(), tracks_.end(), track) - tracks_.begin());
        switch (pick(11)) {
        case 0:
            if (!placed(clip)) {
                const VelaTime start = std::uniform_int_distribution<VelaTime>(-50, 250)(random_);
                what << "add clip " << c << " to track " << t << " at " << start;
                return AddMediaCmd::create(track, clip, start);
            }
            [[fallthrough]]; // a clip on a track is removed instead
        case 1:
            what << "remove clip " << c << " from track " << t;
            return RemoveMediaCmd::create(track, clip);
        case 2: {
            const VelaTime d = delta(60);
            what << "move clip " << c << " on track " << t << " by " << d;
            return MoveCmd::create(track, clip, d);
        }
        case 3: {
            const VelaTime d = delta(25);
            what << "trim start of clip " << c << " on track " << t << " by " << d;
            return TrimStartCmd::create(track, clip, d);
        }
        case 4: {
            const VelaTime d = delta(25);
            what << "trim end of clip " << c << " on track " << t << " by " << d;
            return TrimEndCmd::create(track, clip, d);
        }
        case 5: {
            const SafeRational scalars[] = {SafeRational(1),    SafeRational(1, 3),  SafeRational(1, 2),
                                            SafeRational(2, 3), SafeRational(3, 2),  SafeRational(2),
                                            SafeRational(3),    SafeRational(1, 200)};
            const SafeRational scalar = scalars[pick(8)];
            what << "stretch clip " << c << " to scalar " << scalar.asDouble();
            return StretchCmd::create(clip, scalar);
        }
        case 6: {
            const int flag = pick(3);
            const bool value = pick(2) == 1;
            what << "set flag " << flag << " of track " << t << " to " << value;
            return ChangeTrackFlagCmd::create(tracks_[t], ChangeTrackFlagCmd::Flag(flag), value);
        }
        case 7:
            what << "close gaps on track " << t;
            return CloseGapsOnTrackCmd::create(tracks_[t]);
        case 8: {
            const bool remove = pick(3) == 0;
            what << (remove ? "remove the note of clip " : "set the note of clip ") << c;
            return CommandPtr(new SetNoteCmd(clip, "note " + std::to_string(pick(100)), remove));
        }
        case 9: {
            const int time = pick(4) * 3;
            const double value = pick(11) / 10.0;
            what << "set the opacity of clip " << c << " at " << time << " to " << value;
            return CommandPtr(new SetOpacityCmd(clip, time, value));
        }
        default: {
            const VelaTime d = delta(300); // far: mostly collisions
            what << "long move of clip " << c << " on track " << t << " by " << d;
            return MoveCmd::create(track, clip, d);
        }
        }
    }

    static bool placed(const MediaPtr& clip) {
        bool placed = false;
        clip->parentVisitor([&](const boost::shared_ptr<SubTimeline>& p) { placed = bool(p); });
        return placed;
    }

    ProjectPtr project_ = Project::create(30, 1);
    std::vector<boost::shared_ptr<GenericTrack>> tracks_;
    std::vector<MediaPtr> clips_;
    std::vector<TransitionPtr> transitions_;
    std::mt19937 random_;
};

} // namespace

TEST(RandomEdits, InvariantsHoldAfterEveryStepAndUndoRedoAreExact) {
    RandomEdits run;
    const Snapshot initial = run.snapshot();
    ASSERT_EQ(run.violation(), "") << "before any edit";
    int applied = 0, refused = 0;
    for (int i = 0; i < 2000; ++i) {
        const Snapshot before = run.snapshot();
        bool done = false;
        const std::string what = run.step(done);
        (done ? applied : refused)++;
        ASSERT_EQ(run.violation(), "") << "step " << i << ": " << what;
        if (!done) {
            ASSERT_EQ(run.snapshot().difference(before), "")
                << "step " << i << " was refused but changed: " << what;
        }
        if (done && i % 50 == 0) { // one step back and forth again is exact
            const Snapshot after = run.snapshot();
            ASSERT_TRUE(run.project()->undo()) << "step " << i << ": undo refused after " << what;
            ASSERT_TRUE(run.project()->redo()) << "step " << i << ": redo refused after " << what;
            ASSERT_EQ(run.snapshot().difference(after), "")
                << "step " << i << ": undo and redo changed " << what;
        }
    }
    EXPECT_GT(applied, 400);
    EXPECT_GT(refused, 200);
    const Snapshot final = run.snapshot();
    ASSERT_TRUE(run.project()->commandHistory()->undoAll()) << "an undo was refused";
    EXPECT_EQ(run.snapshot().difference(initial), "")
        << "undoing everything did not give back the first state";
    ASSERT_TRUE(run.project()->commandHistory()->redoAll()) << "a redo was refused";
    EXPECT_EQ(run.snapshot().difference(final), "") << "redoing everything did not give back the last state";
}

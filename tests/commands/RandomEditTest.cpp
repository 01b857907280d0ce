// A seeded run of random edits through the project, valid and invalid, on
// three tracks of which one is magnetic. After every step the model must hold
// its invariants, a refused edit must have changed nothing, and at the end
// undoing everything and redoing everything must give back the exact states.
#include <VelaMediaLib/commands/AtomicEditCmd.h>
#include <VelaMediaLib/commands/ChangeTrackFlagCmd.h>
#include <VelaMediaLib/commands/CloseGapsOnTrackCmd.h>
#include <VelaMediaLib/commands/StretchCmd.h>
#include <VelaMediaLib/commands/TrimCmd.h>
#include <VelaMediaLib/model/InternalProject.h>
#include <VelaMediaLib/model/PlaceholderMedia.h>
#include <VelaMediaLib/time/RationalUtil.h>

#include <algorithm>
#include <gtest/gtest.h>
#include <limits>
#include <map>
#include <random>
#include <sstream>

using namespace VelaMediaLib;

namespace {

// Everything an edit may change: each clip's timing and track, each track's
// clips in order and its flags.
struct Snapshot {
    std::vector<MediaState> states;
    std::vector<const Track*> parents;
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
        }
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
        VelaTime packed = 0; // the magnetic track starts without gaps
        for (int i = 0; i < 4; ++i) {
            tracks_[0]->addMedia(clips_[i], packed);
            packed += clips_[i]->duration();
        }
        for (int i = 4; i < 10; ++i) tracks_[1 + i % 2]->addMedia(clips_[i], (i - 4) * 40);
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
        }
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
        switch (pick(9)) {
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

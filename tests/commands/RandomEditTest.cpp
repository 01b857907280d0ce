// A seeded run of random edits, valid and invalid, on three tracks (one
// magnetic), joining and parting transitions and editing clip metadata and a
// keyframed parameter too. After every step the model holds its invariants and
// a refused edit has changed nothing; undoing and redoing everything is exact.
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/ChangeTrackFlagCmd.h>
#include <VelaMediaLib/commands/edits/CloseGapsOnTrackCmd.h>
#include <VelaMediaLib/commands/edits/StretchCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <boost/make_shared.hpp>
#include <functional>
#include <limits>
#include <random>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

const char* const kNote = "comment";
using Undo = std::function<void()>;

// A host's own edit: `apply` does it and returns how to undo it, or nothing to refuse.
struct HostCmd : Command {
    explicit HostCmd(std::function<Undo()> a) : apply(std::move(a)) {}
    bool execute(CommandHandler*) override { return bool(undo = apply()); }
    bool unexecute(CommandHandler*) override { return undo(), true; }
    std::function<Undo()> apply;
    Undo undo;
};

// Sets (or removes) a clip's note; undo puts back the entry as it was.
CommandPtr setNote(const MediaPtr& clip, bool remove, const std::string& text) {
    return boost::make_shared<HostCmd>([=]() -> Undo {
        const bool had = clip->hasMetaData(kNote);
        const std::string old = clip->metaDataValue(kNote);
        if (remove && !clip->removeMetaData(kNote)) return {};
        if (!remove) clip->addMetaData(kNote, text);
        return [=] { had ? void(clip->addMetaData(kNote, old)) : void(clip->removeMetaData(kNote)); };
    });
}

// Sets the opacity at a keyframe time, adding the keyframe if there is none.
CommandPtr setOpacity(const MediaPtr& clip, const RationalTime& time, double value) {
    return boost::make_shared<HostCmd>([=]() -> Undo {
        const auto opacity = opacityOf(clip);
        if (!opacity->hasKeyFrameAtTime(time)) {
            opacity->addKeyFrame(time, value, RationalTime(0));
            return [=] { opacity->removeKeyFrame(time); };
        }
        const double old = opacity->changeKeyFrame(time, value);
        return [=] { opacity->changeKeyFrame(time, old); };
    });
}

class RandomEdits : public EditTest {
protected:
    RandomEdits() {
        newTrack();
        newTrack();
        const SafeRational scalars[] = {1, SafeRational(3, 2), SafeRational(2, 3), SafeRational(1, 3)};
        VelaTime ends[3] = {0, 0, 0};
        for (int i = 0; i < 14; ++i) {
            const long long mediaDurations[] = {10, 17, 30, 41};
            const MediaPtr clip = slice(i % 3, mediaDurations[i % 4], scalars[i / 4 % 4]);
            clip->addMetaData(kNote, "clip " + std::to_string(i));
            opacityOf(clip)->addKeyFrame(RationalTime(5), 0.5, RationalTime(0));
            // Set before placing, so that placing joins them with touching neighbours.
            if (i % 3 == 0) clip->setRightTransition(transition());
            if (i % 4 == 1) clip->setLeftTransition(transition());
            if (i >= 10) continue; // loose clips, for adds
            // The magnetic track starts packed; the others touch, but for a gap before the last.
            const int t = i < 4 ? 0 : 1 + i % 2;
            if (i >= 8) ends[t] += 10;
            tracks[t]->addMedia(clip, ends[t]);
            ends[t] += clip->duration();
        }
        tracks[0]->magneticAttribute()->setValue(true);
        project->commandHistory()->runFollowUps();
    }

    // Empty when every invariant holds, else what broke.
    std::string violation() const {
        std::ostringstream out;
        for (size_t t = 0; t < tracks.size(); ++t) {
            VelaTime end = t == 0 ? 0 : std::numeric_limits<VelaTime>::min();
            for (const MediaPtr& clip : tracks[t]->medias()) {
                const Range<VelaTime> range = clip->trackRange();
                if (range.start() < end || (t == 0 && range.start() != end))
                    out << "track " << t << ": clip at " << range.start() << " after an end at " << end
                        << "; ";
                end = range.end();
            }
        }
        for (size_t c = 0; c < clips.size(); ++c) {
            const MediaState s = clips[c]->state();
            if (s.mediaStart < s.minMediaStart || s.mediaEnd() > s.maxMediaEnd)
                out << "clip " << c << ": media outside its limits; ";
            if (s.duration != RationalUtil::toVelaTime(RationalUtil::Round(s.mediaDuration * s.scalar)))
                out << "clip " << c << ": duration " << s.duration << " breaks the duration rule; ";
        }
        return out.str();
    }

    // One random edit, valid or not; `what` says which (kind, clip, track, amount).
    CommandPtr randomCommand(std::string& what) {
        const int c = pick(int(clips.size()));
        const MediaPtr clip = clips[c];
        // Mostly the clip's own track; sometimes another one (an invalid edit).
        const auto own = parentOf(clip), target = own && pick(8) ? own : tracks[pick(3)];
        const int t = int(std::find(tracks.begin(), tracks.end(), target) - tracks.begin());
        const int kind = pick(11);
        long long n = 0;
        const auto between = [&](VelaTime low, VelaTime high) {
            return n = std::uniform_int_distribution<VelaTime>(low, high)(random_);
        };
        const SafeRational scalars[] = {
            1, SafeRational(1, 3),  SafeRational(1, 2), SafeRational(2, 3), SafeRational(3, 2), 2,
            3, SafeRational(1, 200)};
        const CommandPtr command = [&]() -> CommandPtr {
            switch (kind) {
            case 0:
                if (!own) return AddMediaCmd::create(target, clip, between(-50, 250));
                [[fallthrough]]; // a clip on a track is removed instead
            case 1:
                return RemoveMediaCmd::create(target, clip);
            case 2:
                return MoveCmd::create(target, clip, between(-60, 60));
            case 3:
                return TrimStartCmd::create(target, clip, between(-25, 25));
            case 4:
                return TrimEndCmd::create(target, clip, between(-25, 25));
            case 5:
                return StretchCmd::create(clip, scalars[n = pick(8)]);
            case 6:
                n = pick(3);
                return ChangeTrackFlagCmd::create(tracks[t], ChangeTrackFlagCmd::Flag(n), pick(2));
            case 7:
                return CloseGapsOnTrackCmd::create(tracks[t]);
            case 8: {
                const bool remove = pick(3) == 0;
                return setNote(clip, remove, "note " + std::to_string(n = pick(100)));
            }
            case 9: {
                const RationalTime time(pick(4) * 3);
                return setOpacity(clip, time, (n = pick(11)) / 10.0);
            }
            default:
                return MoveCmd::create(target, clip, between(-300, 300)); // far: mostly collisions
            }
        }();
        what = "edit " + std::to_string(kind) + " of clip " + std::to_string(c) + " on track " +
               std::to_string(t) + ": " + std::to_string(n);
        return command;
    }

private:
    int pick(int below) { return std::uniform_int_distribution<int>(0, below - 1)(random_); }

    std::mt19937 random_{2000};
};

} // namespace

TEST_F(RandomEdits, InvariantsHoldAfterEveryStepAndUndoRedoAreExact) {
    const auto initial = snapshot();
    ASSERT_EQ(violation(), "") << "before any edit";
    int applied = 0;
    for (int i = 0; i < 2000; ++i) {
        const auto before = snapshot();
        std::string what;
        const bool done = project->execute(randomCommand(what));
        applied += done;
        ASSERT_EQ(violation(), "") << "step " << i << ": " << what;
        if (!done) {
            ASSERT_EQ(snapshot(), before) << "step " << i << " was refused but changed: " << what;
        }
        if (done && i % 50 == 0) { // one step back and forth again is exact
            const auto after = snapshot();
            ASSERT_TRUE(project->undo() && project->redo()) << "step " << i << ": " << what;
            ASSERT_EQ(snapshot(), after) << "step " << i << ": undo and redo changed " << what;
        }
    }
    EXPECT_GT(applied, 400);
    EXPECT_LT(applied, 1800);
    const auto final = snapshot();
    ASSERT_TRUE(project->commandHistory()->undoAll());
    EXPECT_EQ(snapshot(), initial) << "undoing everything did not give back the first state";
    ASSERT_TRUE(project->commandHistory()->redoAll());
    EXPECT_EQ(snapshot(), final) << "redoing everything did not give back the last state";
}

// A seeded run of random edits through the project, valid and invalid, on
// three tracks of which one is magnetic. Some clips carry transitions, so
// adds, removes and moves join and part them; every clip has metadata and a
// keyframed parameter, edited too. After every step the model must hold its
// invariants, a refused edit must have changed nothing, and at the end
// undoing everything and redoing everything must give back the exact states.
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

    // One random edit, valid or not, and what it was.
    CommandPtr randomCommand(std::string& what) {
        const int c = pick(int(clips.size()));
        const MediaPtr clip = clips[c];
        // Mostly the clip's own track; sometimes another one (an invalid edit).
        const auto own = parentOf(clip), target = own && pick(8) ? own : tracks[pick(3)];
        const int t = int(std::find(tracks.begin(), tracks.end(), target) - tracks.begin());
        const auto say = [&](const char* edit, long long n) {
            what = std::string(edit) + " clip " + std::to_string(c) + " track " + std::to_string(t) + " " +
                   std::to_string(n);
        };
        const auto between = [&](VelaTime low, VelaTime high) {
            return std::uniform_int_distribution<VelaTime>(low, high)(random_);
        };
        switch (const int kind = pick(11)) {
        case 0:
            if (!own) {
                const VelaTime start = between(-50, 250);
                return say("add", start), AddMediaCmd::create(target, clip, start);
            }
            [[fallthrough]]; // a clip on a track is removed instead
        case 1:
            return say("remove", 0), RemoveMediaCmd::create(target, clip);
        case 2:
        case 10: {
            const VelaTime d = kind == 2 ? between(-60, 60) : between(-300, 300); // far: mostly collisions
            return say("move", d), MoveCmd::create(target, clip, d);
        }
        case 3: {
            const VelaTime d = between(-25, 25);
            return say("trim start", d), TrimStartCmd::create(target, clip, d);
        }
        case 4: {
            const VelaTime d = between(-25, 25);
            return say("trim end", d), TrimEndCmd::create(target, clip, d);
        }
        case 5: {
            const SafeRational scalars[] = {
                1, SafeRational(1, 3),  SafeRational(1, 2), SafeRational(2, 3), SafeRational(3, 2), 2,
                3, SafeRational(1, 200)};
            const int s = pick(8);
            return say("stretch (scalar index)", s), StretchCmd::create(clip, scalars[s]);
        }
        case 6: {
            const int flag = pick(3), value = pick(2);
            say(value ? "set flag (on)" : "set flag (off)", flag);
            return ChangeTrackFlagCmd::create(tracks[t], ChangeTrackFlagCmd::Flag(flag), value == 1);
        }
        case 7:
            return say("close gaps beside", 0), CloseGapsOnTrackCmd::create(tracks[t]);
        case 8: {
            const bool remove = pick(3) == 0;
            const std::string text = "note " + std::to_string(pick(100));
            say(remove ? "remove the note of" : "set the note of", 0);
            return boost::make_shared<HostCmd>([=]() -> Undo {
                const bool had = clip->hasMetaData(kNote);
                const std::string old = clip->metaDataValue(kNote);
                if (remove && !clip->removeMetaData(kNote)) return {};
                if (!remove) clip->addMetaData(kNote, text);
                return [=] {
                    if (had)
                        clip->addMetaData(kNote, old);
                    else
                        clip->removeMetaData(kNote);
                };
            });
        }
        case 9: {
            // Sets the opacity at a keyframe time, adding the keyframe if there is none.
            const RationalTime time(pick(4) * 3);
            const int tenths = pick(11);
            const double value = tenths / 10.0;
            say("set the opacity (tenths) of", tenths);
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
        }
        return nullptr;
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

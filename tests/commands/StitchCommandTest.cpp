// Stitching touching clips of one source into a stitched media and back: the
// round trip gives the track back, every command undoes and redoes exactly,
// and refusals change nothing.
#include "../JsonTestSupport.h"
#include "../model/SourceTestSupport.h"
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/StitchMediaCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/commands/edits/UnstitchAllCmd.h>
#include <VelaMediaLib/commands/edits/UnstitchMediaCmd.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/project/SourceBin.h>
#include <VelaMediaLib/model/source/Source.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class StitchCommandTest : public EditTest {
protected:
    // P [0, 10), then A, B, C touching from 10 to 55 (B at half speed), then Q
    // [55, 65); transitions between P and A, B and C, C and Q.
    void lineUp() {
        p = place(0, 10);
        a = clip(10);
        b = slice(100, 15, 2);
        c = clip(5);
        track->addMedia(a, 10);
        track->addMedia(b, 20);
        track->addMedia(c, 50);
        q = place(55, 10);
        joined(p, a);
        joined(b, c);
        joined(c, q);
    }
    void joined(const MediaPtr& left, const MediaPtr& right) {
        const TransitionPtr t = transition();
        left->setRightTransition(t);
        right->setLeftTransition(t);
    }
    // The source time each clip of the track plays at each tick of the range.
    std::vector<std::string> playing(VelaTime from, VelaTime to) const {
        std::vector<std::string> lines;
        for (VelaTime tick = from; tick < to; ++tick) {
            const MediaPtr media = track->mediaAtTime(tick).second ? track->mediaAtTime(tick).second
                                                                   : track->mediaAtTime(tick).first;
            std::ostringstream out;
            if (const auto stitched = boost::dynamic_pointer_cast<StitchedMedia>(media)) {
                const SafeRational inside(tick - stitched->startTime());
                out << indexIn(clips, stitched->mediaAndSubTimeForParametricTime(inside).first) << "@"
                    << stitched->toSubMediaSourceTime(inside);
            } else {
                const MediaState s = media->state();
                out << indexIn(clips, media) << "@" << s.mediaStart + SafeRational(tick - s.start) / s.scalar;
            }
            lines.push_back(out.str());
        }
        return lines;
    }

    MediaPtr p, a, b, c, q;
};

TEST_F(StitchCommandTest, StitchingThenUnstitchingGivesTheTrackBack) {
    lineUp();
    const Snapshot original = snapshot();
    const auto stitch = StitchMediaCmd::create(track, {c, a, b}); // any order
    expectExactUndo(stitch);
    const auto stitched = stitch->stitchedMedia();
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{p, stitched, q}));
    EXPECT_EQ(stitched->trackRange(), Range<VelaTime>(10, 45));
    EXPECT_EQ(stitched->medias(), (std::vector<MediaPtr>{a, b, c}));
    EXPECT_EQ(stitched->leftTransition(), transitions[0]);
    EXPECT_EQ(transitions[0]->rightMedia(), stitched);
    EXPECT_EQ(stitched->rightTransition(), transitions[2]);
    EXPECT_EQ(a->leftTransition(), TransitionPtr());
    EXPECT_EQ(b->rightTransition(), transitions[1]); // inside, between parts, it stays

    expectExactUndo(UnstitchMediaCmd::create(track, stitched));
    EXPECT_EQ(snapshot(), original);
    EXPECT_FALSE(stitched->parent());
    EXPECT_EQ(steps(), 4u);
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{p, stitched, q}));
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(snapshot(), original);
}

TEST_F(StitchCommandTest, UnstitchingPutsEachPartWhereItPlayed) {
    lineUp();
    ASSERT_TRUE(project->execute(StitchMediaCmd::create(track, {a, b, c})));
    const auto stitched = boost::dynamic_pointer_cast<StitchedMedia>(track->mediaAtTime(20).first);
    ASSERT_TRUE(stitched);
    stitched->trimStart(15); // into B, half a tick of its media
    stitched->trimEnd(2);    // C cut at its end
    const std::vector<std::string> before = playing(25, 53);
    expectExactUndo(UnstitchMediaCmd::create(track, stitched));
    EXPECT_EQ(playing(25, 53), before);
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{p, b, c, q}));
    EXPECT_FALSE(a->parent()); // played no more: left out
    EXPECT_EQ(b->trackRange(), Range<VelaTime>(25, 25));
    EXPECT_EQ(b->state().mediaStart, SafeRational(205, 2));
    EXPECT_EQ(c->trackRange(), Range<VelaTime>(50, 3));
    EXPECT_EQ(c->rightTransition(), transitions[2]); // kept as the trimmed stitched media kept it
}

TEST_F(StitchCommandTest, RefusalsChangeNothing) {
    lineUp();
    const Snapshot before = snapshot();
    EXPECT_EQ(thrown<VelaMediaLibException>([&] {
                  StitchMediaCmd::create(track, {p, q});
              }),
              "only touching clips can be stitched");
    EXPECT_THROW(StitchMediaCmd::create(track, {a}), AddRemoveException);
    EXPECT_THROW(StitchMediaCmd::create(track, {a, a}), AddRemoveException);
    const MediaPtr loose = PlaceholderMedia::create(project->token(), project->editRateToken(), 20, 10);
    EXPECT_THROW(StitchMediaCmd::create(track, {a, loose}), AddRemoveException); // not on the track
    EXPECT_THROW(StitchMediaCmd::create(TrackPtr(), {a, b}), AddRemoveException);
    EXPECT_EQ(thrown<TypeException>([&] { UnstitchMediaCmd::create(track, a); }),
              "only a stitched media can be unstitched");
    expectRefused(UnstitchAllCmd::create(track)); // nothing to unstitch

    // A clip that moved away after the command was made: refused when run.
    const auto stitch = StitchMediaCmd::create(track, {a, b});
    track->removeMedia(a);
    const Snapshot moved = snapshot();
    EXPECT_THROW(project->execute(stitch), AddRemoveException);
    EXPECT_EQ(snapshot(), moved);
    EXPECT_EQ(steps(), 2u); // only the two placements of the line-up
    track->addMedia(a, 10);
    EXPECT_EQ(snapshot(), before);

    // A stitched media taken off its track meanwhile cannot be unstitched there.
    ASSERT_TRUE(project->execute(stitch));
    const auto unstitch = UnstitchMediaCmd::create(track, stitch->stitchedMedia());
    track->removeMedia(stitch->stitchedMedia());
    expectRefused(unstitch);
}

TEST_F(StitchCommandTest, UnstitchAllUndoesAsOneStep) {
    lineUp();
    const Snapshot original = snapshot();
    ASSERT_TRUE(project->execute(StitchMediaCmd::create(track, {p, a})));
    ASSERT_TRUE(project->execute(StitchMediaCmd::create(track, {b, c, q})));
    EXPECT_EQ(track->numMedias(), 2u);
    expectExactUndo(UnstitchAllCmd::create(track));
    EXPECT_EQ(snapshot(), original);
    EXPECT_EQ(steps(), 5u);
}

class SourceStitchTest : public StitchCommandTest {
protected:
    SourceStitchTest() {
        for (const char* path : {"a.mov", "b.mov"})
            loader->set(path, {stream(TrackType::Video, 0, 3000, 30)});
        project->sourceBin()->setFileSystem(files);
    }
    MediaPtr shot(const SourcePtr& source, VelaTime start, VelaTime mediaStart) {
        clips.push_back(VMFile::create(source, 0, start, SafeRational(mediaStart), SafeRational(10)));
        track->addMedia(clips.back(), start);
        return clips.back();
    }

    RegisteredTableLoader loader;
    boost::shared_ptr<FakeFileSystem> files = boost::make_shared<FakeFileSystem>();
};

TEST_F(SourceStitchTest, OnlyClipsOfOneSourceStitch) {
    const SourcePtr first = project->sourceBin()->loadFile("a.mov");
    const SourcePtr second = project->sourceBin()->loadFile("b.mov");
    const MediaPtr x = shot(first, 0, 100), y = shot(first, 10, 500), z = shot(second, 20, 0);
    const Snapshot before = snapshot();
    EXPECT_EQ(thrown<VelaMediaLibException>([&] {
                  StitchMediaCmd::create(track, {x, y, z});
              }),
              "cannot stitch clips of different sources");
    EXPECT_EQ(snapshot(), before);

    const auto stitch = StitchMediaCmd::create(track, {x, y});
    expectExactUndo(stitch);
    EXPECT_EQ(stitch->stitchedMedia()->source(), first);
    EXPECT_EQ(stitch->stitchedMedia()->toSubMediaSourceTime(12), SafeRational(502));
}

} // namespace

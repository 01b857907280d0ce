// Composites inside composites: no clip may hold itself, walks and the
// timeline-wide query reach every depth, refused growth changes nothing.
#include "MediaTestSupport.h"

#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/media/RationalMediaEditor.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

#include <algorithm>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class CompositeNestingTest : public ModelTest {
protected:
    TimelinePtr timeline = Timeline::create(project, 1280, 720);
    boost::shared_ptr<GenericMixer> main = timeline->newMixer("main");
    boost::shared_ptr<GenericTrack> newTop() {
        const auto t = timeline->newTrack();
        timeline->addTrack(main, t);
        return t;
    }
    MediaPtr leaf(VelaTime duration) { return PlaceholderMedia::create(project, rate, 0, duration); }
    MediaPtr visualPart(VelaTime d) {
        return boost::make_shared<TestClip>(project, rate, timing(0, d, 0, d, 1, 0, 1000),
                                            MediaImpl::Temporal);
    }
    boost::shared_ptr<GenericMixer> mixerOf(const std::vector<std::pair<MediaPtr, VelaTime>>& clips) {
        const auto mixer = GenericMixer::create(project);
        const auto track = GenericTrack::create(project);
        mixer->addTrack(track);
        for (const auto& clip : clips) track->addMedia(clip.first, clip.second);
        return mixer;
    }
    static bool contains(const std::vector<MediaPtr>& all, const MediaPtr& one) {
        return std::find(all.begin(), all.end(), one) != all.end();
    }
};

// A stitched media accepts a stitched media that holds it: a cycle of owners.
TEST_F(CompositeNestingTest, StitchedRefusesAStitchedThatHoldsIt) {
    boost::weak_ptr<StitchedMedia> watch1, watch2;
    {
        const auto inner = StitchedMedia::create({leaf(10)}, 0);
        const auto outer = StitchedMedia::create({inner}, 0);
        watch1 = inner;
        watch2 = outer;
        EXPECT_ANY_THROW(inner->addMedia(outer));
    }
    EXPECT_TRUE(watch1.expired());
    EXPECT_TRUE(watch2.expired());
}

// A group placed inside a group that a stitched clip of its own holds.
TEST_F(CompositeNestingTest, AGroupCannotEnterItselfThroughAStitchedClip) {
    boost::weak_ptr<Group> watch;
    {
        const GroupPtr inner = Group::create(project, rate, mixerOf({{leaf(10), 0}}), 0);
        const auto stitched = StitchedMedia::create({inner}, 0);
        const GroupPtr outer = Group::create(project, rate, mixerOf({{stitched, 0}}), 0);
        watch = outer;
        EXPECT_ANY_THROW(
            boost::dynamic_pointer_cast<GenericTrack>(inner->mixer()->trackAtIndex(0))->addMedia(outer, 100));
    }
    EXPECT_TRUE(watch.expired());
}

// A stitched run of video-only parts makes a group "have audio".
TEST_F(CompositeNestingTest, AGroupOfSilentStitchedPartsHasNoAudio) {
    const auto stitched = StitchedMedia::create({visualPart(10), visualPart(10)}, 0);
    const GroupPtr group = Group::create(project, rate, mixerOf({{stitched, 0}}), 0);
    EXPECT_FALSE(group->hasAudio());
    EXPECT_EQ(group->numChannels(), 0);
    EXPECT_FALSE(group->mixer()->hasAudio());
}

// Walks reach clips of a group that is a part of a stitched clip.
TEST_F(CompositeNestingTest, WalksReachIntoGroupsThatAreStitchedParts) {
    const MediaPtr deep = leaf(10);
    const GroupPtr inner = Group::create(project, rate, mixerOf({{deep, 0}}), 0);
    const auto stitched =
        StitchedMedia::create({inner, Group::create(project, rate, mixerOf({{leaf(5), 0}}), 0)}, 0);
    const auto top = newTop();
    top->addMedia(stitched, 0);
    EXPECT_TRUE(contains(top->allMedias(), inner));
    EXPECT_TRUE(contains(top->allMedias(), deep));
    const GroupPtr outer = Group::create(
        project, rate,
        mixerOf({{StitchedMedia::create({Group::create(project, rate, mixerOf({{leaf(3), 0}}), 0)}, 0), 0}}),
        0);
    (void)outer;
}

// The timeline-wide query answers the part of a stitched clip inside a group,
// but not the part of the same kind of clip standing on a timeline track.
TEST_F(CompositeNestingTest, AllMediasAtTimeTreatsStitchedClipsAlikeAtEveryDepth) {
    const MediaPtr topPart = leaf(10), innerPart = leaf(10);
    const auto topStitched = StitchedMedia::create({topPart, leaf(10)}, 0);
    const auto innerStitched = StitchedMedia::create({innerPart, leaf(10)}, 0);
    newTop()->addMedia(topStitched, 0);
    newTop()->addMedia(Group::create(project, rate, mixerOf({{innerStitched, 0}}), 0), 0);
    const std::vector<MediaPtr> found = timeline->allMediasAtTime(5);
    EXPECT_TRUE(contains(found, innerPart));
    EXPECT_TRUE(contains(found, topPart)) << "top-level stitched part missing";
}

// A refused addition (growing onto a neighbour) leaves the stitched media's
// whole state (limits included) as it was.
TEST_F(CompositeNestingTest, RefusedGrowthLeavesTheStitchedStateWhole) {
    const auto top = newTop();
    const MediaPtr first = visualPart(10);
    const auto stitched = StitchedMedia::create({first}, 0);
    // play 5 ticks beyond the part: extended end
    ASSERT_NO_THROW(stitched->trimEnd(-5));
    top->addMedia(stitched, 0);
    top->addMedia(leaf(10), 15); // touching neighbour
    const MediaState before = stitched->state();
    const MediaState firstBefore = first->state();
    const MediaPtr more = visualPart(10);
    EXPECT_ANY_THROW(stitched->addMedia(more));
    EXPECT_EQ(stitched->state(), before);
    EXPECT_EQ(first->state(), firstBefore);
    EXPECT_EQ(stitched->medias().size(), 1u);
    EXPECT_FALSE(more->parent());
}

TEST_F(CompositeNestingTest, RefusedGrowthLeavesParsedLimitsAlone) {
    const auto top = newTop();
    const auto stitched = StitchedMedia::create(project, rate, timing(0, 15, 0, 15, 1, 0, 20));
    const MediaPtr first = visualPart(10);
    stitched->addMediaWhileParsing(first);
    top->addMedia(stitched, 0);
    top->addMedia(leaf(10), 15);
    const MediaState before = stitched->state();
    EXPECT_ANY_THROW(stitched->addMedia(visualPart(10)));
    EXPECT_EQ(stitched->state().maxMediaEnd, before.maxMediaEnd);
    EXPECT_EQ(stitched->state(), before);
}

TEST_F(CompositeNestingTest, AllMediasAtTimeTreatsUnifiedClipsAlikeAtEveryDepth) {
    const auto v1 = boost::dynamic_pointer_cast<VisualMedia>(visualPart(10)),
               v2 = boost::dynamic_pointer_cast<VisualMedia>(visualPart(10));
    const auto a1 = boost::make_shared<TestAudioClip>(project, timing(0, 10, 0, 10, 1, 0, 10));
    const auto a2 = boost::make_shared<TestAudioClip>(project, timing(0, 10, 0, 10, 1, 0, 10));
    newTop()->addMedia(UnifiedMedia::create(v1, a1), 0);
    newTop()->addMedia(
        Group::create(project, rate, mixerOf({{MediaPtr(UnifiedMedia::create(v2, a2)), 0}}), 0), 0);
    const std::vector<MediaPtr> found = timeline->allMediasAtTime(5);
    EXPECT_EQ(contains(found, MediaPtr(v1)), contains(found, MediaPtr(v2)));
}

// Every clip the exact query reports answers the same parametric time through its own converters.
TEST_F(CompositeNestingTest, ReportedTimesAgreeWithEachClipsConverters) {
    const MediaPtr p1 = visualPart(10), p2 = visualPart(10);
    const auto stitched = StitchedMedia::create({p1, p2}, 0);
    stitched->trimStart(3);
    const GroupPtr group =
        Group::createFromMediaRange(project, rate, mixerOf({{stitched, 5}}), 100, 4, 18, SafeRational(2));
    const auto top = newTop();
    top->addMedia(group, 100);
    int checked = 0;
    for (int half = 2 * 95; half < 2 * 150; ++half) {
        const SafeRational g(half, 2);
        if (g.denominator() != 1) continue;
        for (const Track::MediaAtTime& at : timeline->allMediasAndTimesAtTime(g.asVelaTime())) {
            ++checked;
            EXPECT_EQ(at.media->fromGlobalToParametricTime(RationalTime(g)).asRational(), at.parametricTime)
                << "global " << g;
        }
    }
    EXPECT_GT(checked, 30);
}

} // namespace

// Groups: clips made of a mixer of their own, standing on a track as one clip.
#include "MediaTestSupport.h"

#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

#include <stdexcept>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class GroupTest : public ModelTest {
protected:
    TimelinePtr timeline = Timeline::create(project, 1280, 720);
    boost::shared_ptr<GenericTrack> top = topTrack();

    boost::shared_ptr<GenericTrack> topTrack() {
        const auto track = timeline->newTrack();
        timeline->addTrack(timeline->newMixer("main"), track);
        return track;
    }
    MediaPtr leaf(VelaTime duration, int width = 640, int height = 480) {
        return PlaceholderMedia::create(project, rate, 0, duration, width, height);
    }
    // A mixer of one track holding the clips at their starts.
    boost::shared_ptr<GenericMixer> mixerOf(const std::vector<std::pair<MediaPtr, VelaTime>>& clips) {
        const auto mixer = GenericMixer::create(project);
        const auto track = GenericTrack::create(project);
        mixer->addTrack(track);
        for (const auto& clip : clips) track->addMedia(clip.first, clip.second);
        return mixer;
    }
    GroupPtr groupOf(const MediaPtr& clip, VelaTime at, VelaTime start) {
        return Group::create(project, rate, mixerOf({{clip, at}}), start);
    }
    static std::vector<MediaPtr> mediasOf(const std::vector<Track::MediaAtTime>& found) {
        std::vector<MediaPtr> clips;
        for (const Track::MediaAtTime& each : found) clips.push_back(each.media);
        return clips;
    }
};

// The group's window over its children moves; the children stay in its inner time.
TEST_F(GroupTest, TrimsMoveTheWindowAndRefuseWithTheGroupsMessages) {
    const MediaPtr child = leaf(100);
    const GroupPtr group = groupOf(child, 0, 50);
    top->addMedia(group, 50);
    group->trimEnd(10);
    EXPECT_EQ(group->startTime(), 50);
    EXPECT_EQ(group->state().mediaStart, SafeRational(0));
    EXPECT_EQ(group->duration(), 90);
    EXPECT_EQ(group->state().mediaDuration, SafeRational(90));

    top->trimStart(group, 20); // through the track, too
    EXPECT_EQ(group->trackRange(), Range<VelaTime>(70, 70));
    EXPECT_EQ(group->state().mediaStart, SafeRational(20));
    EXPECT_EQ(child->fromParametricToGlobalTime(RationalTime(30)).asRational(), SafeRational(80));

    expectRefused<InvalidTrimRangeException>(*group, "invalid trimEnd for Group.",
                                             [&] { group->trimEnd(-11); });
    expectRefused<InvalidTrimRangeException>(*group, "invalid trimStart for Group.",
                                             [&] { top->trimStart(group, -21); });
    expectRefused<InvalidTrimRangeException>(*group, "invalid trimStart for Group.",
                                             [&] { group->trimStart(70); });
    group->trimEnd(-10); // back to the end of its content
    EXPECT_EQ(group->endTime(), 150);
}

TEST_F(GroupTest, AMixerBelongsToATimelineOrAGroupNeverBoth) {
    const GroupPtr group = groupOf(leaf(10), 0, 0);
    expectThrows<VelaMediaLibException>("Cannot set parent timeline on a mixer that has a parent group",
                                        [&] { timeline->addMixer("stolen", group->mixer()); });
    EXPECT_EQ(timeline->mixerNames(), std::vector<std::string>{"main"});
    EXPECT_EQ(group->mixer()->parentGroup(), group);
    EXPECT_FALSE(group->mixer()->parentTimeline());

    const MixerPtr main = timeline->mixer("main");
    expectThrows<VelaMediaLibException>("Cannot set parent group on a mixer that has a parent timeline", [&] {
        Group::createFromMediaRange(project, rate, boost::dynamic_pointer_cast<GenericMixer>(main), 0, 0, 10);
    });
    EXPECT_FALSE(main->parentGroup());
    EXPECT_THROW(Group::create(project, rate, group->mixer(), 0), AddRemoveException); // another group's
    const auto otherProject = boost::make_shared<ThreadSafe>();
    EXPECT_THROW(Group::create(otherProject, rate, mixerOf({{leaf(10), 0}}), 0), AddRemoveException);
    EXPECT_THROW(Group::create(project, rate, GenericMixer::create(project), 0), ValueException<long long>);
}

// Three groups deep, the second at half speed: a global tick between the
// inner ticks reaches the innermost clip at an exact fractional time.
TEST_F(GroupTest, ThreeDeepGroupsAnswerTheClipAndItsTimeAtEveryDepth) {
    const MediaPtr inner = leaf(40);
    const GroupPtr g3 = Group::createFromMediaRange(project, rate, mixerOf({{inner, 10}}), 5, 4, 50);
    const GroupPtr g2 =
        Group::createFromMediaRange(project, rate, mixerOf({{g3, 5}}), 20, 2, 60, SafeRational(2));
    const GroupPtr g1 = groupOf(g2, 20, 100);
    top->addMedia(g1, 100);
    ASSERT_EQ(g1->trackRange(), Range<VelaTime>(100, 120));

    const auto at150 = timeline->allMediasAndTimesAtTime(150);
    EXPECT_EQ(mediasOf(at150), (std::vector<MediaPtr>{g1, g2, g3, inner}));
    EXPECT_EQ(timeline->allMediasAtTime(150), mediasOf(at150));
    const std::vector<SafeRational> times{50, 50, 22, 16};
    for (size_t i = 0; i < at150.size() && i < times.size(); ++i)
        EXPECT_EQ(at150[i].parametricTime, times[i]);

    const auto at151 = timeline->allMediasAndTimesAtTime(151);
    ASSERT_EQ(mediasOf(at151), mediasOf(at150));
    EXPECT_EQ(at151[3].parametricTime, SafeRational(33, 2));
    EXPECT_EQ(inner->fromGlobalToParametricTime(RationalTime(151)).asRational(), SafeRational(33, 2));
    EXPECT_EQ(inner->fromParametricToGlobalTime(RationalTime(33, 2)).asRational(), SafeRational(151));
    EXPECT_EQ(g3->fromGlobalToParametricTime(RationalTime(151)).asRational(), SafeRational(45, 2));

    const auto innerTrack = g3->mixer()->trackAtIndex(0);
    EXPECT_EQ(innerTrack->mediaAtTime(26).first, inner);
    EXPECT_EQ(top->mediaAtTime(150), Track::Pair(g1, MediaPtr())); // the plain query stays on its track
    EXPECT_EQ(timeline->allMediasAtTime(100), (std::vector<MediaPtr>{g1, g2})); // g3 starts later inside
    const MediaPtr after = leaf(10);
    top->addMedia(after, 220);
    EXPECT_EQ(timeline->allMediasAtTime(220), (std::vector<MediaPtr>{g1, after})); // g1's end plays nothing
    EXPECT_TRUE(timeline->allMediasAtTime(99).empty());
}

TEST_F(GroupTest, ChildrensConverterMapsExactlyAndCannotBeReparented) {
    const GroupPtr group =
        Group::createFromMediaRange(project, rate, mixerOf({{leaf(30), 0}}), 10, 6, 9, SafeRational(3, 2));
    const TimeConverterPtr converter = group->mixer()->parentTimeConverter();
    ASSERT_EQ(converter, group->childrensTimeConverter());
    EXPECT_EQ(converter->parentParametricTimeToThisParametricTime(SafeRational(1)), SafeRational(20, 3));
    EXPECT_EQ(converter->thisParametricTimeToParentParametricTime(SafeRational(20, 3)), SafeRational(1));
    EXPECT_EQ(converter->clippingParentParametricTimeToThisParametricTime(SafeRational(-4)), SafeRational(6));
    EXPECT_EQ(converter->clippingParentParametricTimeToThisParametricTime(SafeRational(99)),
              SafeRational(46, 3));
    EXPECT_EQ(converter->parentTimeConverter().get(), static_cast<const TimeConverter*>(group.get()));
    const auto children = boost::dynamic_pointer_cast<const GroupChildrensTimeConverter>(converter);
    ASSERT_TRUE(children);
    const auto reparent = [&] {
        const_cast<GroupChildrensTimeConverter&>(*children).setTimeConverterParent(top);
    };
    EXPECT_EQ(thrown<std::runtime_error>(reparent).value().what(),
              std::string("ChildrensTimeConverter::setTimeConverterParent not supported"));
}

TEST_F(GroupTest, WalksAndContentQueriesReachEveryDepth) {
    const MediaPtr deep = leaf(10), beside = leaf(10);
    const GroupPtr inner = groupOf(deep, 0, 0);
    const GroupPtr outer = Group::create(project, rate, mixerOf({{inner, 0}, {beside, 20}}), 0);
    top->addMedia(outer, 0);
    EXPECT_EQ(top->allMedias(), (std::vector<MediaPtr>{outer, inner, deep, beside}));
    EXPECT_EQ(timeline->allMedias(), top->allMedias());
    EXPECT_TRUE(outer->recursivelyContainsMedia(deep));
    EXPECT_FALSE(outer->recursivelyContainsMedia(outer));
    EXPECT_FALSE(inner->recursivelyContainsMedia(beside));
    size_t visited = 0;
    EXPECT_TRUE(top->recursivelyVisitAllMediaWithEarlyExitFlag([&](const MediaPtr& media, bool& stop) {
        ++visited;
        stop = media == deep;
    }));
    EXPECT_EQ(visited, 3u);

    // Groups are seen and heard only through what they hold.
    EXPECT_TRUE(outer->hasVisual());
    EXPECT_FALSE(outer->hasAudio());
    EXPECT_FALSE(timeline->mixer()->hasAudio());
    EXPECT_EQ(outer->numChannels(), 0);
    EXPECT_EQ(outer->autoQuickPropertyList(),
              (std::vector<std::string>{"translation", "scale", "rotation", "opacity"}));
    const auto sound = boost::make_shared<TestAudioClip>(project, timing(0, 10, 0, 10, 1, 0, 10));
    inner->mixer()->trackAtIndex(0)->removeMedia(deep);
    boost::dynamic_pointer_cast<GenericTrack>(inner->mixer()->trackAtIndex(0))->addMedia(sound, 0);
    EXPECT_TRUE(outer->hasAudio());
    EXPECT_TRUE(timeline->mixer()->hasAudio());
    EXPECT_EQ(outer->numChannels(), 2);
    sound->mixToMono()->setValue(true);
    EXPECT_EQ(outer->numChannels(), 1);

    // The picture stands where `beside` does once the inner group only sounds.
    EXPECT_EQ(outer->visualMediaRange(), Range<SafeRational>(20, 10));
    outer->trimEnd(5);
    EXPECT_EQ(outer->visualMediaRange(), Range<SafeRational>(20, 5));
}

TEST_F(GroupTest, AGroupCannotBePlacedInsideItself) {
    const GroupPtr inner = groupOf(leaf(10), 0, 0);
    const GroupPtr outer = groupOf(inner, 0, 0);
    const auto innerTrack = boost::dynamic_pointer_cast<GenericTrack>(inner->mixer()->trackAtIndex(0));
    expectThrows<AddRemoveException>("a group cannot be placed inside itself",
                                     [&] { innerTrack->addMedia(outer, 50); });
    EXPECT_EQ(innerTrack->numMedias(), 1u);
    EXPECT_FALSE(outer->parent());
}

TEST_F(GroupTest, CanvasIsSetOrTakenFromTheLargestChildElseTheTimeline) {
    const GroupPtr small = groupOf(leaf(10, 320, 200), 0, 0);
    const GroupPtr group = Group::create(project, rate, mixerOf({{leaf(10, 640, 480), 0}, {small, 10}}), 0);
    EXPECT_EQ(group->width(), 0);
    EXPECT_TRUE(group->updateGroupWidthAndHeightIfNotSet());
    EXPECT_EQ(std::make_pair(group->width(), group->height()), std::make_pair(640, 480));
    EXPECT_EQ(small->width(), 0); // derived for the comparison, not set
    small->setGroupWidthAndHeight(2000, 1000);
    EXPECT_FALSE(group->updateGroupWidthAndHeightIfNotSet()); // set sides stay
    EXPECT_EQ(group->widthAttr()->value(), 640);
    EXPECT_THROW(group->setGroupWidthAndHeight(10, -1), ValueException<int>);
    EXPECT_EQ(group->heightAttr()->value(), 480);

    const GroupPtr empty = Group::create(project, rate, 0, 10);
    EXPECT_FALSE(empty->updateGroupWidthAndHeightIfNotSet()); // nothing to go by
    top->addMedia(empty, 0);
    EXPECT_TRUE(empty->updateGroupWidthAndHeightIfNotSet());
    EXPECT_EQ(std::make_pair(empty->width(), empty->height()), std::make_pair(1280, 720));
}

TEST_F(GroupTest, OnlyAGroupStateRestoresAGroup) {
    const GroupPtr group = groupOf(leaf(40), 0, 0);
    group->setGroupWidthAndHeight(800, 600);
    const GroupMediaState saved = group->groupMediaState();
    group->trimEnd(15);
    group->setGroupWidthAndHeight(10, 10);

    const GroupMediaState changed = group->groupMediaState();
    expectRefused<VelaMediaLibException>(*group, "Cannot restore state with non-GroupMediaState MediaState",
                                         [&] { group->restoreGroupMediaState(group->defaultState(), 0); });
    EXPECT_EQ(group->groupMediaState(), changed);
    group->restoreGroupMediaState(saved, 0);
    EXPECT_EQ(group->groupMediaState(), saved);
    EXPECT_EQ(group->duration(), 40);
}

TEST_F(GroupTest, ClonesAreDeepAndKeepTheGroupsOwnContent) {
    const MediaPtr deep = leaf(20);
    const GroupPtr inner = groupOf(deep, 5, 0);
    const GroupPtr group = groupOf(inner, 3, 0);
    group->setGroupWidthAndHeight(100, 50);
    group->setQuickPropertyList({"opacity", "scale"});
    group->addAnimationTrack("bounce")->setDefaultValue(2.5);
    group->trimStart(4);

    const auto copy = boost::dynamic_pointer_cast<Group>(group->clone());
    ASSERT_TRUE(copy);
    EXPECT_EQ(copy->groupMediaState(), group->groupMediaState());
    EXPECT_EQ(copy->mixer()->parentGroup(), copy);
    EXPECT_EQ(copy->quickPropertyList(), (std::vector<std::string>{"opacity", "scale"}));
    EXPECT_EQ(copy->unusedQuickPropertyList(), (std::vector<std::string>{"translation", "rotation"}));
    EXPECT_EQ(copy->animationTrackNames(), std::vector<std::string>{"bounce"});
    EXPECT_EQ(copy->animationTrackWithName("bounce")->valueAtTime(RationalTime(0)), 2.5);
    EXPECT_NE(copy->animationTrackWithName("bounce"), group->animationTrackWithName("bounce"));
    EXPECT_FALSE(copy->animationTrackWithName("none"));

    const std::vector<MediaPtr> inside = copy->mixer()->allMedias();
    ASSERT_EQ(inside.size(), 2u);
    EXPECT_NE(inside[0], inner);
    EXPECT_NE(inside[1], deep);
    EXPECT_EQ(inside[1]->state(), deep->state());
    EXPECT_EQ(inside[1]->fromParametricToGlobalTime(RationalTime(0)).asRational(),
              SafeRational(0)); // unmoved by the trim
    inside[1]->trimEnd(5);
    EXPECT_EQ(deep->duration(), 20);
    EXPECT_EQ(MediaTypeFromMediaDispatcher::typeOf(*copy), "Group");
    expectThrows<VelaMediaLibException>("deprecated call sourceCropRectAtTime on Group",
                                        [&] { copy->sourceCropRectAtTime(RationalTime(0)); });
    EXPECT_THROW(group->setQuickPropertyList({"two\nlines"}), ValueException<std::string>);
}

} // namespace

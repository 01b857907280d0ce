// The track answers time queries from an index beside its map: after any run
// of edits, refused or not, both must tell the same story at every tick.
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>
#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <random>

using namespace VelaMediaLib;

namespace {

// What mediaAtTime must answer, worked out from the clips themselves: the
// clip holding t, and before it a touching clip that ends where it starts.
Track::Pair expectedAt(const std::vector<MediaPtr>& clips, VelaTime t) {
    MediaPtr holding, ending;
    for (const MediaPtr& clip : clips) {
        if (clip->startTime() <= t && t < clip->endTime()) holding = clip;
        if (clip->endTime() == t) ending = clip;
    }
    if (holding && ending && holding->startTime() == t) return Track::Pair(ending, holding);
    return Track::Pair(holding, MediaPtr());
}

TEST(ClipIndex, AgreesWithTheClipsAfterRandomEdits) {
    const auto project = boost::make_shared<ThreadSafe>();
    const boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
    const auto track = GenericTrack::create(project);
    std::mt19937 random(5);
    const auto pick = [&](int n) { return std::uniform_int_distribution<int>(0, n - 1)(random); };
    for (int step = 0; step < 400; ++step) {
        const std::vector<MediaPtr> clips = track->medias();
        const MediaPtr clip = clips.empty() ? MediaPtr() : clips[size_t(pick(int(clips.size())))];
        const VelaTime offset = pick(41) - 20;
        try {
            switch (clip ? pick(5) : 0) {
            case 0:
                track->addMedia(PlaceholderMedia::create(project, rate, 0, 1 + pick(15)), pick(200));
                break;
            case 1:
                track->removeMedia(clip);
                break;
            case 2:
                track->move(clip, offset * 5);
                break; // far enough to pass other clips
            case 3:
                track->trimStart(clip, offset);
                break;
            default:
                track->trimEnd(clip, offset);
                break;
            }
        } catch (const std::exception&) {
            // refused edits change nothing, which the check below also covers
        }
        const std::vector<MediaPtr> now = track->medias();
        for (VelaTime t = -1; t <= 300; ++t) ASSERT_EQ(track->mediaAtTime(t), expectedAt(now, t)) << t;
    }
}

} // namespace

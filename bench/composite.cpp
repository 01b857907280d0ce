// Timeline::allMediasAtTime on a timeline of 20 tracks of 500 clips, a tenth
// of which are groups of 10 clips each, against the same timeline flattened
// (each group's clips placed on its track where they play). Both answer the
// same clips at the same random ticks; the figure to quote is the ratio.
#include "Interleaved.h"

#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>

#include <boost/make_shared.hpp>
#include <random>

using namespace VelaMediaLib;

namespace {

const int kTracks = 20, kClipsPerTrack = 500, kGroupEvery = 10, kChildren = 10;
const VelaTime kChildLength = 10, kClipLength = kChildren * kChildLength, kStep = kClipLength + 10;

struct Timelines {
    boost::shared_ptr<ThreadSafe> token = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
    TimelinePtr grouped = Timeline::create(token), flat = Timeline::create(token);
    std::vector<VelaTime> ticks;

    Timelines() {
        const auto groupedMixer = grouped->newMixer("main"), flatMixer = flat->newMixer("main");
        for (int t = 0; t < kTracks; ++t) {
            const auto withGroups = grouped->newTrack(), plain = flat->newTrack();
            grouped->addTrack(groupedMixer, withGroups);
            flat->addTrack(flatMixer, plain);
            for (int c = 0; c < kClipsPerTrack; ++c) fill(*withGroups, *plain, c);
        }
        std::mt19937_64 random(7);
        std::uniform_int_distribution<VelaTime> spread(0, kClipsPerTrack * kStep);
        ticks.resize(4096);
        for (VelaTime& tick : ticks) tick = spread(random);
    }

    MediaPtr clip(VelaTime length) const { return PlaceholderMedia::create(token, rate, 0, length); }

    void fill(GenericTrack& withGroups, GenericTrack& plain, int index) const {
        const VelaTime start = index * kStep;
        if (index % kGroupEvery != 0) {
            withGroups.addMedia(clip(kClipLength), start);
            plain.addMedia(clip(kClipLength), start);
            return;
        }
        const auto inner = GenericMixer::create(token);
        const auto innerTrack = GenericTrack::create(token);
        inner->addTrack(innerTrack);
        for (int c = 0; c < kChildren; ++c) {
            innerTrack->addMedia(clip(kChildLength), c * kChildLength);
            plain.addMedia(clip(kChildLength), start + c * kChildLength);
        }
        withGroups.addMedia(Group::create(token, rate, inner, 0), start);
    }
};

void BM_AllMediasAtTime_GroupedVsFlat(benchmark::State& state) {
    static Timelines timelines;
    size_t found = 0;
    auto query = [&](const TimelinePtr& timeline) {
        return [&, timeline](size_t first, size_t count) {
            for (size_t i = 0; i < count; ++i)
                found +=
                    timeline->allMediasAtTime(timelines.ticks[(first + i) % timelines.ticks.size()]).size();
        };
    };
    Interleaved::compare(state, 64, query(timelines.flat), query(timelines.grouped));
    benchmark::DoNotOptimize(found);
}
BENCHMARK(BM_AllMediasAtTime_GroupedVsFlat);

} // namespace

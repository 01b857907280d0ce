// Timeline::allMediasAtTime on a timeline of 20 tracks of 500 clips, a tenth
// of which are groups of 10 clips each, against the same timeline flattened
// (each group's clips placed on its track where they play), at the same
// random ticks. Where a group plays, the grouped timeline answers the group
// and the clip inside it, the flat one that clip alone. The figure to quote
// is the ratio; BM_AllMediasAtTime_InsideGroups asks only at ticks where
// every track plays a group, the query's worst case.
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
    std::vector<VelaTime> ticks, groupTicks;

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
        std::uniform_int_distribution<int> group(0, kClipsPerTrack / kGroupEvery - 1);
        std::uniform_int_distribution<VelaTime> within(0, kClipLength - 1);
        ticks.resize(4096);
        for (VelaTime& tick : ticks) tick = spread(random);
        groupTicks.resize(4096);
        for (VelaTime& tick : groupTicks) tick = group(random) * kGroupEvery * kStep + within(random);
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

Timelines& timelines() {
    static Timelines made;
    return made;
}

void compareAt(benchmark::State& state, const std::vector<VelaTime>& ticks) {
    size_t found = 0;
    auto query = [&](const TimelinePtr& timeline) {
        return [&, timeline](size_t first, size_t count) {
            for (size_t i = 0; i < count; ++i)
                found += timeline->allMediasAtTime(ticks[(first + i) % ticks.size()]).size();
        };
    };
    Interleaved::compare(state, 64, query(timelines().flat), query(timelines().grouped));
    benchmark::DoNotOptimize(found);
}

void BM_AllMediasAtTime_GroupedVsFlat(benchmark::State& state) { compareAt(state, timelines().ticks); }
BENCHMARK(BM_AllMediasAtTime_GroupedVsFlat);

void BM_AllMediasAtTime_InsideGroups(benchmark::State& state) { compareAt(state, timelines().groupTicks); }
BENCHMARK(BM_AllMediasAtTime_InsideGroups);

} // namespace

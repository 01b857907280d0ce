// Timeline::allMediasAtTime on a timeline of 20 tracks of 500 clips, a tenth
// of which are groups of 10 clips each, against the same timeline flattened
// (each group's clips placed on its track where they play), at the same
// random ticks. Where a group plays, the grouped timeline answers the group
// and the clip inside it, the flat one that clip alone. The figure to quote
// is the ratio; BM_AllMediasAtTime_InsideGroups asks only at ticks where
// every track plays a group, the query's worst case.
// BM_AllMediasAtTime_NestedTrimmedStitched makes every tenth clip either a
// group holding a group of 10 clips, its window trimmed to the middle eight,
// or a stitched clip of 10 parts; the flat timeline holds the clips they play.
#include "Interleaved.h"

#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>

#include <boost/make_shared.hpp>
#include <random>

using namespace VelaMediaLib;

namespace {

const int kTracks = 20, kClipsPerTrack = 500, kGroupEvery = 10, kChildren = 10;
const VelaTime kChildLength = 10, kClipLength = kChildren * kChildLength, kStep = kClipLength + 10;

enum class Composite { Groups, NestedTrimmedOrStitched };

struct Timelines {
    boost::shared_ptr<ThreadSafe> token = boost::make_shared<ThreadSafe>();
    boost::shared_ptr<ProjectEditRate> rate =
        boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
    TimelinePtr grouped = Timeline::create(token), flat = Timeline::create(token);
    std::vector<VelaTime> ticks, groupTicks;
    Composite kind;

    explicit Timelines(Composite made) : kind(made) {
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
        } else if (kind == Composite::Groups) {
            withGroups.addMedia(Group::create(token, rate, childrenIn(plain, start, 0, kChildren), 0), start);
        } else if (index % (2 * kGroupEvery) == 0) {
            withGroups.addMedia(nestedTrimmed(plain, start), start);
        } else {
            std::vector<MediaPtr> parts;
            for (int c = 0; c < kChildren; ++c) {
                parts.push_back(clip(kChildLength));
                plain.addMedia(clip(kChildLength), start + c * kChildLength);
            }
            withGroups.addMedia(StitchedMedia::create(parts, 0), start);
        }
    }

    // A mixer of the children; the flat track gets those from `first` to
    // `last` (exclusive) where the composite plays them.
    boost::shared_ptr<GenericMixer> childrenIn(GenericTrack& plain, VelaTime start, int first,
                                               int last) const {
        const auto inner = GenericMixer::create(token);
        const auto innerTrack = GenericTrack::create(token);
        inner->addTrack(innerTrack);
        for (int c = 0; c < kChildren; ++c) {
            innerTrack->addMedia(clip(kChildLength), c * kChildLength);
            if (c >= first && c < last)
                plain.addMedia(clip(kChildLength), start + (c - first) * kChildLength);
        }
        return inner;
    }

    // A group around a group, playing the inner one's children 1 to 8.
    MediaPtr nestedTrimmed(GenericTrack& plain, VelaTime start) const {
        const auto middle = Group::create(token, rate, childrenIn(plain, start, 1, kChildren - 1), 0);
        const auto outer = GenericMixer::create(token);
        const auto outerTrack = GenericTrack::create(token);
        outer->addTrack(outerTrack);
        outerTrack->addMedia(middle, 0);
        return Group::createFromMediaRange(token, rate, outer, 0, SafeRational(kChildLength),
                                           SafeRational((kChildren - 2) * kChildLength), SafeRational(1));
    }
};

Timelines& timelines(Composite kind = Composite::Groups) {
    static Timelines groups(Composite::Groups), mixed(Composite::NestedTrimmedOrStitched);
    return kind == Composite::Groups ? groups : mixed;
}

void compareAt(benchmark::State& state, const std::vector<VelaTime>& ticks,
               Composite kind = Composite::Groups) {
    size_t found = 0;
    auto query = [&](const TimelinePtr& timeline) {
        return [&, timeline](size_t first, size_t count) {
            for (size_t i = 0; i < count; ++i)
                found += timeline->allMediasAtTime(ticks[(first + i) % ticks.size()]).size();
        };
    };
    Interleaved::compare(state, 64, query(timelines(kind).flat), query(timelines(kind).grouped));
    benchmark::DoNotOptimize(found);
}

void BM_AllMediasAtTime_GroupedVsFlat(benchmark::State& state) { compareAt(state, timelines().ticks); }
BENCHMARK(BM_AllMediasAtTime_GroupedVsFlat);

void BM_AllMediasAtTime_InsideGroups(benchmark::State& state) { compareAt(state, timelines().groupTicks); }
BENCHMARK(BM_AllMediasAtTime_InsideGroups);

void BM_AllMediasAtTime_NestedTrimmedStitched(benchmark::State& state) {
    compareAt(state, timelines(Composite::NestedTrimmedOrStitched).ticks, Composite::NestedTrimmedOrStitched);
}
BENCHMARK(BM_AllMediasAtTime_NestedTrimmedStitched);

} // namespace

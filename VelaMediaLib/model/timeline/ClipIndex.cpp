#include <VelaMediaLib/model/timeline/ClipIndex.h>

#include <VelaMediaLib/model/media/Media.h>

#include <algorithm>
#include <cassert>

namespace VelaMediaLib {

size_t ClipIndex::find(VelaTime start) const {
    return size_t(std::lower_bound(starts_.begin(), starts_.end(), start) - starts_.begin());
}

// Making room first keeps an insert all-or-nothing: the three inserts below
// cannot throw once there is room. Room grows by doubling, as push_back's does.
void ClipIndex::insert(VelaTime start, VelaTime end, const boost::shared_ptr<Media>& media) {
    const size_t at = find(start);
    const auto makeRoom = [](auto& items) {
        if (items.size() == items.capacity()) items.reserve(std::max<size_t>(16, 2 * items.size()));
    };
    makeRoom(starts_);
    makeRoom(ends_);
    makeRoom(medias_);
    starts_.insert(starts_.begin() + std::ptrdiff_t(at), start);
    ends_.insert(ends_.begin() + std::ptrdiff_t(at), end);
    medias_.insert(medias_.begin() + std::ptrdiff_t(at), media);
}

void ClipIndex::erase(VelaTime start) {
    const size_t at = find(start);
    assert(at < starts_.size() && starts_[at] == start && "the index lost step with its track's map");
    if (at == starts_.size() || starts_[at] != start) return;
    starts_.erase(starts_.begin() + std::ptrdiff_t(at));
    ends_.erase(ends_.begin() + std::ptrdiff_t(at));
    medias_.erase(medias_.begin() + std::ptrdiff_t(at));
}

// A move may carry the clip past others into a far gap: the entries between
// its old and new places shift by one, the rest stay.
void ClipIndex::retime(VelaTime from, VelaTime start, VelaTime end) {
    const size_t at = find(from);
    assert(at < starts_.size() && starts_[at] == from && "the index lost step with its track's map");
    if (at == starts_.size() || starts_[at] != from) return;
    const size_t to = find(start) - (start > from ? 1 : 0);
    const auto shift = [&](auto& items) {
        if (to > at)
            std::rotate(items.begin() + std::ptrdiff_t(at), items.begin() + std::ptrdiff_t(at + 1),
                        items.begin() + std::ptrdiff_t(to + 1));
        else if (to < at)
            std::rotate(items.begin() + std::ptrdiff_t(to), items.begin() + std::ptrdiff_t(at),
                        items.begin() + std::ptrdiff_t(at + 1));
    };
    shift(starts_);
    shift(ends_);
    shift(medias_);
    starts_[to] = start;
    ends_[to] = end;
}

} // namespace VelaMediaLib

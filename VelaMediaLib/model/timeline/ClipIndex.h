#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

#include <boost/shared_ptr.hpp>
#include <cstddef>
#include <algorithm>
#include <vector>

namespace VelaMediaLib {

class Media;

/// A track's clips in start order with their ends, kept in three flat arrays
/// beside the track's map: a time query binary-searches the starts alone and
/// reads one end, touching neither a tree node nor a clip. The track changes
/// it in the same write-locked step as the map, so the two always agree.
class VELAMEDIALIB_API ClipIndex {
public:
    size_t size() const { return starts_.size(); }
    VelaTime start(size_t i) const { return starts_[i]; }
    VelaTime end(size_t i) const { return ends_[i]; }
    /// Valid until the index next changes: copy it before the lock is released.
    const boost::shared_ptr<Media>& media(size_t i) const { return medias_[i]; }

    /// How many clips start at or before t: the one holding t, if any, is the last of them.
    size_t countStartingBy(VelaTime t) const {
        return size_t(std::upper_bound(starts_.begin(), starts_.end(), t) - starts_.begin());
    }

    void insert(VelaTime start, VelaTime end, const boost::shared_ptr<Media>& media);
    /// Drops the clip starting at start (one must).
    void erase(VelaTime start);
    /// The clip that started at `from` (one must) now spans [start, end).
    void retime(VelaTime from, VelaTime start, VelaTime end);

private:
    size_t find(VelaTime start) const;

    std::vector<VelaTime> starts_;
    std::vector<VelaTime> ends_;
    std::vector<boost::shared_ptr<Media>> medias_;
};

} // namespace VelaMediaLib

#include <VelaMediaLib/model/source/CachingStatsLoader.h>

#include <algorithm>

namespace VelaMediaLib {

CachingStatsLoader::CachingStatsLoader(bool caching) : caching_(caching) {}

CachingStatsLoader::~CachingStatsLoader() = default;

bool CachingStatsLoader::loadStats(const std::string& path, MediaFileStats& stats) {
    if (!caching_.load()) return loadStatsUncached(path, stats);
    bool hit = false;
    MediaFileStats::Contents cached;
    unsigned long generation;
    {
        std::lock_guard<std::mutex> lock(mutex_);
        const auto found = map_.find(path);
        if (found != map_.end()) {
            hit = true;
            cached = found->second;
        }
        generation = generation_;
    }
    if (hit) {
        stats.setContents(cached);
        return true;
    }
    if (!loadStatsUncached(path, stats)) return false;
    const MediaFileStats::Contents loaded = stats.contents();
    std::lock_guard<std::mutex> lock(mutex_);
    if (caching_.load() && generation == generation_) map_[path] = loaded;
    return true;
}

void CachingStatsLoader::setCachingEnabled(bool caching) { caching_.store(caching); }

bool CachingStatsLoader::isCachingEnabled() const { return caching_.load(); }

void CachingStatsLoader::clearStatsMap() {
    std::lock_guard<std::mutex> lock(mutex_);
    map_.clear();
    ++generation_;
}

void CachingStatsLoader::updateCachedDurationsFromStats(const MediaFileStats& stats) {
    const MediaFileStats::Contents given = stats.contents();
    std::lock_guard<std::mutex> lock(mutex_);
    const auto found = map_.find(given.filename);
    if (found == map_.end()) return;
    std::vector<TrackStats>& tracks = found->second.tracks;
    const size_t common = std::min(tracks.size(), given.tracks.size());
    for (size_t i = 0; i < common; ++i) {
        tracks[i].range = given.tracks[i].range;
        tracks[i].rangeEditRate = given.tracks[i].rangeEditRate;
    }
}

bool CachingStatsLoader::isCached(const std::string& path) const {
    std::lock_guard<std::mutex> lock(mutex_);
    return map_.count(path) != 0;
}

} // namespace VelaMediaLib

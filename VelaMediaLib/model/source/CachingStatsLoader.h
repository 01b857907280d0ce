#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/StatsLoader.h>

#include <atomic>
#include <mutex>
#include <string>
#include <unordered_map>

namespace VelaMediaLib {

/// A loader that keeps what it loaded by path and answers a repeated request
/// from its map, so a file is read once however often it is imported.
/// Thread-safe: the map has a mutex of its own, and the uncached load runs
/// outside it. It keeps a record's contents (name, streams, picture); an
/// effect definition the uncached load set is not kept.
class VELAMEDIALIB_API CachingStatsLoader : public StatsLoader {
public:
    explicit CachingStatsLoader(bool caching = true);
    ~CachingStatsLoader() override;

    /// From the map when caching and the path is known; else from
    /// loadStatsUncached, whose answer is kept when caching.
    bool loadStats(const std::string& path, MediaFileStats& stats) final;

    /// Off: every request asks loadStatsUncached, and nothing is kept.
    void setCachingEnabled(bool caching);
    bool isCachingEnabled() const;
    /// Forgets every path; a load already running keeps nothing either.
    void clearStatsMap();
    /// The entry kept for stats.filename(), if any, takes the ranges and range
    /// rates of the streams of `stats`, stream by stream where both have one.
    void updateCachedDurationsFromStats(const MediaFileStats& stats);
    bool isCached(const std::string& path) const;

protected:
    /// Loads as StatsLoader::loadStats does.
    virtual bool loadStatsUncached(const std::string& path, MediaFileStats& stats) = 0;

private:
    mutable std::mutex mutex_;
    std::unordered_map<std::string, MediaFileStats::Contents> map_;
    unsigned long generation_ = 0; // raised by each clear, so a load begun before it keeps nothing
    std::atomic<bool> caching_;
};

} // namespace VelaMediaLib

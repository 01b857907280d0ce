#pragma once

#include <VelaMediaLib/base/Export.h>

#include <string>

namespace VelaMediaLib {

class MediaFileStats;

/// Where a loader goes in the process-wide list: a non-zero priority puts it
/// before every loader present, 0 after them.
enum StatsLoaderPriority { NormalStatsLoaderPriority = 0, HighStatsLoaderPriority = 1 };

/// Fills the stats of a media file; the host supplies these, since the
/// library decodes nothing. Loaders are called from any thread, several at
/// once, with a record no other thread sees yet.
class VELAMEDIALIB_API StatsLoader {
public:
    virtual ~StatsLoader() = default;
    /// Returns true when it filled `stats`, false when this is not a kind of
    /// file it reads. Throws when it should read the file but cannot.
    virtual bool loadStats(const std::string& path, MediaFileStats& stats) = 0;
};

} // namespace VelaMediaLib

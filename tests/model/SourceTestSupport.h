#pragma once
// Sources without files: a stats loader that answers from a table, and a file
// system whose files exist and can be read as a test says.

#include <VelaMediaLib/model/source/FileSystem.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/StatsLoader.h>

#include <boost/make_shared.hpp>
#include <map>
#include <mutex>
#include <set>
#include <string>

namespace VelaMediaLib {
namespace testing {

inline TrackStats stream(TrackType type, long long start, long long duration, unsigned long rate,
                         int channels = 0) {
    TrackStats track;
    track.type = type;
    track.range = Range<long long>(start, duration);
    track.rangeEditRate = boost::rational<unsigned long>(rate);
    track.sampleRate = SafeRational(static_cast<long long>(rate));
    track.numChannels = channels;
    if (type != TrackType::Audio) track.rect = Rect<int>(0, 0, 640, 480);
    return track;
}

/// Answers for the paths it was given, counting the questions.
class TableStatsLoader : public StatsLoader {
public:
    void set(const std::string& path, std::vector<TrackStats> tracks) {
        std::lock_guard<std::mutex> hold(mutex_);
        MediaFileStats::Contents contents;
        contents.filename = path;
        contents.tracks = std::move(tracks);
        table_[path] = contents;
    }
    void forget(const std::string& path) {
        std::lock_guard<std::mutex> hold(mutex_);
        table_.erase(path);
    }
    bool loadStats(const std::string& path, MediaFileStats& stats) override {
        std::lock_guard<std::mutex> hold(mutex_);
        ++asked;
        const auto found = table_.find(path);
        if (found == table_.end()) return false;
        stats.setContents(found->second);
        return true;
    }
    int asked = 0;

private:
    std::mutex mutex_;
    std::map<std::string, MediaFileStats::Contents> table_;
};

/// Registers a table loader ahead of all others for a test's lifetime.
class RegisteredTableLoader {
public:
    RegisteredTableLoader() { MediaFileStats::addStatsLoader(loader, 1); }
    ~RegisteredTableLoader() { MediaFileStats::removeStatsLoader(loader); }
    TableStatsLoader* operator->() const { return loader.get(); }
    const boost::shared_ptr<TableStatsLoader> loader = boost::make_shared<TableStatsLoader>();
};

class FakeFileSystem : public FileSystem {
public:
    bool exists(const std::string& path) const override { return present.count(path) > 0; }
    bool isReadable(const std::string& path) const override {
        return exists(path) && !unreadable.count(path);
    }
    std::set<std::string> present, unreadable;
};

} // namespace testing
} // namespace VelaMediaLib

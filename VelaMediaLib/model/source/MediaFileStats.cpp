#include <VelaMediaLib/model/source/MediaFileStats.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/model/source/CachingStatsLoader.h>
#include <VelaMediaLib/model/source/StatsLoader.h>
#include <VelaMediaLib/model/source/detail/StatsLoaderList.h>
#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

#include <algorithm>
#include <exception>

namespace VelaMediaLib {
namespace {

bool compatibleStreams(const TrackStats& a, const TrackStats& b) {
    if (a.type != b.type) return false;
    return !isAudioTrackType(a.type) || a.numChannels == b.numChannels;
}

/// The first loader's answer for `path` in a fresh record, or null; a loader
/// that refuses or throws may have half filled its record, so each gets its own.
boost::shared_ptr<MediaFileStats> loadFromLoaders(const std::string& path, std::string& firstError) {
    const auto loaders = detail::StatsLoaderList::instance().snapshot();
    for (const auto& loader : *loaders) {
        const auto stats = MediaFileStats::create();
        try {
            if (loader->loadStats(path, *stats)) return stats;
        } catch (const std::exception& e) {
            if (firstError.empty()) firstError = e.what();
        } catch (...) {
            if (firstError.empty()) firstError = "unknown error";
        }
    }
    return boost::shared_ptr<MediaFileStats>();
}

} // namespace

MediaFileStats::MediaFileStats(const boost::weak_ptr<const ThreadSafe>& projectMutex)
    : Subject(projectMutex) {}

MediaFileStats::~MediaFileStats() = default;

boost::shared_ptr<MediaFileStats> MediaFileStats::create() {
    return boost::shared_ptr<MediaFileStats>(new MediaFileStats());
}

boost::shared_ptr<MediaFileStats>
MediaFileStats::create(const std::string& path, const boost::weak_ptr<const ThreadSafe>& projectMutex) {
    std::string firstError;
    const auto stats = loadFromLoaders(path, firstError);
    if (!stats) {
        std::string message = "no stats loader could read file: " + path;
        if (!firstError.empty()) message += " (" + firstError + ")";
        throw IOException(message);
    }
    // Still private to this thread: filled without locks, then given its project.
    // The record is named by the path it was made for, whatever a loader wrote.
    stats->contents_.filename = path;
    checkContents(stats->contents_);
    stats->setProjectMutex(projectMutex);
    return stats;
}

void MediaFileStats::checkContents(const Contents& contents) {
    if (contents.tracks.empty()) throw IOException("file has no streams: " + contents.filename);
    for (size_t i = 0; i < contents.tracks.size(); ++i) {
        const TrackStats& track = contents.tracks[i];
        if (track.rangeEditRate.numerator() == 0 || track.range.duration() < 0)
            throw IOException("bad stream " + std::to_string(i) + " in file: " + contents.filename);
    }
}

bool MediaFileStats::isFileOpenable(const std::string& path) {
    try {
        create(path);
        return true;
    } catch (...) {
        return false;
    }
}

void MediaFileStats::addStatsLoader(const boost::shared_ptr<StatsLoader>& loader, int priority) {
    detail::StatsLoaderList::instance().add(loader, priority);
}

bool MediaFileStats::removeStatsLoader(const boost::shared_ptr<StatsLoader>& loader) {
    return detail::StatsLoaderList::instance().remove(loader);
}

std::vector<boost::shared_ptr<StatsLoader>> MediaFileStats::statsLoaders() {
    return *detail::StatsLoaderList::instance().snapshot();
}

void MediaFileStats::updateCachedDurationsFromStats(const MediaFileStats& stats) {
    const auto loaders = detail::StatsLoaderList::instance().snapshot();
    for (const auto& loader : *loaders) {
        if (const auto caching = boost::dynamic_pointer_cast<CachingStatsLoader>(loader))
            caching->updateCachedDurationsFromStats(stats);
    }
}

bool MediaFileStats::areCompatibleForChange(const MediaFileStats& other) const {
    if (&other == this) return true;
    const std::vector<TrackStats> others = other.contents().tracks; // under its own lock, not ours
    ScopedReadLock lock(projectLock());
    const std::vector<TrackStats>& ours = contents_.tracks;
    return ours.size() == others.size() &&
           std::equal(ours.begin(), ours.end(), others.begin(), compatibleStreams);
}

std::string MediaFileStats::filename() const {
    ScopedReadLock lock(projectLock());
    return contents_.filename;
}

int MediaFileStats::numTracks() const {
    ScopedReadLock lock(projectLock());
    return int(contents_.tracks.size());
}

Rect<int> MediaFileStats::rect() const {
    ScopedReadLock lock(projectLock());
    return contents_.rect;
}

Range<double> MediaFileStats::mediaRangeInSeconds() const {
    ScopedReadLock lock(projectLock());
    bool any = false;
    double start = 0, end = 0;
    for (const TrackStats& track : contents_.tracks) {
        if (track.rangeEditRate.numerator() == 0) continue;
        const double secondsPerTick =
            double(track.rangeEditRate.denominator()) / track.rangeEditRate.numerator();
        const double trackStart = double(track.range.start()) * secondsPerTick;
        const double trackEnd = double(track.range.end()) * secondsPerTick;
        start = any ? std::min(start, trackStart) : trackStart;
        end = any ? std::max(end, trackEnd) : trackEnd;
        any = true;
    }
    return Range<double>(start, end - start);
}

SafeRational MediaFileStats::videoFrameRateOfFirstVideoTrack() const {
    ScopedReadLock lock(projectLock());
    for (const TrackStats& track : contents_.tracks)
        if (track.type == TrackType::Video || track.type == TrackType::ScreenVideo) return track.sampleRate;
    return SafeRational();
}

SafeRational MediaFileStats::audioSampleRateOfFirstAudioTrack() const {
    ScopedReadLock lock(projectLock());
    for (const TrackStats& track : contents_.tracks)
        if (isAudioTrackType(track.type)) return track.sampleRate;
    return SafeRational();
}

MediaFileStats::Contents MediaFileStats::contents() const {
    ScopedReadLock lock(projectLock());
    return contents_;
}

const TrackStats& MediaFileStats::trackAt(int index) const {
    if (index < 0 || size_t(index) >= contents_.tracks.size())
        throw IndexException("stream index out of range");
    return contents_.tracks[size_t(index)];
}

// Each per-stream accessor copies one member of the stream under the read lock.
#define VELA_STREAM_ACCESSOR(Type, name, member)                                                             \
    Type MediaFileStats::name(int index) const {                                                             \
        ScopedReadLock lock(projectLock());                                                                  \
        return trackAt(index).member;                                                                        \
    }
VELA_STREAM_ACCESSOR(TrackType, trackType, type)
VELA_STREAM_ACCESSOR(Range<long long>, trackRange, range)
VELA_STREAM_ACCESSOR(boost::rational<unsigned long>, rangeEditRate, rangeEditRate)
VELA_STREAM_ACCESSOR(SafeRational, sampleRate, sampleRate)
VELA_STREAM_ACCESSOR(Rect<int>, trackRect, rect)
VELA_STREAM_ACCESSOR(int, bitDepth, bitDepth)
VELA_STREAM_ACCESSOR(int, numChannels, numChannels)
VELA_STREAM_ACCESSOR(double, integratedLUFS, integratedLUFS)
VELA_STREAM_ACCESSOR(double, peakLevel, peakLevel)
VELA_STREAM_ACCESSOR(MediaOrientation, mediaOrientation, orientation)
VELA_STREAM_ACCESSOR(std::vector<std::string>, metaData, metaData)
VELA_STREAM_ACCESSOR(int, fileTrackNumberForTrackStatsIndex, fileTrackNumber)
#undef VELA_STREAM_ACCESSOR

std::string MediaFileStats::filename(int index) const {
    ScopedReadLock lock(projectLock());
    const std::string& own = trackAt(index).filename;
    return own.empty() ? contents_.filename : own;
}

TrackStats MediaFileStats::trackStats(int index) const {
    ScopedReadLock lock(projectLock());
    return trackAt(index);
}

template <typename Change>
void MediaFileStats::edit(Change change) {
    bool changed;
    {
        ScopedWriteLock lock(projectMutex());
        changed = change();
    }
    if (changed) notify();
}

void MediaFileStats::setContents(const Contents& contents) {
    edit([&] {
        if (contents_ == contents) return false;
        contents_ = contents;
        return true;
    });
}

void MediaFileStats::setFilename(const std::string& filename) {
    if (setFilenameUnnotified(filename)) notify();
}

bool MediaFileStats::setFilenameUnnotified(const std::string& filename) {
    ScopedWriteLock lock(projectMutex());
    if (contents_.filename == filename) return false;
    contents_.filename = filename;
    return true;
}

void MediaFileStats::addTrackStats(const TrackStats& stats) {
    edit([&] {
        contents_.tracks.push_back(stats);
        return true;
    });
}

void MediaFileStats::setTrackStats(int index, const TrackStats& stats) {
    edit([&] {
        const TrackStats& present = trackAt(index);
        if (present == stats) return false;
        contents_.tracks[size_t(index)] = stats;
        return true;
    });
}

void MediaFileStats::setRect(const Rect<int>& rect) {
    edit([&] {
        if (contents_.rect == rect) return false;
        contents_.rect = rect;
        return true;
    });
}

void MediaFileStats::setEffectDef(const boost::shared_ptr<const EffectDef>& effectDef) {
    edit([&] {
        if (effectDef_ == effectDef) return false;
        effectDef_ = effectDef;
        return true;
    });
}

boost::shared_ptr<const EffectDef> MediaFileStats::effectDef() const {
    ScopedReadLock lock(projectLock());
    return effectDef_;
}

boost::shared_ptr<MediaFileStats>
MediaFileStats::copy(const boost::weak_ptr<const ThreadSafe>& projectMutex) const {
    const boost::shared_ptr<MediaFileStats> result(new MediaFileStats(projectMutex));
    ScopedReadLock lock(projectLock());
    result->contents_ = contents_;
    result->effectDef_ = effectDef_;
    return result;
}

} // namespace VelaMediaLib

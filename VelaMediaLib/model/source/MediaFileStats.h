#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/model/source/TrackStats.h>
#include <VelaMediaLib/time/sync/Subject.h>

#include <boost/enable_shared_from_this.hpp>
#include <boost/shared_ptr.hpp>
#include <boost/weak_ptr.hpp>
#include <string>
#include <vector>

namespace VelaMediaLib {

class EffectDef;
class StatsLoader;
class ThreadSafe;

/// What is known about one media file: its name, one TrackStats per stream in
/// file order, and its picture rectangle. Stats loaders fill it; the library
/// decodes nothing itself.
///
/// Reads take the project's read lock and changes its write lock, when the
/// record belongs to a project; changes tell the observers after the lock
/// ends, and only when something changed. Per-stream accessors throw
/// IndexException "stream index out of range" for an index outside
/// [0, numTracks()).
class VELAMEDIALIB_API MediaFileStats : public VelaObject,
                                        public Subject,
                                        public boost::enable_shared_from_this<MediaFileStats> {
public:
    /// The whole record as one value.
    struct Contents {
        std::string filename;
        std::vector<TrackStats> tracks;
        Rect<int> rect;

        bool operator==(const Contents& o) const {
            return filename == o.filename && tracks == o.tracks && rect == o.rect;
        }
        bool operator!=(const Contents& o) const { return !(*this == o); }
    };

    ~MediaFileStats() override;

    /// An empty record of no project.
    static boost::shared_ptr<MediaFileStats> create();
    /// Asks the process-wide loaders in list order; the first that answers
    /// true fills the record, which is named `path` whatever the loader
    /// wrote. A loader that throws is passed over. Throws IOException
    /// "no stats loader could read file: <path>" when none answers, followed
    /// by " (<text>)" of the first loader that threw, and the exceptions of
    /// checkContents for an answer without streams or with a bad one.
    static boost::shared_ptr<MediaFileStats>
    create(const std::string& path, const boost::weak_ptr<const ThreadSafe>& projectMutex = {});
    /// Throws IOException "file has no streams: <path>" for contents without
    /// streams, and "bad stream <index> in file: <path>" for a stream of no
    /// rate or of a negative length.
    static void checkContents(const Contents& contents);
    /// Whether create(path) would succeed; never throws.
    static bool isFileOpenable(const std::string& path);

    /// Puts `loader` into the process-wide list: before every loader present
    /// for a non-zero priority, after them for 0. A loader already in the
    /// list moves there. Safe while other threads load stats, which keep
    /// using the list as it was when they started. Throws VelaMediaLibException
    /// "list too long" when the list cannot grow, and for a null loader.
    static void addStatsLoader(const boost::shared_ptr<StatsLoader>& loader, int priority = 0);
    /// Returns whether the loader was in the list.
    static bool removeStatsLoader(const boost::shared_ptr<StatsLoader>& loader);
    /// The loaders in the order they are asked.
    static std::vector<boost::shared_ptr<StatsLoader>> statsLoaders();
    /// Hands the stream ranges of `stats` to every CachingStatsLoader in the
    /// list, for the entry they keep for its file.
    static void updateCachedDurationsFromStats(const MediaFileStats& stats);

    /// Whether the file of `other` may replace this one under the same
    /// source: the same number of streams, and stream by stream the same
    /// TrackType and, for audio, the same number of channels (so every clip
    /// of the source still finds its stream). Records without streams are
    /// compatible.
    bool areCompatibleForChange(const MediaFileStats& other) const;

    std::string filename() const;
    int numTracks() const;
    Rect<int> rect() const;
    /// From the earliest stream start to the latest stream end, in seconds,
    /// as Range(start, duration); Range(0, 0) without streams. Streams with a
    /// zero range rate have no time and are left out.
    Range<double> mediaRangeInSeconds() const;
    /// The sample rate of the first Video or ScreenVideo stream; 0 when none.
    SafeRational videoFrameRateOfFirstVideoTrack() const;
    /// The sample rate of the first Audio stream; 0 when none.
    SafeRational audioSampleRateOfFirstAudioTrack() const;
    Contents contents() const;

    TrackType trackType(int index) const;
    Range<long long> trackRange(int index) const;
    boost::rational<unsigned long> rangeEditRate(int index) const;
    SafeRational sampleRate(int index) const;
    Rect<int> trackRect(int index) const;
    int bitDepth(int index) const;
    int numChannels(int index) const;
    double integratedLUFS(int index) const;
    double peakLevel(int index) const;
    MediaOrientation mediaOrientation(int index) const;
    std::vector<std::string> metaData(int index) const;
    /// The file of the stream: its own when it names one, else the record's.
    std::string filename(int index) const;
    int fileTrackNumberForTrackStatsIndex(int index) const;
    TrackStats trackStats(int index) const;

    void setContents(const Contents& contents);
    void setFilename(const std::string& filename);
    /// The same for an owner that renames under its write lock and notifies
    /// after it; returns whether the name changed.
    bool setFilenameUnnotified(const std::string& filename);
    void addTrackStats(const TrackStats& stats);
    /// Throws IndexException for a bad index, changing nothing.
    void setTrackStats(int index, const TrackStats& stats);
    void setRect(const Rect<int>& rect);
    void setEffectDef(const boost::shared_ptr<const EffectDef>& effectDef);
    boost::shared_ptr<const EffectDef> effectDef() const;

    /// A new record with the same contents and effect, of the project of `projectMutex`.
    boost::shared_ptr<MediaFileStats> copy(const boost::weak_ptr<const ThreadSafe>& projectMutex) const;

    boost::weak_ptr<const void> lifeline() const override { return weak_from_this(); }

protected:
    explicit MediaFileStats(const boost::weak_ptr<const ThreadSafe>& projectMutex = {});

private:
    /// The stream at `index`, under a lock the caller holds; throws IndexException.
    const TrackStats& trackAt(int index) const;
    /// Runs `change` on the contents under the write lock; notifies when it returns true.
    template <typename Change>
    void edit(Change change);

    Contents contents_;
    boost::shared_ptr<const EffectDef> effectDef_;
};

} // namespace VelaMediaLib

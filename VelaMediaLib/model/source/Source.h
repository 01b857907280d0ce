#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/base/XMLIdentified.h>
#include <VelaMediaLib/model/source/OfflineStatus.h>
#include <VelaMediaLib/model/source/SourceMediaIterator.h>
#include <VelaMediaLib/time/parameters/Attributable.h>
#include <VelaMediaLib/time/parameters/MetaDatable.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/SafeRational.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

#include <atomic>
#include <boost/enable_shared_from_this.hpp>
#include <boost/rational.hpp>
#include <string>
#include <vector>

namespace VelaMediaLib {

class FileSystem;
class MediaFileStats;
class ParameterInterface;
class ProjectEditRate;
class ThreadSafe;
class Timeline;

/// One imported media file of a project. It knows the file through its stats
/// record, and plays each stream through a clip of its own, kept on a
/// timeline of its own (one track per stream); clips placed on the project's
/// timeline are clones of those and hold the source alive. Stream ranges are
/// given in ticks of the source's edit rate, the project's, exactly.
///
/// A source is made online. Whether its file is still there is a question
/// asked of its file system (offlineStatus); the project takes a source
/// offline or back online (dropSourceOffline, bringSourceOnline).
class VELAMEDIALIB_API Source : public VelaObject,
                                public XMLable,
                                public MetaDatable,
                                public Attributable,
                                public boost::enable_shared_from_this<Source> {
public:
    /// Reads the file's stats through the registered loaders (see
    /// MediaFileStats::create, whose exceptions it lets through). Without a
    /// file system the host's own is used.
    static boost::shared_ptr<Source> create(const boost::weak_ptr<ProjectEditRate>& rate,
                                            const boost::weak_ptr<const ThreadSafe>& token,
                                            const std::string& path,
                                            const boost::shared_ptr<FileSystem>& fileSystem = {});
    /// A source of stats already read. Throws VelaMediaLibException for a null
    /// record or a project without an edit rate, and IOException "file has no
    /// streams: <path>" for a record without streams.
    static boost::shared_ptr<Source> create(const boost::weak_ptr<ProjectEditRate>& rate,
                                            const boost::weak_ptr<const ThreadSafe>& token,
                                            const boost::shared_ptr<MediaFileStats>& stats,
                                            const boost::shared_ptr<FileSystem>& fileSystem = {});
    ~Source() override;

    /// The metadata key of the time the source was added (UTC, ISO 8601).
    static const char* timeAddedMetaDataKey() { return "timeAdded"; }

    // The file
    boost::shared_ptr<MediaFileStats> stats() const;
    std::string filename() const;
    int numTracks() const;
    const boost::shared_ptr<FileSystem>& fileSystem() const { return fileSystem_; }
    /// The project's edit rate, as the source's clips hold it.
    const boost::weak_ptr<ProjectEditRate>& editRateToken() const { return rateToken_; }
    bool isOnline() const { return online_.load(std::memory_order_acquire); }
    /// 0 online; 1 the file is gone; 2 it is there but unreadable; else 4
    /// when stats can be made for it again (it can be reconnected), 3 when not.
    OfflineStatus offlineStatus() const;

    // Time, in ticks of the source's edit rate
    boost::rational<unsigned long> editRate() const;
    /// Every stream together: from the earliest start to the latest end.
    Range<VelaTime> timeRange() const;
    /// A stream's range widened to whole ticks (start rounded down, end up).
    Range<VelaTime> timeRangeForTrack(int stream) const;
    /// A stream's range exactly: the limits of the clips that play it.
    Range<SafeRational> rationalTimeRangeForTrack(int stream) const;
    Rect<int> trackRect(int stream) const;

    boost::shared_ptr<Attribute<bool>> shouldApplyLoudnessNormalizationAttribute() const {
        return attribute<bool>("shouldApplyLoudnessNormalization");
    }

    // The source's own clips, one per stream of a kind a clip can play
    boost::shared_ptr<Timeline> timeline() const { return timeline_; }
    /// The clip of the stream; null for a stream no clip kind plays.
    boost::shared_ptr<Media> mediaForTrackNumber(int stream) const;
    boost::shared_ptr<ParameterInterface> paramWithName(const std::string& name, int stream) const;
    std::vector<boost::shared_ptr<ParameterInterface>> parameterVector(int stream) const;
    /// The source's clips of a kind (Media, VisualMedia or AudioMedia), in stream order.
    template <typename Kind = Media>
    SourceMediaIterator<Kind> mediaBegin() const {
        return SourceMediaIterator<Kind>(&streamMedia_, 0);
    }
    template <typename Kind = Media>
    SourceMediaIterator<Kind> mediaEnd() const {
        return SourceMediaIterator<Kind>(&streamMedia_, streamMedia_.size());
    }

    // Changes, made by the project and its source bin
    /// Rebuilds the limits of the source's own clips for the new rate.
    void setEditRate(const boost::rational<unsigned long>& rate);
    void setOnline(bool online) { online_.store(online, std::memory_order_release); }
    /// Takes the stats of another file: the source's clips take its streams' ranges.
    void setStats(const boost::shared_ptr<MediaFileStats>& stats);
    /// Renames the file: the stats record keeps its streams.
    void setFilename(const std::string& path);

private:
    Source(const boost::weak_ptr<ProjectEditRate>& rate, const boost::weak_ptr<const ThreadSafe>& token,
           const boost::shared_ptr<MediaFileStats>& stats, const boost::shared_ptr<FileSystem>& fileSystem);
    void buildStreamMedia();
    MediaPtr makeStreamMedia(int stream) const;
    void refitStreamMedia();

    boost::weak_ptr<ProjectEditRate> rateToken_;
    boost::rational<unsigned long> editRate_; // guarded by the project's lock
    boost::shared_ptr<MediaFileStats> stats_; // guarded by the project's lock
    boost::shared_ptr<FileSystem> fileSystem_;
    std::atomic<bool> online_{true};
    boost::shared_ptr<Timeline> timeline_;
    std::vector<MediaPtr> streamMedia_; // by stream; fixed once built
};

typedef boost::shared_ptr<Source> SourcePtr;

} // namespace VelaMediaLib

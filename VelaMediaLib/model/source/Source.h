#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/base/XMLIdentified.h>
#include <VelaMediaLib/model/media/MediaState.h>
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
class XMLOptions;

/// What a change of file or rate gives a source: the stats, the rate, and
/// the states its own clips take (stills keep theirs). Made and taken by the
/// source, its bin and its project.
struct VELAMEDIALIB_API SourceRefit {
    boost::shared_ptr<MediaFileStats> stats;
    boost::rational<unsigned long> rate;
    std::vector<MediaState> states;
    std::vector<bool> changed; // which clips took a new state, to be told
};

/// One imported media file of a project. It knows the file through its stats
/// record, and plays each stream through a clip of its own, kept on a
/// timeline of its own (one track per stream); clips placed on the project's
/// timeline are clones of those and hold the source alive. Stream ranges are
/// given in ticks of the source's edit rate, the project's, exactly.
///
/// A source is made online. Whether its file is still there is a question
/// asked of its file system (offlineStatus); the project takes a source
/// offline or back online (dropSourceOffline, bringSourceOnline).
///
/// Queries take the project's read lock and may be asked from any thread.
/// The file, the edit rate and the stats change only through the project
/// and its source bin (changeSourcesFile, renameSourcesFile, setEditRate),
/// whole or not at all, under the write lock.
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
    /// record or a project without an edit rate, and the exceptions of
    /// MediaFileStats::checkContents.
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
    /// when stats can be made for it again (it can be reconnected), 3 when
    /// not. For an offline source this asks the file system and then the
    /// stats loaders (which may read the file) on every call.
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
    boost::shared_ptr<const Timeline> timeline() const { return timeline_; }
    /// The clip of the stream; null for a stream no clip kind plays.
    boost::shared_ptr<Media> mediaForTrackNumber(int stream) const;
    boost::shared_ptr<ParameterInterface> paramWithName(const std::string& name, int stream) const;
    std::vector<boost::shared_ptr<ParameterInterface>> parameterVector(int stream) const;
    /// The source's clips of a kind (Media, VisualMedia or AudioMedia), in
    /// stream order; an iterator keeps the source alive.
    template <typename Kind = Media>
    SourceMediaIterator<Kind> mediaBegin() const {
        return SourceMediaIterator<Kind>(streamMedia(), 0);
    }
    template <typename Kind = Media>
    SourceMediaIterator<Kind> mediaEnd() const {
        return SourceMediaIterator<Kind>(streamMedia(), streamMedia_.size());
    }

    /// The source's entry, closed at indent: "id", "src" (the path as the
    /// options' path modifier makes it), "rect", "lastMod", "sourceTracks",
    /// "loudnessNormalization", "metadata" (SourceDocument.cpp).
    void toJSON(XMLOptions& options, int indent) const;

    /// Marks the source offline or online (the project does, see
    /// Project::dropSourceOffline and bringSourceOnline).
    void setOnline(bool online) { online_.store(online, std::memory_order_release); }

private:
    friend class SourceBin;
    friend class InternalProject;

    Source(const boost::weak_ptr<ProjectEditRate>& rate, const boost::weak_ptr<const ThreadSafe>& token,
           const boost::shared_ptr<MediaFileStats>& stats, const boost::shared_ptr<FileSystem>& fileSystem);
    void buildStreamMedia();
    /// The list of the source's own clips, keeping the source alive.
    boost::shared_ptr<const std::vector<MediaPtr>> streamMedia() const {
        return boost::shared_ptr<const std::vector<MediaPtr>>(shared_from_this(), &streamMedia_);
    }
    MediaPtr makeStreamMedia(int stream) const;

    // Changes, made by the project and its source bin, whole or not at all.
    // A change is computed (refitFor) and swapped in (swapIn) under one
    // write lock with the rest of the caller's change, so that readers see
    // the stats, the rate and the source's own clips change together; the
    // clips that changed are told once the lock is released (settle), so
    // that no observer runs under the write lock.

    /// The refit for other stats and rate. Throws VelaMediaLibException "file
    /// is not compatible with the source's file: <path>" for stats whose
    /// streams do not match (MediaFileStats::areCompatibleForChange), and
    /// "stream <i> of <path> has no length at this edit rate" when a stream
    /// one of the source's clips plays would have none.
    SourceRefit refitFor(const boost::shared_ptr<MediaFileStats>& stats,
                         const boost::rational<unsigned long>& rate) const;
    /// Takes the refit's stats, rate and clip states (alone on their tracks
    /// and consistent, the clips cannot refuse); the caller holds the write
    /// lock it computed the refit under.
    void swapIn(SourceRefit& refit);
    /// Tells the clips that changed.
    void settle(const SourceRefit& refit);
    void setEditRate(const boost::rational<unsigned long>& rate);
    void setStats(const boost::shared_ptr<MediaFileStats>& stats);
    /// Renames the file: the stats record keeps its streams.
    void setFilename(const std::string& path);

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

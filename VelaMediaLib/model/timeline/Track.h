#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/sync/AddObserverList.h>
#include <VelaMediaLib/base/Cloneable.h>
#include <VelaMediaLib/model/media/IdentityTimeConverter.h>
#include <VelaMediaLib/model/media/Media.h>
#include <VelaMediaLib/model/timeline/ClipIndex.h>
#include <VelaMediaLib/model/timeline/SubTimelineParts.h>
#include <VelaMediaLib/model/timeline/TrackAddObserver.h>

#include <boost/enable_shared_from_this.hpp>
#include <map>
#include <memory>
#include <memory_resource>
#include <set>
#include <vector>

namespace VelaMediaLib {

class Mixer;
class Timeline;

/// A track: clips keyed by start tick, never overlapping, so the map's order
/// is the clips' order. Two ranges collide when they share a tick; a clip
/// that ends where another starts touches it. Every edit through the track
/// checks for collisions before anything changes. Flags are boolean
/// attributes ("audioMuted", "videoHidden", "magnetic", "matte", "solo", all
/// false on a new track); the locked flag is metadata ("isLocked").
class VELAMEDIALIB_API Track : public SubTimelineParts<SubTimeline>,
                               public Cloneable,
                               public IdentityTimeConverter,
                               public boost::enable_shared_from_this<Track> {
public:
    /// Clips by start. The nodes come from a pool of the track's own, so a
    /// query walks memory that lies together rather than nodes scattered
    /// between the clips allocated when they were placed.
    typedef std::pmr::map<VelaTime, MediaPtr> MediaMap;
    /// The clip at a time, or the two touching clips there (the earlier first).
    typedef std::pair<MediaPtr, MediaPtr> Pair;
    /// The answer of a query made under a lock the caller holds.
    typedef std::pair<Media*, Media*> RawPair;
    typedef Media::TransitionAndNeighbour TransitionAndNeighbour;
    typedef boost::function<void(const MediaPtr&)> MediaVisitor;
    /// A visitor that may set its flag to stop the walk.
    typedef boost::function<void(const MediaPtr&, bool& stop)> MediaVisitorWithExit;

    /// A clip and the part of a given range that it covers.
    struct MediaRange {
        MediaPtr media;
        Range<VelaTime> range;
    };
    /// A clip found at a time, and that time as the clip's parametric time.
    struct MediaAtTime {
        MediaPtr media;
        SafeRational parametricTime;
    };

    explicit Track(const boost::weak_ptr<const ThreadSafe>& token);
    ~Track() override;
    boost::weak_ptr<const void> lifeline() const override { return weak_from_this(); }

    static const char* isLockedMetaDataKey() { return "isLocked"; }

    // Contents
    void removeMedia(const MediaPtr& media);
    bool hasMedia(const MediaPtr& media) const;
    size_t numMedias() const;
    /// The clips in start order.
    std::vector<MediaPtr> medias() const;
    /// The clips of the track and, inside groups, theirs.
    std::vector<MediaPtr> allMedias() const;
    /// A copy of the map; iterate it freely.
    MediaMap mediaMap() const;
    /// Iterators over the map itself, by start, without copying it. The
    /// caller must hold the project's read lock (ScopedReadLock on the
    /// track's projectLock()) for as long as it uses them: any edit of the
    /// track may invalidate them.
    MediaMap::const_iterator mediaBegin() const { return medias_.begin(); }
    MediaMap::const_iterator mediaEnd() const { return medias_.end(); }
    MediaMap::const_reverse_iterator mediaRBegin() const { return medias_.rbegin(); }
    MediaMap::const_reverse_iterator mediaREnd() const { return medias_.rend(); }
    /// The first clip starting at or after the time / after the time (same rule).
    MediaMap::const_iterator lower_bound(VelaTime start) const { return medias_.lower_bound(start); }
    MediaMap::const_iterator upper_bound(VelaTime start) const { return medias_.upper_bound(start); }
    std::vector<TransitionPtr> transitions() const;

    // Queries by time
    /// The clip that holds the tick; at a cut between two touching clips,
    /// both, left then right.
    Pair mediaAtTime(VelaTime time) const;
    /// The same answer without taking the lock or sharing the clips: for a
    /// host that holds the project's read lock (ScopedReadLock on
    /// projectLock()) around many queries. The pointers stay valid while it
    /// holds the lock, the project lives (edits of a project that has gone
    /// take no lock) and it makes no edit itself: an edit on the holding
    /// thread gives the read share up meanwhile, and may free the clips.
    RawPair mediaAtTimeUnderLock(VelaTime time) const;
    std::vector<MediaPtr> mediasIntersectingRange(const Range<VelaTime>& range,
                                                  const MediaPtr& leftOut = MediaPtr()) const;
    std::vector<MediaPtr> mediasIntersectingRange(const Range<VelaTime>& range,
                                                  const std::vector<MediaPtr>& leftOut) const;
    std::vector<MediaPtr> mediasIntersectingRange(const Range<VelaTime>& range,
                                                  const std::set<MediaPtr>& leftOut) const;
    bool intersectionAtRange(const Range<VelaTime>& range) const;
    std::vector<MediaRange> subSection(const Range<VelaTime>& range) const;
    static MediaPtr getLeftOfMedia(const MediaPtr& media);
    static MediaPtr getRightOfMedia(const MediaPtr& media);
    static MediaPtr getTouchingMediaToLeftOfMedia(const MediaPtr& media);
    static MediaPtr getTouchingMediaToRightOfMedia(const MediaPtr& media);

    // Edits that refuse collisions; each returns what it separated. A clip
    // edited by itself (clip->move) comes here too.
    TransitionAndNeighbour move(const MediaPtr& media, VelaTime offset);
    TransitionAndNeighbour trimStart(const MediaPtr& media, VelaTime offset);
    TransitionAndNeighbour trimEnd(const MediaPtr& media, VelaTime offset);
    SafeRational stretch(const MediaPtr& media, const SafeRational& factor);
    double stretch(const MediaPtr& media, double factor);
    void restoreMediaState(const MediaPtr& media, const MediaState& state, VelaTime tolerance);

    // Copies and visits
    /// Clones of the clips inside the range, cut to it and counted from its start;
    /// `copied` (when given) maps each original to its copy.
    boost::shared_ptr<Track> copyPortion(const Range<VelaTime>& range,
                                         std::map<MediaPtr, MediaPtr>* copied = nullptr) const;
    /// Clones of the given clips of this track, counted from the earliest one's start.
    boost::shared_ptr<Track> copyPortion(const std::vector<MediaPtr>& clips,
                                         std::map<MediaPtr, MediaPtr>* copied = nullptr) const;
    /// Each clip, and after a group the clips inside it, at any depth.
    void recursivelyVisitAllMedia(const MediaVisitor& visitor) const;
    /// Returns true when the visitor stopped the walk.
    bool recursivelyVisitAllMediaWithEarlyExitFlag(const MediaVisitorWithExit& visitor) const;
    /// The clips at a time of the track (exact: inside a group it may fall
    /// between ticks), as mediaAtTime finds them (both touching clips at a
    /// whole tick; between ticks only the clip holding the time), each
    /// followed by what it plays there when it is a group, at any depth.
    /// Whether the clip is made of clips (a group, a stitched or unified clip):
    /// it is seen and heard through them.
    static bool isMadeOfClips(const Media& media);
    /// The clip this track lies in (a group's or a stitched clip's), or null.
    MediaPtr enclosingClip() const;
    /// The clip the clip lies in (through its track, or a unified clip), or null.
    static MediaPtr enclosingClipOf(const Media& media);
    /// Whether `container` is the clip or lies inside it at any depth: then
    /// the clip may not be put into it.
    static bool isWithin(const Media* container, const Media& clip);
    /// Visits the clip and every clip inside it, at any depth (groups,
    /// stitched and unified clips); true when the visitor stopped.
    static bool visitWithin(const MediaPtr& media, const MediaVisitorWithExit& visitor);
    /// What a clip made of clips plays at its parametric time, at any depth,
    /// each with the time inside it; nothing for a plain clip.
    static void collectInside(const Media& media, const SafeRational& time, std::vector<MediaAtTime>& out);
    void recursivelyCollectMediasAtTime(const SafeRational& time, std::vector<MediaAtTime>& out) const;

    // Flags
    boost::shared_ptr<Attribute<bool>> audioMutedAttribute() const { return flag("audioMuted"); }
    boost::shared_ptr<Attribute<bool>> videoHiddenAttribute() const { return flag("videoHidden"); }
    boost::shared_ptr<Attribute<bool>> magneticAttribute() const { return flag("magnetic"); }
    boost::shared_ptr<Attribute<bool>> matteAttribute() const { return flag("matte"); }
    boost::shared_ptr<Attribute<bool>> soloAttribute() const { return flag("solo"); }
    bool isLocked() const;
    void setIsLocked(bool locked);
    bool isParentMixerInSoloMode() const;
    bool isAudible() const { return isAudible(isParentMixerInSoloMode()); }
    bool isVisible() const { return isVisible(isParentMixerInSoloMode()); }
    bool isRenderable() const { return isRenderable(isParentMixerInSoloMode()); }
    bool isAudible(bool soloMode) const;
    bool isVisible(bool soloMode) const;
    bool isRenderable(bool soloMode) const { return isVisible(soloMode) || isAudible(soloMode); }
    /// Neither seen nor heard.
    bool isDisabled() const { return !isRenderable(); }
    boost::shared_ptr<Parameter<double>> volume() const { return typedParameter<double>("volume"); }

    // Parents and observers
    boost::shared_ptr<Mixer> parentMixer() const;
    /// The timeline the track's mixer belongs to (through a group, its
    /// timeline), followed at each call; null off a timeline.
    boost::shared_ptr<Timeline> parentTimeline() const;
    void setParentMixer(const boost::weak_ptr<Mixer>& mixer);
    MediaPtr parentStitchedMedia() const;
    void setParentStitchedMedia(const boost::weak_ptr<Media>& media);
    void attachAddObserver(TrackAddObserver* observer);
    void detachAddObserver(TrackAddObserver* observer);

    // Time: a track passes its container's time through unchanged.
    VelaTime startTime() const override;
    VelaTime endTime() const override;
    /// The end of the last clip: a track's time starts at 0.
    VelaTime duration() const override { return endTime(); }
    Range<VelaTime> timeRange() const override { return Range<VelaTime>(0, endTime()); }
    /// The mixer, or the stitched clip holding the track, if any.
    TimeConverterPtr parentTimeConverter() const override;

    // Document (TrackDocument.cpp)
    /// The track's object, closed at indent: "trackIndex", "medias" (in time
    /// order), "transitions" (each once, after every clip has its id),
    /// "effects" and "metadata" (when not empty). With withFlags, the name
    /// and flags too ("ident", "audioMuted", ...) before "metadata": for tracks
    /// that no "trackAttributes" entry describes (groups' tracks, later scenes).
    void toJSON(XMLOptions& options, int indent, int trackIndex, bool withFlags = false) const;
    /// The track's "trackAttributes" entry, closed at indent: "ident",
    /// "audioMuted", "videoHidden", "magnetic", "matte", "solo", "metadata".
    void toJSONTrackAttributes(XMLOptions& options, int indent) const;

    /// An empty track of the same kind with the same flags, name and parameters.
    virtual boost::shared_ptr<Track> cloneEmpty() const = 0;

protected:
    /// Places the clip: refuses a collision, keys it, adopts it, merges
    /// transitions at both ends and tells the add observers.
    void addMediaSansTypeCheck(const MediaPtr& media, VelaTime start);
    boost::shared_ptr<ParameterInterface> createDefaultParameter(const std::string& name) const override;
    std::vector<std::string> defaultParameterNames() const override { return {"volume"}; }
    void copyFlagsInto(Track& other) const;

private:
    friend class MediaImpl;
    boost::shared_ptr<Attribute<bool>> flag(const char* key) const { return attribute<bool>(key); }
    void refuseCollision(const Range<VelaTime>& range, const MediaPtr& media) const;
    /// AddRemoveException when the clip is a group holding this track.
    void refuseEnclosingGroup(const MediaPtr& media) const;
    /// The clip's entry: it is on this track when the track is its parent,
    /// keyed under its start (every timing edit of a placed clip re-keys it).
    MediaMap::const_iterator findMedia(const MediaPtr& media) const;
    template <typename Answer>
    typename Answer::Result answerAtTime(VelaTime time) const;
    /// A timing edit of a clip on this track, under the write lock the caller
    /// holds: the clip's preview checked for collisions, the edit computed
    /// (it may refuse), taken and re-keyed in one step with no other code
    /// running in between. Does not notify: `changed` tells the caller to.
    TransitionAndNeighbour editLocked(const MediaPtr& media, const Media::TimingEdit& edit, bool& changed,
                                      MediaState* after);
    /// editLocked under its own write lock, then the clip's notification.
    TransitionAndNeighbour editPlaced(const MediaPtr& media, const Media::TimingEdit& edit,
                                      MediaState* after = nullptr);

    std::unique_ptr<std::pmr::unsynchronized_pool_resource> nodePool_; // before the map that uses it
    MediaMap medias_;
    ClipIndex index_; // the map's clips with their ends, for the time queries
    boost::weak_ptr<Mixer> parentMixer_;
    boost::weak_ptr<Media> parentStitched_;
    AddObserverList<TrackAddObserver> addObservers_;
};

typedef boost::shared_ptr<Track> TrackPtr;

} // namespace VelaMediaLib

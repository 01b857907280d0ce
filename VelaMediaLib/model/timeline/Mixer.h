#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/timeline/MixerAddObserver.h>
#include <VelaMediaLib/model/timeline/RemoveTrackInfo.h>
#include <VelaMediaLib/model/timeline/Track.h>

namespace VelaMediaLib {

class Source;

class Timeline;

/// An ordered list of tracks; a track's index is its place in the list. A
/// mixer belongs to a timeline or to a group clip, never both. It observes
/// its tracks and passes their clip additions and removals on.
class VELAMEDIALIB_API Mixer : public SubTimelineParts<SubTimeline>,
                               public Cloneable,
                               public IdentityTimeConverter,
                               public TrackAddObserver,
                               public boost::enable_shared_from_this<Mixer> {
public:
    typedef std::vector<TrackPtr> Tracks;

    explicit Mixer(const boost::weak_ptr<const ThreadSafe>& token)
        : SubTimeline(token), SubTimelineParts(token) {}
    ~Mixer() override;
    boost::weak_ptr<const void> lifeline() const override { return weak_from_this(); }

    // Tracks
    TrackPtr trackAtIndex(unsigned index) const;
    /// The track's index, or -1 when the mixer does not hold it.
    int indexForTrack(const TrackPtr& track) const;
    Tracks tracks() const;
    /// Iterators over the list itself; the caller holds the project's read
    /// lock while it uses them.
    Tracks::const_iterator trackBegin() const { return tracks_.begin(); }
    Tracks::const_iterator trackEnd() const { return tracks_.end(); }
    size_t numTracks() const;
    bool hasTrack(const TrackPtr& track) const;
    /// Returns whether the mixer held the track.
    bool removeTrack(const TrackPtr& track);
    void removeTracks(const Tracks& tracks);
    /// Swaps the places of two tracks the mixer holds and notifies; false,
    /// changing nothing, when it does not hold both.
    bool swapTrackOrder(const TrackPtr& first, const TrackPtr& second);
    /// Removes the track and says how to put it back; throws AddRemoveException
    /// when the mixer does not hold it.
    RemoveTrackInfo removeTrackImpl(const TrackPtr& track);
    /// True when a's index is lower than b's (in their mixers).
    static bool sortTracksByIndex(const TrackPtr& a, const TrackPtr& b);

    // The tracks together
    std::vector<MediaPtr> allMedias() const;
    /// The sources the clips play, each once.
    std::vector<boost::shared_ptr<const Source>> allSources() const;
    bool hasAudio() const;
    bool hasVisual() const;
    VelaTime startTime() const override;
    VelaTime endTime() const override;
    VelaTime duration() const override { return endTime(); }
    Range<VelaTime> timeRange() const override { return Range<VelaTime>(0, endTime()); }
    /// The end of the last clip on the tracks that are seen or heard.
    VelaTime endTimeNotIncludingHiddenAndMutedTracks() const;
    /// At least one track has "solo" set.
    bool isInSoloMode() const;

    // Parents and observers
    boost::shared_ptr<Timeline> parentTimeline() const;
    /// The parent timeline, or the one its parent group lies on.
    boost::shared_ptr<Timeline> enclosingTimeline() const;
    /// Throws when the mixer has a parent group.
    void setParentTimeline(const boost::weak_ptr<Timeline>& timeline);
    MediaPtr parentGroup() const;
    /// Throws when the mixer has a parent timeline.
    void setParentGroup(const boost::weak_ptr<Media>& group);
    void attachAddObserver(MixerAddObserver* observer);
    void detachAddObserver(MixerAddObserver* observer);
    void onTrackAddMedia(Track& track, const MediaPtr& media) override;
    void onTrackRemoveMedia(Track& track, const MediaPtr& media) override;

    /// Copies of the tracks cut to the range (see Track::copyPortion), in order.
    boost::shared_ptr<Mixer> copyPortion(const Range<VelaTime>& range,
                                         std::map<MediaPtr, MediaPtr>* copied = nullptr) const;
    virtual boost::shared_ptr<Mixer> cloneEmpty() const = 0;

    /// The group holding the mixer, or its timeline.
    TimeConverterPtr parentTimeConverter() const override;

protected:
    /// Index -1 appends; 0 to the number of tracks inserts there; any other
    /// throws ValueException<int> "invalid index". A track in another mixer
    /// (or inside a stitched clip) throws AddRemoveException.
    void addTrackSansTypeCheck(const TrackPtr& track, int index);

private:
    /// Folds over the tracks under one read lock, so a concurrent edit
    /// cannot change the list between steps.
    template <typename Fold>
    void eachTrack(Fold fold) const {
        ScopedReadLock lock(projectLock());
        for (const TrackPtr& track : tracks_) fold(*track);
    }

    Tracks tracks_;
    boost::weak_ptr<Timeline> timeline_;
    boost::weak_ptr<Media> group_;
    AddObserverList<MixerAddObserver> addObservers_;
};

typedef boost::shared_ptr<Mixer> MixerPtr;

} // namespace VelaMediaLib

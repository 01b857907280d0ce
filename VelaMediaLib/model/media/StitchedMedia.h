#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/AbstractUnifiedMedia.h>
#include <VelaMediaLib/model/media/ScreenDataProvider.h>
#include <VelaMediaLib/model/media/StitchedMediaChildrensTimeConverter.h>
#include <VelaMediaLib/model/project/Sourceable.h>

#include <boost/optional.hpp>
#include <utility>
#include <vector>

namespace VelaMediaLib {

class Effect;
class Track;

/// A run of clips of one source played one after another as if they were one
/// continuous recording. The clips (its parts) lie end to end on an internal
/// track from 0; the joins are its stitches.
///
/// Times. The stitched media's media time is its internal track's time (its
/// "parameter time"): its media range is the window of the parts it plays,
/// and its scalar stretches that window onto its own track as any clip's
/// does. Its parametric time counts ticks from its start on its track, so
/// internal time = media start + parametric time / scalar, exactly. A part
/// at internal start a plays internal time m at its own parametric time
/// m - a, which is source time media start + (m - a) / scalar of the part.
///
/// Extended time. Its limits reach as far as its source does: before the
/// first part by the media that part could still show at its start, after
/// the last by what that part could show at its end (widened to cover the
/// parts when a part's rounded length reaches past its media). Trimming it
/// outward plays that time beyond its parts, the first or last part
/// continued; removeExtendedTime hands it to those parts for good.
///
/// Parts are given to it and edited through it (a part edited directly keeps
/// its place until the next change of the parts). Every addition checks all
/// its parts first and changes nothing when it refuses.
class VELAMEDIALIB_API StitchedMedia : public AbstractUnifiedMedia,
                                       public ScreenDataProvider,
                                       public Sourceable {
public:
    /// A part and a time inside it, in the part's parametric time.
    typedef std::pair<MediaPtr, SafeRational> MediaAndSubTime;
    /// A part with the state that plays, on the stitched media's track, what
    /// the stitched media plays of it.
    struct Placement {
        MediaPtr media;
        MediaState state;
    };

    /// A time is near a stitch when it lies within half a tick of it (in
    /// parametric time): the tick that rounds to a stitch between ticks finds it.
    static SafeRational stitchTolerance() { return SafeRational(1, 2); }

    /// A stitched media without parts, with the state a document gives it;
    /// the parts follow through addMediaWhileParsing.
    static boost::shared_ptr<StitchedMedia> create(const boost::weak_ptr<const ThreadSafe>& token,
                                                   const boost::weak_ptr<ProjectEditRate>& rate,
                                                   const MediaState& state);
    /// The parts end to end from start on its track, all of them played at
    /// scalar 1. Throws as addMedias does, and VelaMediaLibException "a
    /// stitched media needs at least one clip" for none.
    static boost::shared_ptr<StitchedMedia> create(const std::vector<MediaPtr>& parts, VelaTime start);

    // Parts
    boost::shared_ptr<Track> track() const { return track_; }
    /// The stream of the source its parts play, or -1 when they play none.
    int trackNumber() const;
    /// The parts in the order they play.
    std::vector<MediaPtr> medias() const;
    std::vector<boost::shared_ptr<AudioMedia>> audioMedias() const;
    std::vector<boost::shared_ptr<VisualMedia>> visualMedias() const;
    /// The length of the parts together (the internal track's end).
    VelaTime fullDuration() const;

    // Adding parts
    /// Appends a part after the others. A stitched media that played to the
    /// end of its parts plays the new part too (its media and track durations
    /// grow; on a track that may collide, and then nothing changes); one that
    /// played beyond them first hands its extended end to its last part, so
    /// that what it played stays. A part must lie on no track, belong to the
    /// same project and play the same source as the parts (none counts as a
    /// source: generated clips stitch with each other): AddRemoveException
    /// or VelaMediaLibException otherwise, changing nothing.
    void addMedia(const MediaPtr& media);
    /// The same for several parts, in order, all or none.
    void addMedias(const std::vector<MediaPtr>& medias);
    /// addMedias; with takeProperties, a stitched media that had no parts
    /// then takes the first part's content (name, parameters, attributes,
    /// metadata, effects and edge modifications, as a clone would), so that
    /// it looks as that clip did; the parts keep theirs.
    void addMediasWithPropertiesOptional(const std::vector<MediaPtr>& medias, bool takeProperties);
    /// Places the part after the others and refits the limits to the parts;
    /// the media range stays (the stitched media plays what it played).
    void addMediaToTrackAndUpdateRanges(const MediaPtr& media);
    /// Places a part read from a document where its start says, leaving the
    /// stitched media's own state, which the document gives, alone.
    void addMediaWhileParsing(const MediaPtr& media);
    /// Takes every part off the internal track, leaving the stitched media's
    /// state alone; returns them in order. For unstitching.
    std::vector<MediaPtr> removeAllMedias();
    /// The parts it plays, each with the state that plays on its track what
    /// it plays of that part: cut to the window, placed from its start, at
    /// the part's scalar times its own. Cuts between parts round to the
    /// nearest tick and parts always touch; a part whose speed does not fit
    /// its rounded length exactly gets the scalar that does. A part played
    /// for less than half a tick is left out.
    std::vector<Placement> placementsWherePlayed() const;

    // Stitches
    /// The joins between parts, in internal time.
    std::vector<VelaTime> stitchTimes() const;
    /// The same joins in parametric time (before its start or after its end
    /// when the window cuts them off).
    std::vector<SafeRational> parametricStitchTimes() const;
    size_t numStitches() const;
    /// The stitch within stitchTolerance of the parametric time, if any (the
    /// nearest; the earlier of two as near).
    boost::optional<SafeRational> stitchNearTime(const SafeRational& parametricTime) const;
    /// Its index among the stitches, or -1.
    int stitchIndexNearTime(const SafeRational& parametricTime) const;
    bool isTimeNearStitch(const SafeRational& parametricTime) const;

    // Times
    /// The part playing the parametric tick; at a stitch the later part (a
    /// part holds its start, not its end). Null outside the clip or without parts.
    MediaPtr mediaAtTime(VelaTime parametricTime) const;
    MediaAndSubTime mediaAndSubTimeForParametricTime(const SafeRational& parametricTime) const;
    /// The same for internal time; before the parts the first part answers,
    /// after them the last, continued. A null part without parts.
    MediaAndSubTime mediaAndSubTimeForParameterTime(const SafeRational& parameterTime) const;
    /// The source time played at the parametric time, exactly. Throws
    /// VelaMediaLibException "a stitched media without parts plays no source".
    SafeRational toSubMediaSourceTime(const SafeRational& parametricTime) const;
    /// Whether its parts all play at one speed (the same scalar), so that a
    /// clip speed given to the whole applies to every part alike.
    bool compatibleClipSpeeds() const;

    // Extended time
    /// The internal time it may reach: its parts and the time kept beyond
    /// them for extension (its limits; unbounded sides at the 64-bit extremes).
    Range<SafeRational> extendedTimeRange() const;
    /// The parametric time it plays beyond its parts, before the first and
    /// after the last (0 where it plays within them).
    std::pair<SafeRational, SafeRational> extendedParametricTime() const;
    /// Hands the time it plays beyond its parts to the first and last part
    /// (extended by whole ticks, as far as they allow), so that it plays its
    /// parts only; what it plays does not change. Returns whether anything did.
    bool removeExtendedTime();
    /// How many ticks of its own time a trim of its end by the offset would
    /// play beyond its last part (0 when none would).
    VelaTime extendFrameTrimAmount(VelaTime trimEndOffset) const;

    // Source
    boost::shared_ptr<const Source> source() const override;
    /// Checks every part first; then every part plays the source.
    void setSource(const boost::shared_ptr<const Source>& source) override;
    void checkSource(const boost::shared_ptr<const Source>& source) const override;
    /// The effect applied to the source as a whole (for example a cursor
    /// effect over the recording); clones hold a clone of it.
    boost::shared_ptr<Effect> sourceEffect() const;
    void setSourceEffect(const boost::shared_ptr<Effect>& effect);

    // Screen data, in internal time, asked of the parts that hold it
    /// There is no one recording: throws "StitchedMedia::screenMetaData() unimplemented\n".
    boost::shared_ptr<const ScreenRecordingData> screenMetaData() const;
    /// As screenMetaData; setting throws "StitchedMedia::setScreenData() unimplemented\n".
    boost::shared_ptr<const ScreenRecordingData> screenData() const override { return screenMetaData(); }
    void setScreenData(const boost::shared_ptr<const ScreenRecordingData>& data) override;
    bool hasCursorData() const override;
    /// The part's answer at the source time played; the origin for a part
    /// without screen data.
    Point3d cursorPositionAtTime(const RationalTime& time) const override;
    /// Each part answers for the part of the range it plays (the first
    /// before the parts, the last after them), its events in internal time.
    std::vector<ScreenClick> clicksInRange(const Range<RationalTime>& range) const override;
    std::vector<ScreenKeystroke> keystrokesInRange(const Range<RationalTime>& range) const override;
    /// The first part's with screen data; empty without.
    Rect<int> recordingRect() const override;

    // Not offered by stitched media
    /// Throws "StitchedMedia::splitChannels() unimplemented\n".
    void splitChannels();
    using MediaImpl::findScalar;
    /// Throws "double StitchedMedia::findScalar(double dSuggestedScalar) unimplemented\n".
    double findScalar(double dSuggestedScalar) const;

    /// What its internal track names as converter parent.
    boost::shared_ptr<const StitchedMediaChildrensTimeConverter> childrensTimeConverter() const {
        return converter_;
    }

    /// A deep copy: clones of the parts in their places, the same state,
    /// content and source effect.
    boost::shared_ptr<Media> clone() const override;
    void dispatch(MediaDispatcher& dispatcher) override;
    void dispatch(ConstMediaDispatcher& dispatcher) const override;
    /// Tells the parts, then refits the limits to them.
    void mediaSourceChanged() override;
    /// The source a clip plays: a file clip's, a unified clip's parts' (the
    /// visual part's first), or null; clips that can be stitched share it.
    static boost::shared_ptr<const Source> sourceOf(const MediaPtr& media);
    /// Writes "medias", the parts.
    void toJSONSpecificProperties(XMLOptions& options, int indent) const override;

private:
    StitchedMedia(const boost::weak_ptr<const ThreadSafe>& token,
                  const boost::weak_ptr<ProjectEditRate>& rate, const MediaState& state);
    void adopt();

    /// Refuses parts it cannot take, before anything changes.
    void checkParts(const std::vector<MediaPtr>& parts) const;
    /// Appends checked parts; grows the window when it played to the end.
    void appendParts(const std::vector<MediaPtr>& parts, bool growWindow);
    /// The state with its limits refitted to the parts (and widened to the window).
    MediaState withPartLimits(MediaState state) const;
    /// Takes a state computed here (through its track when it stands on one).
    void takeState(const MediaState& next);
    bool extendFirstPart();
    bool extendLastPart();
    template <typename Event, typename Ask>
    std::vector<Event> eventsInRange(const Range<RationalTime>& range, Ask ask) const;

    boost::shared_ptr<Track> track_;
    boost::shared_ptr<StitchedMediaChildrensTimeConverter> converter_;
    boost::shared_ptr<Effect> sourceEffect_;
};

} // namespace VelaMediaLib

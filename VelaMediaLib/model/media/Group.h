#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/format/JSONTree.h>
#include <VelaMediaLib/model/media/AbstractUnifiedMedia.h>
#include <VelaMediaLib/model/media/GroupChildrensTimeConverter.h>
#include <VelaMediaLib/model/media/GroupMediaState.h>
#include <VelaMediaLib/model/timeline/GenericMixer.h>
#include <VelaMediaLib/model/timeline/MixerAddObserver.h>

#include <string>
#include <typeinfo>
#include <vector>

namespace VelaMediaLib {

/// A clip made of clips: it owns one mixer (whose parent group it is) with
/// tracks of its own, and stands on its parent track as one clip, seen and
/// heard. Its media is the time of its own tracks: it plays the slice from
/// its media start at its scalar (temporal editor, limits those it was made
/// with), so a child at inner time c plays at the group's parametric time
/// (c - media start) * scalar. Trimming a group moves its window over its
/// children, which stay where they are in its inner time.
///
/// Its canvas is the int attributes "widthAttr" and "heightAttr" (0: not set). Its
/// quick properties are names kept one per line in the string attribute
/// "quickPropertyList"; its animation tracks are double parameters named
/// "animationTrack:" + name, so that they clone and write with its other
/// parameters.
class VELAMEDIALIB_API Group final : public AbstractUnifiedMedia, public MixerAddObserver {
public:
    /// An empty group (a new mixer without tracks) on its track from start for
    /// duration ticks, playing its inner time [0, duration) at scalar 1.
    static boost::shared_ptr<Group> create(const boost::weak_ptr<const ThreadSafe>& token,
                                           const boost::weak_ptr<ProjectEditRate>& rate, VelaTime start,
                                           VelaTime duration);
    /// A group of the mixer's clips, playing them all at scalar 1 (from the
    /// earliest clip's start to the latest end) from start on its track.
    /// Throws ValueException<long long> "a group needs clips to play" for an
    /// empty mixer, and as createFromMediaRange does.
    static boost::shared_ptr<Group> create(const boost::weak_ptr<const ThreadSafe>& token,
                                           const boost::weak_ptr<ProjectEditRate>& rate,
                                           const boost::shared_ptr<GenericMixer>& mixer, VelaTime start);
    /// A group playing the slice of its mixer's time at the scalar, from start
    /// on its track; its limits are the slice and the mixer's clips together.
    /// The mixer becomes the group's: AddRemoveException when there is none,
    /// when it already has a group, or when it belongs to another project;
    /// VelaMediaLibException "Cannot set parent group on a mixer that has a
    /// parent timeline" when it is a timeline's.
    static boost::shared_ptr<Group> createFromMediaRange(const boost::weak_ptr<const ThreadSafe>& token,
                                                         const boost::weak_ptr<ProjectEditRate>& rate,
                                                         const boost::shared_ptr<GenericMixer>& mixer,
                                                         VelaTime start, const SafeRational& mediaStart,
                                                         const SafeRational& mediaDuration,
                                                         const SafeRational& scalar = SafeRational(1));
    ~Group() override;

    /// The clip as a group, or null. Walks ask it of every clip: a type
    /// comparison first keeps it cheap for the clips that are not groups
    /// (a cast through the virtual base costs a walk of the clip's bases).
    static const Group* asGroup(const Media* media) {
        return media && typeid(*media) == typeid(Group) ? dynamic_cast<const Group*>(media) : nullptr;
    }

    boost::shared_ptr<GenericMixer> mixer() const { return mixer_; }
    /// The converter the group's mixer reports as its parent (sharing the group's ownership).
    TimeConverterPtr childrensTimeConverter() const;

    // Canvas
    boost::shared_ptr<Attribute<int>> widthAttr() const { return attribute<int>("widthAttr"); }
    boost::shared_ptr<Attribute<int>> heightAttr() const { return attribute<int>("heightAttr"); }
    int width() const { return attributeValue<int>("widthAttr", 0); }
    int height() const { return attributeValue<int>("heightAttr", 0); }
    /// Throws ValueException<int> "a group's size must not be negative", changing nothing.
    void setGroupWidthAndHeight(int width, int height);
    /// Fills a side that is not set (0) from the children: the largest by
    /// area of the children on the group's tracks that declare a size
    /// (placeholders by their "width" and "height", groups by their canvas,
    /// derived the same way when unset); without one, the canvas of the
    /// timeline the group lies on. Returns whether it set anything.
    bool updateGroupWidthAndHeightIfNotSet();

    // Document (GroupDocument.cpp)
    /// "tracks" (each inner track's object, flags included) then
    /// "assetProperties" (when not empty).
    void toJSONSpecificProperties(XMLOptions& options, int indent) const override;
    /// The "tracks" member alone: the group's inner tracks, written at indent.
    void toJSONVelaML(XMLOptions& options, int indent) const;
    /// The group's asset properties (entries with "name", "type", "objects",
    /// "themeMappings"), kept whole as the document gave them.
    JSONTree assetProperties() const;
    void setAssetProperties(const JSONTree& properties);

    // Quick properties: a choice among the properties the group offers
    std::vector<std::string> quickPropertyList() const;
    boost::shared_ptr<Attribute<std::string>> quickPropertyListAttribute() const {
        return attribute<std::string>("quickPropertyList");
    }
    /// Throws ValueException<std::string> for an empty name or one holding a line break.
    void setQuickPropertyList(const std::vector<std::string>& names);
    /// What the group offers by itself: "translation", "scale", "rotation",
    /// "opacity" when it shows a picture, "volume" when it plays sound.
    std::vector<std::string> autoQuickPropertyList() const;
    /// The offered properties not in the quick property list, in offered order.
    std::vector<std::string> unusedQuickPropertyList() const;

    // Animation tracks
    std::vector<std::string> animationTrackNames() const;
    /// The named track, or null.
    boost::shared_ptr<Parameter<double>> animationTrackWithName(const std::string& name) const;
    /// The named track, made (value 0, no keyframes) if the group has none.
    boost::shared_ptr<Parameter<double>> addAnimationTrack(const std::string& name);

    // Content, at any depth (the groups inside answer for their children)
    bool hasAudio() const;
    bool hasVisual() const;
    /// The most channels a clip inside plays: 1 for a clip mixed to mono, a
    /// file clip its stream's count, any other sound 2; 0 without sound.
    int numChannels() const;
    /// Whether the clip lies anywhere inside the group (the group itself does not).
    bool recursivelyContainsMedia(const MediaPtr& media) const;
    /// The part of the group's media range (its inner time) where clips that
    /// show a picture stand; empty (at the media start) when none does.
    Range<SafeRational> visualMediaRange() const;
    /// Visits the clips on the group's tracks and, inside groups, theirs;
    /// returns true when the visitor stopped the walk.
    bool recursivelyVisitAllMedia(const Track::MediaVisitorWithExit& visitor) const;
    /// The clips the group plays at its parametric time (in [0, duration)),
    /// track by track, with their own parametric times; a group found is
    /// followed by what it plays.
    void collectMediasAtParametricTime(const SafeRational& time, std::vector<Track::MediaAtTime>& out) const;

    // Saved state
    GroupMediaState groupMediaState() const;
    /// Takes the timing (checked as restoreState checks it) and the canvas.
    /// Throws ValueException<int> for a negative size, changing nothing.
    void restoreGroupMediaState(const GroupMediaState& saved, VelaTime tolerance);
    /// Always throws VelaMediaLibException "Cannot restore state with
    /// non-GroupMediaState MediaState": a plain state carries no canvas.
    void restoreGroupMediaState(const MediaState& saved, VelaTime tolerance);

    /// Ask validTrimStart / validTrimEnd first: InvalidTrimRangeException
    /// "invalid trimStart for Group." / "invalid trimEnd for Group.".
    void trimStart(VelaTime offset) override;
    void trimEnd(VelaTime offset) override;
    /// Throws VelaMediaLibException "deprecated call sourceCropRectAtTime on Group".
    Rect<float> sourceCropRectAtTime(const RationalTime& time) const override;

    /// A deep copy: the mixer's tracks with clones of every clip inside.
    boost::shared_ptr<Media> clone() const override;
    void dispatch(MediaDispatcher& dispatcher) override;
    void dispatch(ConstMediaDispatcher& dispatcher) const override;

    // The group relays its mixer's events to its own add observers.
    void attachAddObserver(MixerAddObserver* observer) { addObservers_.attach(observer); }
    void detachAddObserver(MixerAddObserver* observer) { addObservers_.detach(observer, mutex()); }
    void onMixerAddTrack(Mixer& mixer, const TrackPtr& track) override;
    void onMixerRemoveTrack(Mixer& mixer, const TrackPtr& track) override;
    void onMixerAddMedia(Mixer& mixer, Track& track, const MediaPtr& media) override;
    void onMixerRemoveMedia(Mixer& mixer, Track& track, const MediaPtr& media) override;

protected:
    /// The trims' own refusals, for trims carried out through the group's track.
    MediaState stateAfter(const TimingEdit& edit) const override;

private:
    Group(const boost::weak_ptr<const ThreadSafe>& token, const boost::weak_ptr<ProjectEditRate>& rate,
          const MediaState& initial, const boost::shared_ptr<GenericMixer>& mixer);
    /// Makes the mixer the group's; throws, leaving the mixer as it was.
    static boost::shared_ptr<Group> adopt(const boost::shared_ptr<Group>& group);
    /// The size the group declares: its own where set, else derived from its children.
    std::pair<int, int> declaredSize() const;
    std::pair<int, int> derivedSize() const;
    void checkTrim(TimingEdit::Kind kind, VelaTime offset) const;

    const boost::shared_ptr<GenericMixer> mixer_;
    const GroupChildrensTimeConverter childrensTime_;
    AddObserverList<MixerAddObserver> addObservers_;
    JSONTree assetProperties_; // guarded by the project's lock
};

typedef boost::shared_ptr<Group> GroupPtr;

} // namespace VelaMediaLib

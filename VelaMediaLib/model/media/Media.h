#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/timeline/CollisionException.h>
#include <VelaMediaLib/base/Cloneable.h>
#include <VelaMediaLib/model/media/EdgeModifiable.h>
#include <VelaMediaLib/model/media/MediaState.h>
#include <VelaMediaLib/model/timeline/SubTimeline.h>
#include <VelaMediaLib/model/media/Transition.h>
#include <VelaMediaLib/time/rational/ProjectEditRate.h>
#include <VelaMediaLib/time/rational/TimeConverter.h>

#include <boost/enable_shared_from_this.hpp>
#include <boost/function.hpp>
#include <utility>

namespace VelaMediaLib {

class ConstMediaDispatcher;
class MediaDispatcher;
class MediaEditor;
class RationalMediaEditor;
class Timeline;
class Track;
class XMLOptions;

/// A clip that can stand on a track. It plays a slice of its media (the media
/// range) over a stretch of its track (the track range) at a speed (the
/// scalar), within its media's limits. Reads take the project's read lock,
/// edits its write lock; a refused edit throws and changes nothing.
class VELAMEDIALIB_API Media : public SubTimeline,
                               public DecoratedCloneable<Media>,
                               public boost::enable_shared_from_this<Media>,
                               public EdgeModifiable,
                               public TimeConverter {
public:
    typedef boost::function<void(const boost::shared_ptr<SubTimeline>&)> ParentVisitor;
    typedef std::pair<TransitionPtr, boost::shared_ptr<Media>> TransitionAndNeighbour;

    /// A change of the clip's timing as a value, so that the clip's track can
    /// check where it would put the clip before the clip takes it. It lives
    /// for one call: a restore refers to the caller's saved state.
    struct TimingEdit {
        enum Kind { Move, TrimStart, TrimEnd, SetStart, Stretch, Restore };
        Kind kind = Move;
        VelaTime amount = 0; // the offset; the new start for SetStart; the tolerance for Restore
        SafeRational factor; // Stretch
        const MediaState* saved = nullptr; // Restore

        static TimingEdit of(Kind kind, VelaTime amount) {
            TimingEdit edit;
            edit.kind = kind;
            edit.amount = amount;
            return edit;
        }
        static TimingEdit stretch(const SafeRational& factor) {
            TimingEdit edit = of(Stretch, 0);
            edit.factor = factor;
            return edit;
        }
        static TimingEdit restore(const MediaState& saved, VelaTime tolerance) {
            TimingEdit edit = of(Restore, tolerance);
            edit.saved = &saved;
            return edit;
        }
    };

    explicit Media(const boost::weak_ptr<const ThreadSafe>& token) : SubTimeline(token) {}

    virtual boost::weak_ptr<ProjectEditRate> projectEditRate() const = 0;
    virtual void setProjectEditRate(const boost::weak_ptr<ProjectEditRate>& rate) = 0;
    /// Previews: the track range the clip would have, changing nothing.
    virtual Range<VelaTime> trackRangeWithMove(VelaTime offset) const = 0;
    virtual Range<VelaTime> trackRangeWithTrimStart(VelaTime offset) const = 0;
    virtual Range<VelaTime> trackRangeWithTrimEnd(VelaTime offset) const = 0;
    virtual Range<VelaTime> trackRangeWithStretch(double factor) const = 0;
    virtual Range<double> mediaRange() const = 0;
    virtual double minMediaStart() const = 0;
    virtual double maxMediaEnd() const = 0;
    virtual Range<VelaTime> trackRange() const = 0;
    /// The track range without taking the lock, for a container that already
    /// holds the project's lock (a track answering a query).
    virtual Range<VelaTime> lockedTrackRange() const = 0;
    virtual double scalar() const = 0;
    virtual SafeRational rationalScalar() const = 0;
    /// The scalar at which the clip's media would last the given track duration.
    virtual double findScalar(VelaTime duration) const = 0;
    virtual VelaTime trimEndLimit() const = 0;
    virtual VelaTime trimStartLimit() const = 0;
    virtual bool validTrimStart(VelaTime offset) const = 0;
    virtual bool validTrimEnd(VelaTime offset) const = 0;
    virtual Range<SafeRational> rationalMediaRange() const = 0;
    virtual SafeRational minRationalMediaStart() const = 0;
    virtual SafeRational maxRationalMediaEnd() const = 0;
    virtual Range<VelaTime> trackRangeWithRationalStretch(const SafeRational& factor) const = 0;
    virtual SafeRational findRationalScalar(VelaTime duration) const = 0;
    virtual MediaState state() const = 0;
    /// The clip playing all its media (as far as its limits go) at scalar 1 from its start.
    virtual MediaState defaultState() const = 0;
    /// Takes a saved state after checking it; tolerance in ticks.
    virtual void restoreState(const MediaState& saved, VelaTime tolerance) = 0;
    virtual boost::shared_ptr<ParameterInterface>
    paramWithFullyQualifiedName(const std::string& name) const = 0;
    virtual TransitionPtr leftTransition() = 0;
    virtual TransitionPtr leftTransition() const = 0;
    virtual TransitionPtr rightTransition() = 0;
    virtual TransitionPtr rightTransition() const = 0;
    virtual void setLeftTransition(const TransitionPtr& transition) = 0;
    virtual void setRightTransition(const TransitionPtr& transition) = 0;
    /// Told when a transition is set or cleared on either edge.
    virtual Observable& transitionAddRemoveObservable() = 0;
    virtual void mediaSourceChanged() {}
    /// The transition covering the tick, if any.
    virtual TransitionPtr transitionAtTime(VelaTime time) const = 0;
    /// Writers (see JSONWriter.h): the clip's object, closed at indent; its
    /// temporal values and its kind's own members, written at indent.
    virtual void toJSONTemporalValues(XMLOptions& options, int indent) const = 0;
    virtual void toJSON(XMLOptions& options, int indent) const = 0;
    virtual void toJSONSpecificProperties(XMLOptions&, int) const {}
    /// The right transition and the clip on its other side, which a split or a merge carries over.
    virtual TransitionAndNeighbour splitMergeTransitions() const = 0;
    /// Timing edits. On a track they go through the track, which refuses a
    /// collision (CollisionException) and keeps its clips keyed by start.
    virtual void move(VelaTime offset) = 0;
    virtual void trimStart(VelaTime offset) = 0;
    virtual void trimEnd(VelaTime offset) = 0;
    virtual void setTrackStart(VelaTime start) = 0;
    /// Returns the new scalar. Throws ValueException<double> for a stretch
    /// to no tick, or below the room the clip's transitions need (the
    /// previews above refuse the same).
    virtual double stretch(double factor) = 0;
    virtual SafeRational rationalStretch(const SafeRational& factor) = 0;

    // Editors, kinds and parents
    virtual MediaEditor& mediaEditor() = 0;
    virtual const RationalMediaEditor& rationalMediaEditor() const = 0;
    virtual void dispatch(MediaDispatcher& dispatcher) = 0;
    virtual void dispatch(ConstMediaDispatcher& dispatcher) const = 0;
    virtual long long editingUnit() const = 0;
    /// The timeline the clip's containers lead to, followed outward from its
    /// parent at each call; empty off a timeline.
    virtual boost::weak_ptr<Timeline> parentTimeline() const = 0;
    /// The clip's container (a track or a group), held weakly: the one link
    /// outward, from which its time converter parent and timeline follow.
    virtual boost::shared_ptr<SubTimeline> parent() const = 0;
    /// Calls the visitor with the clip's parent (a track or a group), if it has one.
    virtual void parentVisitor(const ParentVisitor& visitor) const = 0;
    /// Set by the container as it takes the clip in or lets it go.
    virtual void setParent(const boost::weak_ptr<SubTimeline>& parent) = 0;
    /// Makes the clone share what must stay shared with this clip.
    virtual void setupSharedClone(const boost::shared_ptr<Media>& clone) const = 0;
    /// The parent as a time converter (every container is one), or null.
    virtual boost::shared_ptr<const TimeConverter> timeConverterParent() const = 0;
    /// The same link as setParent: a container converts the time of what it holds.
    void setTimeConverterParent(const boost::weak_ptr<SubTimeline>& parent) { setParent(parent); }
    /// Global timeline time to the clip's parametric time and back.
    virtual RationalTime fromGlobalToParametricTime(const RationalTime& time) const = 0;
    virtual RationalTime fromParametricToGlobalTime(const RationalTime& time) const = 0;
    virtual RationalTime clippingFromGlobalToParametricTime(const RationalTime& time) const = 0;

    // Per-clip metadata keys
    static const char* clipSpeedMetaDataKey() { return "clipSpeedAttribute"; }
    static const char* voxaneMetaDataKey() { return "voxaneAttribute"; }
    static const char* voxaneLinkedSessionMetadataKey() { return "voxaneLinkedSession"; }
    /// The clip's attribute under the key, made (false or empty) if it has none.
    static boost::shared_ptr<Attribute<bool>> clipSpeedAttributeForMedia(Media& media);
    static boost::shared_ptr<Attribute<bool>> voxaneAttributeForMedia(Media& media);
    static boost::shared_ptr<Attribute<std::string>> voxaneLinkedSessionAttributeForMedia(Media& media);

protected:
    friend class Track;
    /// The state the edit would give the clip; throws as the edit would
    /// refuse, changing nothing.
    virtual MediaState stateAfter(const TimingEdit& edit) const = 0;
    /// Takes a state computed by stateAfter, under the write lock its caller
    /// holds, without notifying; returns whether anything changed. The track
    /// uses this to change a clip and re-key it in one step, and notifies after.
    virtual bool takeStateUnnotified(const MediaState& next) = 0;
};

typedef boost::shared_ptr<Media> MediaPtr;

} // namespace VelaMediaLib

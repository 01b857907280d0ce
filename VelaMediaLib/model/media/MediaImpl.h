#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/effects/StoredEffect.h>
#include <VelaMediaLib/model/media/AnimationTrack.h>
#include <VelaMediaLib/model/media/Media.h>
#include <VelaMediaLib/model/media/RationalMediaEditor.h>
#include <VelaMediaLib/model/timeline/SubTimelineParts.h>

#include <atomic>
#include <map>
#include <memory>

namespace VelaMediaLib {

/// The state every clip holds and the operations over it. A clip's parametric
/// time counts ticks from its start on the track: its parameters' keyframes
/// move with it and are cut, not shifted, when its start is trimmed.
class VELAMEDIALIB_API MediaImpl : public SubTimelineParts<Media> {
public:
    enum EditorKind { Temporal, Static };

    MediaImpl(const boost::weak_ptr<const ThreadSafe>& token, const boost::weak_ptr<ProjectEditRate>& rate,
              const MediaState& initial, EditorKind editor);
    ~MediaImpl() override;
    boost::weak_ptr<const void> lifeline() const override { return weak_from_this(); }

    // Placement
    VelaTime startTime() const override;
    VelaTime endTime() const override;
    VelaTime duration() const override;
    Range<VelaTime> timeRange() const override { return trackRange(); }

    // Timing
    boost::weak_ptr<ProjectEditRate> projectEditRate() const override;
    void setProjectEditRate(const boost::weak_ptr<ProjectEditRate>& rate) override;
    Range<VelaTime> trackRangeWithMove(VelaTime offset) const override;
    Range<VelaTime> trackRangeWithTrimStart(VelaTime offset) const override;
    Range<VelaTime> trackRangeWithTrimEnd(VelaTime offset) const override;
    Range<VelaTime> trackRangeWithStretch(double factor) const override;
    Range<double> mediaRange() const override;
    double minMediaStart() const override { return minRationalMediaStart().asDouble(); }
    double maxMediaEnd() const override { return maxRationalMediaEnd().asDouble(); }
    Range<VelaTime> trackRange() const override;
    Range<VelaTime> lockedTrackRange() const override { return state_.trackRange(); }
    double scalar() const override { return rationalScalar().asDouble(); }
    SafeRational rationalScalar() const override { return state().scalar; }
    double findScalar(VelaTime duration) const override { return findRationalScalar(duration).asDouble(); }
    VelaTime trimEndLimit() const override;
    VelaTime trimStartLimit() const override;
    bool validTrimStart(VelaTime offset) const override;
    bool validTrimEnd(VelaTime offset) const override;
    Range<SafeRational> rationalMediaRange() const override { return state().mediaRange(); }
    SafeRational minRationalMediaStart() const override { return state().minMediaStart; }
    SafeRational maxRationalMediaEnd() const override { return state().maxMediaEnd; }
    Range<VelaTime> trackRangeWithRationalStretch(const SafeRational& factor) const override;
    SafeRational findRationalScalar(VelaTime duration) const override;
    MediaState state() const override;
    MediaState defaultState() const override;
    void restoreState(const MediaState& saved, VelaTime tolerance) override;
    /// The same under the write lock the caller holds, telling no one:
    /// returns whether the clip changed, and the caller then notifies it.
    bool restoreStateUnnotified(const MediaState& saved, VelaTime tolerance);
    void move(VelaTime offset) override;
    void trimStart(VelaTime offset) override;
    void trimEnd(VelaTime offset) override;
    void setTrackStart(VelaTime start) override;
    double stretch(double factor) override;
    SafeRational rationalStretch(const SafeRational& factor) override;
    long long editingUnit() const override;
    MediaEditor& mediaEditor() override;
    const RationalMediaEditor& rationalMediaEditor() const override { return *editor_; }

    // Transitions
    TransitionPtr leftTransition() override;
    TransitionPtr leftTransition() const override;
    TransitionPtr rightTransition() override;
    TransitionPtr rightTransition() const override;
    void setLeftTransition(const TransitionPtr& transition) override;
    void setRightTransition(const TransitionPtr& transition) override;
    /// Its observers are told the clip itself.
    Observable& transitionAddRemoveObservable() override { return transitionSubject_; }
    TransitionPtr transitionAtTime(VelaTime time) const override;
    TransitionAndNeighbour splitMergeTransitions() const override;

    // Edge modifications
    void addLeftEdgeModification(const EdgeModificationPtr& modification) override;
    void addRightEdgeModification(const EdgeModificationPtr& modification) override;
    bool removeLeftEdgeModification(const EdgeModificationPtr& modification) override;
    bool removeRightEdgeModification(const EdgeModificationPtr& modification) override;
    EdgeModifications leftEdgeModifications() const override;
    EdgeModifications rightEdgeModifications() const override;
    VelaTime leftEdgeModificationLength() const override;
    VelaTime rightEdgeModificationLength() const override;
    void setLeftEdgeModificationLength(VelaTime length) override;
    void setRightEdgeModificationLength(VelaTime length) override;
    std::set<std::string> edgeModGroupNames() const override;
    bool setLeftEdgeModificationsUnnotified(const EdgeModifications& modifications) override;
    bool setRightEdgeModificationsUnnotified(const EdgeModifications& modifications) override;

    // Time conversion: the clip's parametric time counts from its start.
    SafeRational parentParametricTimeToThisParametricTime(const SafeRational& time) const override;
    SafeRational clippingParentParametricTimeToThisParametricTime(const SafeRational& time) const override;
    SafeRational thisParametricTimeToParentParametricTime(const SafeRational& time) const override;
    TimeConverterPtr parentTimeConverter() const override { return timeConverterParent(); }
    TimeConverterPtr timeConverterParent() const override;
    RationalTime fromGlobalToParametricTime(const RationalTime& time) const override;
    RationalTime fromParametricToGlobalTime(const RationalTime& time) const override;
    RationalTime clippingFromGlobalToParametricTime(const RationalTime& time) const override;

    // Parents, parameters, cloning, document
    boost::weak_ptr<Timeline> parentTimeline() const override;
    boost::shared_ptr<SubTimeline> parent() const override;
    void parentVisitor(const ParentVisitor& visitor) const override;
    void setParent(const boost::weak_ptr<SubTimeline>& parent) override;
    boost::shared_ptr<ParameterInterface> paramWithFullyQualifiedName(const std::string& name) const override;
    void setupSharedClone(const boost::shared_ptr<Media>& clone) const override;
    void toJSONTemporalValues(XMLOptions& options, int indent) const override;
    /// "id", "_type", the file kinds' "src" and "trackNumber", "attributes",
    /// the kind's members, the temporal values, then "animationTracks",
    /// "parameters", "effects", "hotspot", "leftEdgeMods", "rightEdgeMods",
    /// "sourceEffect" (each only when there is something) and "metadata".
    /// Each value is read under the project's read lock on its own.
    void toJSON(XMLOptions& options, int indent) const override;

    // Parts the document keeps whole (read and written, cloned with the clip)
    typedef std::map<std::string, AnimationTrack> AnimationTracks;
    /// The clip's animation tracks by parameter name.
    AnimationTracks animationTracks() const;
    /// Sets the animations of the parameter (the track takes the name); a
    /// track without animations removes the parameter's. Notifies when changed.
    void setAnimationTrack(const std::string& name, const AnimationTrack& track);
    void setAnimationTrack(const AnimationTrack& track) { setAnimationTrack(track.name(), track); }
    /// The effect applied to the clip's source itself, or null.
    StoredEffectPtr sourceEffect() const;
    /// Null clears it. Notifies when changed.
    void setSourceEffect(const StoredEffectPtr& effect);

protected:
    MediaState stateAfter(const TimingEdit& edit) const override;
    /// The limits a clip takes after an edit: the edited state's own here; a
    /// kind whose limits follow its source gives the source's present ones.
    virtual MediaState editedLimits(const MediaState& edited) const { return edited; }
    bool takeStateUnnotified(const MediaState& next) override;
    /// Carries a timing edit out: through the clip's track when it has one,
    /// on the clip alone otherwise; notifies when something changed.
    MediaState applyTimingEdit(const TimingEdit& edit);
    /// The same under the write lock the caller holds, without notifying.
    bool applyTimingEditLocked(const TimingEdit& edit, MediaState& next);

    /// Gives a clone of this clip everything but its placement on a track:
    /// name, parameters, attributes, metadata, effects and edge modifications.
    void copyContentInto(MediaImpl& clone) const;
    /// What a clip family adds to copyContentInto (a visual clip's hotspot).
    virtual void copyFamilyContentInto(MediaImpl&) const {}
    /// The members a clip family writes after "effects" (a visual clip's "hotspot").
    virtual void toJSONFamilyMembers(XMLOptions&, int) const {}
    void addEdgeModification(EdgeModifications& side, const EdgeModificationPtr& modification);
    bool removeEdgeModification(EdgeModifications& side, const EdgeModificationPtr& modification);
    void setEdgeModificationLength(EdgeModifications& side, VelaTime length);
    bool setEdgeModificationsUnnotified(EdgeModifications& side, const EdgeModifications& modifications);
    void setTransition(TransitionPtr& slot, const TransitionPtr& transition, bool left);

private:
    /// stateAfter and takeStateUnnotified under the lock the caller holds.
    MediaState lockedStateAfter(const TimingEdit& edit) const;
    /// What the editor makes of the edit, before the kind's limits.
    MediaState editorStateAfter(const TimingEdit& edit) const;
    Range<VelaTime> previewRange(const TimingEdit& edit) const;
    bool lockedTakeState(const MediaState& next);

    PartSubject transitionSubject_; // notifies under the clip's token
    MediaState state_;
    TransitionPtr left_, right_;
    boost::weak_ptr<ProjectEditRate> editRate_;
    std::unique_ptr<RationalMediaEditor> editor_;
    /// Made on first use and published atomically, so that asking for it
    /// takes no lock (readers ask for it inside their snapshots).
    std::atomic<MediaEditor*> oldEditor_{nullptr};
    EdgeModifications leftEdges_, rightEdges_;
    AnimationTracks animationTracks_; // guarded by the project's lock
    StoredEffectPtr sourceEffect_;
    boost::weak_ptr<SubTimeline> parent_;
};

} // namespace VelaMediaLib

#include <VelaMediaLib/model/media/MediaImpl.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/model/media/MediaEditor.h>
#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/media/RationalStaticEditor.h>
#include <VelaMediaLib/model/media/RationalTemporalEditor.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/model/timeline/Track.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <algorithm>

namespace VelaMediaLib {

MediaImpl::MediaImpl(const boost::weak_ptr<const ThreadSafe>& token,
                     const boost::weak_ptr<ProjectEditRate>& rate, const MediaState& initial,
                     EditorKind editor)
    : Media(token), SubTimelineParts<Media>(token), transitionSubject_(*this), state_(initial),
      editRate_(rate) {
    if (initial.duration <= 0)
        throw ValueException<long long>("a clip's duration must be greater than 0", initial.duration);
    if (initial.mediaDuration <= 0)
        throw ValueException<double>("a clip's media duration must be greater than 0",
                                     initial.mediaDuration.asDouble());
    if (initial.scalar <= 0)
        throw ValueException<double>("a clip's scalar must be greater than 0", initial.scalar.asDouble());
    transitionSubject_.setOwner(this);
    if (editor == Temporal)
        editor_.reset(new RationalTemporalEditor(*this));
    else
        editor_.reset(new RationalStaticEditor(*this));
}

MediaImpl::~MediaImpl() { delete oldEditor_.load(); }

MediaState MediaImpl::state() const {
    ScopedReadLock lock(projectLock());
    return state_;
}

VelaTime MediaImpl::startTime() const { return trackRange().start(); }
VelaTime MediaImpl::endTime() const { return trackRange().end(); }
VelaTime MediaImpl::duration() const { return trackRange().duration(); }

Range<VelaTime> MediaImpl::trackRange() const {
    ScopedReadLock lock(projectLock());
    return state_.trackRange();
}

boost::weak_ptr<ProjectEditRate> MediaImpl::projectEditRate() const {
    ScopedReadLock lock(projectLock());
    return editRate_;
}

void MediaImpl::setProjectEditRate(const boost::weak_ptr<ProjectEditRate>& rate) {
    ScopedWriteLock lock(projectMutex());
    editRate_ = rate;
}

long long MediaImpl::editingUnit() const {
    const boost::shared_ptr<ProjectEditRate> rate = projectEditRate().lock();
    return rate ? (long long)rate->editingUnit() : 1;
}

Range<VelaTime> MediaImpl::trackRangeWithMove(VelaTime offset) const {
    return previewRange(TimingEdit::of(TimingEdit::Move, offset));
}

Range<VelaTime> MediaImpl::trackRangeWithTrimStart(VelaTime offset) const {
    const Range<VelaTime> range = trackRange();
    return Range<VelaTime>(range.start() + offset, range.duration() - offset);
}

Range<VelaTime> MediaImpl::trackRangeWithTrimEnd(VelaTime offset) const {
    const Range<VelaTime> range = trackRange();
    return Range<VelaTime>(range.start(), range.duration() - offset);
}

Range<VelaTime> MediaImpl::trackRangeWithStretch(double factor) const {
    return trackRangeWithRationalStretch(RationalUtil::fromDoubleApprox(factor));
}

// Through the editor, so the preview refuses what the stretch refuses.
Range<VelaTime> MediaImpl::trackRangeWithRationalStretch(const SafeRational& factor) const {
    return previewRange(TimingEdit::stretch(factor));
}

Range<double> MediaImpl::mediaRange() const { return RationalUtil::toDoubleRange(rationalMediaRange()); }

SafeRational MediaImpl::findRationalScalar(VelaTime duration) const {
    return SafeRational(duration) / state().mediaDuration;
}

VelaTime MediaImpl::trimEndLimit() const { return editor_->trimEndLimit(state()); }
VelaTime MediaImpl::trimStartLimit() const { return editor_->trimStartLimit(state()); }
bool MediaImpl::validTrimStart(VelaTime offset) const { return editor_->validTrimStart(state(), offset); }
bool MediaImpl::validTrimEnd(VelaTime offset) const { return editor_->validTrimEnd(state(), offset); }

// All the media the limits allow at scalar 1, the duration its rounded
// length; media shorter than half a tick plays over one tick instead.
MediaState MediaImpl::defaultState() const {
    MediaState whole = state();
    if (!whole.minUnbounded()) whole.mediaStart = whole.minMediaStart;
    if (!whole.minUnbounded() && !whole.maxUnbounded()) whole.mediaDuration = whole.fullMediaLength();
    whole.scalar = SafeRational(1);
    whole.duration = RationalUtil::toVelaTime(RationalUtil::Round(whole.mediaDuration));
    if (whole.duration <= 0) {
        whole.duration = 1;
        whole.scalar = SafeRational(1) / whole.mediaDuration;
    }
    return whole;
}

MediaState MediaImpl::stateAfter(const TimingEdit& edit) const {
    ScopedReadLock lock(projectLock());
    return lockedStateAfter(edit);
}

MediaState MediaImpl::lockedStateAfter(const TimingEdit& edit) const {
    return editedLimits(editorStateAfter(edit));
}

MediaState MediaImpl::editorStateAfter(const TimingEdit& edit) const {
    switch (edit.kind) {
    case TimingEdit::Move:
        return editor_->move(state_, edit.amount);
    case TimingEdit::SetStart:
        return editor_->move(state_, edit.amount - state_.start);
    case TimingEdit::TrimStart:
        return editor_->trimStart(state_, edit.amount);
    case TimingEdit::TrimEnd:
        return editor_->trimEnd(state_, edit.amount);
    case TimingEdit::Stretch:
        return editor_->stretch(state_, edit.factor);
    case TimingEdit::Restore:
        return editor_->restoreState(*edit.saved, edit.amount);
    }
    return state_;
}

// Previews answer the track range alone, which the limits do not change.
Range<VelaTime> MediaImpl::previewRange(const TimingEdit& edit) const {
    ScopedReadLock lock(projectLock());
    return editorStateAfter(edit).trackRange();
}

bool MediaImpl::lockedTakeState(const MediaState& next) {
    if (state_ == next) return false;
    state_ = next;
    return true;
}

bool MediaImpl::takeStateUnnotified(const MediaState& next) {
    ScopedWriteLock lock(projectMutex());
    return lockedTakeState(next);
}

MediaState MediaImpl::applyTimingEdit(const TimingEdit& edit) {
    MediaState next;
    bool changed = false;
    {
        ScopedWriteLock lock(projectMutex()); // the clip stays on (or off) its track meanwhile
        changed = applyTimingEditLocked(edit, next);
    }
    if (changed) notify();
    return next;
}

bool MediaImpl::applyTimingEditLocked(const TimingEdit& edit, MediaState& next) {
    ScopedWriteLock lock(projectMutex()); // the caller's, taken again
    bool changed = false;
    const boost::shared_ptr<SubTimeline> container = parent_.lock();
    if (const boost::shared_ptr<Track> track = boost::dynamic_pointer_cast<Track>(container)) {
        track->editLocked(shared_from_this(), edit, changed, &next);
    } else { // through the kind's own steps, as a track would take them
        next = stateAfter(edit);
        changed = takeStateUnnotified(next);
    }
    return changed;
}

void MediaImpl::restoreState(const MediaState& saved, VelaTime tolerance) {
    applyTimingEdit(TimingEdit::restore(saved, tolerance));
}

bool MediaImpl::restoreStateUnnotified(const MediaState& saved, VelaTime tolerance) {
    MediaState next;
    return applyTimingEditLocked(TimingEdit::restore(saved, tolerance), next);
}

void MediaImpl::move(VelaTime offset) { applyTimingEdit(TimingEdit::of(TimingEdit::Move, offset)); }

void MediaImpl::trimStart(VelaTime offset) { applyTimingEdit(TimingEdit::of(TimingEdit::TrimStart, offset)); }

void MediaImpl::trimEnd(VelaTime offset) { applyTimingEdit(TimingEdit::of(TimingEdit::TrimEnd, offset)); }

void MediaImpl::setTrackStart(VelaTime start) {
    applyTimingEdit(TimingEdit::of(TimingEdit::SetStart, start));
}

double MediaImpl::stretch(double factor) {
    return rationalStretch(RationalUtil::fromDoubleApprox(factor)).asDouble();
}

SafeRational MediaImpl::rationalStretch(const SafeRational& factor) {
    return applyTimingEdit(TimingEdit::stretch(factor)).scalar;
}

MediaEditor& MediaImpl::mediaEditor() {
    MediaEditor* existing = oldEditor_.load(std::memory_order_acquire);
    if (existing) return *existing;
    std::unique_ptr<MediaEditor> made;
    if (dynamic_cast<RationalTemporalEditor*>(editor_.get()))
        made.reset(new TemporalEditor(*this));
    else
        made.reset(new StaticEditor(*this));
    // Another thread may have published one meanwhile: then that one is the editor.
    if (oldEditor_.compare_exchange_strong(existing, made.get(), std::memory_order_acq_rel,
                                           std::memory_order_acquire))
        return *made.release();
    return *existing;
}

TransitionPtr MediaImpl::leftTransition() {
    ScopedReadLock lock(projectLock());
    return left_;
}
TransitionPtr MediaImpl::leftTransition() const {
    ScopedReadLock lock(projectLock());
    return left_;
}
TransitionPtr MediaImpl::rightTransition() {
    ScopedReadLock lock(projectLock());
    return right_;
}
TransitionPtr MediaImpl::rightTransition() const {
    ScopedReadLock lock(projectLock());
    return right_;
}

// The old transition lets go of the clip; the new one holds it on the side
// facing it. A transition has one clip on each side: a clip that held it on
// this side lets go under the same lock, so no reader sees two holders and no
// slot is left naming a transition that names another clip. Setting the
// transition the slot already holds changes nothing.
void MediaImpl::setTransition(TransitionPtr& slot, const TransitionPtr& transition, bool left) {
    const MediaPtr self = shared_from_this();
    boost::shared_ptr<MediaImpl> former;
    {
        ScopedWriteLock lock(projectMutex());
        if (slot == transition) return;
        const TransitionPtr old = slot;
        slot = transition;
        if (old && left && old->rightMedia() == self) old->setRightMedia(boost::weak_ptr<Media>());
        if (old && !left && old->leftMedia() == self) old->setLeftMedia(boost::weak_ptr<Media>());
        if (transition) {
            former = boost::dynamic_pointer_cast<MediaImpl>(left ? transition->rightMedia()
                                                                 : transition->leftMedia());
            if (former && former != self && (left ? former->left_ : former->right_) == transition)
                (left ? former->left_ : former->right_).reset();
            else
                former.reset();
            if (left)
                transition->setRightMedia(self);
            else
                transition->setLeftMedia(self);
        }
    }
    for (MediaImpl* told : {this, former.get()}) {
        if (!told) continue;
        told->transitionSubject_.notify();
        told->notify();
    }
}

void MediaImpl::setLeftTransition(const TransitionPtr& transition) { setTransition(left_, transition, true); }

void MediaImpl::setRightTransition(const TransitionPtr& transition) {
    setTransition(right_, transition, false);
}

TransitionPtr MediaImpl::transitionAtTime(VelaTime time) const {
    ScopedReadLock lock(projectLock());
    const Range<VelaTime> range = state_.trackRange();
    if (left_ && time >= range.start() && time < range.start() + left_->duration()) return left_;
    if (right_ && time < range.end() && time >= range.end() - right_->duration()) return right_;
    return TransitionPtr();
}

Media::TransitionAndNeighbour MediaImpl::splitMergeTransitions() const {
    const TransitionPtr right = rightTransition();
    return TransitionAndNeighbour(right, right ? right->rightMedia() : MediaPtr());
}

TimeConverterPtr MediaImpl::timeConverterParent() const {
    return boost::dynamic_pointer_cast<const TimeConverter>(parent());
}

SafeRational MediaImpl::parentParametricTimeToThisParametricTime(const SafeRational& time) const {
    return time - SafeRational(startTime());
}

SafeRational MediaImpl::clippingParentParametricTimeToThisParametricTime(const SafeRational& time) const {
    const Range<VelaTime> range = trackRange();
    const SafeRational inside = time - SafeRational(range.start());
    if (inside < 0) return SafeRational(0);
    return inside > range.duration() ? SafeRational(range.duration()) : inside;
}

SafeRational MediaImpl::thisParametricTimeToParentParametricTime(const SafeRational& time) const {
    return time + SafeRational(startTime());
}

// One read lock for the whole walk, so that no edit falls between its steps.
RationalTime MediaImpl::fromGlobalToParametricTime(const RationalTime& time) const {
    ScopedReadLock lock(projectLock());
    return TimeConverter::recursiveFromGlobalToParametricTime(this, time.asRational());
}

RationalTime MediaImpl::fromParametricToGlobalTime(const RationalTime& time) const {
    ScopedReadLock lock(projectLock());
    return TimeConverter::recursiveFromParametricToGlobalTime(this, time.asRational());
}

RationalTime MediaImpl::clippingFromGlobalToParametricTime(const RationalTime& time) const {
    ScopedReadLock lock(projectLock());
    return TimeConverter::clippingRecursiveFromGlobalToParametricTime(this, time.asRational());
}

// Followed outward at each call: a track leads to its mixer's timeline, a
// group to its own parent timeline.
boost::weak_ptr<Timeline> MediaImpl::parentTimeline() const {
    ScopedReadLock lock(projectLock());
    const boost::shared_ptr<SubTimeline> container = parent_.lock();
    if (const auto track = boost::dynamic_pointer_cast<Track>(container)) return track->parentTimeline();
    if (const auto group = boost::dynamic_pointer_cast<Media>(container)) return group->parentTimeline();
    return boost::weak_ptr<Timeline>();
}

boost::shared_ptr<SubTimeline> MediaImpl::parent() const {
    ScopedReadLock lock(projectLock());
    return parent_.lock();
}

void MediaImpl::parentVisitor(const ParentVisitor& visitor) const {
    if (const boost::shared_ptr<SubTimeline> container = parent()) visitor(container);
}

void MediaImpl::setParent(const boost::weak_ptr<SubTimeline>& parent) {
    ScopedWriteLock lock(projectMutex());
    parent_ = parent;
}

// A plain name is the clip's own parameter; "effect.parameter" names one of
// an effect's, which effects answer once they carry parameters.
boost::shared_ptr<ParameterInterface> MediaImpl::paramWithFullyQualifiedName(const std::string& name) const {
    if (name.find('.') == std::string::npos) return parameter(name);
    return boost::shared_ptr<ParameterInterface>();
}

void MediaImpl::copyContentInto(MediaImpl& clone) const {
    clone.setIdentifier(identifier());
    cloneParametersInto(clone);
    copyAttributesTo(clone);
    for (const auto& entry : metaDataCopy()) clone.addMetaData(entry.first, entry.second);
    clone.effectList().replaceAll(effectList().cloned());
    {
        ScopedReadLock lock(projectLock());
        for (const EdgeModificationPtr& edge : leftEdges_)
            clone.leftEdges_.push_back(EdgeModificationPtr(new EdgeModification(*edge)));
        for (const EdgeModificationPtr& edge : rightEdges_)
            clone.rightEdges_.push_back(EdgeModificationPtr(new EdgeModification(*edge)));
        clone.animationTracks_ = animationTracks_;
        if (sourceEffect_)
            clone.sourceEffect_ = boost::static_pointer_cast<StoredEffect>(sourceEffect_->cloneEffect());
    }
    copyFamilyContentInto(clone);
}

void MediaImpl::setupSharedClone(const boost::shared_ptr<Media>& clone) const {
    if (!clone) return;
    for (const std::string& name : parameterNames()) {
        if (!hasMadeParameter(name) || !clone->hasMadeParameter(name)) continue;
        parameter(name)->setupSharedClone(clone->parameter(name));
    }
}

void MediaImpl::toJSONTemporalValues(XMLOptions& options, int indent) const {
    const MediaState s = state();
    writeJSONMember(options, indent, "start", s.start);
    writeJSONMember(options, indent, "duration", s.duration);
    writeJSONMember(options, indent, "mediaStart", s.mediaStart);
    writeJSONMember(options, indent, "mediaDuration", s.mediaDuration);
    writeJSONMember(options, indent, "scalar", s.scalar);
}

} // namespace VelaMediaLib

namespace VelaMediaLib {
namespace {

VelaTime longest(const EdgeModifiable::EdgeModifications& modifications) {
    VelaTime length = 0;
    for (const EdgeModificationPtr& modification : modifications)
        length = std::max(length, modification->duration());
    return length;
}

} // namespace

void MediaImpl::addEdgeModification(EdgeModifications& side, const EdgeModificationPtr& modification) {
    if (!modification) throw AddRemoveException("no edge modification to add");
    {
        ScopedWriteLock lock(projectMutex());
        side.push_back(modification);
    }
    notify();
}

bool MediaImpl::removeEdgeModification(EdgeModifications& side, const EdgeModificationPtr& modification) {
    {
        ScopedWriteLock lock(projectMutex());
        const auto found = std::find(side.begin(), side.end(), modification);
        if (found == side.end()) return false;
        side.erase(found);
    }
    notify();
    return true;
}

void MediaImpl::setEdgeModificationLength(EdgeModifications& side, VelaTime length) {
    bool changed = false;
    {
        ScopedWriteLock lock(projectMutex());
        for (const EdgeModificationPtr& modification : side) {
            changed = changed || modification->duration() != length;
            modification->setDuration(length);
        }
    }
    if (changed) notify();
}

bool MediaImpl::setEdgeModificationsUnnotified(EdgeModifications& side,
                                               const EdgeModifications& modifications) {
    for (const EdgeModificationPtr& modification : modifications)
        if (!modification) throw AddRemoveException("no edge modification to add");
    EdgeModifications next(modifications); // copied before the lock: the swap cannot throw
    ScopedWriteLock lock(projectMutex());
    if (side == next) return false;
    side.swap(next);
    return true;
}

void MediaImpl::addLeftEdgeModification(const EdgeModificationPtr& m) { addEdgeModification(leftEdges_, m); }
void MediaImpl::addRightEdgeModification(const EdgeModificationPtr& m) {
    addEdgeModification(rightEdges_, m);
}
bool MediaImpl::removeLeftEdgeModification(const EdgeModificationPtr& m) {
    return removeEdgeModification(leftEdges_, m);
}
bool MediaImpl::removeRightEdgeModification(const EdgeModificationPtr& m) {
    return removeEdgeModification(rightEdges_, m);
}
void MediaImpl::setLeftEdgeModificationLength(VelaTime length) {
    setEdgeModificationLength(leftEdges_, length);
}
void MediaImpl::setRightEdgeModificationLength(VelaTime length) {
    setEdgeModificationLength(rightEdges_, length);
}

bool MediaImpl::setLeftEdgeModificationsUnnotified(const EdgeModifications& m) {
    return setEdgeModificationsUnnotified(leftEdges_, m);
}
bool MediaImpl::setRightEdgeModificationsUnnotified(const EdgeModifications& m) {
    return setEdgeModificationsUnnotified(rightEdges_, m);
}

EdgeModifiable::EdgeModifications MediaImpl::leftEdgeModifications() const {
    ScopedReadLock lock(projectLock());
    return leftEdges_;
}

EdgeModifiable::EdgeModifications MediaImpl::rightEdgeModifications() const {
    ScopedReadLock lock(projectLock());
    return rightEdges_;
}

VelaTime MediaImpl::leftEdgeModificationLength() const { return longest(leftEdgeModifications()); }
VelaTime MediaImpl::rightEdgeModificationLength() const { return longest(rightEdgeModifications()); }

std::set<std::string> MediaImpl::edgeModGroupNames() const {
    ScopedReadLock lock(projectLock());
    std::set<std::string> names;
    for (const EdgeModificationPtr& modification : leftEdges_) names.insert(modification->group());
    for (const EdgeModificationPtr& modification : rightEdges_) names.insert(modification->group());
    return names;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/model/MediaImpl.h>

#include <VelaMediaLib/document/JSONWriter.h>
#include <VelaMediaLib/document/XMLOptions.h>
#include <VelaMediaLib/model/MediaEditor.h>
#include <VelaMediaLib/model/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/RationalStaticEditor.h>
#include <VelaMediaLib/model/RationalTemporalEditor.h>
#include <VelaMediaLib/time/RationalUtil.h>

#include <algorithm>

namespace VelaMediaLib {

MediaImpl::MediaImpl(const boost::weak_ptr<const ThreadSafe>& token,
                     const boost::weak_ptr<ProjectEditRate>& rate, const MediaState& initial,
                     EditorKind editor)
    : Media(token), SubTimelineParts<Media>(token), transitionSubject_(token), state_(initial),
      editRate_(rate) {
    if (initial.duration <= 0)
        throw ValueException<long long>("a clip's duration must be greater than 0", initial.duration);
    if (initial.scalar <= 0)
        throw ValueException<double>("a clip's scalar must be greater than 0", initial.scalar.asDouble());
    if (editor == Temporal)
        editor_.reset(new RationalTemporalEditor(*this));
    else
        editor_.reset(new RationalStaticEditor(*this));
}

MediaImpl::~MediaImpl() = default;

MediaState MediaImpl::state() const {
    ScopedReadLock lock(projectMutex());
    return state_;
}

VelaTime MediaImpl::startTime() const { return trackRange().start(); }
VelaTime MediaImpl::endTime() const { return trackRange().end(); }
VelaTime MediaImpl::duration() const { return trackRange().duration(); }

Range<VelaTime> MediaImpl::trackRange() const {
    ScopedReadLock lock(projectMutex());
    return state_.trackRange();
}

boost::weak_ptr<ProjectEditRate> MediaImpl::projectEditRate() const {
    ScopedReadLock lock(projectMutex());
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
    return editor_->move(state(), offset).trackRange();
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

Range<VelaTime> MediaImpl::trackRangeWithRationalStretch(const SafeRational& factor) const {
    const MediaState current = state();
    const SafeRational duration = SafeRational(current.duration) * factor;
    return Range<VelaTime>(current.start, RationalUtil::toVelaTime(RationalUtil::Round(duration)));
}

Range<double> MediaImpl::mediaRange() const { return RationalUtil::toDoubleRange(rationalMediaRange()); }

SafeRational MediaImpl::findRationalScalar(VelaTime duration) const {
    return SafeRational(duration) / state().mediaDuration;
}

VelaTime MediaImpl::trimEndLimit() const { return editor_->trimEndLimit(state()); }
VelaTime MediaImpl::trimStartLimit() const { return editor_->trimStartLimit(state()); }
bool MediaImpl::validTrimStart(VelaTime offset) const { return editor_->validTrimStart(state(), offset); }
bool MediaImpl::validTrimEnd(VelaTime offset) const { return editor_->validTrimEnd(state(), offset); }

MediaState MediaImpl::defaultState() const {
    MediaState whole = state();
    if (!whole.minUnbounded()) whole.mediaStart = whole.minMediaStart;
    if (!whole.minUnbounded() && !whole.maxUnbounded()) whole.mediaDuration = whole.fullMediaLength();
    whole.scalar = SafeRational(1);
    const VelaTime duration = RationalUtil::toVelaTime(RationalUtil::Round(whole.mediaDuration));
    whole.duration = duration > 0 ? duration : whole.duration;
    return whole;
}

void MediaImpl::restoreState(const MediaState& saved, VelaTime tolerance) {
    commit([&](const MediaState&) { return editor_->restoreState(saved, tolerance); });
}

void MediaImpl::move(VelaTime offset) {
    commit([&](const MediaState& s) { return editor_->move(s, offset); });
}

void MediaImpl::trimStart(VelaTime offset) {
    commit([&](const MediaState& s) { return editor_->trimStart(s, offset); });
}

void MediaImpl::trimEnd(VelaTime offset) {
    commit([&](const MediaState& s) { return editor_->trimEnd(s, offset); });
}

void MediaImpl::setTrackStart(VelaTime start) {
    commit([&](const MediaState& s) { return editor_->move(s, start - s.start); });
}

double MediaImpl::stretch(double factor) {
    return rationalStretch(RationalUtil::fromDoubleApprox(factor)).asDouble();
}

SafeRational MediaImpl::rationalStretch(const SafeRational& factor) {
    SafeRational scalar;
    commit([&](const MediaState& s) {
        const MediaState stretched = editor_->stretch(s, factor);
        scalar = stretched.scalar;
        return stretched;
    });
    return scalar;
}

MediaEditor& MediaImpl::mediaEditor() {
    ScopedWriteLock lock(projectMutex());
    if (!oldEditor_) {
        if (dynamic_cast<RationalTemporalEditor*>(editor_.get()))
            oldEditor_.reset(new TemporalEditor(*this));
        else
            oldEditor_.reset(new StaticEditor(*this));
    }
    return *oldEditor_;
}

TransitionPtr MediaImpl::leftTransition() {
    ScopedReadLock lock(projectMutex());
    return left_;
}
TransitionPtr MediaImpl::leftTransition() const {
    ScopedReadLock lock(projectMutex());
    return left_;
}
TransitionPtr MediaImpl::rightTransition() {
    ScopedReadLock lock(projectMutex());
    return right_;
}
TransitionPtr MediaImpl::rightTransition() const {
    ScopedReadLock lock(projectMutex());
    return right_;
}

void MediaImpl::setTransition(TransitionPtr& slot, const TransitionPtr& transition) {
    {
        ScopedWriteLock lock(projectMutex());
        if (slot == transition) return;
        slot = transition;
    }
    transitionSubject_.notify();
    notify();
}

void MediaImpl::setLeftTransition(const TransitionPtr& transition) {
    if (transition) transition->setRightMedia(shared_from_this());
    setTransition(left_, transition);
}

void MediaImpl::setRightTransition(const TransitionPtr& transition) {
    if (transition) transition->setLeftMedia(shared_from_this());
    setTransition(right_, transition);
}

TransitionPtr MediaImpl::transitionAtTime(VelaTime time) const {
    ScopedReadLock lock(projectMutex());
    const Range<VelaTime> range = state_.trackRange();
    if (left_ && time >= range.start() && time < range.start() + left_->duration()) return left_;
    if (right_ && time < range.end() && time >= range.end() - right_->duration()) return right_;
    return TransitionPtr();
}

Media::TransitionAndNeighbour MediaImpl::splitMergeTransitions() const {
    const TransitionPtr right = rightTransition();
    return TransitionAndNeighbour(right, right ? right->rightMedia() : MediaPtr());
}

const TimeConverter* MediaImpl::timeConverterParent() const {
    ScopedReadLock lock(projectMutex());
    return timeConverterParent_;
}

void MediaImpl::setTimeConverterParent(const TimeConverter* parent) {
    ScopedWriteLock lock(projectMutex());
    timeConverterParent_ = parent;
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

RationalTime MediaImpl::fromGlobalToParametricTime(const RationalTime& time) const {
    return TimeConverter::recursiveFromGlobalToParametricTime(this, time.asRational());
}

RationalTime MediaImpl::fromParametricToGlobalTime(const RationalTime& time) const {
    return TimeConverter::recursiveFromParametricToGlobalTime(this, time.asRational());
}

RationalTime MediaImpl::clippingFromGlobalToParametricTime(const RationalTime& time) const {
    return TimeConverter::clippingRecursiveFromGlobalToParametricTime(this, time.asRational());
}

boost::weak_ptr<Timeline> MediaImpl::parentTimeline() const {
    ScopedReadLock lock(projectMutex());
    return timeline_;
}

void MediaImpl::setParentTimeline(const boost::weak_ptr<Timeline>& timeline) {
    ScopedWriteLock lock(projectMutex());
    timeline_ = timeline;
}

void MediaImpl::parentVisitor(const ParentVisitor& visitor) const {
    boost::shared_ptr<SubTimeline> parent;
    {
        ScopedReadLock lock(projectMutex());
        parent = parent_.lock();
    }
    if (parent) visitor(parent);
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
    ScopedReadLock lock(projectMutex());
    for (const EdgeModificationPtr& edge : leftEdges_)
        clone.leftEdges_.push_back(EdgeModificationPtr(new EdgeModification(*edge)));
    for (const EdgeModificationPtr& edge : rightEdges_)
        clone.rightEdges_.push_back(EdgeModificationPtr(new EdgeModification(*edge)));
}

void MediaImpl::setupSharedClone(const boost::shared_ptr<Media>& clone) const {
    if (!clone) return;
    for (const std::string& name : parameterNames()) {
        if (!hasMadeParameter(name) || !clone->hasMadeParameter(name)) continue;
        parameter(name)->setupSharedClone(clone->parameter(name));
    }
}

void MediaImpl::toJSONTemporalValues(JSONWriter& writer) const {
    const MediaState s = state();
    writer.key("start") << s.start;
    writer.key("duration") << s.duration;
    ValueFormatter<SafeRational>::write(writer.key("mediaStart"), s.mediaStart);
    ValueFormatter<SafeRational>::write(writer.key("mediaDuration"), s.mediaDuration);
    ValueFormatter<SafeRational>::write(writer.key("scalar"), s.scalar);
}

void MediaImpl::toJSON(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    object.key("id") << options.assignNewIdent(this);
    object.key("_type") << quotedJSONString(MediaTypeFromMediaDispatcher::typeOf(*this));
    object.key("attributes");
    {
        JSONWriter attributes(options, object.memberLevel());
        attributes.key("ident") << quotedJSONString(identifier());
        writeAttributes(attributes);
    }
    toJSONSpecificProperties(object);
    toJSONTemporalValues(object);
    toJSONParameterList(object);
    MetaDatable::toJSON(object, *this);
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
    {
        ScopedWriteLock lock(projectMutex());
        for (const EdgeModificationPtr& modification : side) modification->setDuration(length);
    }
    notify();
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

EdgeModifiable::EdgeModifications MediaImpl::leftEdgeModifications() const {
    ScopedReadLock lock(projectMutex());
    return leftEdges_;
}

EdgeModifiable::EdgeModifications MediaImpl::rightEdgeModifications() const {
    ScopedReadLock lock(projectMutex());
    return rightEdges_;
}

VelaTime MediaImpl::leftEdgeModificationLength() const { return longest(leftEdgeModifications()); }
VelaTime MediaImpl::rightEdgeModificationLength() const { return longest(rightEdgeModifications()); }

std::set<std::string> MediaImpl::edgeModGroupNames() const {
    ScopedReadLock lock(projectMutex());
    std::set<std::string> names;
    for (const EdgeModificationPtr& modification : leftEdges_) names.insert(modification->group());
    for (const EdgeModificationPtr& modification : rightEdges_) names.insert(modification->group());
    return names;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/model/media/UnifiedMedia.h>

#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/model/media/MediaDispatcher.h>
#include <VelaMediaLib/model/project/Sourceable.h>
#include <VelaMediaLib/model/timeline/Track.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>
#include <VelaMediaLib/time/rational/TimeExceptions.h>

#include <algorithm>
#include <cstdlib>

namespace VelaMediaLib {
namespace {

bool onTrack(const Media& clip) { return bool(boost::dynamic_pointer_cast<Track>(clip.parent())); }

MediaImpl* implOf(const boost::shared_ptr<Media>& clip) {
    MediaImpl* const impl = dynamic_cast<MediaImpl*>(clip.get());
    if (!impl) throw TypeException("a unified media's parts must hold their own timing");
    return impl;
}

/// The rounding the state's duration already has, which a restore allows.
VelaTime roundingOf(const MediaState& state) {
    const VelaTime implied =
        RationalUtil::toVelaTime(RationalUtil::Round(state.mediaDuration * state.scalar));
    return std::llabs(implied - state.duration);
}

/// A part plays the unified slice at its scalar from 0 in the unified
/// clip's time, within its own limits widened to the slice (a restore of it
/// cannot refuse).
MediaState partState(const MediaState& unified, const MediaState& part) {
    MediaState next = part;
    next.start = 0;
    next.duration = unified.duration;
    next.mediaStart = unified.mediaStart;
    next.mediaDuration = unified.mediaDuration;
    next.scalar = unified.scalar;
    next.minMediaStart = std::min(part.minMediaStart, unified.mediaStart);
    next.maxMediaEnd = std::max(part.maxMediaEnd, unified.mediaEnd());
    return next;
}

/// The limits both parts allow, widened to the slice the unified clip plays.
MediaState withSharedLimits(MediaState unified, const MediaState& visual, const MediaState& audio) {
    unified.minMediaStart = std::min(std::max(visual.minMediaStart, audio.minMediaStart), unified.mediaStart);
    unified.maxMediaEnd = std::max(std::min(visual.maxMediaEnd, audio.maxMediaEnd), unified.mediaEnd());
    return unified;
}

bool isVisualParameter(const std::string& name) {
    return std::find(std::begin(VisualMediaImpl::kParameterNames), std::end(VisualMediaImpl::kParameterNames),
                     name) != std::end(VisualMediaImpl::kParameterNames);
}

bool sameProject(const Media& a, const Media& b) {
    return !a.projectMutex().owner_before(b.projectMutex()) &&
           !b.projectMutex().owner_before(a.projectMutex());
}

/// The checks of create after the four that name a missing clip or a track.
void checkParts(const Media& visual, const Media& audio) {
    if (&visual == &audio) throw AddRemoveException("a unified media needs two clips");
    if (visual.parent() || audio.parent())
        throw AddRemoveException("unable to create unified media with a clip inside another clip");
    if (!sameProject(visual, audio))
        throw AddRemoveException("unable to create unified media with clips of two projects");
}

} // namespace

UnifiedMedia::UnifiedMedia(const boost::shared_ptr<VisualMedia>& visual,
                           const boost::shared_ptr<AudioMedia>& audio, const MediaState& initial)
    : Media(visual->projectMutex()), VisualMedia(visual->projectMutex()), AudioMedia(visual->projectMutex()),
      AbstractUnifiedMedia(visual->projectMutex(), visual->projectEditRate(), initial, Temporal),
      visual_(visual), audio_(audio), visualImpl_(implOf(visual)), audioImpl_(implOf(audio)) {}

boost::shared_ptr<UnifiedMedia> UnifiedMedia::create(const boost::shared_ptr<VisualMedia>& visual,
                                                     const boost::shared_ptr<AudioMedia>& audio) {
    if (!audio) throw VelaMediaLibException("created a unified media without an audiomedia");
    if (!visual) throw VelaMediaLibException("created a unified media without an visualmedia");
    if (audio->parentTrack())
        throw AddRemoveException("unable to create unified media with audio media having a parent track");
    if (onTrack(*visual))
        throw AddRemoveException("unable to create unified media with video media having a parent track");
    checkParts(*visual, *audio);
    const MediaState initial = withSharedLimits(visual->state(), visual->state(), audio->state());
    const boost::shared_ptr<UnifiedMedia> made(new UnifiedMedia(visual, audio, initial));
    made->adoptInternals();
    return made;
}

UnifiedMediaState UnifiedMedia::unifiedMediaState() const {
    ScopedReadLock lock(projectLock()); // one snapshot of the three
    return UnifiedMediaState{state(), visual_->state(), audio_->state()};
}

bool UnifiedMedia::holdsInternals() const {
    ScopedReadLock lock(projectLock());
    return holding_;
}

void UnifiedMedia::releaseInternals() {
    ScopedWriteLock lock(projectMutex());
    if (!holding_) return;
    visual_->setParent(boost::weak_ptr<SubTimeline>());
    audio_->setParent(boost::weak_ptr<SubTimeline>());
    audio_->setParentUnifiedMedia(boost::weak_ptr<Media>());
    holding_ = false;
}

void UnifiedMedia::adoptInternals() {
    {
        ScopedWriteLock lock(projectMutex());
        if (holding_) return;
        if (audio_->parentTrack())
            throw AddRemoveException("unable to create unified media with audio media having a parent track");
        if (onTrack(*visual_))
            throw AddRemoveException("unable to create unified media with video media having a parent track");
        checkParts(*visual_, *audio_);
        const MediaPtr self = shared_from_this();
        visual_->setParent(self);
        audio_->setParent(self);
        audio_->setParentUnifiedMedia(self);
        holding_ = true;
        shareForwardedParameters();
        syncPartsLocked(state());
    }
    notify();
}

void UnifiedMedia::syncPartsLocked(const MediaState& unified) {
    const MediaState visual = visual_->state(), audio = audio_->state();
    const VelaTime rounding = roundingOf(unified);
    bool moved = visualImpl_->restoreStateUnnotified(partState(unified, visual), rounding);
    moved = audioImpl_->restoreStateUnnotified(partState(unified, audio), rounding) || moved;
    if (moved) partsToTell_ = true;
}

MediaState UnifiedMedia::stateAfter(const TimingEdit& edit) const {
    const bool start = edit.kind == TimingEdit::TrimStart, end = edit.kind == TimingEdit::TrimEnd;
    if ((start || end) && edit.amount != 0) {
        ScopedReadLock lock(projectLock());
        if (!(start ? validTrimStart(edit.amount) : validTrimEnd(edit.amount)))
            throw InvalidTrimRangeException("invalid trim of unified media", edit.amount, lockedTrackRange());
    }
    return AbstractUnifiedMedia::stateAfter(edit);
}

bool UnifiedMedia::takeStateUnnotified(const MediaState& next) {
    ScopedWriteLock lock(projectMutex());
    const bool changed = AbstractUnifiedMedia::takeStateUnnotified(next);
    if (holding_) syncPartsLocked(next);
    return changed;
}

void UnifiedMedia::notify() {
    AbstractUnifiedMedia::notify();
    if (!partsToTell_.exchange(false)) return;
    visual_->notify();
    audio_->notify();
}

boost::shared_ptr<ParameterInterface> UnifiedMedia::createDefaultParameter(const std::string& name) const {
    if (name == "volume") return audio_->parameter(name);
    if (isVisualParameter(name)) return visual_->parameter(name);
    return AbstractUnifiedMedia::createDefaultParameter(name);
}

// What a part made before it was bound (or a copy of this clip's content
// made for a clone) gives way to the part's own parameter object.
void UnifiedMedia::shareForwardedParameters() {
    for (const std::string& name : parameterNames()) {
        const Media* part = name == "volume"          ? static_cast<const Media*>(audio_.get())
                            : isVisualParameter(name) ? visual_.get()
                                                      : nullptr;
        if (part && (hasMadeParameter(name) || part->hasMadeParameter(name)))
            addParameter(name, part->parameter(name));
    }
}

boost::shared_ptr<Media> UnifiedMedia::clone() const {
    const auto visual = boost::dynamic_pointer_cast<VisualMedia>(visual_->clone());
    const auto audio = boost::dynamic_pointer_cast<AudioMedia>(audio_->clone());
    const boost::shared_ptr<UnifiedMedia> copy(new UnifiedMedia(visual, audio, state()));
    copyContentInto(*copy);
    copy->adoptInternals();
    return copy;
}

boost::shared_ptr<UnifiedMedia>
UnifiedMedia::cloneWithSource(const boost::shared_ptr<const Source>& source) const {
    if (!source) throw VelaMediaLibException("no source for the unified media's copy to play");
    const boost::shared_ptr<UnifiedMedia> copy = boost::dynamic_pointer_cast<UnifiedMedia>(clone());
    std::vector<std::pair<Sourceable*, Media*>> files;
    copy->accessInternals(
        [&](const boost::shared_ptr<VisualMedia>& visual, const boost::shared_ptr<AudioMedia>& audio) {
            for (Media* part : {static_cast<Media*>(visual.get()), static_cast<Media*>(audio.get())})
                if (Sourceable* file = dynamic_cast<Sourceable*>(part)) files.emplace_back(file, part);
        });
    if (files.empty()) throw TypeException("a unified media without file clips plays no source");
    for (const auto& file : files) file.first->checkSource(source);
    for (const auto& file : files) file.first->setSource(source);
    copy->mediaSourceChanged();
    return copy;
}

void UnifiedMedia::mediaSourceChanged() {
    if (!holdsInternals()) return;
    visual_->mediaSourceChanged();
    audio_->mediaSourceChanged();
    const MediaState now = state();
    const MediaState next = withSharedLimits(now, visual_->state(), audio_->state());
    if (next != now) restoreState(next, roundingOf(now));
}

void UnifiedMedia::toJSONSpecificProperties(XMLOptions& options, int indent) const {
    options.key("video");
    visual_->toJSON(options, indent);
    options.key("audio");
    audio_->toJSON(options, indent);
}

void UnifiedMedia::dispatch(MediaDispatcher& dispatcher) { dispatcher.dispatchUnifiedMedia(*this); }
void UnifiedMedia::dispatch(ConstMediaDispatcher& dispatcher) const {
    dispatcher.dispatchUnifiedMedia(*this);
}

} // namespace VelaMediaLib

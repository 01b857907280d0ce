#include <VelaMediaLib/model/media/StitchedMedia.h>

#include <VelaMediaLib/model/media/UnifiedMedia.h>

#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/effects/Effect.h>
#include <VelaMediaLib/model/media/FileMedia.h>
#include <VelaMediaLib/model/media/MediaDispatcher.h>
#include <VelaMediaLib/model/media/RationalMediaEditor.h>
#include <VelaMediaLib/model/timeline/Track.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <algorithm>
#include <cstdlib>
#include <limits>

namespace VelaMediaLib {
namespace {

// The internal track: its clips' times lead, through the stitched media's
// children's converter, to the stitched media's own time.
class PartsTrack : public Track {
public:
    static boost::shared_ptr<PartsTrack> create(const boost::weak_ptr<const ThreadSafe>& token) {
        return boost::shared_ptr<PartsTrack>(new PartsTrack(token));
    }
    void place(const MediaPtr& media, VelaTime start) { addMediaSansTypeCheck(media, start); }
    boost::shared_ptr<Track> cloneEmpty() const override {
        const boost::shared_ptr<PartsTrack> empty = create(projectMutex());
        copyFlagsInto(*empty);
        return empty;
    }
    TimeConverterPtr parentTimeConverter() const override {
        const auto stitched = boost::dynamic_pointer_cast<const StitchedMedia>(parentStitchedMedia());
        return stitched ? stitched->childrensTimeConverter() : TimeConverterPtr();
    }

private:
    explicit PartsTrack(const boost::weak_ptr<const ThreadSafe>& token) : SubTimeline(token), Track(token) {}
};

PartsTrack& partsTrack(const boost::shared_ptr<Track>& track) { return static_cast<PartsTrack&>(*track); }

// A part and its state, read together.
struct Part {
    MediaPtr media;
    MediaState state;
};

std::vector<Part> partsOn(const Track& track) {
    std::vector<Part> parts;
    for (const MediaPtr& media : track.medias()) parts.push_back(Part{media, media->state()});
    return parts;
}

VelaTime endOf(const std::vector<Part>& parts) {
    return parts.empty() ? 0 : parts.back().state.trackRange().end();
}

// The part that plays internal time m: the last one starting at or before
// it, the first one before them all.
size_t indexAt(const std::vector<Part>& parts, const SafeRational& m) {
    const auto after =
        std::upper_bound(parts.begin(), parts.end(), m, [](const SafeRational& t, const Part& p) {
            return t < SafeRational(p.state.start);
        });
    return after == parts.begin() ? 0 : size_t(after - parts.begin()) - 1;
}

// A part's parametric time (internal time less its start) and its source time.
SafeRational sourceAt(const MediaState& part, const SafeRational& internal) {
    return part.mediaStart + (internal - SafeRational(part.start)) / part.scalar;
}
SafeRational internalAt(const MediaState& part, const SafeRational& source) {
    return SafeRational(part.start) + (source - part.mediaStart) * part.scalar;
}

VelaTime ceilTicks(const SafeRational& x) { return RationalUtil::toVelaTime(RationalUtil::Ceil(x)); }
VelaTime floorTicks(const SafeRational& x) { return RationalUtil::toVelaTime(RationalUtil::Floor(x)); }

// A restore allows the rounding the state already has.
VelaTime roundingOf(const MediaState& state) {
    return std::abs(RationalMediaEditor::durationFor(state.mediaDuration, state.scalar) - state.duration);
}

} // namespace

StitchedMedia::StitchedMedia(const boost::weak_ptr<const ThreadSafe>& token,
                             const boost::weak_ptr<ProjectEditRate>& rate, const MediaState& state)
    : Media(token), VisualMedia(token), AudioMedia(token), AbstractUnifiedMedia(token, rate, state, Temporal),
      track_(PartsTrack::create(token)) {}

boost::shared_ptr<StitchedMedia> StitchedMedia::create(const boost::weak_ptr<const ThreadSafe>& token,
                                                       const boost::weak_ptr<ProjectEditRate>& rate,
                                                       const MediaState& state) {
    const boost::shared_ptr<StitchedMedia> stitched(new StitchedMedia(token, rate, state));
    stitched->converter_.reset(
        new StitchedMediaChildrensTimeConverter(boost::weak_ptr<const StitchedMedia>(stitched)));
    stitched->track_->setParentStitchedMedia(boost::weak_ptr<Media>(stitched));
    return stitched;
}

boost::shared_ptr<StitchedMedia> StitchedMedia::create(const std::vector<MediaPtr>& parts, VelaTime start) {
    if (parts.empty() || !parts.front())
        throw VelaMediaLibException("a stitched media needs at least one clip");
    const MediaPtr& first = parts.front();
    const boost::shared_ptr<StitchedMedia> stitched =
        create(first->projectMutex(), first->projectEditRate(), MediaState::unbounded(start, 1));
    stitched->addMedias(parts);
    return stitched;
}

// Parts

int StitchedMedia::trackNumber() const {
    for (const MediaPtr& media : medias())
        if (const auto file = boost::dynamic_pointer_cast<FileMedia>(media)) return file->streamIndex();
    return -1;
}

std::vector<MediaPtr> StitchedMedia::medias() const { return track_->medias(); }

std::vector<boost::shared_ptr<AudioMedia>> StitchedMedia::audioMedias() const {
    std::vector<boost::shared_ptr<AudioMedia>> found;
    for (const MediaPtr& media : medias())
        if (const auto audio = boost::dynamic_pointer_cast<AudioMedia>(media)) found.push_back(audio);
    return found;
}

std::vector<boost::shared_ptr<VisualMedia>> StitchedMedia::visualMedias() const {
    std::vector<boost::shared_ptr<VisualMedia>> found;
    for (const MediaPtr& media : medias())
        if (const auto visual = boost::dynamic_pointer_cast<VisualMedia>(media)) found.push_back(visual);
    return found;
}

VelaTime StitchedMedia::fullDuration() const { return track_->endTime(); }

// Adding parts

void StitchedMedia::checkParts(const std::vector<MediaPtr>& parts) const {
    const std::vector<MediaPtr> held = medias();
    const boost::shared_ptr<const ThreadSafe> project = projectMutex().lock();
    bool first = held.empty();
    boost::shared_ptr<const Source> source =
        first ? boost::shared_ptr<const Source>() : sourceOf(held.front());
    for (size_t i = 0; i < parts.size(); ++i) {
        const MediaPtr& part = parts[i];
        if (!part) throw AddRemoveException("no clip to stitch");
        if (Track::isWithin(this, *part)) throw AddRemoveException("a stitched media cannot hold itself");
        if (part->parent()) throw AddRemoveException("the clip is already on a track or in a group");
        if (std::find(parts.begin(), parts.begin() + std::ptrdiff_t(i), part) !=
            parts.begin() + std::ptrdiff_t(i))
            throw AddRemoveException("the clip is given twice");
        if (part->projectMutex().lock() != project)
            throw AddRemoveException("the clip belongs to another project");
        const boost::shared_ptr<const Source> partSource = sourceOf(part);
        if (first) {
            source = partSource;
            first = false;
        } else if (partSource != source) {
            throw VelaMediaLibException("cannot stitch clips of different sources");
        }
    }
}

MediaState StitchedMedia::withPartLimits(MediaState state) const {
    const std::vector<Part> parts = partsOn(*track_);
    if (parts.empty()) return state;
    const MediaState& first = parts.front().state;
    const MediaState& last = parts.back().state;
    if (first.minUnbounded()) {
        state.minMediaStart = MediaState::unboundedStart();
    } else {
        const SafeRational reach = internalAt(first, first.minMediaStart);
        state.minMediaStart = std::min(std::min(reach, SafeRational(first.start)), state.mediaStart);
    }
    if (last.maxUnbounded()) {
        state.maxMediaEnd = MediaState::unboundedEnd();
    } else {
        const SafeRational reach = internalAt(last, last.maxMediaEnd);
        state.maxMediaEnd = std::max(std::max(reach, SafeRational(endOf(parts))), state.mediaEnd());
    }
    return state;
}

void StitchedMedia::takeState(const MediaState& next) { restoreState(next, roundingOf(next)); }

void StitchedMedia::appendParts(const std::vector<MediaPtr>& parts, bool growWindow) {
    checkParts(parts);
    const std::vector<Part> before = partsOn(*track_);
    std::vector<MediaState> loose;
    for (const MediaPtr& part : parts) loose.push_back(part->state());
    const bool hadParts = !before.empty();
    const MediaState own = state();
    const bool playedToEnd = hadParts && own.mediaEnd() >= SafeRational(endOf(before));
    size_t placed = 0;
    try {
        if (growWindow && playedToEnd) extendLastPart();
        VelaTime at = fullDuration();
        for (const MediaPtr& part : parts) {
            partsTrack(track_).place(part, at);
            ++placed;
            at = part->endTime();
        }
        MediaState next = state();
        if (growWindow && (!hadParts || playedToEnd)) {
            if (!hadParts) next.mediaStart = SafeRational(0);
            next.mediaDuration = SafeRational(at) - next.mediaStart;
            next.duration = RationalMediaEditor::durationFor(next.mediaDuration, next.scalar);
        }
        takeState(withPartLimits(next));
    } catch (...) {
        for (size_t i = placed; i-- > 0;) {
            track_->removeMedia(parts[i]);
            parts[i]->restoreState(loose[i], roundingOf(loose[i]));
        }
        for (const Part& part : before)
            track_->restoreMediaState(part.media, part.state, roundingOf(part.state));
        if (state() != own) takeState(own); // its limits may have grown with the last part
        throw;
    }
}

void StitchedMedia::addMedia(const MediaPtr& media) { appendParts({media}, true); }

void StitchedMedia::addMedias(const std::vector<MediaPtr>& medias) { appendParts(medias, true); }

void StitchedMedia::addMediasWithPropertiesOptional(const std::vector<MediaPtr>& medias,
                                                    bool takeProperties) {
    checkParts(medias);
    const auto first = medias.empty() ? boost::shared_ptr<MediaImpl>()
                                      : boost::dynamic_pointer_cast<MediaImpl>(medias.front());
    if (takeProperties && first && track_->numMedias() == 0) {
        appendParts(medias, true);
        // The content of any clip implementation, reached as this class's own.
        const auto copyContent = &StitchedMedia::copyContentInto;
        (first.get()->*copyContent)(*this);
        return;
    }
    appendParts(medias, true);
}

void StitchedMedia::addMediaToTrackAndUpdateRanges(const MediaPtr& media) { appendParts({media}, false); }

void StitchedMedia::addMediaWhileParsing(const MediaPtr& media) {
    checkParts({media});
    partsTrack(track_).place(media, media->startTime());
}

std::vector<MediaPtr> StitchedMedia::removeAllMedias() {
    const std::vector<MediaPtr> parts = medias();
    for (const MediaPtr& part : parts) track_->removeMedia(part);
    return parts;
}

std::vector<StitchedMedia::Placement> StitchedMedia::placementsWherePlayed() const {
    ScopedReadLock lock(projectLock());
    const std::vector<Part> parts = partsOn(*track_);
    const MediaState own = state();
    const SafeRational from = own.mediaStart, to = own.mediaEnd();
    // Where an internal time lands on the stitched media's track: its own
    // ends exactly, the cuts between them at the nearest tick.
    const auto landing = [&](const SafeRational& m) {
        if (m == from) return own.start;
        if (m == to) return own.trackRange().end();
        return own.start + RationalUtil::toVelaTime(RationalUtil::Round((m - from) * own.scalar));
    };
    std::vector<Placement> placements;
    for (size_t i = 0; i < parts.size(); ++i) {
        const MediaState& s = parts[i].state;
        const SafeRational a(s.start), b(s.trackRange().end());
        const SafeRational lo = i == 0 ? from : std::max(a, from);
        const SafeRational hi = i + 1 == parts.size() ? to : std::min(b, to);
        if (hi <= lo) continue;
        const VelaTime start = landing(lo), end = landing(hi);
        if (end <= start) continue;
        MediaState next = s;
        next.mediaStart = lo == a ? s.mediaStart : sourceAt(s, lo);
        const SafeRational mediaEnd = hi == b ? s.mediaEnd() : sourceAt(s, hi);
        next.mediaDuration = mediaEnd - next.mediaStart;
        next.start = start;
        next.duration = end - start;
        next.scalar = s.scalar * own.scalar;
        if (RationalMediaEditor::durationFor(next.mediaDuration, next.scalar) != next.duration)
            next.scalar = SafeRational(next.duration) / next.mediaDuration;
        if (!next.minUnbounded() && next.mediaStart < next.minMediaStart)
            next.minMediaStart = next.mediaStart;
        if (!next.maxUnbounded() && mediaEnd > next.maxMediaEnd) next.maxMediaEnd = mediaEnd;
        placements.push_back(Placement{parts[i].media, next});
    }
    return placements;
}

// Stitches

std::vector<VelaTime> StitchedMedia::stitchTimes() const {
    std::vector<VelaTime> times;
    const std::vector<MediaPtr> parts = medias();
    for (size_t i = 1; i < parts.size(); ++i) times.push_back(parts[i]->startTime());
    return times;
}

std::vector<SafeRational> StitchedMedia::parametricStitchTimes() const {
    ScopedReadLock lock(projectLock());
    const MediaState own = state();
    std::vector<SafeRational> times;
    for (VelaTime stitch : stitchTimes())
        times.push_back((SafeRational(stitch) - own.mediaStart) * own.scalar);
    return times;
}

size_t StitchedMedia::numStitches() const {
    const size_t parts = track_->numMedias();
    return parts == 0 ? 0 : parts - 1;
}

int StitchedMedia::stitchIndexNearTime(const SafeRational& parametricTime) const {
    const std::vector<SafeRational> stitches = parametricStitchTimes();
    int nearest = -1;
    SafeRational distance = stitchTolerance();
    for (size_t i = 0; i < stitches.size(); ++i) {
        SafeRational apart = stitches[i] - parametricTime;
        if (apart < 0) apart = -apart;
        if (apart < distance || (apart == distance && nearest < 0)) {
            nearest = int(i);
            distance = apart;
        }
    }
    return nearest;
}

boost::optional<SafeRational> StitchedMedia::stitchNearTime(const SafeRational& parametricTime) const {
    ScopedReadLock lock(projectLock());
    const int index = stitchIndexNearTime(parametricTime);
    if (index < 0) return boost::none;
    return parametricStitchTimes()[size_t(index)];
}

bool StitchedMedia::isTimeNearStitch(const SafeRational& parametricTime) const {
    return stitchIndexNearTime(parametricTime) >= 0;
}

// Times

MediaPtr StitchedMedia::mediaAtTime(VelaTime parametricTime) const {
    ScopedReadLock lock(projectLock());
    if (parametricTime < 0 || parametricTime >= duration()) return MediaPtr();
    return mediaAndSubTimeForParametricTime(SafeRational(parametricTime)).first;
}

StitchedMedia::MediaAndSubTime
StitchedMedia::mediaAndSubTimeForParametricTime(const SafeRational& parametricTime) const {
    ScopedReadLock lock(projectLock());
    const MediaState own = state();
    return mediaAndSubTimeForParameterTime(own.mediaStart + parametricTime / own.scalar);
}

StitchedMedia::MediaAndSubTime
StitchedMedia::mediaAndSubTimeForParameterTime(const SafeRational& parameterTime) const {
    ScopedReadLock lock(projectLock());
    if (track_->mediaBegin() == track_->mediaEnd()) return MediaAndSubTime(MediaPtr(), parameterTime);
    // As indexAt, by the track's own index: this runs for every time query.
    auto part = track_->upper_bound(floorTicks(parameterTime));
    if (part != track_->mediaBegin()) --part;
    return MediaAndSubTime(part->second, parameterTime - SafeRational(part->first));
}

SafeRational StitchedMedia::toSubMediaSourceTime(const SafeRational& parametricTime) const {
    ScopedReadLock lock(projectLock());
    const MediaAndSubTime found = mediaAndSubTimeForParametricTime(parametricTime);
    if (!found.first) throw VelaMediaLibException("a stitched media without parts plays no source");
    const MediaState part = found.first->state();
    return part.mediaStart + found.second / part.scalar;
}

bool StitchedMedia::compatibleClipSpeeds() const {
    const std::vector<MediaPtr> parts = medias();
    for (const MediaPtr& part : parts)
        if (part->rationalScalar() != parts.front()->rationalScalar()) return false;
    return true;
}

// Extended time

Range<SafeRational> StitchedMedia::extendedTimeRange() const {
    const MediaState own = state();
    if (own.minUnbounded() || own.maxUnbounded())
        return Range<SafeRational>(own.minMediaStart, MediaState::unboundedEnd());
    return Range<SafeRational>(own.minMediaStart, own.maxMediaEnd - own.minMediaStart);
}

std::pair<SafeRational, SafeRational> StitchedMedia::extendedParametricTime() const {
    ScopedReadLock lock(projectLock());
    const MediaState own = state();
    const std::vector<Part> parts = partsOn(*track_);
    if (parts.empty()) return std::make_pair(SafeRational(0), SafeRational(0));
    const SafeRational before = SafeRational(parts.front().state.start) - own.mediaStart;
    const SafeRational after = own.mediaEnd() - SafeRational(endOf(parts));
    return std::make_pair(std::max(before, SafeRational(0)) * own.scalar,
                          std::max(after, SafeRational(0)) * own.scalar);
}

// The first part shows k more ticks of its source at its start and the parts
// move k later, so that the first starts where it did: the window moves with
// them and plays what it played.
bool StitchedMedia::extendFirstPart() {
    const std::vector<Part> parts = partsOn(*track_);
    const MediaState own = state();
    if (parts.empty() || own.mediaStart >= SafeRational(parts.front().state.start)) return false;
    const MediaState& first = parts.front().state;
    VelaTime k = ceilTicks(SafeRational(first.start) - own.mediaStart);
    if (!first.minUnbounded())
        k = std::min(k, floorTicks((first.mediaStart - first.minMediaStart) * first.scalar));
    if (k <= 0) return false;
    MediaState longer = first;
    longer.mediaStart = first.mediaStart - SafeRational(k) / first.scalar;
    longer.mediaDuration = first.mediaDuration + SafeRational(k) / first.scalar;
    longer.start -= k;
    longer.duration += k;
    track_->restoreMediaState(parts.front().media, longer, roundingOf(longer));
    for (auto part = parts.rbegin(); part != parts.rend(); ++part) track_->move(part->media, k);
    MediaState next = own;
    next.mediaStart += SafeRational(k);
    takeState(withPartLimits(next));
    return true;
}

// The last part shows k more ticks of its source at its end.
bool StitchedMedia::extendLastPart() {
    const std::vector<Part> parts = partsOn(*track_);
    const MediaState own = state();
    if (parts.empty() || own.mediaEnd() <= SafeRational(endOf(parts))) return false;
    const MediaState& last = parts.back().state;
    VelaTime k = ceilTicks(own.mediaEnd() - SafeRational(endOf(parts)));
    if (!last.maxUnbounded()) k = std::min(k, floorTicks((last.maxMediaEnd - last.mediaEnd()) * last.scalar));
    if (k <= 0) return false;
    MediaState longer = last;
    longer.mediaDuration = last.mediaDuration + SafeRational(k) / last.scalar;
    longer.duration += k;
    track_->restoreMediaState(parts.back().media, longer, roundingOf(longer));
    takeState(withPartLimits(own));
    return true;
}

bool StitchedMedia::removeExtendedTime() {
    const bool first = extendFirstPart();
    const bool last = extendLastPart();
    return first || last;
}

VelaTime StitchedMedia::extendFrameTrimAmount(VelaTime trimEndOffset) const {
    ScopedReadLock lock(projectLock());
    const MediaState own = state();
    const SafeRational partsEnd = (SafeRational(fullDuration()) - own.mediaStart) * own.scalar;
    return std::max<VelaTime>(0, ceilTicks(SafeRational(own.duration - trimEndOffset) - partsEnd));
}

// Source

boost::shared_ptr<const Source> StitchedMedia::source() const {
    const std::vector<MediaPtr> parts = medias();
    return parts.empty() ? boost::shared_ptr<const Source>() : sourceOf(parts.front());
}

void StitchedMedia::checkSource(const boost::shared_ptr<const Source>& source) const {
    for (const MediaPtr& part : medias()) {
        const auto sourceable = boost::dynamic_pointer_cast<Sourceable>(part);
        if (sourceable)
            sourceable->checkSource(source);
        else if (source)
            throw TypeException("a part of the stitched media plays no source");
    }
}

void StitchedMedia::setSource(const boost::shared_ptr<const Source>& source) {
    checkSource(source);
    for (const MediaPtr& part : medias())
        if (const auto sourceable = boost::dynamic_pointer_cast<Sourceable>(part))
            sourceable->setSource(source);
}

boost::shared_ptr<Effect> StitchedMedia::sourceEffect() const {
    ScopedReadLock lock(projectLock());
    return sourceEffect_;
}

void StitchedMedia::setSourceEffect(const boost::shared_ptr<Effect>& effect) {
    {
        ScopedWriteLock lock(projectMutex());
        if (sourceEffect_ == effect) return;
        sourceEffect_ = effect;
    }
    notify();
}

boost::shared_ptr<const Source> StitchedMedia::sourceOf(const MediaPtr& media) {
    if (const auto unified = boost::dynamic_pointer_cast<const UnifiedMedia>(media)) {
        const boost::shared_ptr<const Source> seen = sourceOf(unified->internalVisualMedia());
        return seen ? seen : sourceOf(unified->internalAudioMedia());
    }
    const auto sourceable = boost::dynamic_pointer_cast<Sourceable>(media);
    return sourceable ? sourceable->source() : boost::shared_ptr<const Source>();
}

void StitchedMedia::mediaSourceChanged() {
    for (const MediaPtr& part : medias()) part->mediaSourceChanged();
    takeState(withPartLimits(state()));
}

// Screen data

boost::shared_ptr<const ScreenRecordingData> StitchedMedia::screenMetaData() const {
    throw VelaMediaLibException("StitchedMedia::screenMetaData() unimplemented\n");
}

void StitchedMedia::setScreenData(const boost::shared_ptr<const ScreenRecordingData>&) {
    throw VelaMediaLibException("StitchedMedia::setScreenData() unimplemented\n");
}

bool StitchedMedia::hasCursorData() const {
    for (const MediaPtr& part : medias())
        if (const auto provider = boost::dynamic_pointer_cast<ScreenMetaDataProvider>(part))
            if (provider->hasCursorData()) return true;
    return false;
}

Point3d StitchedMedia::cursorPositionAtTime(const RationalTime& time) const {
    ScopedReadLock lock(projectLock());
    const std::vector<Part> parts = partsOn(*track_);
    if (parts.empty()) return Point3d();
    const Part& part = parts[indexAt(parts, time.asRational())];
    const auto provider = boost::dynamic_pointer_cast<ScreenMetaDataProvider>(part.media);
    return provider ? provider->cursorPositionAtTime(sourceAt(part.state, time.asRational())) : Point3d();
}

template <typename Event, typename Ask>
std::vector<Event> StitchedMedia::eventsInRange(const Range<RationalTime>& range, Ask ask) const {
    if (range.duration() < RationalTime(0))
        throw ValueException<const SafeRational>("screen data range has a negative duration",
                                                 range.duration().asRational());
    ScopedReadLock lock(projectLock());
    const std::vector<Part> parts = partsOn(*track_);
    const SafeRational from = range.start().asRational(), to = range.end().asRational();
    std::vector<Event> found;
    for (size_t i = 0; i < parts.size(); ++i) {
        const auto provider = boost::dynamic_pointer_cast<ScreenMetaDataProvider>(parts[i].media);
        if (!provider) continue;
        const MediaState& s = parts[i].state;
        const SafeRational lo = i == 0 ? from : std::max(from, SafeRational(s.start));
        const SafeRational hi = i + 1 == parts.size() ? to : std::min(to, SafeRational(s.trackRange().end()));
        if (hi <= lo) continue;
        const SafeRational sourceFrom = sourceAt(s, lo);
        for (Event event : ask(*provider, Range<RationalTime>(sourceFrom, sourceAt(s, hi) - sourceFrom))) {
            event.time = RationalTime(internalAt(s, event.time.asRational()));
            found.push_back(event);
        }
    }
    return found;
}

std::vector<ScreenClick> StitchedMedia::clicksInRange(const Range<RationalTime>& range) const {
    return eventsInRange<ScreenClick>(range,
                                      [](const ScreenMetaDataProvider& provider,
                                         const Range<RationalTime>& r) { return provider.clicksInRange(r); });
}

std::vector<ScreenKeystroke> StitchedMedia::keystrokesInRange(const Range<RationalTime>& range) const {
    return eventsInRange<ScreenKeystroke>(
        range, [](const ScreenMetaDataProvider& provider, const Range<RationalTime>& r) {
            return provider.keystrokesInRange(r);
        });
}

Rect<int> StitchedMedia::recordingRect() const {
    for (const MediaPtr& part : medias())
        if (const auto provider = boost::dynamic_pointer_cast<ScreenMetaDataProvider>(part))
            return provider->recordingRect();
    return Rect<int>();
}

// Not offered

void StitchedMedia::splitChannels() {
    throw VelaMediaLibException("StitchedMedia::splitChannels() unimplemented\n");
}

double StitchedMedia::findScalar(double) const {
    throw VelaMediaLibException("double StitchedMedia::findScalar(double dSuggestedScalar) unimplemented\n");
}

// Copies, kinds, document

boost::shared_ptr<Media> StitchedMedia::clone() const {
    const std::vector<Part> parts = partsOn(*track_);
    const boost::shared_ptr<StitchedMedia> copy = create(projectMutex(), projectEditRate(), state());
    for (const Part& part : parts) {
        const MediaPtr partCopy = part.media->clone();
        part.media->setupSharedClone(partCopy);
        partsTrack(copy->track_).place(partCopy, part.state.start);
    }
    copyContentInto(*copy);
    if (const boost::shared_ptr<Effect> effect = sourceEffect()) copy->sourceEffect_ = effect->cloneEffect();
    return copy;
}

void StitchedMedia::dispatch(MediaDispatcher& dispatcher) { dispatcher.dispatchStitchedMedia(*this); }
void StitchedMedia::dispatch(ConstMediaDispatcher& dispatcher) const {
    dispatcher.dispatchStitchedMedia(*this);
}

void StitchedMedia::toJSONSpecificProperties(XMLOptions& options, int indent) const {
    options.key("medias");
    JSONWriter array(options, indent, JSONWriter::Array);
    for (const MediaPtr& part : medias()) {
        options.element();
        part->toJSON(options, array.memberLevel());
    }
}

} // namespace VelaMediaLib

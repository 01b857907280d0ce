#include <VelaMediaLib/model/media/RationalTemporalEditor.h>

#include <VelaMediaLib/time/rational/RationalUtil.h>
#include <VelaMediaLib/time/rational/TimeExceptions.h>

#include <limits>

namespace VelaMediaLib {

SafeRational RationalTemporalEditor::mediaDurationFor(const MediaState& state, VelaTime duration) {
    return snap(SafeRational(duration) / state.scalar, state.fullMediaLength());
}

namespace {

// Where a value's denominator outgrew the exact arithmetic (many edit-rate
// changes multiply them) it is rounded, and a start trim's slice could then
// reach a hair past the end of its media: its start gives way, so the slice
// stays inside. (A start a hair before the media's is snapped to it already;
// an end trim keeps its start and its check refuses a slice past the end.)
void keepInside(MediaState& next) {
    if (!next.maxUnbounded() && next.mediaEnd() > next.maxMediaEnd &&
        next.mediaEnd() - next.maxMediaEnd < SafeRational(1, 10000))
        next.mediaStart = next.maxMediaEnd - next.mediaDuration;
}

} // namespace

MediaState RationalTemporalEditor::trimmedStart(const MediaState& state, VelaTime offset) {
    MediaState next = state;
    next.start += offset;
    next.duration -= offset;
    next.mediaDuration = mediaDurationFor(state, next.duration);
    next.mediaStart =
        snap(state.mediaStart + (state.mediaDuration - next.mediaDuration), state.minMediaStart);
    keepInside(next);
    return next;
}

// The remaining track length must hold the transitions, and the media it
// implies (snapped to 0 and to the full length) must be some and no more than all.
bool RationalTemporalEditor::leavesEnoughMedia(const MediaState& state, VelaTime offset) const {
    if (state.duration - minimumTrackDuration() - offset < 0) return false;
    const SafeRational media = snap(
        snap(SafeRational(state.duration - offset) / state.scalar, SafeRational(0)), state.fullMediaLength());
    return media > 0 && media <= state.fullMediaLength();
}

bool RationalTemporalEditor::validTrimStart(const MediaState& state, VelaTime offset) const {
    if (!leavesEnoughMedia(state, offset)) return false;
    const SafeRational mediaStart = trimmedStart(state, offset).mediaStart;
    if (mediaStart < state.minMediaStart) return false;
    return state.maxUnbounded() || mediaStart < state.maxMediaEnd;
}

// The limit alone is not enough when the duration was rounded up: the media
// the extended duration implies must still end within the media.
bool RationalTemporalEditor::validTrimEnd(const MediaState& state, VelaTime offset) const {
    if (!leavesEnoughMedia(state, offset) || offset < trimEndLimit(state)) return false;
    return state.maxUnbounded() ||
           state.mediaStart + mediaDurationFor(state, state.duration - offset) <= state.maxMediaEnd;
}

MediaState RationalTemporalEditor::trimStart(const MediaState& state, VelaTime offset) const {
    if (offset == 0) return state;
    if (!validTrimStart(state, offset))
        throw InvalidTrimRangeException("invalid media start trim offset", offset, state.trackRange());
    return trimmedStart(state, offset);
}

MediaState RationalTemporalEditor::trimEnd(const MediaState& state, VelaTime offset) const {
    if (offset == 0) return state;
    if (!validTrimEnd(state, offset))
        throw InvalidTrimRangeException("invalid media trim end offset", offset, state.trackRange());
    MediaState next = state;
    next.duration -= offset;
    next.mediaDuration = mediaDurationFor(state, next.duration);
    return next;
}

VelaTime RationalTemporalEditor::trimStartLimit(const MediaState& state) const {
    if (state.minUnbounded()) return std::numeric_limits<long long>::min();
    return -RationalUtil::toVelaTime(
        RationalUtil::Floor(state.scalar * (state.mediaStart - state.minMediaStart)));
}

VelaTime RationalTemporalEditor::trimEndLimit(const MediaState& state) const {
    if (state.maxUnbounded()) return std::numeric_limits<long long>::min();
    return -RationalUtil::toVelaTime(
        RationalUtil::Floor(state.scalar * (state.maxMediaEnd - state.mediaEnd())));
}

} // namespace VelaMediaLib

#include <VelaMediaLib/model/media/RationalStaticEditor.h>

#include <VelaMediaLib/model/media/MediaImpl.h>
#include <VelaMediaLib/time/rational/TimeExceptions.h>

#include <limits>

namespace VelaMediaLib {

namespace {

// A static clip's media follows its track length; a clip given bounded
// limits still may not play past them.
bool staysWithinMedia(const MediaState& state, VelaTime duration) {
    return state.maxUnbounded() ||
           state.mediaStart + SafeRational(duration) / state.scalar <= state.maxMediaEnd;
}

} // namespace

bool RationalStaticEditor::validTrimStart(const MediaState& state, VelaTime offset) const {
    return state.duration - offset - minimumTrackDuration() > 0 &&
           staysWithinMedia(state, state.duration - offset);
}

bool RationalStaticEditor::validTrimEnd(const MediaState& state, VelaTime offset) const {
    return state.duration - offset - minimumTrackDuration() > 0 &&
           staysWithinMedia(state, state.duration - offset);
}

MediaState RationalStaticEditor::trimStart(const MediaState& state, VelaTime offset) const {
    if (offset == 0) return state;
    if (!validTrimStart(state, offset))
        throw InvalidTrimRangeException("invalid media start trim offset", offset, state.trackRange());
    MediaState next = state;
    next.start += offset;
    next.duration -= offset;
    next.mediaDuration = SafeRational(next.duration) / next.scalar;
    if (next.hasStartOffset) {
        const boost::shared_ptr<ProjectEditRate> rate = clip_.projectEditRate().lock();
        if (!rate) throw DanglingWeakPtrException<ProjectEditRate>("the clip's edit rate has gone");
        const boost::rational<unsigned long> ticks = rate->editRate();
        next.startOffset = next.startOffset +
                           RationalTime(SafeRational(offset) / SafeRational((long long)ticks.numerator(),
                                                                            (long long)ticks.denominator()));
    }
    return next;
}

MediaState RationalStaticEditor::trimEnd(const MediaState& state, VelaTime offset) const {
    if (offset == 0) return state;
    if (!validTrimEnd(state, offset))
        throw InvalidTrimRangeException("invalid media trim end offset", offset, state.trackRange());
    MediaState next = state;
    next.duration -= offset;
    next.mediaDuration = SafeRational(next.duration) / next.scalar;
    return next;
}

VelaTime RationalStaticEditor::trimEndLimit(const MediaState&) const {
    return std::numeric_limits<long long>::min();
}

VelaTime RationalStaticEditor::trimStartLimit(const MediaState&) const {
    return std::numeric_limits<long long>::min();
}

} // namespace VelaMediaLib

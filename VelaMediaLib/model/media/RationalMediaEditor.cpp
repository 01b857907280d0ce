#include <VelaMediaLib/model/media/RationalMediaEditor.h>

#include <VelaMediaLib/model/media/MediaImpl.h>
#include <VelaMediaLib/model/media/Transition.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <cmath>

namespace VelaMediaLib {

SafeRational RationalMediaEditor::snap(const SafeRational& x, const SafeRational& b) {
    return abs(x - b) < SafeRational(1, 10000) ? b : x;
}

VelaTime RationalMediaEditor::minimumTrackDuration() const { return Transition::minimumTrackDuration(clip_); }

MediaState RationalMediaEditor::move(const MediaState& state, VelaTime offset) const {
    MediaState moved = state;
    moved.start += offset;
    return moved;
}

VelaTime RationalMediaEditor::durationFor(const SafeRational& mediaDuration, const SafeRational& scalar) {
    return RationalUtil::toVelaTime(RationalUtil::Round(mediaDuration * scalar));
}

MediaState RationalMediaEditor::stretch(const MediaState& state, const SafeRational& factor) const {
    MediaState stretched = state;
    stretched.scalar = state.scalar * factor;
    stretched.duration = durationFor(state.mediaDuration, stretched.scalar);
    if (stretched.duration <= 0 || stretched.scalar <= 0)
        throw ValueException<double>("invalid duration after media stretch (<=0)", factor.asDouble());
    if (stretched.duration < minimumTrackDuration()) // the least a temporal trim leaves
        throw ValueException<double>("a stretch must leave the clip room for its transitions",
                                     factor.asDouble());
    return stretched;
}

namespace {

[[noreturn]] void refuseRestore(const char* message, const SafeRational& value) {
    throw ValueException<const SafeRational>(message, value);
}

} // namespace

MediaState RationalMediaEditor::restoreState(const MediaState& saved, VelaTime tolerance) const {
    if (saved.duration <= 0)
        refuseRestore("restored duration is not greater than 0", SafeRational(saved.duration));
    if (saved.mediaDuration <= 0)
        refuseRestore("restored media duration is not greater than 0", saved.mediaDuration);
    if (saved.scalar <= 0) refuseRestore("restored scalar is not greater than 0", saved.scalar);
    if (saved.mediaStart < saved.minMediaStart)
        refuseRestore("restored mediaRange start is less than minimum", saved.mediaStart);
    if (saved.mediaStart > saved.maxMediaEnd)
        refuseRestore("restored mediaRange start is greater than maximum", saved.mediaStart);
    if (saved.mediaEnd().asDouble() - saved.maxMediaEnd.asDouble() > 0.001)
        refuseRestore("restored mediaRange end is greater than maximum", saved.mediaEnd());
    const VelaTime implied = durationFor(saved.mediaDuration, saved.scalar);
    if (std::llabs(implied - saved.duration) > 2 * tolerance)
        refuseRestore("restored scalar is inconsistent with restored ranges", saved.scalar);
    return saved;
}

} // namespace VelaMediaLib

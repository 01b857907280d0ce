#include <VelaMediaLib/model/media/MediaState.h>

#include <VelaMediaLib/time/rational/RationalUtil.h>

namespace VelaMediaLib {

MediaState MediaState::ofSlice(VelaTime start, const SafeRational& mediaStart,
                               const SafeRational& mediaDuration, const SafeRational& scalar) {
    MediaState state;
    state.start = start;
    state.duration = RationalUtil::toVelaTime(RationalUtil::Round(mediaDuration * scalar));
    state.mediaStart = mediaStart;
    state.mediaDuration = mediaDuration;
    state.scalar = scalar;
    state.minMediaStart = mediaStart;
    state.maxMediaEnd = mediaStart + mediaDuration;
    return state;
}

} // namespace VelaMediaLib

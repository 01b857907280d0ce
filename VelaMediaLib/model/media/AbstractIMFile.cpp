#include <VelaMediaLib/model/media/AbstractIMFile.h>

namespace VelaMediaLib {

MediaState AbstractIMFile::stillState(const SourceLink& link, StreamFilter plays, VelaTime start,
                                      VelaTime duration) {
    checkStream(link, plays);
    if (duration <= 0)
        throw ValueException<const SafeRational>("invalid duration after media stretch (<=0)",
                                                 SafeRational(duration));
    MediaState state;
    state.start = start;
    state.duration = duration;
    state.mediaDuration = SafeRational(duration);
    return state;
}

} // namespace VelaMediaLib

#include <VelaMediaLib/model/media/AbstractIMFile.h>

namespace VelaMediaLib {

MediaState AbstractIMFile::stillState(const SourceLink& link, StreamFilter plays, VelaTime start,
                                      VelaTime duration) {
    checkStream(link, plays);
    if (duration <= 0)
        throw ValueException<const SafeRational>("invalid duration after media stretch (<=0)",
                                                 SafeRational(duration));
    return MediaState::unbounded(start, duration);
}

} // namespace VelaMediaLib

#include <VelaMediaLib/model/MediaDispatcher.h>

#include <VelaMediaLib/model/ColorMedia.h>
#include <VelaMediaLib/model/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/PlaceholderMedia.h>

namespace VelaMediaLib {

void MediaDispatcher::dispatchPlaceholderMedia(PlaceholderMedia& media) { dispatchAnyMedia(media); }
void MediaDispatcher::dispatchColorMedia(ColorMedia& media) { dispatchAnyMedia(media); }
void ConstMediaDispatcher::dispatchPlaceholderMedia(const PlaceholderMedia& media) {
    dispatchAnyMedia(media);
}
void ConstMediaDispatcher::dispatchColorMedia(const ColorMedia& media) { dispatchAnyMedia(media); }

std::string MediaTypeFromMediaDispatcher::typeOf(const Media& media) {
    MediaTypeFromMediaDispatcher namer;
    media.dispatch(namer);
    return namer.type();
}

} // namespace VelaMediaLib

#include <VelaMediaLib/model/media/MediaDispatcher.h>

#include <VelaMediaLib/model/media/AMFile.h>
#include <VelaMediaLib/model/media/Callout.h>
#include <VelaMediaLib/model/media/Caption.h>
#include <VelaMediaLib/model/media/ColorMedia.h>
#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/IMFile.h>
#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/media/ScreenIMFile.h>
#include <VelaMediaLib/model/media/ScreenVMFile.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/media/VMFile.h>

namespace VelaMediaLib {

void MediaDispatcher::dispatchPlaceholderMedia(PlaceholderMedia& media) { dispatchAnyMedia(media); }
void MediaDispatcher::dispatchColorMedia(ColorMedia& media) { dispatchAnyMedia(media); }
void ConstMediaDispatcher::dispatchPlaceholderMedia(const PlaceholderMedia& media) {
    dispatchAnyMedia(media);
}
void ConstMediaDispatcher::dispatchColorMedia(const ColorMedia& media) { dispatchAnyMedia(media); }
void MediaDispatcher::dispatchVMFile(VMFile& media) { dispatchAnyMedia(media); }
void ConstMediaDispatcher::dispatchVMFile(const VMFile& media) { dispatchAnyMedia(media); }
void MediaDispatcher::dispatchAMFile(AMFile& media) { dispatchAnyMedia(media); }
void ConstMediaDispatcher::dispatchAMFile(const AMFile& media) { dispatchAnyMedia(media); }
void MediaDispatcher::dispatchIMFile(IMFile& media) { dispatchAnyMedia(media); }
void ConstMediaDispatcher::dispatchIMFile(const IMFile& media) { dispatchAnyMedia(media); }
void MediaDispatcher::dispatchScreenVMFile(ScreenVMFile& media) { dispatchAnyMedia(media); }
void ConstMediaDispatcher::dispatchScreenVMFile(const ScreenVMFile& media) { dispatchAnyMedia(media); }
void MediaDispatcher::dispatchScreenIMFile(ScreenIMFile& media) { dispatchAnyMedia(media); }
void ConstMediaDispatcher::dispatchScreenIMFile(const ScreenIMFile& media) { dispatchAnyMedia(media); }
void MediaDispatcher::dispatchCallout(Callout& media) { dispatchAnyMedia(media); }
void MediaDispatcher::dispatchCaption(Caption& media) { dispatchAnyMedia(media); }
void ConstMediaDispatcher::dispatchCallout(const Callout& media) { dispatchAnyMedia(media); }
void ConstMediaDispatcher::dispatchCaption(const Caption& media) { dispatchAnyMedia(media); }
void MediaDispatcher::dispatchGroup(Group& media) { dispatchAnyMedia(media); }
void ConstMediaDispatcher::dispatchGroup(const Group& media) { dispatchAnyMedia(media); }
void MediaDispatcher::dispatchUnifiedMedia(UnifiedMedia& media) { dispatchAnyMedia(media); }
void ConstMediaDispatcher::dispatchUnifiedMedia(const UnifiedMedia& media) { dispatchAnyMedia(media); }
void MediaDispatcher::dispatchStitchedMedia(StitchedMedia& media) { dispatchAnyMedia(media); }
void ConstMediaDispatcher::dispatchStitchedMedia(const StitchedMedia& media) { dispatchAnyMedia(media); }

std::string MediaTypeFromMediaDispatcher::typeOf(const Media& media) {
    MediaTypeFromMediaDispatcher namer;
    media.dispatch(namer);
    return namer.type();
}

} // namespace VelaMediaLib

#include <VelaMediaLib/model/media/Media.h>

namespace VelaMediaLib {

boost::shared_ptr<Attribute<bool>> Media::clipSpeedAttributeForMedia(Media& media) {
    return media.attributeOrAdd<bool>(clipSpeedMetaDataKey(), false);
}

boost::shared_ptr<Attribute<bool>> Media::voxaneAttributeForMedia(Media& media) {
    return media.attributeOrAdd<bool>(voxaneMetaDataKey(), false);
}

boost::shared_ptr<Attribute<std::string>> Media::voxaneLinkedSessionAttributeForMedia(Media& media) {
    return media.attributeOrAdd<std::string>(voxaneLinkedSessionMetadataKey(), std::string());
}

} // namespace VelaMediaLib

#include <VelaMediaLib/model/Media.h>

namespace VelaMediaLib {

boost::shared_ptr<Attribute<bool>> Media::clipSpeedAttributeForMedia(Media& media) {
    if (const auto existing = media.attribute<bool>(clipSpeedMetaDataKey())) return existing;
    return media.addAttribute<bool>(clipSpeedMetaDataKey(), false);
}

boost::shared_ptr<Attribute<bool>> Media::voxaneAttributeForMedia(Media& media) {
    if (const auto existing = media.attribute<bool>(voxaneMetaDataKey())) return existing;
    return media.addAttribute<bool>(voxaneMetaDataKey(), false);
}

boost::shared_ptr<Attribute<std::string>> Media::voxaneLinkedSessionAttributeForMedia(Media& media) {
    if (const auto existing = media.attribute<std::string>(voxaneLinkedSessionMetadataKey())) return existing;
    return media.addAttribute<std::string>(voxaneLinkedSessionMetadataKey(), std::string());
}

} // namespace VelaMediaLib

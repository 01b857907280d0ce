#include <VelaMediaLib/document/CalloutReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/model/media/Callout.h>
#include <VelaMediaLib/model/media/Caption.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/model/project/Project.h>

namespace VelaMediaLib {

boost::shared_ptr<Media> CalloutReader::createMedia(const Json::Value&, const MediaState& timing) {
    Project& project = *context().project;
    return Callout::create(project.token(), project.editRateToken(), timing.start, timing.duration);
}

boost::shared_ptr<Media> CaptionReader::createMedia(const Json::Value&, const MediaState& timing) {
    Project& project = *context().project;
    return Caption::create(project.token(), project.editRateToken(), timing.start, timing.duration);
}

void CaptionReader::readSpecificProperties(const Json::Value& value, Media& media) {
    auto& caption = dynamic_cast<Caption&>(media);
    if (const Json::Value* longest = optionalMember(value, "maxMediaDuration"))
        caption.setMaxMediaDuration(jsonValueAsVelaTime(*longest));
    if (const Json::Value* allow = optionalMember(value, "allowTrimOut"))
        caption.setAllowTrimOut(jsonValueAsBool(*allow));
}

boost::shared_ptr<Media> PlaceholderReader::createMedia(const Json::Value&, const MediaState& timing) {
    Project& project = *context().project;
    return PlaceholderMedia::createFromMediaRange(project.token(), project.editRateToken(), timing.start,
                                                  timing.mediaStart, timing.mediaDuration, timing.scalar);
}

} // namespace VelaMediaLib

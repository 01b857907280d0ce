#include <VelaMediaLib/document/GroupReader.h>
#include <VelaMediaLib/document/MixerReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/document/format/detail/JSONTreeAccess.h>
#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/timeline/GenericMixer.h>

namespace VelaMediaLib {

boost::shared_ptr<Media> GroupReader::createMedia(const Json::Value& value, const MediaState& timing) {
    Project& project = *context().project;
    const auto mixer = GenericMixer::create(project.token());
    if (const Json::Value* tracks = optionalMember(value, "tracks"))
        MixerReader(readContext(), mixer).read(*tracks);
    return Group::createFromMediaRange(project.token(), project.editRateToken(), mixer, timing.start,
                                       timing.mediaStart, timing.mediaDuration, timing.scalar);
}

void GroupReader::readOtherAttributes(const Json::Value& attributes, Media& media) {
    auto& group = dynamic_cast<Group&>(media);
    const Json::Value* width = optionalMember(attributes, "widthAttr");
    const Json::Value* height = optionalMember(attributes, "heightAttr");
    if (width || height)
        group.setGroupWidthAndHeight(width ? jsonValueAsInt(*width) : group.width(),
                                     height ? jsonValueAsInt(*height) : group.height());
}

void GroupReader::readSpecificProperties(const Json::Value& value, Media& media) {
    if (const Json::Value* properties = optionalMember(value, "assetProperties"))
        dynamic_cast<Group&>(media).setAssetProperties(
            jsonTreeFromValue(documentArray(*properties, "an array of asset properties")));
}

} // namespace VelaMediaLib

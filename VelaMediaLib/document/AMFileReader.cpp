#include <VelaMediaLib/document/AMFileReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/model/media/AMFile.h>

namespace VelaMediaLib {

boost::shared_ptr<Media> AMFileReader::createMedia(const Json::Value& value, const MediaState& timing) {
    const SourceLink link = readLink(value);
    return AMFile::create(link, streamState(link, AMFile::playsStream, timing));
}

void AMFileReader::readOtherAttributes(const Json::Value& attributes, Media& media) {
    if (const Json::Value* channel = optionalMember(attributes, "channelNumber"))
        dynamic_cast<AMFile&>(media).setChannelNumber(jsonValueAsInt(*channel));
}

} // namespace VelaMediaLib

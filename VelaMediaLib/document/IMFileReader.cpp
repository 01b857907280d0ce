#include <VelaMediaLib/document/IMFileReader.h>
#include <VelaMediaLib/document/detail/ScreenDataReading.h>
#include <VelaMediaLib/model/media/IMFile.h>
#include <VelaMediaLib/model/media/ScreenIMFile.h>

namespace VelaMediaLib {

boost::shared_ptr<Media> IMFileReader::createMedia(const Json::Value& value, const MediaState& timing) {
    const SourceLink link = readLink(value);
    return IMFile::create(link, stillState(link, IMFile::playsStream, timing));
}

boost::shared_ptr<Media> ScreenIMFileReader::createMedia(const Json::Value& value, const MediaState& timing) {
    const SourceLink link = readLink(value);
    return ScreenIMFile::create(link, stillState(link, ScreenIMFile::playsStream, timing));
}

void ScreenIMFileReader::readSpecificProperties(const Json::Value& value, Media& media) {
    readScreenData(value, dynamic_cast<ScreenDataHolder&>(media));
}

} // namespace VelaMediaLib

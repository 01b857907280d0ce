#include <VelaMediaLib/document/VMFileReader.h>
#include <VelaMediaLib/document/detail/ScreenDataReading.h>
#include <VelaMediaLib/model/media/ScreenVMFile.h>
#include <VelaMediaLib/model/media/VMFile.h>

namespace VelaMediaLib {

boost::shared_ptr<Media> VMFileReader::createMedia(const Json::Value& value, const MediaState& timing) {
    const SourceLink link = readLink(value);
    return VMFile::create(link, streamState(link, VMFile::playsStream, timing));
}

boost::shared_ptr<Media> ScreenVMFileReader::createMedia(const Json::Value& value, const MediaState& timing) {
    const SourceLink link = readLink(value);
    return ScreenVMFile::create(link, streamState(link, ScreenVMFile::playsStream, timing));
}

void ScreenVMFileReader::readSpecificProperties(const Json::Value& value, Media& media) {
    readScreenData(value, dynamic_cast<ScreenDataHolder&>(media));
}

} // namespace VelaMediaLib

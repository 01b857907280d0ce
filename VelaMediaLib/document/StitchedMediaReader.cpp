#include <VelaMediaLib/document/StitchedMediaReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/model/media/AudioMedia.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>
#include <VelaMediaLib/model/media/VisualMedia.h>
#include <VelaMediaLib/model/project/Project.h>

namespace VelaMediaLib {

namespace {

/// The media object read by the reader of its kind; refused when its kind is unknown.
MediaPtr readPart(const Json::Value& value, const boost::shared_ptr<ReadContext>& context, const char* what) {
    const std::unique_ptr<MediaReader> reader = JSONReader::mediaReaderForJsonValue(value, context);
    if (!reader) refuseJSONValue(what, value.isObject() ? value["_type"] : value);
    reader->read(value);
    return reader->media();
}

} // namespace

boost::shared_ptr<Media> StitchedMediaReader::createMedia(const Json::Value& value,
                                                          const MediaState& timing) {
    Project& project = *context().project;
    const auto stitched = StitchedMedia::create(project.token(), project.editRateToken(), timing);
    if (const Json::Value* parts = optionalMember(value, "medias"))
        for (const Json::Value& part : documentArray(*parts, "an array of media objects"))
            stitched->addMediaWhileParsing(readPart(part, readContext(), "a media kind of a stitched part"));
    return stitched;
}

boost::shared_ptr<Media> UnifiedMediaReader::createMedia(const Json::Value& value, const MediaState&) {
    const MediaPtr video = readPart(requiredMember(value, "video", where().c_str()), readContext(),
                                    "a media kind of a video part");
    const MediaPtr audio = readPart(requiredMember(value, "audio", where().c_str()), readContext(),
                                    "a media kind of an audio part");
    const auto visual = boost::dynamic_pointer_cast<VisualMedia>(video);
    const auto sound = boost::dynamic_pointer_cast<AudioMedia>(audio);
    if (!visual) refuseDocument(where() + ": \"video\" is not a visual media");
    if (!sound) refuseDocument(where() + ": \"audio\" is not an audio media");
    return UnifiedMedia::create(visual, sound);
}

} // namespace VelaMediaLib

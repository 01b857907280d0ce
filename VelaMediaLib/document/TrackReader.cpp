#include <VelaMediaLib/document/MediaReader.h>
#include <VelaMediaLib/document/TrackReader.h>
#include <VelaMediaLib/document/TransitionReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/model/media/Media.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>

namespace VelaMediaLib {

namespace {

const char* const kFlags[] = {"audioMuted", "videoHidden", "magnetic", "matte", "solo"};

} // namespace

bool TrackReader::read(const Json::Value& value) {
    setValue(value);
    documentObject(value, "a track object");
    track_ = GenericTrack::create(context().project->token());
    if (const Json::Value* medias = optionalMember(value, "medias"))
        for (const Json::Value& entry : documentArray(*medias, "an array of media objects")) {
            const std::unique_ptr<MediaReader> reader = mediaReaderForJsonValue(entry, readContext());
            if (!reader) continue; // a kind this library does not know
            reader->read(entry);
            const MediaPtr media = reader->media();
            const auto where = [&] {
                return "media " + (entry.isMember(idTagName()) ? compactJSON(entry[idTagName()]) : "");
            };
            readingWhere(where, [&] { track_->addMedia(media, media->startTime()); });
        }
    if (const Json::Value* transitions = optionalMember(value, "transitions"))
        for (const Json::Value& entry : documentArray(*transitions, "an array of transitions"))
            TransitionReader(readContext(), track_).read(entry);
    readParametersEffectsAndMetaData(value, *track_);
    readTrackAttributes(value, *track_);
    return true;
}

void TrackReader::readTrackAttributes(const Json::Value& value, Track& track) {
    documentObject(value, "a track attributes object");
    if (const Json::Value* ident = optionalMember(value, "ident"))
        track.setIdentifier(jsonValueAsString(*ident));
    for (const char* flag : kFlags)
        if (const Json::Value* set = optionalMember(value, flag))
            track.addAttribute<bool>(flag, jsonValueAsBool(*set));
    readMetaData(value, track);
}

} // namespace VelaMediaLib

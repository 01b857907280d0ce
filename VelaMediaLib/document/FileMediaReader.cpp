#include <VelaMediaLib/document/FileMediaReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/model/media/AbstractIMFile.h>
#include <VelaMediaLib/model/source/Source.h>

namespace VelaMediaLib {

SourceLink FileMediaReader::readLink(const Json::Value& value) const {
    const long long id = jsonValueAsInt64(requiredMember(value, "src", where().c_str()));
    const auto found = context().sources.find(id);
    if (found == context().sources.end()) refuseDocument("unknown source id: " + std::to_string(id));
    const int stream = jsonValueAsInt(requiredMember(value, "trackNumber", where().c_str()));
    return SourceLink::holding(found->second, stream);
}

MediaState FileMediaReader::streamState(const SourceLink& link, StreamFilter plays,
                                        const MediaState& timing) {
    FileMedia::checkStream(link, plays);
    return FileMedia::withStreamLimits(timing, *link.source(), link.stream);
}

MediaState FileMediaReader::stillState(const SourceLink& link, StreamFilter plays, const MediaState& timing) {
    MediaState state = AbstractIMFile::stillState(link, plays, timing.start, timing.duration);
    state.mediaStart = timing.mediaStart;
    state.mediaDuration = timing.mediaDuration;
    state.scalar = timing.scalar;
    return state;
}

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/MediaReader.h>
#include <VelaMediaLib/model/media/FileMedia.h>

namespace VelaMediaLib {

/// What the file kinds' readers share: "src" (the "id" of a source entry
/// read before) and "trackNumber" (the stream played) make the clip's link.
/// A "src" naming no source is refused with "Invalid project json - unknown
/// source id: N".
class VELAMEDIALIB_API FileMediaReader : public MediaReader {
public:
    using MediaReader::MediaReader;

protected:
    SourceLink readLink(const Json::Value& value) const;
    /// The timing within the stream's limits (widened to what it plays).
    static MediaState streamState(const SourceLink& link, StreamFilter plays, const MediaState& timing);
    /// A still's timing: it shows its picture for its track length.
    static MediaState stillState(const SourceLink& link, StreamFilter plays, const MediaState& timing);
};

} // namespace VelaMediaLib

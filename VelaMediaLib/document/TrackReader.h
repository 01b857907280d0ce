#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/JSONReader.h>

namespace VelaMediaLib {

class GenericTrack;
class Track;

/// Reads a track object into a new track: its "medias" (a media of an
/// unknown "_type" is skipped), then its "transitions" between them, its
/// "effects", "parameters", flags, "ident" and "metadata". Clips are placed
/// before the track joins a mixer, so no one hears of each.
class VELAMEDIALIB_API TrackReader : public JSONReader {
public:
    using JSONReader::JSONReader;
    bool read(const Json::Value& value) override;
    const boost::shared_ptr<GenericTrack>& track() const { return track_; }

    /// The flags, "ident" and "metadata" of a track object or of a
    /// "trackAttributes" entry, onto the track.
    static void readTrackAttributes(const Json::Value& value, Track& track);

private:
    boost::shared_ptr<GenericTrack> track_;
};

} // namespace VelaMediaLib

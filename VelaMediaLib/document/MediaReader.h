#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/JSONReader.h>
#include <VelaMediaLib/model/media/MediaState.h>

#include <vector>
#include <string>

namespace VelaMediaLib {

class Media;

/// Reads one media object. The base reads what every kind has: "id", the
/// temporal values ("start", "duration", "mediaStart", "mediaDuration",
/// "scalar"; "trimStartSum" is accepted), "attributes" (the name "ident",
/// then the kind's readOtherAttributes, then the rest as attributes),
/// "parameters", "animationTracks", "effects", "hotspot", the edge
/// modifications, "sourceEffect" and "metadata". The kind builds the media
/// (createMedia) in the document's timing and reads its own members. A
/// refusal of the model is reported as ParserException "Invalid project
/// json - media <id>: " and the refusal.
class VELAMEDIALIB_API MediaReader : public JSONReader {
public:
    using JSONReader::JSONReader;
    bool read(const Json::Value& value) override;
    /// The media read, or null.
    const boost::shared_ptr<Media>& media() const { return media_; }

protected:
    /// Builds the media of the kind, in the timing the document gives.
    virtual boost::shared_ptr<Media> createMedia(const Json::Value& value, const MediaState& timing) = 0;
    /// The kind's own attributes; the base reads "ident" and takes the rest as they come.
    virtual void readOtherAttributes(const Json::Value& attributes, Media& media);
    /// The attribute names readOtherAttributes took.
    virtual std::vector<const char*> otherAttributeNames() const { return {}; }
    /// The kind's own members, once the common ones are read.
    virtual void readSpecificProperties(const Json::Value& value, Media& media);
    /// Whether the kind's track length follows its media length and scalar;
    /// clips without media extent (stills, callouts, captions) say no.
    virtual bool hasMediaExtent() const { return true; }
    /// "<kind> <id>" for messages.
    const std::string& where() const { return where_; }

private:
    MediaState readTiming(const Json::Value& value) const;
    void readCommon(const Json::Value& value, Media& media);
    void takeTiming(Media& media, const MediaState& timing) const;

    boost::shared_ptr<Media> media_;
    std::string where_ = "media";
};

} // namespace VelaMediaLib

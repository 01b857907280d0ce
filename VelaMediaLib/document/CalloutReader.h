#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/MediaReader.h>

namespace VelaMediaLib {

/// A callout ("Callout"): its text is its "text" parameter; "autoRotateText"
/// is among its attributes.
class VELAMEDIALIB_API CalloutReader : public MediaReader {
public:
    using MediaReader::MediaReader;

protected:
    boost::shared_ptr<Media> createMedia(const Json::Value& value, const MediaState& timing) override;
    bool hasMediaExtent() const override { return false; }
};

/// A caption ("Caption"), with its "maxMediaDuration" and "allowTrimOut".
class VELAMEDIALIB_API CaptionReader : public MediaReader {
public:
    using MediaReader::MediaReader;

protected:
    boost::shared_ptr<Media> createMedia(const Json::Value& value, const MediaState& timing) override;
    void readSpecificProperties(const Json::Value& value, Media& media) override;
    bool hasMediaExtent() const override { return false; }
};

/// A placeholder ("PlaceholderMedia"), made from "mediaStart" and "mediaDuration";
/// "width", "height" and "note" are among its attributes.
class VELAMEDIALIB_API PlaceholderReader : public MediaReader {
public:
    using MediaReader::MediaReader;

protected:
    boost::shared_ptr<Media> createMedia(const Json::Value& value, const MediaState& timing) override;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/FileMediaReader.h>

namespace VelaMediaLib {

/// A still image clip ("IMFile"): shown for its track length; it keeps the
/// "mediaStart" the document gives.
class VELAMEDIALIB_API IMFileReader : public FileMediaReader {
public:
    using FileMediaReader::FileMediaReader;

protected:
    boost::shared_ptr<Media> createMedia(const Json::Value& value, const MediaState& timing) override;
    bool hasMediaExtent() const override { return false; }
};

/// A still frame of a screen recording ("ScreenIMFile"), with its "screenData".
class VELAMEDIALIB_API ScreenIMFileReader : public FileMediaReader {
public:
    using FileMediaReader::FileMediaReader;

protected:
    boost::shared_ptr<Media> createMedia(const Json::Value& value, const MediaState& timing) override;
    void readSpecificProperties(const Json::Value& value, Media& media) override;
    bool hasMediaExtent() const override { return false; }
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/FileMediaReader.h>

namespace VelaMediaLib {

/// A video file clip ("VMFile").
class VELAMEDIALIB_API VMFileReader : public FileMediaReader {
public:
    using FileMediaReader::FileMediaReader;

protected:
    boost::shared_ptr<Media> createMedia(const Json::Value& value, const MediaState& timing) override;
};

/// A screen recording clip ("ScreenVMFile"); its "screenData" (cursor,
/// clicks, keystrokes) is read whole.
class VELAMEDIALIB_API ScreenVMFileReader : public FileMediaReader {
public:
    using FileMediaReader::FileMediaReader;

protected:
    boost::shared_ptr<Media> createMedia(const Json::Value& value, const MediaState& timing) override;
    void readSpecificProperties(const Json::Value& value, Media& media) override;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/FileMediaReader.h>

namespace VelaMediaLib {

/// An audio file clip ("AMFile"); reads "channelNumber" among its attributes.
class VELAMEDIALIB_API AMFileReader : public FileMediaReader {
public:
    using FileMediaReader::FileMediaReader;

protected:
    boost::shared_ptr<Media> createMedia(const Json::Value& value, const MediaState& timing) override;
    void readOtherAttributes(const Json::Value& attributes, Media& media) override;
    std::vector<const char*> otherAttributeNames() const override { return {"channelNumber"}; }
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/MediaReader.h>

namespace VelaMediaLib {

/// A group ("Group"): its inner "tracks" are read first (track objects, the
/// inner clips' starts in the group's time), then the group is made over
/// them playing the slice its timing gives. "assetProperties" is kept whole;
/// "widthAttr" and "heightAttr" are among its attributes.
class VELAMEDIALIB_API GroupReader : public MediaReader {
public:
    using MediaReader::MediaReader;

protected:
    boost::shared_ptr<Media> createMedia(const Json::Value& value, const MediaState& timing) override;
    void readOtherAttributes(const Json::Value& attributes, Media& media) override;
    std::vector<const char*> otherAttributeNames() const override { return {"widthAttr", "heightAttr"}; }
    void readSpecificProperties(const Json::Value& value, Media& media) override;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/MediaReader.h>

namespace VelaMediaLib {

/// A stitched clip ("StitchedMedia"): made in its document timing, then its
/// parts ("medias", media objects in its internal time) placed where their
/// starts say.
class VELAMEDIALIB_API StitchedMediaReader : public MediaReader {
public:
    using MediaReader::MediaReader;

protected:
    boost::shared_ptr<Media> createMedia(const Json::Value& value, const MediaState& timing) override;
};

/// A unified clip ("UnifiedMedia"): its "video" and "audio" media objects
/// are read, then bound together in the unified clip's timing.
class VELAMEDIALIB_API UnifiedMediaReader : public MediaReader {
public:
    using MediaReader::MediaReader;

protected:
    boost::shared_ptr<Media> createMedia(const Json::Value& value, const MediaState& timing) override;
};

} // namespace VelaMediaLib

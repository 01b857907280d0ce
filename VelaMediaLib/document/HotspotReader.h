#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/JSONReader.h>

namespace VelaMediaLib {

struct HotspotInfo;

/// Reads a media's "hotspot" ("action", "pauseAtEnd", "url", "gotoTime",
/// "openURLInNewWindow", "markerParametricId", "markerTime",
/// "lastMarkerGlobalTime") onto the visual media. A marker target is named
/// by id and may be read later: the load resolves it at its end
/// (postProcessHotspots).
class VELAMEDIALIB_API HotspotReader : public JSONReader {
public:
    HotspotReader(const boost::shared_ptr<ReadContext>& context, VisualMedia& media);
    bool read(const Json::Value& value) override;

    static HotspotInfo readHotspot(const Json::Value& value);
    /// Gives every hotspot read its marker target: the media or the timeline
    /// of the id. Refuses "Invalid project json - hotspot marker refers to no
    /// object: N" for an id that names neither.
    static void postProcessHotspots(ReadContext& context);

private:
    VisualMedia& media_;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/JSONReader.h>

#include <string>

namespace VelaMediaLib {

/// Reads the "timeline" object into the project's timeline: each scene of
/// "sceneTrack" becomes a mixer (built whole, then added), "trackAttributes"
/// go to the first mixer's tracks by index, then "captionAttributes",
/// "backgroundColor", "gain", "legacyAttenuateAudioMix", "parameters",
/// "effects" and "metadata".
class VELAMEDIALIB_API TimelineReader : public JSONReader {
public:
    using JSONReader::JSONReader;
    bool read(const Json::Value& value) override;

    /// The name the mixer of the scene at the index takes: a scene's own
    /// "ident" (the mixer name written) when it has one, else "scene" and the index on four digits, so
    /// that mixers keep their scene order.
    static std::string sceneMixerName(const Json::Value& scene, unsigned index);
};

} // namespace VelaMediaLib

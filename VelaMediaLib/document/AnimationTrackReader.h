#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/JSONReader.h>

namespace VelaMediaLib {

class AnimationTrack;

/// Reads a media's "animationTracks" object: per parameter name, an array of
/// animations ("range", "endTime", "duration", "interp", "keyframes" with
/// "parameterName", "value", "interp"), set on the media.
class VELAMEDIALIB_API AnimationTrackReader : public JSONReader {
public:
    AnimationTrackReader(const boost::shared_ptr<ReadContext>& context, Media& media);
    bool read(const Json::Value& tracks) override;

    /// One parameter's array of animations.
    static AnimationTrack readTrack(const std::string& name, const Json::Value& animations);

private:
    Media& media_;
};

} // namespace VelaMediaLib

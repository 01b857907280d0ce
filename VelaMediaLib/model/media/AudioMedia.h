#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/CaptionData.h>
#include <VelaMediaLib/model/media/Media.h>

#include <vector>

namespace VelaMediaLib {

/// A clip that can carry captions.
class VELAMEDIALIB_API CaptionableMedia : public virtual Media {
public:
    explicit CaptionableMedia(const boost::weak_ptr<const ThreadSafe>& token) : Media(token) {}
    virtual std::vector<CaptionData> captions() const = 0;
    virtual bool hasCaptions() const = 0;
    virtual void setCaptions(const std::vector<CaptionData>& captions) = 0;
};

/// A clip whose speech can be transcribed.
class VELAMEDIALIB_API TranscribableMedia : public virtual Media {
public:
    explicit TranscribableMedia(const boost::weak_ptr<const ThreadSafe>& token) : Media(token) {}
    virtual std::string transcription() const = 0;
    virtual void setTranscription(const std::string& text) = 0;
};

/// A clip that plays sound: a keyframed volume, a gain, mixing to mono,
/// loudness normalisation, an offset into the source file, the track and
/// unified clip it belongs to, and fades as edge modifications.
class VELAMEDIALIB_API AudioMedia : public CaptionableMedia, public TranscribableMedia {
public:
    explicit AudioMedia(const boost::weak_ptr<const ThreadSafe>& token)
        : Media(token), CaptionableMedia(token), TranscribableMedia(token) {}

    virtual boost::shared_ptr<Parameter<double>> volume() const = 0;
    virtual boost::shared_ptr<Attribute<double>> gain() = 0;
    virtual boost::shared_ptr<Attribute<bool>> mixToMono() = 0;
    virtual boost::shared_ptr<Attribute<bool>> shouldApplyLoudnessNormalizationAttribute() = 0;
    virtual boost::shared_ptr<Attribute<long long>> sourceFileOffset() = 0;
    virtual boost::shared_ptr<SubTimeline> parentTrack() const = 0;
    virtual void setParentTrack(const boost::weak_ptr<SubTimeline>& track) = 0;
    virtual boost::shared_ptr<Media> parentUnifiedMedia() const = 0;
    virtual void setParentUnifiedMedia(const boost::weak_ptr<Media>& unified) = 0;
    /// Replaces the clip's fades with a fade in and a fade out of the given lengths (0 for none).
    virtual void addAudioFadeEdgeMods(VelaTime fadeIn, VelaTime fadeOut) = 0;
    static const char* audioFadeEdgeModGroupName() { return "audioFade"; }
};

} // namespace VelaMediaLib

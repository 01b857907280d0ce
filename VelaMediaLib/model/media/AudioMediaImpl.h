#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/AudioMedia.h>
#include <VelaMediaLib/model/media/MediaImpl.h>

namespace VelaMediaLib {

/// The shared implementation of audio clips. Volume is a parameter (made when
/// first asked for); gain ("gain", 1), mixing to mono ("mixToMono", false),
/// loudness normalisation ("loudnessNormalization", false) and the source
/// file offset ("sourceFileOffset", 0 ticks) are attributes.
class VELAMEDIALIB_API AudioMediaImpl : public MediaImpl, public virtual AudioMedia {
public:
    /// The part of the clip that holds the timing state.
    typedef MediaImpl ConcreteMediaImpl;

    AudioMediaImpl(const boost::weak_ptr<const ThreadSafe>& token,
                   const boost::weak_ptr<ProjectEditRate>& rate, const MediaState& initial,
                   EditorKind editor);

    boost::shared_ptr<Parameter<double>> volume() const override { return typedParameter<double>("volume"); }
    boost::shared_ptr<Attribute<double>> gain() override;
    boost::shared_ptr<Attribute<bool>> mixToMono() override;
    boost::shared_ptr<Attribute<bool>> shouldApplyLoudnessNormalizationAttribute() override;
    boost::shared_ptr<Attribute<long long>> sourceFileOffset() override;
    /// The clip's parent when that is a track: the one parent link, not a copy.
    boost::shared_ptr<SubTimeline> parentTrack() const override;
    void setParentTrack(const boost::weak_ptr<SubTimeline>& track) override { setParent(track); }
    boost::shared_ptr<Media> parentUnifiedMedia() const override;
    void setParentUnifiedMedia(const boost::weak_ptr<Media>& unified) override;
    void addAudioFadeEdgeMods(VelaTime fadeIn, VelaTime fadeOut) override;

    std::vector<CaptionData> captions() const override;
    bool hasCaptions() const override { return !captions().empty(); }
    void setCaptions(const std::vector<CaptionData>& captions) override;
    std::string transcription() const override;
    void setTranscription(const std::string& text) override;

protected:
    boost::shared_ptr<ParameterInterface> createDefaultParameter(const std::string& name) const override;
    std::vector<std::string> defaultParameterNames() const override { return {"volume"}; }

private:
    boost::weak_ptr<Media> parentUnified_;
    std::vector<CaptionData> captions_;
    std::string transcription_;
};

} // namespace VelaMediaLib

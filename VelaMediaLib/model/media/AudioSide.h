#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/AudioMedia.h>
#include <VelaMediaLib/model/media/MediaImpl.h>
#include <VelaMediaLib/model/media/VisualMediaImpl.h>

namespace VelaMediaLib {

/// The sound of a clip, over the implementation it extends (a plain clip's
/// MediaImpl, or the visual implementation for clips that are both seen and
/// heard). Volume is a parameter (made when first asked for); gain ("gain",
/// 1), mixing to mono ("mixToMono", false), loudness normalisation
/// ("loudnessNormalization", false) and the source file offset
/// ("sourceFileOffset", 0 ticks) are attributes.
template <typename Base>
class VELAMEDIALIB_TEMPLATE_API AudioSide : public Base, public virtual AudioMedia {
public:
    AudioSide(const boost::weak_ptr<const ThreadSafe>& token, const boost::weak_ptr<ProjectEditRate>& rate,
              const MediaState& initial, MediaImpl::EditorKind editor);

    boost::shared_ptr<Parameter<double>> volume() const override {
        return this->template typedParameter<double>("volume");
    }
    boost::shared_ptr<Attribute<double>> gain() override;
    boost::shared_ptr<Attribute<bool>> mixToMono() override;
    boost::shared_ptr<Attribute<bool>> shouldApplyLoudnessNormalizationAttribute() override;
    boost::shared_ptr<Attribute<long long>> sourceFileOffset() override;
    /// The clip's parent when that is a track: the one parent link, not a copy.
    boost::shared_ptr<SubTimeline> parentTrack() const override;
    void setParentTrack(const boost::weak_ptr<SubTimeline>& track) override { this->setParent(track); }
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
    std::vector<std::string> defaultParameterNames() const override;

private:
    boost::weak_ptr<Media> parentUnified_;
    std::vector<CaptionData> captions_;
    std::string transcription_;
};

extern template class VELAMEDIALIB_EXTERN_TEMPLATE AudioSide<MediaImpl>;
extern template class VELAMEDIALIB_EXTERN_TEMPLATE AudioSide<VisualMediaImpl>;

} // namespace VelaMediaLib

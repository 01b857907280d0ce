#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/RationalMediaEditor.h>

namespace VelaMediaLib {

/// The editor of clips whose media has an extent (video, audio, screen
/// recordings): trims keep the media range and scalar consistent with the
/// track range and stay within the source's limits. Trims may leave the
/// minimum track duration itself.
class VELAMEDIALIB_API RationalTemporalEditor : public RationalMediaEditor {
public:
    using RationalMediaEditor::RationalMediaEditor;

    MediaState trimStart(const MediaState& state, VelaTime offset) const override;
    bool validTrimStart(const MediaState& state, VelaTime offset) const override;
    MediaState trimEnd(const MediaState& state, VelaTime offset) const override;
    bool validTrimEnd(const MediaState& state, VelaTime offset) const override;
    VelaTime trimEndLimit(const MediaState& state) const override;
    VelaTime trimStartLimit(const MediaState& state) const override;

private:
    /// The media duration a clip of the track duration plays, snapped to the full length.
    static SafeRational mediaDurationFor(const MediaState& state, VelaTime duration);
    /// The media duration and start after a trim of the start, as the trim would set them.
    static MediaState trimmedStart(const MediaState& state, VelaTime offset);
    bool leavesEnoughMedia(const MediaState& state, VelaTime offset) const;
};

} // namespace VelaMediaLib

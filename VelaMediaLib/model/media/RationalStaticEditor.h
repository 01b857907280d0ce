#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/RationalMediaEditor.h>

namespace VelaMediaLib {

/// The editor of clips without a media extent (stills, generated content):
/// trims change only the track range, always keeping more than the minimum
/// track duration (one tick more than the temporal editor, deliberately),
/// and shift an attached start offset with the start. The media duration
/// follows the track duration (duration / scalar), so the clip's state keeps
/// the rule that restoring checks. Its limits are unbounded.
class VELAMEDIALIB_API RationalStaticEditor : public RationalMediaEditor {
public:
    using RationalMediaEditor::RationalMediaEditor;

    MediaState trimStart(const MediaState& state, VelaTime offset) const override;
    bool validTrimStart(const MediaState& state, VelaTime offset) const override;
    MediaState trimEnd(const MediaState& state, VelaTime offset) const override;
    bool validTrimEnd(const MediaState& state, VelaTime offset) const override;
    VelaTime trimEndLimit(const MediaState& state) const override;
    VelaTime trimStartLimit(const MediaState& state) const override;
};

} // namespace VelaMediaLib

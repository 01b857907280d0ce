#include <VelaMediaLib/model/media/MediaEditor.h>

#include <VelaMediaLib/model/media/Media.h>
#include <VelaMediaLib/time/rational/TimeExceptions.h>

namespace VelaMediaLib {

void MediaEditor::move(VelaTime offset) { clip_.move(offset); }
void MediaEditor::trimStart(VelaTime offset) { clip_.trimStart(offset); }
bool MediaEditor::validTrimStart(VelaTime offset) const { return clip_.validTrimStart(offset); }
void MediaEditor::trimEnd(VelaTime offset) { clip_.trimEnd(offset); }
bool MediaEditor::validTrimEnd(VelaTime offset) const { return clip_.validTrimEnd(offset); }
double MediaEditor::stretch(double factor) { return clip_.stretch(factor); }
VelaTime MediaEditor::trimEndLimit() const { return clip_.trimEndLimit(); }
VelaTime MediaEditor::trimStartLimit() const { return clip_.trimStartLimit(); }

void TemporalEditor::trimStart(VelaTime offset) {
    if (offset != 0 && !validTrimStart(offset))
        throw InvalidTrimRangeException("invalid media duration trim offset", offset, clip_.trackRange());
    clip_.trimStart(offset);
}

void TemporalEditor::trimEnd(VelaTime offset) {
    if (offset != 0 && !validTrimEnd(offset))
        throw InvalidTrimRangeException("invalid media duration trim offset", offset, clip_.trackRange());
    clip_.trimEnd(offset);
}

} // namespace VelaMediaLib

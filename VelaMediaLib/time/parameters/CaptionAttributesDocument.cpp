// The timeline's caption settings as a document object.
#include <VelaMediaLib/base/CaptionAttributes.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/time/parameters/ValueTraits.h>

namespace VelaMediaLib {

void CaptionAttributes::toJSON(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    options.key("enabled");
    writeJSONValue(options, members, enabled);
    options.key("fontName");
    writeJSONValue(options, members, fontName);
    options.key("fontSize");
    writeJSONValue(options, members, fontSize);
    options.key("backgroundColor");
    ValueTraits<TemplatedColor<int>>::write(options, members, backgroundColor);
    options.key("foregroundColor");
    ValueTraits<TemplatedColor<int>>::write(options, members, foregroundColor);
    options.key("lang");
    writeJSONValue(options, members, lang);
    options.key("alignment");
    writeJSONValue(options, members, alignment);
    options.key("defaultFontSize");
    writeJSONValue(options, members, defaultFontSize);
    options.key("opacity");
    writeJSONValue(options, members, opacity);
    options.key("backgroundEnabled");
    writeJSONValue(options, members, backgroundEnabled);
    options.key("backgroundOnlyAroundText");
    writeJSONValue(options, members, backgroundOnlyAroundText);
}

} // namespace VelaMediaLib

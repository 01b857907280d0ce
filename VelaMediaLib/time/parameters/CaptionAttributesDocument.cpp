// The timeline's caption settings as a document object.
#include <VelaMediaLib/base/CaptionAttributes.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/time/parameters/ValueTraits.h>

namespace VelaMediaLib {

void CaptionAttributes::toJSON(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    writeJSONMember(options, members, "enabled", enabled);
    writeJSONMember(options, members, "fontName", fontName);
    writeJSONMember(options, members, "fontSize", fontSize);
    options.key("backgroundColor");
    ValueTraits<TemplatedColor<int>>::write(options, members, backgroundColor);
    options.key("foregroundColor");
    ValueTraits<TemplatedColor<int>>::write(options, members, foregroundColor);
    writeJSONMember(options, members, "lang", lang);
    writeJSONMember(options, members, "alignment", alignment);
    writeJSONMember(options, members, "defaultFontSize", defaultFontSize);
    writeJSONMember(options, members, "opacity", opacity);
    writeJSONMember(options, members, "backgroundEnabled", backgroundEnabled);
    writeJSONMember(options, members, "backgroundOnlyAroundText", backgroundOnlyAroundText);
}

} // namespace VelaMediaLib

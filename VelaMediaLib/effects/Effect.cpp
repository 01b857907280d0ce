#include <VelaMediaLib/effects/Effect.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>

namespace VelaMediaLib {

void Effect::toJSON(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    writeJSONMember(options, object.memberLevel(), "_type", std::string("Effect"));
    writeJSONMember(options, object.memberLevel(), "effectName", effectName());
}

} // namespace VelaMediaLib

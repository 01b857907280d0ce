#include <VelaMediaLib/effects/Effect.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>

namespace VelaMediaLib {

void Effect::toJSON(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    options.key("_type");
    writeJSONValue(options, object.memberLevel(), std::string("Effect"));
    options.key("effectName");
    writeJSONValue(options, object.memberLevel(), effectName());
}

} // namespace VelaMediaLib

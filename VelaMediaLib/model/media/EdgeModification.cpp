#include <VelaMediaLib/model/media/EdgeModification.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>

namespace VelaMediaLib {

void EdgeModification::toJSON(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    writeJSONMember(options, members, "duration", (long long)duration_);
    writeJSONMember(options, members, "group", group_);
    options.key("func");
    {
        JSONWriter func(options, members);
        writeJSONMember(options, func.memberLevel(), "name", functionName_);
        writeJSONMember(options, func.memberLevel(), "value", value_);
    }
    if (parameters_.isEmpty()) return;
    options.key("parameters");
    parameters_.write(options, members);
}

} // namespace VelaMediaLib

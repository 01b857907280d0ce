#include <VelaMediaLib/model/media/EdgeModification.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>

namespace VelaMediaLib {

void EdgeModification::toJSON(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    options.key("duration");
    writeJSONValue(options, members, (long long)duration_);
    options.key("group");
    writeJSONValue(options, members, group_);
    options.key("func");
    {
        JSONWriter func(options, members);
        options.key("name");
        writeJSONValue(options, func.memberLevel(), functionName_);
        options.key("value");
        writeJSONValue(options, func.memberLevel(), value_);
    }
    if (parameters_.isEmpty()) return;
    options.key("parameters");
    parameters_.write(options, members);
}

} // namespace VelaMediaLib

#include <VelaMediaLib/effects/StoredEffect.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>

namespace VelaMediaLib {

boost::shared_ptr<StoredEffect> StoredEffect::create(const Fields& fields) {
    return boost::shared_ptr<StoredEffect>(new StoredEffect(fields));
}

boost::shared_ptr<Effect> StoredEffect::cloneEffect() const { return create(fields_); }

bool StoredEffect::isMagnetized() const {
    return fields_.effectName == "DeviceFrameEffect" || fields_.effectName == "CursorPath";
}

boost::shared_ptr<Effect> StoredEffect::withTimeRange(const Range<VelaTime>& range) const {
    Fields fields = fields_;
    fields.start = range.start();
    fields.duration = range.duration();
    return create(fields);
}

namespace {

void writeTree(XMLOptions& options, int indent, const char* key, const JSONTree& tree) {
    if (tree.isNull()) return;
    options.key(key);
    tree.write(options, indent);
}

} // namespace

void StoredEffect::toJSON(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    writeJSONMember(options, members, "_type", fields_.type);
    writeJSONMember(options, members, "effectName", fields_.effectName);
    writeJSONMember(options, members, "category", fields_.category);
    writeJSONMember(options, members, "bypassed", fields_.bypassed);
    writeJSONMember(options, members, "start", (long long)fields_.start);
    writeJSONMember(options, members, "duration", (long long)fields_.duration);
    writeTree(options, members, "in", fields_.in);
    writeTree(options, members, "center", fields_.center);
    writeTree(options, members, "out", fields_.out);
    writeTree(options, members, "parameters", fields_.parameters);
    writeTree(options, members, "metadata", fields_.metadata);
}

} // namespace VelaMediaLib

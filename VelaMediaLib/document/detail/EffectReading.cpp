#include <VelaMediaLib/document/detail/EffectReading.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/document/format/detail/JSONTreeAccess.h>
#include <VelaMediaLib/effects/Effectable.h>
#include <VelaMediaLib/effects/StoredEffect.h>

namespace VelaMediaLib {

namespace {

JSONTree treeOf(const Json::Value& value, const char* key) {
    const Json::Value* member = optionalMember(value, key);
    return member ? jsonTreeFromValue(*member) : JSONTree();
}

} // namespace

boost::shared_ptr<Effect> readEffect(const Json::Value& value) {
    documentObject(value, "an effect object");
    StoredEffect::Fields fields;
    if (const Json::Value* type = optionalMember(value, "_type")) fields.type = jsonValueAsString(*type);
    if (const Json::Value* name = optionalMember(value, "effectName"))
        fields.effectName = jsonValueAsString(*name);
    if (const Json::Value* category = optionalMember(value, "category"))
        fields.category = jsonValueAsString(*category);
    if (const Json::Value* bypassed = optionalMember(value, "bypassed"))
        fields.bypassed = jsonValueAsBool(*bypassed);
    if (const Json::Value* start = optionalMember(value, "start")) fields.start = jsonValueAsVelaTime(*start);
    if (const Json::Value* duration = optionalMember(value, "duration"))
        fields.duration = jsonValueAsVelaTime(*duration);
    fields.in = treeOf(value, "in");
    fields.center = treeOf(value, "center");
    fields.out = treeOf(value, "out");
    if (const Json::Value* parameters = optionalMember(value, "parameters"))
        fields.parameters = jsonTreeFromValue(documentObject(*parameters, "an object of parameters"));
    if (const Json::Value* metadata = optionalMember(value, "metadata"))
        fields.metadata = jsonTreeFromValue(documentObject(*metadata, "an object of metadata"));
    return StoredEffect::create(fields);
}

void readEffects(const Json::Value& effects, Effectable& target) {
    documentArray(effects, "an array of effects");
    for (const Json::Value& entry : effects) target.addEffect(readEffect(entry));
}

} // namespace VelaMediaLib

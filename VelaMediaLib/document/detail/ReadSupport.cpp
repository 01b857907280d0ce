#include <VelaMediaLib/base/TemplatedColor.h>
#include <VelaMediaLib/document/detail/EffectReading.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/model/timeline/SubTimeline.h>
#include <VelaMediaLib/time/parameters/Attributable.h>
#include <VelaMediaLib/time/parameters/ValueTraits.h>

#include <cstring>
#include <limits>

namespace VelaMediaLib {

const Json::Value& documentObject(const Json::Value& value, const char* what) {
    if (!value.isObject()) refuseJSONValue(what, value);
    return value;
}

const Json::Value& documentArray(const Json::Value& value, const char* what) {
    if (!value.isArray()) refuseJSONValue(what, value);
    return value;
}

const Json::Value* optionalMember(const Json::Value& object, const char* key) {
    const Json::Value* found = object.find(key, key + std::strlen(key));
    return found && !found->isNull() ? found : nullptr;
}

const Json::Value& requiredMember(const Json::Value& object, const char* key, const char* what) {
    const Json::Value* found = optionalMember(object, key);
    if (!found) refuseDocument(std::string("missing member \"") + key + "\" in " + what);
    return *found;
}

namespace {

/// Sets the attribute when the target has one of the name in type T.
template <typename T>
bool setTyped(Attributable& target, const std::string& name, const Json::Value& json) {
    if (!target.attribute<T>(name)) return false;
    target.addAttribute<T>(name, ValueTraits<T>::read(json));
    return true;
}

bool setExisting(Attributable& target, const std::string& name, const Json::Value& json) {
    return setTyped<bool>(target, name, json) || setTyped<int>(target, name, json) ||
           setTyped<long long>(target, name, json) || setTyped<double>(target, name, json) ||
           setTyped<float>(target, name, json) || setTyped<std::string>(target, name, json) ||
           setTyped<TemplatedColor<int>>(target, name, json);
}

void addInferred(Attributable& target, const std::string& name, const Json::Value& json) {
    if (json.isBool())
        target.addAttribute<bool>(name, json.asBool());
    else if (json.isInt())
        target.addAttribute<int>(name, json.asInt());
    else if (json.isInt64())
        target.addAttribute<long long>(name, json.asInt64());
    else if (json.isDouble())
        target.addAttribute<double>(name, json.asDouble());
    else if (json.isString())
        target.addAttribute<std::string>(name, json.asString());
    else
        refuseJSONValue("an attribute value (boolean, number or string)", json);
}

} // namespace

void readAttributeMembers(const Json::Value& attributes, Attributable& target,
                          const std::vector<const char*>& skipped) {
    documentObject(attributes, "an object of attributes");
    for (auto it = attributes.begin(); it != attributes.end(); ++it) {
        const std::string name = it.name();
        bool skip = false;
        for (const char* key : skipped) skip = skip || name == key;
        if (skip) continue;
        if (!setExisting(target, name, *it)) addInferred(target, name, *it);
    }
}

void readAttributeMember(const Json::Value& object, const char* key, Attributable& target) {
    if (const Json::Value* value = optionalMember(object, key))
        if (!setExisting(target, key, *value)) addInferred(target, key, *value);
}

void readParametersEffectsAndMetaData(const Json::Value& value, SubTimeline& object) {
    if (const Json::Value* parameters = optionalMember(value, JSONReader::parametersTagName()))
        object.readParameterList(documentObject(*parameters, "an object of parameters"));
    if (const Json::Value* effects = optionalMember(value, "effects")) readEffects(*effects, object);
    JSONReader::readMetaData(value, object);
}

NestingGuard::NestingGuard(ReadContext& context) : context_(context) {
    if (context_.depth >= kMaxReadNesting) refuseDocument("nesting too deep");
    ++context_.depth;
}

} // namespace VelaMediaLib

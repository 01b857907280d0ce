#include <VelaMediaLib/model/Attributable.h>

#include <VelaMediaLib/document/JSONWriter.h>

namespace VelaMediaLib {

Attributable::AttributePtr Attributable::findAttribute(const std::string& name) const {
    ScopedReadLock lock(attributesToken_);
    if (!attributes_) return AttributePtr();
    const auto found = attributes_->find(name);
    return found == attributes_->end() ? AttributePtr() : found->second;
}

void Attributable::insertAttribute(const AttributePtr& attribute) {
    ScopedWriteLock lock(attributesToken_);
    if (!attributes_) attributes_.reset(new std::map<std::string, AttributePtr>);
    (*attributes_)[attribute->name()] = attribute;
}

std::vector<std::string> Attributable::attributeNames() const {
    ScopedReadLock lock(attributesToken_);
    std::vector<std::string> names;
    if (attributes_)
        for (const auto& entry : *attributes_) names.push_back(entry.first);
    return names;
}

void Attributable::writeAttributes(JSONWriter& writer) const {
    for (const std::string& name : attributeNames()) findAttribute(name)->writeValue(writer.key(name));
}

void Attributable::copyAttributesTo(Attributable& other) const {
    ScopedReadLock lock(attributesToken_);
    if (!attributes_) return;
    if (!other.attributes_) other.attributes_.reset(new std::map<std::string, AttributePtr>);
    for (const auto& entry : *attributes_)
        (*other.attributes_)[entry.first] = entry.second->cloneAttribute(other.attributesToken_);
}

} // namespace VelaMediaLib

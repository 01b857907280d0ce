#include <VelaMediaLib/time/parameters/Attributable.h>

#include <VelaMediaLib/document/format/JSONWriter.h>

namespace VelaMediaLib {

void writeAttributeMember(XMLOptions& options, int indent, const char* key,
                          const boost::shared_ptr<const AttributeInterface>& attribute) {
    if (!attribute) return;
    options.key(key);
    attribute->writeValue(options, indent);
}

Attributable::AttributePtr Attributable::findAttribute(const std::string& name) const {
    ScopedReadLock lock(projectLock());
    return attributes_.find(name);
}

Attributable::AttributePtr Attributable::insertAttribute(const AttributePtr& attribute) {
    ScopedWriteLock lock(projectMutex());
    return attributes_.insertIfAbsent(attribute->name(), attribute);
}

Attributable::AttributePtr Attributable::insertAttributeIfAbsent(const AttributePtr& attribute) {
    ScopedReadLock lock(projectLock());
    return attributes_.insertIfAbsent(attribute->name(), attribute);
}

std::vector<std::string> Attributable::attributeNames() const {
    ScopedReadLock lock(projectLock());
    std::vector<std::string> names;
    attributes_.forEach([&](const std::string& name, const AttributePtr&) { names.push_back(name); });
    return names;
}

void Attributable::writeAttributes(XMLOptions& options, int indent) const {
    for (const std::string& name : attributeNames()) {
        options.key(name);
        findAttribute(name)->writeValue(options, indent);
    }
}

void Attributable::copyAttributesTo(Attributable& other) const {
    ScopedReadLock lock(projectLock());
    attributes_.forEach([&](const std::string& name, const AttributePtr& attribute) {
        other.attributes_.set(name, attribute->cloneAttribute(other.projectMutex()));
    });
}

} // namespace VelaMediaLib

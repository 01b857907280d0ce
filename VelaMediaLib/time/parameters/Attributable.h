#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/parameters/Attribute.h>
#include <VelaMediaLib/time/sync/LazyCreation.h>
#include <VelaMediaLib/time/sync/ProjectToken.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <vector>

namespace VelaMediaLib {

class XMLOptions;

/// Named, typed, observable attributes of a model object ("width", "mixToMono",
/// a track's "solo"). Each name holds one type; asking for it as another type
/// answers null, adding it as another type throws TypeException.
class VELAMEDIALIB_API Attributable : public virtual ProjectToken {
public:
    typedef boost::shared_ptr<AttributeInterface> AttributePtr;

    explicit Attributable(
        const boost::weak_ptr<const ThreadSafe>& token = boost::weak_ptr<const ThreadSafe>()) {
        recordProjectToken(token);
    }
    virtual ~Attributable() = default;

    template <typename T>
    boost::shared_ptr<Attribute<T>> attribute(const std::string& name) const {
        return boost::dynamic_pointer_cast<Attribute<T>>(findAttribute(name));
    }
    /// Adds the attribute, or sets the value of the one the name already has.
    template <typename T>
    boost::shared_ptr<Attribute<T>> addAttribute(const std::string& name, const T& value) {
        AttributePtr kept = findAttribute(name);
        if (!kept) kept = insertAttribute(AttributePtr(new Attribute<T>(name, value, projectMutex())));
        const auto typed = boost::dynamic_pointer_cast<Attribute<T>>(kept);
        if (!typed) throw TypeException("attribute " + name + " holds another type");
        typed->setValue(value); // tells nobody when it holds the value already
        return typed;
    }
    /// The attribute of the name, made with the initial value if it has none.
    /// Making it takes only the read lock (the initial value is the default
    /// readers assume), so it may be asked inside a reader's snapshot.
    template <typename T>
    boost::shared_ptr<Attribute<T>> attributeOrAdd(const std::string& name, const T& initial) {
        if (const auto existing = attribute<T>(name)) return existing;
        const auto typed = boost::dynamic_pointer_cast<Attribute<T>>(
            insertAttributeIfAbsent(AttributePtr(new Attribute<T>(name, initial, projectMutex()))));
        if (!typed) throw TypeException("attribute " + name + " holds another type");
        return typed;
    }
    /// The value, or the fallback when the name has no attribute of that type.
    template <typename T>
    T attributeValue(const std::string& name, const T& fallback) const {
        const auto typed = attribute<T>(name);
        return typed ? typed->value() : fallback;
    }

    bool hasAttribute(const std::string& name) const { return bool(findAttribute(name)); }
    std::vector<std::string> attributeNames() const;
    /// Writes each attribute as a member of the object being written, its
    /// members at indent.
    void writeAttributes(XMLOptions& options, int indent) const;

protected:
    /// Copies every attribute's value into another object's attributes.
    void copyAttributesTo(Attributable& other) const;

private:
    AttributePtr findAttribute(const std::string& name) const;
    /// Links the attribute in under the write lock unless the name has one; returns the one it has.
    AttributePtr insertAttribute(const AttributePtr& attribute);
    /// The attribute the name has, or else the given one, linked in under the read lock.
    AttributePtr insertAttributeIfAbsent(const AttributePtr& attribute);

    NamedEntries<AttributeInterface> attributes_;
};

} // namespace VelaMediaLib

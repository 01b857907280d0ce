#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/parameters/ValueTraits.h>
#include <VelaMediaLib/time/sync/ReadWriteMutex.h>
#include <VelaMediaLib/time/sync/Subject.h>

#include <boost/enable_shared_from_this.hpp>
#include <boost/shared_ptr.hpp>
#include <string>

namespace VelaMediaLib {

/// The type-independent face of an attribute: its name and its value as
/// document text. Attributes are held by shared pointer; that pointer is
/// their lifeline.
class VELAMEDIALIB_API AttributeInterface : public Subject,
                                            public boost::enable_shared_from_this<AttributeInterface> {
public:
    using Subject::Subject;
    boost::weak_ptr<const void> lifeline() const override { return weak_from_this(); }
    virtual const std::string& name() const = 0;
    /// Writes the value, in its type's document form.
    virtual void writeValue(XMLOptions& options, int indent) const = 0;
    /// A new attribute with the same name and value, for another object.
    virtual boost::shared_ptr<AttributeInterface>
    cloneAttribute(const boost::weak_ptr<const ThreadSafe>& token) const = 0;
};

/// The attribute as the member `key` of the object being written; nothing
/// for no attribute.
VELAMEDIALIB_API void writeAttributeMember(XMLOptions& options, int indent, const char* key,
                                           const boost::shared_ptr<const AttributeInterface>& attribute);

/// A named value that tells its observers when it changes. Reads take the
/// project's read lock and writes its write lock; setting the value it
/// already has changes nothing and tells nobody.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API Attribute : public AttributeInterface {
public:
    Attribute(std::string name, T value,
              const boost::weak_ptr<const ThreadSafe>& token = boost::weak_ptr<const ThreadSafe>())
        : AttributeInterface(token), name_(std::move(name)), value_(std::move(value)) {}

    const std::string& name() const override { return name_; }
    void writeValue(XMLOptions& options, int indent) const override {
        ValueTraits<T>::write(options, indent, value());
    }
    boost::shared_ptr<AttributeInterface>
    cloneAttribute(const boost::weak_ptr<const ThreadSafe>& token) const override {
        return boost::shared_ptr<AttributeInterface>(new Attribute(name_, value(), token));
    }

    T value() const {
        ScopedReadLock lock(this->projectLock());
        return value_;
    }

    /// Returns whether the value changed.
    bool setValue(const T& value) {
        {
            ScopedWriteLock lock(projectMutex());
            if (value_ == value) return false;
            value_ = value;
        }
        notify();
        return true;
    }

private:
    const std::string name_;
    T value_;
};

} // namespace VelaMediaLib

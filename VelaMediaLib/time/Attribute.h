#pragma once

#include <VelaMediaLib/time/ReadWriteMutex.h>
#include <VelaMediaLib/time/Subject.h>

#include <string>

namespace VelaMediaLib {

/// A named value that tells its observers when it changes. Reads take the
/// project's read lock and writes its write lock; setting the value it
/// already has changes nothing and tells nobody.
template <typename T> class Attribute : public Subject {
public:
    Attribute(std::string name, T value,
              const boost::weak_ptr<const ThreadSafe>& token = boost::weak_ptr<const ThreadSafe>())
        : Subject(token), name_(std::move(name)), value_(std::move(value)) {}

    const std::string& name() const { return name_; }

    T value() const {
        ScopedReadLock lock(projectMutex());
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

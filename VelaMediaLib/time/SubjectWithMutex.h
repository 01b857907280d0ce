#pragma once

#include <VelaMediaLib/time/Subject.h>

namespace VelaMediaLib {

/// A subject attached to and detached from on several threads (the command
/// history, the edit rate): its own mutex guards list changes and walks.
class SubjectWithMutex : public Subject {
public:
    using Subject::Subject;

protected:
    std::unique_lock<std::recursive_mutex> lockLists() const override {
        return std::unique_lock<std::recursive_mutex>(mutex_);
    }

private:
    mutable std::recursive_mutex mutex_;
};

} // namespace VelaMediaLib

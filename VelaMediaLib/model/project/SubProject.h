#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/base/XMLIdentified.h>
#include <VelaMediaLib/time/parameters/MetaDatable.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

namespace VelaMediaLib {

/// A part of a project: it finds the project's lock through the project's
/// token and carries metadata.
class VELAMEDIALIB_API SubProject : public VelaObject, public XMLable, public MetaDatable {
public:
    explicit SubProject(const boost::weak_ptr<const ThreadSafe>& token) : MetaDatable(token), token_(token) {}

    /// The project's lock, or null once the project has gone.
    virtual ReadWriteMutex* mutex() const {
        const boost::shared_ptr<const ThreadSafe> project = token_.lock();
        return project ? &project->mutex() : nullptr;
    }
    virtual boost::weak_ptr<const ThreadSafe> projectMutex() const { return token_; }

private:
    const boost::weak_ptr<const ThreadSafe> token_;
};

} // namespace VelaMediaLib

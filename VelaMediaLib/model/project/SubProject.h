#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/base/XMLIdentified.h>
#include <VelaMediaLib/time/parameters/MetaDatable.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

namespace VelaMediaLib {

/// A part of a project: it finds the project's lock through the project's
/// token (the object's one ProjectToken) and carries metadata.
class VELAMEDIALIB_API SubProject : public VelaObject, public XMLable, public MetaDatable {
public:
    explicit SubProject(const boost::weak_ptr<const ThreadSafe>& token) : MetaDatable(token) {}

    /// The project's lock, or null once the project has gone.
    virtual ReadWriteMutex* mutex() const { return metaDataMutex(); }
    /// The project's token: the object's one ProjectToken, answered through
    /// the model's interface. Final: the object's parts ask ProjectToken.
    virtual const boost::weak_ptr<const ThreadSafe>& projectMutex() const final {
        return ProjectToken::projectMutex();
    }
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/EdgeModification.h>

#include <set>
#include <vector>

namespace VelaMediaLib {

/// What carries edge modifications at its start (left) and end (right).
class VELAMEDIALIB_API EdgeModifiable {
public:
    typedef std::vector<EdgeModificationPtr> EdgeModifications;

    virtual ~EdgeModifiable() = default;
    virtual void addLeftEdgeModification(const EdgeModificationPtr& modification) = 0;
    virtual void addRightEdgeModification(const EdgeModificationPtr& modification) = 0;
    virtual bool removeLeftEdgeModification(const EdgeModificationPtr& modification) = 0;
    virtual bool removeRightEdgeModification(const EdgeModificationPtr& modification) = 0;
    virtual EdgeModifications leftEdgeModifications() const = 0;
    virtual EdgeModifications rightEdgeModifications() const = 0;
    /// The longest modification on that side, 0 without any.
    virtual VelaTime leftEdgeModificationLength() const = 0;
    virtual VelaTime rightEdgeModificationLength() const = 0;
    /// Gives every modification on that side the length.
    virtual void setLeftEdgeModificationLength(VelaTime length) = 0;
    virtual void setRightEdgeModificationLength(VelaTime length) = 0;
    virtual std::set<std::string> edgeModGroupNames() const = 0;
    /// Gives that side exactly the list (the same modifications in the same
    /// order) under the project's write lock, which the caller may hold
    /// already, and tells no one: true when the side changed, and the caller
    /// then notifies the clip once its lock has ended. An edit that checks a
    /// side and changes it in one locked step uses it. A null entry throws
    /// AddRemoveException and changes nothing.
    virtual bool setLeftEdgeModificationsUnnotified(const EdgeModifications& modifications) = 0;
    virtual bool setRightEdgeModificationsUnnotified(const EdgeModifications& modifications) = 0;
};

} // namespace VelaMediaLib

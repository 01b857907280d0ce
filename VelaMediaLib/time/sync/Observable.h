#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/sync/Observer.h>

#include <boost/weak_ptr.hpp>

namespace VelaMediaLib {

/// The base of every subject. Observers are held by plain pointer: an observer
/// detaches itself before it goes (the scoped observers below do so).
class VELAMEDIALIB_API Observable {
public:
    virtual ~Observable() = default;
    virtual void attach(Observer* observer) = 0;
    /// Observers attached so are told at once, even while a notify delay is active.
    virtual void attachWithoutNotifyDelay(Observer* observer) = 0;
    virtual void detach(Observer* observer) = 0;
    virtual void notify() = 0;
    /// A weak reference to the shared pointer that owns this object, or the
    /// object it is a part of; empty for objects not owned so. A notification
    /// held back by a NotifyDelay keeps the object alive through it while it
    /// is delivered, so observers never see it half destroyed.
    virtual boost::weak_ptr<const void> lifeline() const { return boost::weak_ptr<const void>(); }
};

} // namespace VelaMediaLib

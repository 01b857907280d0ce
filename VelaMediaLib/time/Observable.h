#pragma once

#include <VelaMediaLib/time/Observer.h>

namespace VelaMediaLib {

/// The base of every subject. Observers are held by plain pointer: an observer
/// detaches itself before it goes (the scoped observers below do so).
class Observable {
public:
    virtual ~Observable() = default;
    virtual void attach(Observer* observer) = 0;
    /// Observers attached so are told at once, even while a notify delay is active.
    virtual void attachWithoutNotifyDelay(Observer* observer) = 0;
    virtual void detach(Observer* observer) = 0;
    virtual void notify() = 0;
};

} // namespace VelaMediaLib

#pragma once

namespace VelaMediaLib {

class Observable;

/// Anything that wants to hear that a subject changed.
class Observer {
public:
    virtual ~Observer() = default;
    virtual void update(Observable* subject) = 0;
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>

namespace VelaMediaLib {

class Observable;

/// Anything that wants to hear that a subject changed.
class VELAMEDIALIB_API Observer {
public:
    virtual ~Observer() = default;
    virtual void update(Observable* subject) = 0;
};

} // namespace VelaMediaLib

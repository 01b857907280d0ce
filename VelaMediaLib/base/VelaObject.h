#pragma once

#include <VelaMediaLib/base/Export.h>

namespace VelaMediaLib {

/// The root of the model's object classes.
class VELAMEDIALIB_API VelaObject {
public:
    virtual ~VelaObject() = default;
};

} // namespace VelaMediaLib

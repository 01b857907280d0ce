#pragma once

namespace VelaMediaLib {

/// The root of the model's object classes.
class VelaObject {
public:
    virtual ~VelaObject() = default;
};

} // namespace VelaMediaLib

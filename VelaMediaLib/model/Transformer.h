#pragma once

#include <VelaMediaLib/model/TransformMatrix.h>
#include <VelaMediaLib/time/RationalTime.h>

namespace VelaMediaLib {

/// Something that places content on the canvas with a transform that may
/// change over its parametric time.
class Transformer {
public:
    virtual ~Transformer() = default;
    virtual TransformMatrix transformAtTime(const RationalTime& time) const = 0;
};

} // namespace VelaMediaLib

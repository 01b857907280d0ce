#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/TransformMatrix.h>
#include <VelaMediaLib/time/rational/RationalTime.h>

namespace VelaMediaLib {

/// Something that places content on the canvas with a transform that may
/// change over its parametric time.
class VELAMEDIALIB_API Transformer {
public:
    virtual ~Transformer() = default;
    virtual TransformMatrix transformAtTime(const RationalTime& time) const = 0;
};

/// The transform base of containers that place their content unchanged
/// unless a kind says otherwise (the timeline).
class VELAMEDIALIB_API TransformerImpl : public Transformer {
public:
    TransformMatrix transformAtTime(const RationalTime&) const override { return TransformMatrix(); }
};

} // namespace VelaMediaLib

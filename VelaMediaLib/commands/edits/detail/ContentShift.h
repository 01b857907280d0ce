#pragma once

#include <VelaMediaLib/model/media/Media.h>

namespace VelaMediaLib {
namespace detail {

/// Moves every keyframe of the clip's made parameters and every animation by
/// `by` of the clip's own ticks (counted from its start). When the clip's
/// start moves by d, shifting by -d keeps its content where it was on the
/// time line. Parameters not made yet are left unmade. A stitched clip's
/// parameters are views of its parts', which keep their own place: it is
/// left alone.
void shiftKeyframesAndAnimations(Media& media, VelaTime by);

} // namespace detail
} // namespace VelaMediaLib

#pragma once

namespace VelaMediaLib {

/// How a visual stream's picture is turned when shown, clockwise.
enum class MediaOrientation { Normal = 0, Rotated90 = 1, Rotated180 = 2, Rotated270 = 3 };

} // namespace VelaMediaLib

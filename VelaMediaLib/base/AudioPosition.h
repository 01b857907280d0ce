#pragma once

#include <VelaMediaLib/base/Export.h>

#include <ostream>

namespace VelaMediaLib {

/// Where a sound sits in the listening field: pan from -1 (left) to 1 (right)
/// and depth from 0 (front) to 1 (far).
struct VELAMEDIALIB_API AudioPosition {
    double pan = 0.0;
    double depth = 0.0;

    AudioPosition() = default;
    AudioPosition(double pan_, double depth_) : pan(pan_), depth(depth_) {}

    bool operator==(const AudioPosition& o) const { return pan == o.pan && depth == o.depth; }
    bool operator!=(const AudioPosition& o) const { return !(*this == o); }
};

inline std::ostream& operator<<(std::ostream& out, const AudioPosition& p) {
    return out << "AudioPosition(" << p.pan << ", " << p.depth << ")";
}

} // namespace VelaMediaLib

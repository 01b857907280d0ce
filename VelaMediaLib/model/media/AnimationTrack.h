#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/format/JSONTree.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

#include <string>
#include <vector>

namespace VelaMediaLib {

class XMLOptions;

/// The animations of one parameter of a clip, by the parameter's name. A
/// value: the clip keeps a copy under the project lock.
class VELAMEDIALIB_API AnimationTrack {
public:
    /// One keyframe of an animation's description: the parameter it sets, the
    /// value (kept whole, in the parameter's document form) and the interpolater
    /// code that leads into it.
    struct KeyFrame {
        std::string parameterName;
        JSONTree value;
        std::string interp;

        bool operator==(const KeyFrame& other) const {
            return parameterName == other.parameterName && value == other.value && interp == other.interp;
        }
    };

    /// One animation of a parameter: the ticks it covers on its clip, its end
    /// and length, its interpolater code and the keyframes it describes.
    struct Animation {
        Range<long long> range = Range<long long>(0, 0);
        VelaTime endTime = 0;
        VelaTime duration = 0;
        std::string interp;
        std::vector<KeyFrame> keyframes;

        bool operator==(const Animation& other) const {
            return range == other.range && endTime == other.endTime && duration == other.duration &&
                   interp == other.interp && keyframes == other.keyframes;
        }
    };

    AnimationTrack() = default;
    AnimationTrack(std::string name, std::vector<Animation> animations)
        : name_(std::move(name)), animations_(std::move(animations)) {}

    const std::string& name() const { return name_; }
    const std::vector<Animation>& animations() const { return animations_; }
    bool empty() const { return animations_.empty(); }

    /// The array of animations, closed at indent: each {"range", "endTime",
    /// "duration", "interp", "keyframes": [{"parameterName", "value", "interp"}]}.
    void toJSON(XMLOptions& options, int indent) const;

    bool operator==(const AnimationTrack& other) const {
        return name_ == other.name_ && animations_ == other.animations_;
    }
    bool operator!=(const AnimationTrack& other) const { return !(*this == other); }

private:
    std::string name_;
    std::vector<Animation> animations_;
};

} // namespace VelaMediaLib

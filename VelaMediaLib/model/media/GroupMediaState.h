#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/MediaState.h>

namespace VelaMediaLib {

/// What a group saves: its timing (the MediaState it is) and its canvas
/// size (0 where not set). It passes wherever a clip's timing state does;
/// only a group's own restore entry reads the canvas back, and that entry
/// refuses a state held as a plain MediaState, which carries none.
struct VELAMEDIALIB_API GroupMediaState : public MediaState {
    int width = 0;
    int height = 0;

    GroupMediaState() = default;
    GroupMediaState(const MediaState& timing, int canvasWidth, int canvasHeight)
        : MediaState(timing), width(canvasWidth), height(canvasHeight) {}

    bool operator==(const GroupMediaState& o) const {
        return MediaState::operator==(o) && width == o.width && height == o.height;
    }
    bool operator!=(const GroupMediaState& o) const { return !(*this == o); }
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>
#include <VelaMediaLib/model/media/Media.h>

namespace VelaMediaLib {

/// What the commands that open or remove time inside a clip's content
/// (keyframes, animations, effects) hold: the clip, the time in the clip's
/// own ticks, the amount, and whether time is opened (extend) or removed.
class VELAMEDIALIB_API ClipTimeCmd : public Command {
protected:
    /// Throws VelaMediaLibException "no clip to <what>" for no clip and
    /// ValueException<long long> "<kind> time amount must not be negative".
    ClipTimeCmd(const MediaPtr& media, VelaTime time, VelaTime amount, bool extend, const char* what,
                const char* kind);

    MediaPtr media_;
    VelaTime time_;
    VelaTime amount_;
    bool extend_;
};

} // namespace VelaMediaLib

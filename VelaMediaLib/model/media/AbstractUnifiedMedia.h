#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/AudioSide.h>

namespace VelaMediaLib {

/// What the clips made of other clips share (groups, stitched and unified
/// media): each is seen and heard, with the visual clips' parameters and
/// transforms and the audio clips' volume and attributes, so that it can
/// stand wherever a plain clip can.
class VELAMEDIALIB_API AbstractUnifiedMedia : public AudioSide<VisualMediaImpl> {
public:
    /// The part of the clip that holds the timing state.
    typedef MediaImpl ConcreteMediaImpl;

protected:
    AbstractUnifiedMedia(const boost::weak_ptr<const ThreadSafe>& token,
                         const boost::weak_ptr<ProjectEditRate>& rate, const MediaState& initial,
                         EditorKind editor)
        : Media(token), VisualMedia(token),
          AudioMedia(token), AudioSide<VisualMediaImpl>(token, rate, initial, editor) {}
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/AudioSide.h>

namespace VelaMediaLib {

/// The shared implementation of audio clips: the sound of a clip (see
/// AudioSide) over the timing state every clip holds.
class VELAMEDIALIB_API AudioMediaImpl : public AudioSide<MediaImpl> {
public:
    /// The part of the clip that holds the timing state.
    typedef MediaImpl ConcreteMediaImpl;

    AudioMediaImpl(const boost::weak_ptr<const ThreadSafe>& token,
                   const boost::weak_ptr<ProjectEditRate>& rate, const MediaState& initial,
                   EditorKind editor);
};

} // namespace VelaMediaLib

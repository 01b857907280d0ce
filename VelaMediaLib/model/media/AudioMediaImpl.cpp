#include <VelaMediaLib/model/media/AudioMediaImpl.h>

namespace VelaMediaLib {

AudioMediaImpl::AudioMediaImpl(const boost::weak_ptr<const ThreadSafe>& token,
                               const boost::weak_ptr<ProjectEditRate>& rate, const MediaState& initial,
                               EditorKind editor)
    : Media(token), AudioMedia(token), AudioSide<MediaImpl>(token, rate, initial, editor) {}

} // namespace VelaMediaLib

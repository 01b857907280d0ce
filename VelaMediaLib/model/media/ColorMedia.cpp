#include <VelaMediaLib/model/media/ColorMedia.h>

#include <VelaMediaLib/model/media/MediaDispatcher.h>

namespace VelaMediaLib {

boost::shared_ptr<ColorMedia> ColorMedia::create(const boost::weak_ptr<const ThreadSafe>& token,
                                                 const boost::weak_ptr<ProjectEditRate>& rate, VelaTime start,
                                                 VelaTime duration, const TemplatedColor<int>& color) {
    const MediaState state = MediaState::unbounded(start, duration);
    const boost::shared_ptr<ColorMedia> media(new ColorMedia(token, rate, state));
    media->addAttribute("color", color);
    return media;
}

boost::shared_ptr<Media> ColorMedia::clone() const {
    const boost::shared_ptr<ColorMedia> copy(new ColorMedia(projectMutex(), projectEditRate(), state()));
    copyContentInto(*copy);
    return copy;
}

void ColorMedia::dispatch(MediaDispatcher& dispatcher) { dispatcher.dispatchColorMedia(*this); }
void ColorMedia::dispatch(ConstMediaDispatcher& dispatcher) const { dispatcher.dispatchColorMedia(*this); }

} // namespace VelaMediaLib

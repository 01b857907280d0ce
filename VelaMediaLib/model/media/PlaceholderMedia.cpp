#include <VelaMediaLib/model/media/PlaceholderMedia.h>

#include <VelaMediaLib/model/media/MediaDispatcher.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

namespace VelaMediaLib {

boost::shared_ptr<PlaceholderMedia> PlaceholderMedia::create(const boost::weak_ptr<const ThreadSafe>& token,
                                                             const boost::weak_ptr<ProjectEditRate>& rate,
                                                             VelaTime start, VelaTime duration, int width,
                                                             int height, const std::string& note) {
    const auto media = createFromMediaRange(token, rate, start, SafeRational(0), SafeRational(duration));
    media->addAttribute<int>("width", width);
    media->addAttribute<int>("height", height);
    media->addAttribute<std::string>("note", note);
    return media;
}

boost::shared_ptr<PlaceholderMedia>
PlaceholderMedia::createFromMediaRange(const boost::weak_ptr<const ThreadSafe>& token,
                                       const boost::weak_ptr<ProjectEditRate>& rate, VelaTime start,
                                       const SafeRational& mediaStart, const SafeRational& mediaDuration,
                                       const SafeRational& scalar) {
    MediaState state = MediaState::ofSlice(start, mediaStart, mediaDuration, scalar);
    return boost::shared_ptr<PlaceholderMedia>(new PlaceholderMedia(token, rate, state));
}

boost::shared_ptr<Media> PlaceholderMedia::clone() const {
    const boost::shared_ptr<PlaceholderMedia> copy(
        new PlaceholderMedia(projectMutex(), projectEditRate(), state()));
    copyContentInto(*copy);
    return copy;
}

void PlaceholderMedia::dispatch(MediaDispatcher& dispatcher) { dispatcher.dispatchPlaceholderMedia(*this); }
void PlaceholderMedia::dispatch(ConstMediaDispatcher& dispatcher) const {
    dispatcher.dispatchPlaceholderMedia(*this);
}

} // namespace VelaMediaLib

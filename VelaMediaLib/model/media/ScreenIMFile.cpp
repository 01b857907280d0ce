#include <VelaMediaLib/model/media/ScreenIMFile.h>

#include <VelaMediaLib/model/media/MediaDispatcher.h>

namespace VelaMediaLib {

boost::shared_ptr<ScreenIMFile> ScreenIMFile::create(const SourceLink& link, const MediaState& state) {
    return boost::shared_ptr<ScreenIMFile>(new ScreenIMFile(link, state));
}

boost::shared_ptr<ScreenIMFile> ScreenIMFile::create(const boost::shared_ptr<const Source>& source,
                                                     int stream, VelaTime start, VelaTime duration) {
    return createStill<ScreenIMFile>(source, stream, start, duration);
}

boost::shared_ptr<Media> ScreenIMFile::clone() const {
    const boost::shared_ptr<ScreenIMFile> copy = create(cloneLink(), state());
    copyContentInto(*copy);
    copy->setScreenData(screenData());
    return copy;
}

void ScreenIMFile::dispatch(MediaDispatcher& dispatcher) { dispatcher.dispatchScreenIMFile(*this); }
void ScreenIMFile::dispatch(ConstMediaDispatcher& dispatcher) const {
    dispatcher.dispatchScreenIMFile(*this);
}

} // namespace VelaMediaLib

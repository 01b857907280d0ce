#include <VelaMediaLib/model/media/ScreenVMFile.h>

#include <VelaMediaLib/model/media/MediaDispatcher.h>

namespace VelaMediaLib {

boost::shared_ptr<ScreenVMFile> ScreenVMFile::create(const SourceLink& link, const MediaState& state) {
    return boost::shared_ptr<ScreenVMFile>(new ScreenVMFile(link, state));
}

boost::shared_ptr<ScreenVMFile> ScreenVMFile::create(const boost::shared_ptr<const Source>& source,
                                                     int stream, VelaTime start) {
    return createWhole<ScreenVMFile>(source, stream, start);
}

boost::shared_ptr<ScreenVMFile> ScreenVMFile::create(const boost::shared_ptr<const Source>& source,
                                                     int stream, VelaTime start,
                                                     const SafeRational& mediaStart,
                                                     const SafeRational& mediaDuration,
                                                     const SafeRational& scalar) {
    return createSlice<ScreenVMFile>(source, stream, start, mediaStart, mediaDuration, scalar);
}

boost::shared_ptr<Media> ScreenVMFile::clone() const {
    const boost::shared_ptr<ScreenVMFile> copy = create(cloneLink(), state());
    copyContentInto(*copy);
    copy->setScreenData(screenData());
    return copy;
}

void ScreenVMFile::dispatch(MediaDispatcher& dispatcher) { dispatcher.dispatchScreenVMFile(*this); }
void ScreenVMFile::dispatch(ConstMediaDispatcher& dispatcher) const {
    dispatcher.dispatchScreenVMFile(*this);
}

} // namespace VelaMediaLib

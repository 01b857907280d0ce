#include <VelaMediaLib/model/media/IMFile.h>

#include <VelaMediaLib/model/media/MediaDispatcher.h>

namespace VelaMediaLib {

boost::shared_ptr<IMFile> IMFile::create(const SourceLink& link, const MediaState& state) {
    return boost::shared_ptr<IMFile>(new IMFile(link, state));
}

boost::shared_ptr<IMFile> IMFile::create(const boost::shared_ptr<const Source>& source, int stream,
                                         VelaTime start, VelaTime duration) {
    return createStill<IMFile>(source, stream, start, duration);
}

boost::shared_ptr<Media> IMFile::clone() const {
    const boost::shared_ptr<IMFile> copy = create(cloneLink(), state());
    copyContentInto(*copy);
    return copy;
}

void IMFile::dispatch(MediaDispatcher& dispatcher) { dispatcher.dispatchIMFile(*this); }
void IMFile::dispatch(ConstMediaDispatcher& dispatcher) const { dispatcher.dispatchIMFile(*this); }

} // namespace VelaMediaLib

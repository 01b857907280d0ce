#include <VelaMediaLib/model/media/VMFile.h>

#include <VelaMediaLib/model/media/MediaDispatcher.h>

namespace VelaMediaLib {

VMFile::VMFile(const SourceLink& link, const MediaState& initial, StreamFilter plays)
    : Media(tokenOf(link)), VisualMedia(tokenOf(link)),
      VisualMediaImpl(tokenOf(link), rateOf(link), initial, Temporal), FileMedia(link, plays) {}

boost::shared_ptr<VMFile> VMFile::create(const SourceLink& link, const MediaState& state) {
    return boost::shared_ptr<VMFile>(new VMFile(link, state));
}

boost::shared_ptr<VMFile> VMFile::create(const boost::shared_ptr<const Source>& source, int stream,
                                         VelaTime start) {
    return createWhole<VMFile>(source, stream, start);
}

boost::shared_ptr<VMFile> VMFile::create(const boost::shared_ptr<const Source>& source, int stream,
                                         VelaTime start, const SafeRational& mediaStart,
                                         const SafeRational& mediaDuration, const SafeRational& scalar) {
    return createSlice<VMFile>(source, stream, start, mediaStart, mediaDuration, scalar);
}

boost::shared_ptr<Media> VMFile::clone() const {
    const boost::shared_ptr<VMFile> copy = create(cloneLink(), state());
    copyContentInto(*copy);
    return copy;
}

void VMFile::mediaSourceChanged() { takeStreamLimits(*this); }
void VMFile::dispatch(MediaDispatcher& dispatcher) { dispatcher.dispatchVMFile(*this); }
void VMFile::dispatch(ConstMediaDispatcher& dispatcher) const { dispatcher.dispatchVMFile(*this); }

} // namespace VelaMediaLib

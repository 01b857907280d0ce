#include <VelaMediaLib/model/media/AMFile.h>

#include <VelaMediaLib/model/media/MediaDispatcher.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/Source.h>

namespace VelaMediaLib {

AMFile::AMFile(const SourceLink& link, const MediaState& initial)
    : Media(tokenOf(link)), AudioMedia(tokenOf(link)),
      AudioMediaImpl(tokenOf(link), rateOf(link), initial, Temporal), FileMedia(link, playsStream) {}

boost::shared_ptr<AMFile> AMFile::create(const SourceLink& link, const MediaState& state) {
    const boost::shared_ptr<AMFile> media(new AMFile(link, state));
    media->addAttribute<int>("channelNumber", allChannels);
    return media;
}

boost::shared_ptr<AMFile> AMFile::create(const boost::shared_ptr<const Source>& source, int stream,
                                         VelaTime start) {
    return createWhole<AMFile>(source, stream, start);
}

boost::shared_ptr<AMFile> AMFile::create(const boost::shared_ptr<const Source>& source, int stream,
                                         VelaTime start, const SafeRational& mediaStart,
                                         const SafeRational& mediaDuration, const SafeRational& scalar) {
    return createSlice<AMFile>(source, stream, start, mediaStart, mediaDuration, scalar);
}

void AMFile::setChannelNumber(int channel) {
    const boost::shared_ptr<const Source> playing = source();
    const int channels = playing ? playing->stats()->numChannels(streamIndex()) : 0;
    if (channel < allChannels || channel >= channels) throw IndexException("channel number out of range");
    addAttribute<int>("channelNumber", channel);
}

boost::shared_ptr<Media> AMFile::clone() const {
    const boost::shared_ptr<AMFile> copy = create(cloneLink(), state());
    copyContentInto(*copy);
    return copy;
}

void AMFile::dispatch(MediaDispatcher& dispatcher) { dispatcher.dispatchAMFile(*this); }
void AMFile::dispatch(ConstMediaDispatcher& dispatcher) const { dispatcher.dispatchAMFile(*this); }

} // namespace VelaMediaLib

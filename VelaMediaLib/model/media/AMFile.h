#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/AudioMediaImpl.h>
#include <VelaMediaLib/model/media/FileMedia.h>

namespace VelaMediaLib {

/// A clip that plays an audio stream of a source, within the stream's
/// range. "channelNumber" picks one channel of the stream (0 is the first);
/// -1, the default, plays them all. Gain, mixing to mono, loudness
/// normalisation and the source file offset are the audio clips' attributes.
class VELAMEDIALIB_API AMFile : public AudioMediaImpl, public FileMedia {
public:
    static constexpr int allChannels = -1;

    /// The whole stream at normal speed, from start on the track.
    static boost::shared_ptr<AMFile> create(const boost::shared_ptr<const Source>& source, int stream,
                                            VelaTime start);
    /// A slice of the stream at the scalar; see FileMedia::stateFor for what it refuses.
    static boost::shared_ptr<AMFile> create(const boost::shared_ptr<const Source>& source, int stream,
                                            VelaTime start, const SafeRational& mediaStart,
                                            const SafeRational& mediaDuration,
                                            const SafeRational& scalar = SafeRational(1));
    static boost::shared_ptr<AMFile> create(const SourceLink& link, const MediaState& state);
    static bool playsStream(TrackType type) { return type == TrackType::Audio; }

    int channelNumber() const { return attributeValue<int>("channelNumber", allChannels); }
    /// Throws IndexException "channel number out of range" for a channel the
    /// stream does not have, changing nothing.
    void setChannelNumber(int channel);

    boost::shared_ptr<Media> clone() const override;
    void dispatch(MediaDispatcher& dispatcher) override;
    void dispatch(ConstMediaDispatcher& dispatcher) const override;
    void mediaSourceChanged() override { takeStreamLimits(*this); }

protected:
    /// After every edit the limits are the stream's as it is now, widened to
    /// the slice played: an undone edit finds the stream at the project's
    /// present rate, and undoing gives back the limits the clip had.
    MediaState editedLimits(const MediaState& edited) const override { return withOwnStreamLimits(edited); }

private:
    AMFile(const SourceLink& link, const MediaState& initial);
};

} // namespace VelaMediaLib

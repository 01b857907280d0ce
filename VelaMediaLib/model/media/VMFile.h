#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/FileMedia.h>
#include <VelaMediaLib/model/media/VisualMediaImpl.h>

namespace VelaMediaLib {

/// A clip that plays a video stream of a source. The stream's range gives
/// its limits: it can be trimmed out to the ends of the stream, not beyond.
class VELAMEDIALIB_API VMFile : public VisualMediaImpl, public FileMedia {
public:
    /// The whole stream at normal speed, from start on the track.
    static boost::shared_ptr<VMFile> create(const boost::shared_ptr<const Source>& source, int stream,
                                            VelaTime start);
    /// A slice of the stream (ticks of the source's edit rate) at the scalar;
    /// see FileMedia::stateFor for what it refuses.
    static boost::shared_ptr<VMFile> create(const boost::shared_ptr<const Source>& source, int stream,
                                            VelaTime start, const SafeRational& mediaStart,
                                            const SafeRational& mediaDuration,
                                            const SafeRational& scalar = SafeRational(1));
    /// A clip of the link's stream with a state already checked (sources and documents).
    static boost::shared_ptr<VMFile> create(const SourceLink& link, const MediaState& state);
    /// The stream kinds a video clip plays.
    static bool playsStream(TrackType type) {
        return type == TrackType::Video || type == TrackType::ScreenVideo;
    }

    boost::shared_ptr<Media> clone() const override;
    void dispatch(MediaDispatcher& dispatcher) override;
    void dispatch(ConstMediaDispatcher& dispatcher) const override;
    void mediaSourceChanged() override;

protected:
    /// After every edit the limits are the stream's as it is now, widened to
    /// the slice played: an undone edit finds the stream at the project's
    /// present rate, and undoing gives back the limits the clip had.
    MediaState editedLimits(const MediaState& edited) const override { return withOwnStreamLimits(edited); }
    VMFile(const SourceLink& link, const MediaState& initial, StreamFilter plays = playsStream);
};

} // namespace VelaMediaLib

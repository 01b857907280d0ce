#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/AbstractIMFile.h>

namespace VelaMediaLib {

/// A clip that shows a still image of a source.
class VELAMEDIALIB_API IMFile : public AbstractIMFile {
public:
    /// The still from start for duration ticks; see AbstractIMFile::stillState.
    static boost::shared_ptr<IMFile> create(const boost::shared_ptr<const Source>& source, int stream,
                                            VelaTime start, VelaTime duration);
    static boost::shared_ptr<IMFile> create(const SourceLink& link, const MediaState& state);
    static bool playsStream(TrackType type) {
        return type == TrackType::Image || type == TrackType::ScreenImage;
    }

    boost::shared_ptr<Media> clone() const override;
    void dispatch(MediaDispatcher& dispatcher) override;
    void dispatch(ConstMediaDispatcher& dispatcher) const override;

private:
    IMFile(const SourceLink& link, const MediaState& initial)
        : Media(tokenOf(link)), VisualMedia(tokenOf(link)), AbstractIMFile(link, initial, playsStream) {}
};

} // namespace VelaMediaLib

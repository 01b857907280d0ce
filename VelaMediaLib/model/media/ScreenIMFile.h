#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/AbstractIMFile.h>
#include <VelaMediaLib/model/media/ScreenDataProvider.h>

namespace VelaMediaLib {

/// A still frame of a screen recording, with the recording's cursor, click
/// and keystroke data (given by the host, shared by clones).
class VELAMEDIALIB_API ScreenIMFile : public AbstractIMFile, public ScreenDataHolder {
public:
    /// "screenData" (see ScreenRecordingData::toJSON), when the clip has any.
    void toJSONSpecificProperties(XMLOptions& options, int indent) const override {
        writeScreenData(options, indent, *this);
    }
    /// The still from start for duration ticks; see AbstractIMFile::stillState.
    static boost::shared_ptr<ScreenIMFile> create(const boost::shared_ptr<const Source>& source, int stream,
                                                  VelaTime start, VelaTime duration);
    static boost::shared_ptr<ScreenIMFile> create(const SourceLink& link, const MediaState& state);
    static bool playsStream(TrackType type) { return type == TrackType::ScreenImage; }

    boost::shared_ptr<Media> clone() const override;
    void dispatch(MediaDispatcher& dispatcher) override;
    void dispatch(ConstMediaDispatcher& dispatcher) const override;

private:
    ScreenIMFile(const SourceLink& link, const MediaState& initial)
        : Media(tokenOf(link)), VisualMedia(tokenOf(link)), AbstractIMFile(link, initial, playsStream),
          ScreenDataHolder(tokenOf(link)) {}
};

} // namespace VelaMediaLib

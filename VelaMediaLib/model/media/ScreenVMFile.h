#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/ScreenDataProvider.h>
#include <VelaMediaLib/model/media/VMFile.h>

namespace VelaMediaLib {

/// A clip that plays a screen recording: a video clip that also answers the
/// cursor, click and keystroke questions from the recording's data, which
/// the host gives it (setScreenData) and its clones share.
class VELAMEDIALIB_API ScreenVMFile : public VMFile, public ScreenDataHolder {
public:
    /// "screenData" (see ScreenRecordingData::toJSON), when the clip has any.
    void toJSONSpecificProperties(XMLOptions& options, int indent) const override {
        writeScreenData(options, indent, *this);
    }
    static boost::shared_ptr<ScreenVMFile> create(const boost::shared_ptr<const Source>& source, int stream,
                                                  VelaTime start);
    static boost::shared_ptr<ScreenVMFile> create(const boost::shared_ptr<const Source>& source, int stream,
                                                  VelaTime start, const SafeRational& mediaStart,
                                                  const SafeRational& mediaDuration,
                                                  const SafeRational& scalar = SafeRational(1));
    static boost::shared_ptr<ScreenVMFile> create(const SourceLink& link, const MediaState& state);
    static bool playsStream(TrackType type) { return type == TrackType::ScreenVideo; }

    boost::shared_ptr<Media> clone() const override;
    void dispatch(MediaDispatcher& dispatcher) override;
    void dispatch(ConstMediaDispatcher& dispatcher) const override;

private:
    ScreenVMFile(const SourceLink& link, const MediaState& initial)
        : Media(tokenOf(link)), VisualMedia(tokenOf(link)), VMFile(link, initial, playsStream),
          ScreenDataHolder(tokenOf(link)) {}
};

} // namespace VelaMediaLib

#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/FileMedia.h>
#include <VelaMediaLib/model/media/VisualMediaImpl.h>

namespace VelaMediaLib {

/// What the still-image kinds share: a clip that shows one picture stream of
/// a source for as long as it stands on its track. A still has no media
/// extent: its static editor changes only the track range, without limit.
class VELAMEDIALIB_API AbstractIMFile : public VisualMediaImpl, public FileMedia {
public:
    /// The state of a still shown from start for duration ticks. Throws as
    /// FileMedia::stateFor does, and ValueException<const SafeRational>
    /// "invalid duration after media stretch (<=0)" for a duration of 0 or less.
    static MediaState stillState(const SourceLink& link, StreamFilter plays, VelaTime start,
                                 VelaTime duration);

protected:
    /// A still of the kind (the kinds' create functions).
    template <typename Kind>
    static boost::shared_ptr<Kind> createStill(const boost::shared_ptr<const Source>& source, int stream,
                                               VelaTime start, VelaTime duration) {
        const SourceLink link = SourceLink::holding(source, stream);
        return Kind::create(link, stillState(link, Kind::playsStream, start, duration));
    }
    AbstractIMFile(const SourceLink& link, const MediaState& initial, StreamFilter plays)
        : Media(tokenOf(link)), VisualMedia(tokenOf(link)),
          VisualMediaImpl(tokenOf(link), rateOf(link), initial, Static), FileMedia(link, plays) {}
};

} // namespace VelaMediaLib
